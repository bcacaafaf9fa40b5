// Clustered bars, one colour per series; boxes with a top and a side face in 3-D.
#include <QPainter>
#include <QPolygonF>
#include <cmath>

#include "chart/control/render/Colors.h"
#include "chart/control/render/PaintContext.h"

namespace kg::control {

namespace {
constexpr double kOutlineFrom = 4;  // bars narrower than this get no outline
constexpr double kFacesFrom = 2;    // nor 3-D faces, which would not show

// The part of the bars' room that the view shows (all of it unless scaled, moved or zoomed), in
// the chart's own coordinates: a bar outside it would cost its rasterising and show nothing.
QRectF shownPart(const ChartLayout& L)
{
    const QRectF room = L.seriesArea();
    if (L.view.isIdentity()) return room;
    bool invertible = false;
    const QTransform back = L.view.inverted(&invertible);
    return invertible ? room.intersected(back.mapRect(L.chartContent)) : room;
}

void fillBox(QPainter& p, const QRectF& front, const QPolygonF& top, const QPolygonF& side, const QColor& color)
{
    p.setPen(Qt::NoPen);
    p.setBrush(topShade(color));
    p.drawPolygon(top);
    p.setBrush(sideShade(color));
    p.drawPolygon(side);
    p.setBrush(color);
    p.drawRect(front);
}

void paintBox(const PaintContext& ctx, const QRectF& r, const QColor& color, bool outline)
{
    QPainter& p = ctx.painter;
    const auto [top, side] = ctx.layout.barFaces(r);
    if (!outline) {
        fillBox(p, r, top, side, color);
        return;
    }
    // Antialiasing large slanted faces is the slowest part of a bar chart (four times a plain
    // fill): the faces are filled without it, and their antialiased outlines cover the steps.
    const bool smooth = p.testRenderHint(QPainter::Antialiasing);
    p.setRenderHint(QPainter::Antialiasing, false);
    fillBox(p, r, top, side, color);
    p.setRenderHint(QPainter::Antialiasing, smooth);
    p.setPen(ctx.thinPen(color.darker(170), 0.75));
    p.setBrush(Qt::NoBrush);
    p.drawPolygon(top);
    p.drawPolygon(side);
    p.drawRect(r);
}
}  // namespace

void paintBars(const PaintContext& ctx)
{
    const ChartLayout& L = ctx.layout;
    const ChartData& data = ctx.chart.data();
    QPainter& p = ctx.painter;
    p.save();
    p.setClipRect(L.seriesArea(), Qt::IntersectClip);
    const bool flat = L.depth.isNull();
    const bool outline = L.barWidth >= kOutlineFrom;
    const bool faces = L.barWidth >= kFacesFrom;
    const int32_t seriesCount = data.seriesCount();
    const int32_t points = int32_t(L.xPositions.size());
    const QRectF shown = shownPart(L);
    // Outlines and antialiased edges reach a little past a bar's box (and a bar of 0 is a line).
    const double edge = 2 / std::max(1e-9, std::sqrt(std::fabs(L.view.determinant())));
    // In 3-D, bars further from the viewer are drawn first so that nearer faces cover them.
    const bool leftToRight = L.depth.x() >= 0;
    for (int32_t i = 0; i < points; ++i) {
        const int32_t point = leftToRight ? i + 1 : points - i;
        const double x = L.mapping.xPixel(L.xOf(point));
        if (x + L.clusterWidth < L.plotArea.left() - std::fabs(L.depth.x()) ||
            x - L.clusterWidth > L.plotArea.right() + std::fabs(L.depth.x()))
            continue;
        for (int32_t j = 0; j < seriesCount; ++j) {
            const int32_t series = leftToRight ? j + 1 : seriesCount - j;
            const QRectF r = L.barRect(ctx.chart, series, point);
            if (r.isNull()) continue;
            if (!r.united(r.translated(L.barDepth)).adjusted(-edge, -edge, edge, edge).intersects(shown)) continue;
            const QColor color = seriesColor(series);
            if (!flat && faces) {
                paintBox(ctx, r, color, outline);
            } else if (outline) {
                p.setPen(ctx.thinPen(color.darker(170), 0.75));
                p.setBrush(color);
                p.drawRect(r);
            } else {
                p.fillRect(r, color);  // thin bars: the quickest fill, no outline to see
            }
        }
    }
    p.restore();
}

std::optional<LabelAnchor> barAnchor(const PaintContext& ctx, int32_t series, int32_t point)
{
    const ChartData& data = ctx.chart.data();
    const QRectF r = ctx.layout.barRect(ctx.chart, series, point);
    if (r.isNull()) return std::nullopt;
    const double value = data.ys(series)[size_t(point - 1)];
    const bool up = value >= 0;
    QPointF at(r.center().x(), up ? r.top() : r.bottom());
    // On a 3-D bar the label points at the middle of the top face.
    if ((up && ctx.layout.depth.y() <= 0) || (!up && ctx.layout.depth.y() > 0)) at += ctx.layout.barDepth / 2;
    return LabelAnchor{at, QPointF(0, up ? -1 : 1)};
}

}  // namespace kg::control
