// Plot area, grid and axes of the bar, plot and area charts.
#include <QPainter>
#include <QPolygonF>
#include <cmath>

#include "chart/control/render/Colors.h"
#include "chart/control/render/PaintContext.h"

namespace kg::control {

namespace {
constexpr double kTickMark = 4;
constexpr double kTickGap = 3;
const QColor kAxisColor(0x40, 0x40, 0x40);
const QColor kGridColor(0, 0, 0, 45);

QPolygonF quad(QPointF a, QPointF b, QPointF c, QPointF d) { return QPolygonF({a, b, c, d}); }

// The back plane, and in 3-D the side wall and floor that join it to the front plane.
void paintPlotArea(const PaintContext& ctx)
{
    QPainter& p = ctx.painter;
    const QRectF front = ctx.layout.plotArea;
    const QPointF d = ctx.layout.depth;
    const QRectF back = front.translated(d);
    const bool flat = d.isNull();
    const PlotArea& area = ctx.chart.chartArea.plotArea;
    const QColor fill = area.isShown ? toQColor(area.backgroundColor) : QColor();
    p.setPen(Qt::NoPen);
    if (fill.isValid()) p.fillRect(back, fill);
    if (flat) {
        p.setPen(ctx.thinPen(kAxisColor));
        p.setBrush(Qt::NoBrush);
        p.drawRect(front);
        return;
    }
    const QColor wall = fill.isValid() ? fill.darker(112) : QColor(0, 0, 0, 25);
    const QColor floor = fill.isValid() ? fill.darker(125) : QColor(0, 0, 0, 40);
    // The wall on the side the back plane moved away from, and the floor (or ceiling).
    const QPolygonF side = d.x() >= 0
                               ? quad(front.topLeft(), back.topLeft(), back.bottomLeft(), front.bottomLeft())
                               : quad(front.topRight(), back.topRight(), back.bottomRight(), front.bottomRight());
    const QPolygonF base = d.y() <= 0
                               ? quad(front.bottomLeft(), back.bottomLeft(), back.bottomRight(), front.bottomRight())
                               : quad(front.topLeft(), back.topLeft(), back.topRight(), front.topRight());
    p.setBrush(wall);
    p.drawPolygon(side);
    p.setBrush(floor);
    p.drawPolygon(base);
    p.setBrush(Qt::NoBrush);
    p.setPen(ctx.thinPen(kAxisColor));
    p.drawRect(back);
    p.drawPolygon(side);
    p.drawPolygon(base);
}

void paintGrid(const PaintContext& ctx)
{
    QPainter& p = ctx.painter;
    const ChartLayout& L = ctx.layout;
    const QRectF front = L.plotArea;
    const QPointF d = L.depth;
    const double sideX = d.x() >= 0 ? front.left() : front.right();
    p.setPen(ctx.thinPen(kGridColor));
    for (const AxisLabel& t : L.yLabels) {
        const double y = L.mapping.yPixel(t.value);
        if (y < front.top() - 0.5 || y > front.bottom() + 0.5) continue;
        p.drawLine(QPointF(front.left() + d.x(), y + d.y()), QPointF(front.right() + d.x(), y + d.y()));
        if (!d.isNull()) p.drawLine(QPointF(sideX, y), QPointF(sideX + d.x(), y + d.y()));
    }
    // The zero line stands out when the scale runs through it.
    if (L.mapping.yMin < 0 && L.mapping.yMax > 0) {
        const double y = L.mapping.yPixel(0);
        p.setPen(ctx.thinPen(kAxisColor));
        p.drawLine(QPointF(front.left() + d.x(), y + d.y()), QPointF(front.right() + d.x(), y + d.y()));
        if (!d.isNull()) p.drawLine(QPointF(sideX, y), QPointF(sideX + d.x(), y + d.y()));
    }
}

void paintYAxis(const PaintContext& ctx)
{
    QPainter& p = ctx.painter;
    const ChartLayout& L = ctx.layout;
    const QRectF front = L.plotArea;
    const double axisX = std::min(front.left(), front.left() + L.depth.x());
    const MeasuredFont& f = ctx.fonts.tick;
    p.setPen(ctx.thinPen(kAxisColor));
    for (const AxisLabel& t : L.yLabels) {
        const double y = L.mapping.yPixel(t.value);
        if (y < front.top() - 0.5 || y > front.bottom() + 0.5) continue;
        p.drawLine(QPointF(axisX - kTickMark, y), QPointF(axisX, y));
    }
    p.setPen(Qt::black);
    for (const AxisLabel& t : L.yLabels) {
        const double y = L.mapping.yPixel(t.value);
        if (y < front.top() - 0.5 || y > front.bottom() + 0.5) continue;
        drawTextAt(p, f, axisX - kTickMark - kTickGap - f.width(t.text), y - f.height / 2, t.text);
    }
    if (!L.yTitle.isEmpty()) {
        const QString title = displayText(ctx.chart.chartArea.y.title);
        const MeasuredFont& tf = ctx.fonts.axisTitle;
        if (ctx.chart.chartArea.y.presentationCode == kTitleRotatedUp) {
            // Turned to read upwards, centred along the axis.
            p.save();
            p.translate(L.yTitle.center());
            p.rotate(-90);
            drawTextCentred(p, tf, QRectF(-L.yTitle.height() / 2, -tf.height / 2, L.yTitle.height(), tf.height), title);
            p.restore();
        } else {
            drawTextAt(p, tf, L.yTitle.left(), L.yTitle.top(), title);
        }
    }
}

void paintXAxis(const PaintContext& ctx)
{
    QPainter& p = ctx.painter;
    const ChartLayout& L = ctx.layout;
    const QRectF front = L.plotArea;
    const double axisY = std::max(front.bottom(), front.bottom() + L.depth.y());
    const MeasuredFont& f = ctx.fonts.tick;
    p.setPen(ctx.thinPen(kAxisColor));
    for (const AxisLabel& t : L.xLabels) {
        const double x = L.mapping.xPixel(t.value);
        p.drawLine(QPointF(x, axisY), QPointF(x, axisY + kTickMark));
    }
    p.setPen(Qt::black);
    const double top = axisY + kTickMark + kTickGap;
    for (const AxisLabel& t : L.xLabels) {
        const double x = L.mapping.xPixel(t.value);
        if (L.xLabelsRotated) {
            // Turned 45 degrees, ending at the tick and reading upwards to the right.
            p.save();
            p.translate(x, top);
            p.rotate(-45);
            drawTextAt(p, f, -f.width(t.text) - 2, -f.height / 2, t.text);
            p.restore();
        } else {
            drawTextAt(p, f, x - f.width(t.text) / 2, top, t.text);
        }
    }
    if (!L.xTitle.isEmpty())
        drawTextCentred(p, ctx.fonts.axisTitle, L.xTitle, displayText(ctx.chart.chartArea.x.title));
}
}  // namespace

void paintAxes(const PaintContext& ctx)
{
    paintPlotArea(ctx);
    paintGrid(ctx);
    paintYAxis(ctx);
    paintXAxis(ctx);
}

}  // namespace kg::control
