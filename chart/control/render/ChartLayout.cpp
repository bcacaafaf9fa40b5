#include "chart/control/render/ChartLayout.h"

#include <QPaintDevice>
#include <algorithm>
#include <cmath>

#include "chart/control/render/Borders.h"
#include "chart/control/render/ChartText.h"
#include "chart/control/render/LayoutParts.h"

namespace kg::control {

namespace {
constexpr double kMargin = 6;     // inside the control's border
constexpr double kTitleGap = 4;   // below the header, above the footer
constexpr double kFarAway = 1e5;  // pixel coordinates are kept this close to the plot

double finiteOr(double v, double fallback) { return std::isfinite(v) ? v : fallback; }
}  // namespace

namespace layout {

LabelRoom valueLabelRoom(const ChartControl& chart, const ChartFonts& fonts, bool measureWidths)
{
    LabelRoom room;
    for (const ChartLabel& l : chart.chartLabels) {
        if (l.attachMethod != kAttachToDataPoint) continue;
        room.any = true;
        const double border = 2 * std::clamp(double(l.borderWidth), 0.0, 10.0) + (l.border == kBorderShadow ? 3 : 0);
        room.height = std::max(room.height, fonts.label.height + 2 * kLabelPadY + border);
        const double offset = std::clamp(double(l.offset), 0.0, 200.0);
        room.above = std::max(room.above, offset);
        if (measureWidths)
            room.width = std::max(room.width, fonts.label.width(displayText(l.text)) + 2 * kLabelPadX + border);
    }
    if (room.any) {
        room.above += room.height + 4;
        room.below = room.above;
    }
    return room;
}

}  // namespace layout

ChartKind chartKindOf(int16_t chartType)
{
    switch (chartType) {
    case kPlot: return ChartKind::Plot;
    case kPie: return ChartKind::Pie;
    case kArea: return ChartKind::Area;
    default: return ChartKind::Bar;
    }
}

double ValueMapping::xPixel(double x) const
{
    const double span = xMax - xMin;
    const double px = span != 0 ? plot.left() + (x - xMin) / span * plot.width() : plot.center().x();
    return std::clamp(finiteOr(px, plot.left()), plot.left() - kFarAway, plot.right() + kFarAway);
}

double ValueMapping::yPixel(double y) const
{
    const double span = yMax - yMin;
    const double py = span != 0 ? plot.bottom() - (y - yMin) / span * plot.height() : plot.center().y();
    return std::clamp(finiteOr(py, plot.bottom()), plot.top() - kFarAway, plot.bottom() + kFarAway);
}

QPointF ValueMapping::toValue(QPointF pixel) const
{
    const double x = plot.width() > 0 ? xMin + (pixel.x() - plot.left()) / plot.width() * (xMax - xMin) : xMin;
    const double y = plot.height() > 0 ? yMin + (plot.bottom() - pixel.y()) / plot.height() * (yMax - yMin) : yMin;
    return {x, y};
}

QPointF ChartLayout::toScreen(double x, double y) const { return view.map(mapping.toPixel(x, y)); }

bool ChartLayout::toValue(QPointF screen, QPointF& value) const
{
    bool invertible = false;
    const QTransform back = view.inverted(&invertible);
    if (!invertible) return false;
    value = mapping.toValue(back.map(screen));
    return true;
}

double ChartLayout::xOf(int32_t point) const
{
    if (point >= 1 && size_t(point) <= xPositions.size()) return xPositions[size_t(point - 1)];
    return point;
}

ChartLayout::BarFaces ChartLayout::barFaces(const QRectF& r) const
{
    const QPointF d = barDepth;
    return {d.y() <= 0 ? QPolygonF({r.topLeft(), r.topLeft() + d, r.topRight() + d, r.topRight()})
                       : QPolygonF({r.bottomLeft(), r.bottomLeft() + d, r.bottomRight() + d, r.bottomRight()}),
            d.x() >= 0 ? QPolygonF({r.topRight(), r.topRight() + d, r.bottomRight() + d, r.bottomRight()})
                       : QPolygonF({r.topLeft(), r.topLeft() + d, r.bottomLeft() + d, r.bottomLeft()})};
}

QRectF ChartLayout::barRect(const ChartControl& chart, int32_t series, int32_t point) const
{
    const ChartData& d = chart.data();
    if (series < 1 || series > d.seriesCount() || point < 1 || point > d.pointCount(series)) return {};
    const double value = d.ys(series)[size_t(point - 1)];
    if (!std::isfinite(value)) return {};
    const double base = std::clamp(0.0, mapping.yMin, mapping.yMax);
    const double left = mapping.xPixel(xOf(point)) - clusterWidth / 2 + (series - 1) * barWidth;
    const double y0 = mapping.yPixel(base), y1 = mapping.yPixel(value);
    return QRectF(QPointF(left, std::min(y0, y1)), QPointF(left + barWidth, std::max(y0, y1))).translated(barShift);
}

QTransform viewTransform(const ViewState& view, const QRectF& r)
{
    QTransform t;
    if (view.isIdentity()) return t;
    const double scale = std::isfinite(view.scale) ? std::clamp(view.scale, 0.02, 50.0) : 1.0;
    const double dx = std::isfinite(view.offsetX) ? std::clamp(view.offsetX, -10.0, 10.0) : 0.0;
    const double dy = std::isfinite(view.offsetY) ? std::clamp(view.offsetY, -10.0, 10.0) : 0.0;
    const QPointF c = r.center();
    t.translate(c.x() + dx * r.width(), c.y() + dy * r.height());
    t.scale(scale, scale);
    t.translate(-c.x(), -c.y());
    return t;
}

ChartLayout computeLayout(const ChartControl& chart, const QRectF& target, QPaintDevice* device)
{
    (void)device;  // fonts are sized in pixels, so their measures do not depend on the device
    return computeLayout(chart, target, ChartFonts(chart));
}

ChartLayout computeLayout(const ChartControl& chart, const QRectF& target, const ChartFonts& fonts)
{
    ChartLayout L;
    L.kind = chartKindOf(chart.group1.chartType);
    L.bounds = target.normalized();
    if (L.bounds.width() < 1 || L.bounds.height() < 1) return L;

    const double controlInset = std::min(borderInset(chart.border), std::min(L.bounds.width(), L.bounds.height()) / 2);
    QRectF inner = L.bounds.adjusted(controlInset, controlInset, -controlInset, -controlInset)
                       .adjusted(kMargin, kMargin, -kMargin, -kMargin);
    if (!chart.header.text.empty()) {
        L.header = QRectF(inner.left(), inner.top(), inner.width(), fonts.header.height);
        inner.setTop(L.header.bottom() + kTitleGap);
    }
    if (!chart.footer.text.empty()) {
        L.footer = QRectF(inner.left(), inner.bottom() - fonts.footer.height, inner.width(), fonts.footer.height);
        inner.setBottom(L.footer.top() - kTitleGap);
    }
    layout::placeLegend(chart, L, fonts, inner);
    if (inner.width() < 1 || inner.height() < 1) inner = QRectF(inner.topLeft(), QSizeF(1, 1));
    L.chartArea = inner;
    const double areaInset = std::min(borderInset(chart.chartArea.border), std::min(inner.width(), inner.height()) / 2);
    L.chartContent = inner.adjusted(areaInset, areaInset, -areaInset, -areaInset);
    L.view = viewTransform(chart.view, L.chartContent);
    if (L.kind == ChartKind::Pie)
        layout::placePie(chart, L, fonts);
    else
        layout::placeAxesAndPlot(chart, L, fonts);
    return L;
}

}  // namespace kg::control
