#include "chart/control/render/NiceScale.h"

#include <algorithm>
#include <cmath>

namespace kg::control {

namespace {
// Ranges are kept well inside double range so that spans and steps stay finite.
constexpr double kLargest = 1e300;
constexpr int kMostTicks = 200;

double clampFinite(double v) { return std::isnan(v) ? 0.0 : std::clamp(v, -kLargest, kLargest); }

void fillTicks(AxisScale& s)
{
    s.ticks.clear();
    const double first = std::ceil(s.min / s.step - 1e-9);
    for (int i = 0; i < kMostTicks; ++i) {
        const double v = (first + i) * s.step;
        if (v > s.max + s.step * 1e-9) break;
        // Snap values that should be 0 but carry rounding noise.
        s.ticks.push_back(std::fabs(v) < s.step * 1e-9 ? 0.0 : v);
    }
}
}  // namespace

double niceStep(double span, int maxIntervals)
{
    span = std::fabs(clampFinite(span));
    if (span == 0) return 1;
    const double raw = span / std::max(1, maxIntervals);
    const double magnitude = std::pow(10.0, std::floor(std::log10(raw)));
    for (double m : {1.0, 2.0, 2.5, 5.0, 10.0}) {
        if (m * magnitude >= raw * (1 - 1e-12)) return m * magnitude;
    }
    return 10 * magnitude;
}

AxisScale autoScale(double dataMin, double dataMax, int maxIntervals)
{
    double lo = std::min(0.0, clampFinite(std::min(dataMin, dataMax)));
    double hi = std::max(0.0, clampFinite(std::max(dataMin, dataMax)));
    if (lo == hi) hi = 1;
    AxisScale s;
    s.step = niceStep(hi - lo, maxIntervals);
    s.min = std::floor(lo / s.step + 1e-9) * s.step;
    s.max = std::ceil(hi / s.step - 1e-9) * s.step;
    if (s.max <= s.min) s.max = s.min + s.step;
    fillTicks(s);
    return s;
}

AxisScale fixedScale(double min, double max, int maxIntervals, double minStep)
{
    AxisScale s;
    s.min = clampFinite(std::min(min, max));
    s.max = clampFinite(std::max(min, max));
    if (s.max - s.min <= 0) s.max = s.min + 1;
    s.step = std::max(niceStep(s.max - s.min, maxIntervals), minStep);
    fillTicks(s);
    return s;
}

QString tickText(double value, double step)
{
    if (value == 0) return QStringLiteral("0");
    const double magnitude = std::max(std::fabs(value), std::fabs(step));
    if (magnitude >= 1e15 || std::fabs(step) < 1e-12) return QString::number(value, 'g', 6);
    // Decimals enough for the step (2.5 x 10^n needs one more than 10^n).
    int decimals = 0;
    if (step > 0) decimals = std::max(0, int(std::ceil(-std::log10(step) - 1e-9)));
    decimals = std::min(decimals + 1, 15);
    QString text = QString::number(value, 'f', decimals);
    if (text.contains(QLatin1Char('.'))) {
        while (text.endsWith(QLatin1Char('0'))) text.chop(1);
        if (text.endsWith(QLatin1Char('.'))) text.chop(1);
    }
    if (text == QLatin1String("-0")) text = QStringLiteral("0");
    return text;
}

}  // namespace kg::control
