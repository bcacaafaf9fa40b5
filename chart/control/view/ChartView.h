#pragma once
// The chart control's window part: a widget that shows the model through the one chart painter
// and repaints when the model announces a change (once per batch).
//
//   auto chart = kg::makeRef<kg::control::ChartControl>();
//   kg::control::ChartView view(chart);
//   view.show();
#include <QWidget>

#include "chart/control/model/ChartControl.h"
#include "core/Ref.h"

namespace kg::control {

class ChartView : public QWidget {
    Q_OBJECT
public:
    explicit ChartView(Ref<ChartControl> chart, QWidget* parent = nullptr);
    ~ChartView() override;

    ChartControl& chart() const { return *chart_; }
    QSize sizeHint() const override;
    QSize minimumSizeHint() const override;

protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;

private:
    Ref<ChartControl> chart_;
};

}  // namespace kg::control
