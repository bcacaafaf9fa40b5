// Pie chart: one slice per series (its first point), clockwise from the top; in 3-D a tilted
// disc whose front rim shows the depth.
#include <QPainter>
#include <QPainterPath>
#include <cmath>

#include "chart/control/render/Colors.h"
#include "chart/control/render/PaintContext.h"

namespace kg::control {

namespace {
constexpr double kPi = 3.14159265358979323846;
double radians(double degrees) { return degrees * kPi / 180; }

QPointF onEllipse(const PieGeometry& pie, double degrees, double drop = 0)
{
    return {pie.centre.x() + pie.rx * std::cos(radians(degrees)),
            pie.centre.y() - pie.ry * std::sin(radians(degrees)) + drop};
}

QRectF topFace(const PieGeometry& pie)
{
    return QRectF(pie.centre.x() - pie.rx, pie.centre.y() - pie.ry, 2 * pie.rx, 2 * pie.ry);
}

// The part of a slice's rim that faces the viewer: the lower half of the disc (180 to 360 degrees).
void paintRim(QPainter& p, const PieGeometry& pie, const PieSlice& slice, const QColor& color)
{
    const double lo = slice.startAngle + slice.spanAngle, hi = slice.startAngle;
    const QRectF top = topFace(pie), bottom = top.translated(0, pie.rim);
    for (int k = -2; k <= 2; ++k) {
        const double a = std::max(lo, 180.0 + 360.0 * k), b = std::min(hi, 360.0 + 360.0 * k);
        if (b <= a) continue;
        QPainterPath path(onEllipse(pie, a));
        path.arcTo(top, a, b - a);
        path.lineTo(onEllipse(pie, b, pie.rim));
        path.arcTo(bottom, b, a - b);
        path.closeSubpath();
        p.setBrush(sideShade(color));
        p.drawPath(path);
    }
}
}  // namespace

void paintPie(const PaintContext& ctx)
{
    QPainter& p = ctx.painter;
    const PieGeometry& pie = ctx.layout.pie;
    if (pie.slices.empty()) {
        // Nothing to share out: the empty disc's outline.
        p.setPen(ctx.thinPen(QColor(0x80, 0x80, 0x80)));
        p.setBrush(Qt::NoBrush);
        p.drawEllipse(topFace(pie));
        return;
    }
    const QPen edge = ctx.thinPen(QColor(0x30, 0x30, 0x30, 170), 0.75);
    p.setPen(edge);
    if (pie.rim > 0) {
        for (const PieSlice& s : pie.slices) paintRim(p, pie, s, seriesColor(s.series));
    }
    for (const PieSlice& s : pie.slices) {
        QPainterPath path(pie.centre);
        path.arcTo(topFace(pie), s.startAngle, s.spanAngle);
        path.closeSubpath();
        p.setBrush(seriesColor(s.series));
        p.drawPath(path);
    }
}

std::optional<LabelAnchor> pieAnchor(const PaintContext& ctx, int32_t series, int32_t point)
{
    if (point != 1) return std::nullopt;
    const PieGeometry& pie = ctx.layout.pie;
    for (const PieSlice& s : pie.slices) {
        if (s.series != series) continue;
        const double a = radians(s.midAngle());
        const QPointF dir(std::cos(a), -std::sin(a));
        // A point on the front half of the disc sits on the rim's lower edge.
        const double drop = dir.y() > 0 ? pie.rim : 0;
        return LabelAnchor{onEllipse(pie, s.midAngle(), drop), dir};
    }
    return std::nullopt;
}

}  // namespace kg::control
