#pragma once
// The chart control's window part: a widget that shows the model through the one chart painter,
// repaints when the model announces a change (once per batch), and passes the mouse and the keys
// to the chart's interactions (ChartInteraction: scale, move, zoom, rotate, reset) and its tips.
//
//   auto chart = kg::makeRef<kg::control::ChartControl>();
//   kg::control::ChartView view(chart);
//   view.show();
#include <QWidget>

#include "chart/control/model/ChartControl.h"
#include "chart/control/view/ChartInteraction.h"
#include "core/Ref.h"

class QRubberBand;

namespace kg::control {

class ChartView : public QWidget {
    Q_OBJECT
public:
    explicit ChartView(Ref<ChartControl> chart, QWidget* parent = nullptr);
    ~ChartView() override;

    ChartControl& chart() const { return *chart_; }
    const ChartInteraction& interaction() const { return interaction_; }
    QSize sizeHint() const override;
    QSize minimumSizeHint() const override;

    // The tip shown when the mouse rests at `pos`; empty where no data point is drawn.
    QString toolTipAt(QPointF pos) const;
    // The zoom selection's marker, shown while a zoom selection is in progress.
    const QRubberBand* selectionMarker() const { return band_; }

protected:
    bool event(QEvent* event) override;
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void wheelEvent(QWheelEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;

private:
    void showSelection();

    Ref<ChartControl> chart_;
    ChartInteraction interaction_;
    QRubberBand* band_ = nullptr;
};

}  // namespace kg::control
