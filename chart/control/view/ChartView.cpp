#include "chart/control/view/ChartView.h"

#include <QPainter>
#include <QPointer>
#include <QResizeEvent>

#include "chart/control/render/ChartPainter.h"

namespace kg::control {

ChartView::ChartView(Ref<ChartControl> chart, QWidget* parent) : QWidget(parent), chart_(std::move(chart))
{
    if (!chart_) chart_ = makeRef<ChartControl>();
    // The painter covers every pixel, so Qt need not clear the background first.
    setAttribute(Qt::WA_OpaquePaintEvent);
    QPointer<ChartView> self(this);
    chart_->setChangeListener([self] {
        if (self) self->update();
    });
}

ChartView::~ChartView()
{
    chart_->setChangeListener(nullptr);
    chart_->shownWidth = chart_->shownHeight = 0;
}

// The chart window's first inner size, 6756 x 3732 twips at 15 twips a pixel.
QSize ChartView::sizeHint() const { return {450, 249}; }
QSize ChartView::minimumSizeHint() const { return {120, 90}; }

void ChartView::paintEvent(QPaintEvent*)
{
    QPainter painter(this);
    paintChart(*chart_, painter, QRectF(rect()));
}

void ChartView::resizeEvent(QResizeEvent* event)
{
    chart_->shownWidth = event->size().width();
    chart_->shownHeight = event->size().height();
    QWidget::resizeEvent(event);
}

}  // namespace kg::control
