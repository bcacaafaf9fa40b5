#include "chart/control/view/ChartHitTest.h"

#include <QPolygonF>
#include <QTransform>
#include <algorithm>
#include <cmath>

#include "chart/control/render/ChartText.h"
#include "core/Convert.h"

namespace kg::control {

namespace {
constexpr double kPi = 3.14159265358979323846;

// The faces of a 3-D bar beside its front face, as the bar painter draws them.
bool onBarFaces(const ChartLayout& L, const QRectF& r, QPointF p)
{
    if (L.barDepth.isNull()) return false;
    const auto [top, side] = L.barFaces(r);
    return top.containsPoint(p, Qt::OddEvenFill) || side.containsPoint(p, Qt::OddEvenFill);
}

// `p` in the chart's own coordinates (before scale and move). Nearer bars are drawn later, so
// they are tried first.
std::optional<ChartHit> hitBar(const ChartControl& chart, const ChartLayout& L, QPointF p)
{
    if (!L.seriesArea().contains(p)) return std::nullopt;
    const ChartData& data = chart.data();
    const int32_t seriesCount = data.seriesCount();
    const int32_t points = int32_t(L.xPositions.size());
    const bool leftToRight = L.depth.x() >= 0;
    for (int32_t i = points - 1; i >= 0; --i) {
        const int32_t point = leftToRight ? i + 1 : points - i;
        for (int32_t j = seriesCount - 1; j >= 0; --j) {
            const int32_t series = leftToRight ? j + 1 : seriesCount - j;
            const QRectF r = L.barRect(chart, series, point);
            if (r.isNull()) continue;
            if (r.contains(p) || onBarFaces(L, r, p)) return ChartHit{series, point, data.ys(series)[size_t(point - 1)]};
        }
    }
    return std::nullopt;
}

// The marker nearest to `screen` within the hit radius; later series are drawn over earlier ones.
std::optional<ChartHit> hitMarker(const ChartControl& chart, const ChartLayout& L, QPointF screen)
{
    const ChartData& data = chart.data();
    const QRectF shown = L.seriesArea().adjusted(-0.5, -0.5, 0.5, 0.5);
    std::optional<ChartHit> best;
    double bestDistance = kHitRadius;
    for (int32_t s = 1; s <= data.seriesCount(); ++s) {
        const std::vector<double>& ys = data.ys(s);
        const size_t n = std::min(ys.size(), L.xPositions.size());
        for (size_t i = 0; i < n; ++i) {
            if (!std::isfinite(ys[i])) continue;
            const QPointF at = L.mapping.toPixel(L.xPositions[i], ys[i]);
            if (!shown.contains(at)) continue;
            const QPointF d = L.view.map(at) - screen;
            const double distance = std::hypot(d.x(), d.y());
            if (distance <= bestDistance) {
                bestDistance = distance;
                best = ChartHit{s, int32_t(i + 1), ys[i]};
            }
        }
    }
    return best;
}

// The slice under `p`: on the top face, or on the rim that the 3-D look shows below it.
std::optional<ChartHit> hitPie(const ChartLayout& L, QPointF p)
{
    const PieGeometry& pie = L.pie;
    if (pie.slices.empty() || !(pie.rx > 0) || !(pie.ry > 0)) return std::nullopt;
    const double u = (p.x() - pie.centre.x()) / pie.rx;
    const double w = (pie.centre.y() - p.y()) / pie.ry;
    double angle = 0;
    if (u * u + w * w <= 1) {
        angle = std::atan2(w, u) * 180 / kPi;
    } else {
        if (pie.rim <= 0 || std::fabs(u) > 1) return std::nullopt;
        const double down = std::sqrt(1 - u * u);
        const double edge = pie.centre.y() + pie.ry * down;
        if (p.y() < edge || p.y() > edge + pie.rim) return std::nullopt;
        angle = std::atan2(-down, u) * 180 / kPi;
    }
    for (const PieSlice& s : pie.slices) {
        // Slices run clockwise from their start: how far clockwise the angle lies from it.
        double along = std::fmod(s.startAngle - angle, 360.0);
        if (along < 0) along += 360;
        if (along <= -s.spanAngle) return ChartHit{s.series, 1, s.value};
    }
    return std::nullopt;
}

QString labelAt(const std::vector<std::string>& labels, int32_t index)
{
    return index >= 1 && size_t(index) <= labels.size() ? displayText(labels[size_t(index - 1)]) : QString();
}
}  // namespace

std::optional<ChartHit> hitTest(const ChartControl& chart, const ChartLayout& layout, QPointF pos)
{
    // QRectF::contains takes a position that is no number for inside.
    if (!std::isfinite(pos.x()) || !std::isfinite(pos.y()) || !layout.chartContent.contains(pos)) return std::nullopt;
    bool invertible = false;
    const QTransform back = layout.view.inverted(&invertible);
    if (!invertible) return std::nullopt;
    const QPointF p = back.map(pos);
    switch (layout.kind) {
    case ChartKind::Pie: return hitPie(layout, p);
    case ChartKind::Bar: return hitBar(chart, layout, p);
    default: return hitMarker(chart, layout, pos);
    }
}

QString hitText(const ChartControl& chart, const ChartHit& hit)
{
    const QString value = QString::fromStdString(numberText(hit.value));
    const ChartGroup& g = chart.group1;
    if (chartKindOf(g.chartType) == ChartKind::Pie) {
        // Named as the legend names the slice: from whichever label list covers more slices.
        const size_t count = size_t(std::max(0, chart.data().seriesCount()));
        const bool byPointLabels = std::min(g.pointLabels.size(), count) > std::min(g.seriesLabels.size(), count);
        QString slice = labelAt(byPointLabels ? g.pointLabels : g.seriesLabels, hit.series);
        if (slice.isEmpty()) slice = QStringLiteral("Point %1").arg(hit.series);
        const QString series = byPointLabels ? labelAt(g.seriesLabels, 1) : QString();
        return (series.isEmpty() ? slice : series + QStringLiteral(", ") + slice) + QStringLiteral(": ") + value;
    }
    QString series = labelAt(g.seriesLabels, hit.series);
    if (series.isEmpty()) series = QStringLiteral("Series %1").arg(hit.series);
    QString point = labelAt(g.pointLabels, hit.point);
    if (point.isEmpty()) point = QStringLiteral("Point %1").arg(hit.point);
    return series + QStringLiteral(", ") + point + QStringLiteral(": ") + value;
}

}  // namespace kg::control
