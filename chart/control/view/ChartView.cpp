#include "chart/control/view/ChartView.h"

#include <QHelpEvent>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QPainter>
#include <QPointer>
#include <QResizeEvent>
#include <QRubberBand>
#include <QToolTip>
#include <QWheelEvent>

#include "chart/control/render/ChartLayout.h"
#include "chart/control/render/ChartPainter.h"
#include "chart/control/view/ChartHitTest.h"

namespace kg::control {

namespace {
Ref<ChartControl> orNewChart(Ref<ChartControl> chart) { return chart ? std::move(chart) : makeRef<ChartControl>(); }
}  // namespace

ChartView::ChartView(Ref<ChartControl> chart, QWidget* parent)
    : QWidget(parent), chart_(orNewChart(std::move(chart))), interaction_(*chart_)
{
    // The painter covers every pixel, so Qt need not clear the background first.
    setAttribute(Qt::WA_OpaquePaintEvent);
    // The "r" and Escape keys need the focus; the right button belongs to the gestures.
    setFocusPolicy(Qt::StrongFocus);
    setContextMenuPolicy(Qt::PreventContextMenu);
    band_ = new QRubberBand(QRubberBand::Rectangle, this);
    band_->hide();
    interaction_.setTarget(QRectF(rect()));
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
    interaction_.setTarget(QRectF(QPointF(0, 0), QSizeF(event->size())));
    QWidget::resizeEvent(event);
}

QString ChartView::toolTipAt(QPointF pos) const
{
    const ChartLayout layout = computeLayout(*chart_, QRectF(rect()));
    const std::optional<ChartHit> hit = hitTest(*chart_, layout, pos);
    return hit ? hitText(*chart_, *hit) : QString();
}

bool ChartView::event(QEvent* event)
{
    if (event->type() != QEvent::ToolTip) return QWidget::event(event);
    auto* help = static_cast<QHelpEvent*>(event);
    // No tip while a gesture is under way: it would cover what the gesture changes.
    const QString text = interaction_.gesture() == Gesture::None ? toolTipAt(help->pos()) : QString();
    if (text.isEmpty()) {
        QToolTip::hideText();
        event->ignore();
    } else {
        QToolTip::showText(help->globalPos(), text, this);
    }
    return true;
}

void ChartView::mousePressEvent(QMouseEvent* event)
{
    if (interaction_.press(event->position(), event->buttons(), event->modifiers())) {
        QToolTip::hideText();
        event->accept();
    } else {
        event->ignore();
    }
    showSelection();
}

void ChartView::mouseMoveEvent(QMouseEvent* event)
{
    if (interaction_.move(event->position()))
        event->accept();
    else
        event->ignore();
    showSelection();
}

void ChartView::mouseReleaseEvent(QMouseEvent* event)
{
    if (interaction_.release(event->position(), event->buttons()))
        event->accept();
    else
        event->ignore();
    showSelection();
}

void ChartView::wheelEvent(QWheelEvent* event)
{
    if (interaction_.wheel(event->position(), event->angleDelta().y(), event->modifiers()))
        event->accept();
    else
        event->ignore();
}

void ChartView::keyPressEvent(QKeyEvent* event)
{
    const bool used = interaction_.keyPress(event->key(), event->modifiers());
    showSelection();
    if (used)
        event->accept();
    else
        QWidget::keyPressEvent(event);
}

void ChartView::showSelection()
{
    const Gesture g = interaction_.gesture();
    if (g != Gesture::GraphicsZoom && g != Gesture::AxisZoom) {
        band_->hide();
        return;
    }
    band_->setGeometry(interaction_.selection().toAlignedRect());
    band_->show();
}

}  // namespace kg::control
