// Axes and plot of the bar, plot and area charts: the X positions of the points, the Y scale,
// the texts along both axes, the plot's front plane and the 3-D depth.
#include <algorithm>
#include <cmath>

#include "chart/control/render/LayoutParts.h"

namespace kg::control::layout {

namespace {
constexpr double kSin45 = 0.70710678118654752;

int32_t pointCountOf(const ChartControl& chart)
{
    int32_t n = 0;
    for (int32_t s = 1; s <= chart.data().seriesCount(); ++s) n = std::max(n, chart.data().pointCount(s));
    return n;
}

// Series 1's X values place the points when they run strictly upwards; otherwise point p sits at p.
std::vector<double> xPositionsOf(const ChartControl& chart, int32_t n)
{
    std::vector<double> xs(static_cast<size_t>(n));
    for (int32_t p = 1; p <= n; ++p) xs[size_t(p - 1)] = p;
    if (chart.data().seriesCount() < 1 || chart.data().pointCount(1) < n) return xs;
    const std::vector<double>& given = chart.data().xs(1);
    for (int32_t i = 0; i < n; ++i) {
        if (!std::isfinite(given[size_t(i)]) || (i > 0 && !(given[size_t(i)] > given[size_t(i - 1)]))) return xs;
    }
    std::copy(given.begin(), given.begin() + n, xs.begin());
    return xs;
}

double smallestStep(const std::vector<double>& xs)
{
    double step = 0;
    for (size_t i = 1; i < xs.size(); ++i) {
        const double d = xs[i] - xs[i - 1];
        if (d > 0 && (step == 0 || d < step)) step = d;
    }
    return step > 0 ? step : 1;
}

bool hasValidRange(const Axis& a)
{
    return a.hasFixedRange && std::isfinite(a.min) && std::isfinite(a.max) && a.min != a.max;
}

double planXLabels(const ChartControl& chart, ChartLayout& L, const ChartFonts& fonts, double maxBand)
{
    const MeasuredFont& f = fonts.tick;
    const ValueMapping& m = L.mapping;
    L.xLabels.clear();
    L.xLabelsRotated = false;
    const double spacing = std::fabs(m.xPixel(smallestStep(L.xPositions)) - m.xPixel(0));
    const double plotW = m.plot.width();
    if (chart.chartArea.x.annotationMethod == kAnnotatePointLabels) {
        const std::vector<std::string>& labels = chart.group1.pointLabels;
        std::vector<AxisLabel> all;
        double widest = 0;
        for (size_t i = 0; i < L.xPositions.size() && i < labels.size(); ++i) {
            const double x = L.xPositions[i];
            if (x < m.xMin || x > m.xMax || labels[i].empty()) continue;
            AxisLabel a{x, displayText(labels[i])};
            widest = std::max(widest, f.width(a.text));
            all.push_back(std::move(a));
        }
        if (all.empty()) return 0;
        const double need = widest + 6;
        const double needTurned = f.height * 1.15 + 2;
        size_t every = 1;
        if (need > spacing && needTurned <= spacing) {
            L.xLabelsRotated = true;
        } else if (need > spacing) {
            every = size_t(std::ceil(need / std::max(spacing, 1e-9)));
        }
        for (size_t i = 0; i < all.size(); i += every) L.xLabels.push_back(all[i]);
        if (!L.xLabelsRotated) return f.height;
        // Turned texts longer than the band allows are cut with an ellipsis.
        const double maxText = std::max(20.0, maxBand / kSin45 - f.height);
        double longest = 0;
        for (AxisLabel& a : L.xLabels) {
            if (f.width(a.text) > maxText) a.text = f.metrics.elidedText(a.text, Qt::ElideRight, maxText);
            longest = std::max(longest, f.width(a.text));
        }
        return (longest + f.height) * kSin45;
    }
    if (L.xPositions.empty()) return f.height;
    const bool whole =
        std::all_of(L.xPositions.begin(), L.xPositions.end(), [](double x) { return x == std::floor(x); });
    const double sample = std::max(f.width(tickText(m.xMax, 1)), f.width(tickText(m.xMin, 1)));
    const int intervals = std::max(1, int(plotW / (sample + 16)));
    const AxisScale s = fixedScale(m.xMin, m.xMax, intervals, whole ? 1.0 : 0.0);
    for (double t : s.ticks) L.xLabels.push_back({t, tickText(t, s.step)});
    return f.height;
}

int yIntervalsFor(double height) { return std::clamp(int(height / 45), 2, 10); }

void scaleY(const ChartControl& chart, ChartLayout& L, double dataMin, double dataMax, const LabelRoom& room,
            double plotH)
{
    const Axis& y = chart.chartArea.y;
    if (hasValidRange(y)) {
        L.yScale = fixedScale(y.min, y.max, yIntervalsFor(plotH));
        return;
    }
    // A little air between the extreme values and the plot's edge.
    double lo = dataMin < 0 ? dataMin * 1.02 : dataMin;
    double hi = dataMax > 0 ? dataMax * 1.02 : dataMax;
    L.yScale = autoScale(lo, hi, yIntervalsFor(plotH));
    // Widen the range until the value labels above the highest (below the lowest) value fit;
    // a small plot keeps its scale, or the labels would squash the data.
    for (int round = 0; round < 4 && room.any && plotH > 4 * room.above; ++round) {
        const double span = L.yScale.max - L.yScale.min;
        const double topGap = (L.yScale.max - std::max(dataMax, 0.0)) / span * plotH;
        const double bottomGap = (std::min(dataMin, 0.0) - L.yScale.min) / span * plotH;
        const bool needTop = dataMax > 0 && topGap < room.above;
        const bool needBottom = dataMin < 0 && bottomGap < room.below;
        if (!needTop && !needBottom) break;
        if (needTop) hi = L.yScale.max + span * (room.above - topGap) / (plotH - room.above);
        if (needBottom) lo = L.yScale.min - span * (room.below - bottomGap) / (plotH - room.below);
        L.yScale = autoScale(lo, hi, yIntervalsFor(plotH));
    }
}

}  // namespace

void placeAxesAndPlot(const ChartControl& chart, ChartLayout& L, const ChartFonts& fonts)
{
    const ChartArea& area = chart.chartArea;
    const ChartData& d = chart.data();
    const int32_t n = pointCountOf(chart);
    L.xPositions = xPositionsOf(chart, n);

    double dataMin = 0, dataMax = 0;
    bool anyValue = false;
    for (int32_t s = 1; s <= d.seriesCount(); ++s) {
        for (double v : d.ys(s)) {
            if (!std::isfinite(v)) continue;
            dataMin = anyValue ? std::min(dataMin, v) : v;
            dataMax = anyValue ? std::max(dataMax, v) : v;
            anyValue = true;
        }
    }

    ValueMapping& m = L.mapping;
    if (hasValidRange(area.x)) {
        m.xMin = std::min(area.x.min, area.x.max);
        m.xMax = std::max(area.x.min, area.x.max);
    } else if (n > 0) {
        const double pad = smallestStep(L.xPositions) / 2;
        m.xMin = L.xPositions.front() - pad;
        m.xMax = L.xPositions.back() + pad;
    } else {
        m.xMin = 0.5;
        m.xMax = 1.5;
    }

    const LabelRoom room = valueLabelRoom(chart, fonts, false);
    const QRectF content = L.chartContent.adjusted(kContentPad, kContentPad, -kContentPad, -kContentPad);
    const MeasuredFont& tf = fonts.tick;
    const MeasuredFont& at = fonts.axisTitle;
    const QString xTitle = displayText(area.x.title);
    const QString yTitle = displayText(area.y.title);
    const bool yTurned = area.y.presentationCode == kTitleRotatedUp;
    const double yTitleW = yTitle.isEmpty() ? 0 : (yTurned ? at.height + 6 : 0);
    const double yTitleH = (!yTitle.isEmpty() && !yTurned) ? at.height + 4 : 0;
    const double xTitleH = xTitle.isEmpty() ? 0 : at.height + 4;

    const double top = content.top() + std::max(tf.height / 2, yTitleH);
    double bottom = content.bottom() - xTitleH - tf.height - kTickMark - kTickGap;
    double left = content.left() + yTitleW;
    double right = content.right() - 8;
    QRectF avail;
    for (int pass = 0; pass < 3; ++pass) {
        const double plotH = std::max(1.0, bottom - top);
        scaleY(chart, L, dataMin, dataMax, room, plotH);
        double widest = 0;
        L.yLabels.clear();
        for (double t : L.yScale.ticks) {
            AxisLabel a{t, tickText(t, L.yScale.step)};
            widest = std::max(widest, tf.width(a.text));
            L.yLabels.push_back(std::move(a));
        }
        left = content.left() + yTitleW + widest + kTickGap + kTickMark;
        avail = QRectF(QPointF(left, top), QPointF(std::max(left + 1, right), std::max(top + 1, bottom)));
        m.plot = avail;
        m.yMin = L.yScale.min;
        m.yMax = L.yScale.max;
        const double band = planXLabels(chart, L, fonts, content.height() * 0.3);
        const double newBottom = content.bottom() - xTitleH - band - kTickMark - kTickGap;
        if (std::fabs(newBottom - bottom) < 0.5) break;
        bottom = newBottom;
    }

    // 3-D: the back plane is offset by `depth`; the front plane gives way so both fit.
    const View3D& v = area.view3D;
    if (!v.isFlat()) {
        const double unit = n > 0 ? avail.width() * smallestStep(L.xPositions) / (m.xMax - m.xMin) : avail.width();
        double len = std::clamp(double(v.depth), 0.0, 100.0) / 100 * std::max(unit, 40.0);
        len = std::min(len, 0.25 * std::min(avail.width(), avail.height()));
        const double angle = std::atan2(double(v.elevation), double(v.rotation));
        L.depth = QPointF(len * std::cos(angle), -len * std::sin(angle));
    }
    QRectF front = avail;
    if (L.depth.x() > 0)
        front.setRight(front.right() - L.depth.x());
    else
        front.setLeft(front.left() - L.depth.x());
    if (L.depth.y() < 0)
        front.setTop(front.top() - L.depth.y());
    else
        front.setBottom(front.bottom() - L.depth.y());
    m.plot = front;
    L.plotArea = front;
    planXLabels(chart, L, fonts, content.height() * 0.3);  // thinned for the final spacing

    if (!yTitle.isEmpty()) {
        L.yTitle = yTurned ? QRectF(content.left(), avail.top(), at.height, avail.height())
                           : QRectF(content.left(), content.top(), avail.right() - content.left(), at.height);
    }
    if (!xTitle.isEmpty()) L.xTitle = QRectF(avail.left(), content.bottom() - at.height, avail.width(), at.height);

    const double unitPx = std::fabs(m.xPixel(smallestStep(L.xPositions)) - m.xPixel(0));
    L.clusterWidth = unitPx * 0.75;
    L.barWidth = L.clusterWidth / std::max<int32_t>(1, d.seriesCount());
    const double len = std::hypot(L.depth.x(), L.depth.y());
    if (len > 0) {
        const double own = std::min(len, std::max(L.barWidth, 1.0));
        L.barDepth = L.depth * (own / len);
        L.barShift = L.depth * ((len - own) / 2 / len);
    }
}

}  // namespace kg::control::layout
