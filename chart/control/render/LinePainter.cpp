// Plot and area charts: each series one polyline (a polygon when filled), so that large series
// stay on the painter's fast path for thin lines.
#include <QPainter>
#include <QPolygonF>
#include <algorithm>
#include <cmath>

#include "chart/control/render/Colors.h"
#include "chart/control/render/PaintContext.h"

namespace kg::control {

namespace {
constexpr int32_t kMostMarkedPoints = 50;  // more points than this per series: no markers
constexpr int32_t kThickLineUpTo = 200;    // short series get a slightly stronger line
constexpr double kMarkerSize = 6;
constexpr int kAreaAlpha = 140;

// The runs of finite values of a series as pixel polylines (a missing value breaks the line).
std::vector<QPolygonF> seriesRuns(const PaintContext& ctx, int32_t series)
{
    const ChartLayout& L = ctx.layout;
    const std::vector<double>& ys = ctx.chart.data().ys(series);
    const size_t n = std::min(ys.size(), L.xPositions.size());
    std::vector<QPolygonF> runs(1);
    runs.back().reserve(qsizetype(n));
    for (size_t i = 0; i < n; ++i) {
        if (!std::isfinite(ys[i])) {
            if (!runs.back().isEmpty()) runs.emplace_back();
            continue;
        }
        runs.back().append(QPointF(L.mapping.xPixel(L.xPositions[i]), L.mapping.yPixel(ys[i])));
    }
    if (runs.back().isEmpty()) runs.pop_back();
    return runs;
}

double lineWidthOf(const PaintContext& ctx, int32_t series, int32_t points)
{
    const std::vector<SeriesStyle>& styles = ctx.chart.group1.seriesStyles;
    if (size_t(series) <= styles.size() && styles[size_t(series - 1)].lineWidth > 0)
        return std::min(styles[size_t(series - 1)].lineWidth, 20);
    return points <= kThickLineUpTo ? 2 : 1;
}

void paintMarker(QPainter& p, QPointF c, int shape)
{
    const double h = kMarkerSize / 2;
    switch (shape % 4) {
    case 0: p.drawEllipse(c, h, h); break;
    case 1: p.drawRect(QRectF(c.x() - h, c.y() - h, kMarkerSize, kMarkerSize)); break;
    case 2:
        p.drawPolygon(
            QPolygonF({c + QPointF(0, -h - 1), c + QPointF(h + 1, 0), c + QPointF(0, h + 1), c + QPointF(-h - 1, 0)}));
        break;
    default: p.drawPolygon(QPolygonF({c + QPointF(0, -h - 1), c + QPointF(h + 1, h), c + QPointF(-h - 1, h)})); break;
    }
}

// Larger series first, so that an area hides as little of the others as it can.
std::vector<int32_t> backToFront(const ChartData& data)
{
    std::vector<int32_t> order(size_t(std::max(0, data.seriesCount())));
    std::vector<double> mean(order.size(), 0);
    for (size_t i = 0; i < order.size(); ++i) {
        order[i] = int32_t(i + 1);
        double sum = 0;
        size_t count = 0;
        for (double v : data.ys(int32_t(i + 1))) {
            if (std::isfinite(v)) {
                sum += std::fabs(v);
                ++count;
            }
        }
        mean[i] = count ? sum / double(count) : 0;
    }
    std::stable_sort(order.begin(), order.end(),
                     [&](int32_t a, int32_t b) { return mean[size_t(a - 1)] > mean[size_t(b - 1)]; });
    return order;
}
}  // namespace

void paintLines(const PaintContext& ctx, bool filled)
{
    const ChartLayout& L = ctx.layout;
    const ChartData& data = ctx.chart.data();
    QPainter& p = ctx.painter;
    p.save();
    p.setClipRect(L.seriesArea(), Qt::IntersectClip);
    const QPointF d = L.depth;
    const double base = L.mapping.yPixel(std::clamp(0.0, L.mapping.yMin, L.mapping.yMax));
    if (filled) {
        // All fills first, back to front, then every outline on top, so that each series'
        // profile stays visible where the areas overlap.
        const std::vector<int32_t> order = backToFront(data);
        for (int32_t series : order) {
            const QColor color = seriesColor(series);
            for (const QPolygonF& run : seriesRuns(ctx, series)) {
                QPolygonF area = run;
                area.prepend(QPointF(run.front().x(), base));
                area.append(QPointF(run.back().x(), base));
                p.setPen(Qt::NoPen);
                if (!d.isNull()) {
                    QColor back = sideShade(color);
                    back.setAlpha(kAreaAlpha);
                    p.setBrush(back);
                    p.drawPolygon(area.translated(d));
                }
                QColor face = color;
                face.setAlpha(kAreaAlpha);
                p.setBrush(face);
                p.drawPolygon(area);
            }
        }
        p.setBrush(Qt::NoBrush);
        for (int32_t series : order) {
            p.setPen(ctx.thinPen(seriesColor(series).darker(115), lineWidthOf(ctx, series, data.pointCount(series))));
            for (const QPolygonF& run : seriesRuns(ctx, series)) p.drawPolyline(run);
        }
        p.restore();
        return;
    }
    for (int32_t series = 1; series <= data.seriesCount(); ++series) {
        const int32_t points = data.pointCount(series);
        const QColor color = seriesColor(series);
        const std::vector<QPolygonF> runs = seriesRuns(ctx, series);
        const double width = lineWidthOf(ctx, series, points);
        for (const QPolygonF& run : runs) {
            if (!d.isNull()) {
                QColor shadow = sideShade(color);
                shadow.setAlpha(110);
                p.setPen(ctx.thinPen(shadow, width));
                p.drawPolyline(run.translated(d));
            }
            p.setPen(ctx.thinPen(color, width));
            p.drawPolyline(run);
        }
        if (points <= kMostMarkedPoints) {
            p.setPen(ctx.thinPen(color.darker(160), 1));
            p.setBrush(color);
            for (const QPolygonF& run : runs)
                for (const QPointF& pt : run) paintMarker(p, pt, int(series - 1));
        }
    }
    p.restore();
}

std::optional<LabelAnchor> lineAnchor(const PaintContext& ctx, int32_t series, int32_t point)
{
    const ChartData& data = ctx.chart.data();
    if (series < 1 || series > data.seriesCount() || point < 1 || point > data.pointCount(series)) return std::nullopt;
    if (size_t(point) > ctx.layout.xPositions.size()) return std::nullopt;
    const double value = data.ys(series)[size_t(point - 1)];
    if (!std::isfinite(value)) return std::nullopt;
    const QPointF at = ctx.layout.mapping.toPixel(ctx.layout.xOf(point), value);
    return LabelAnchor{at, QPointF(0, value >= 0 ? -1 : 1)};
}

}  // namespace kg::control
