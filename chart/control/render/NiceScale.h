#pragma once
// Axis scales with round tick values (1, 2, 2.5 or 5 times a power of ten) and their texts.
//
//   AxisScale s = autoScale(3, 97, 8);   // 0 .. 100 in steps of 20 (or 10)
//   s.ticks -> 0, 20, 40, ...            tickText(40, s.step) -> "40"
#include <QString>
#include <vector>

namespace kg::control {

struct AxisScale {
    double min = 0, max = 1;
    double step = 1;
    std::vector<double> ticks;  // tick values from min to max, each a multiple of step
};

// The smallest round step that divides `span` into at most `maxIntervals` parts.
double niceStep(double span, int maxIntervals);

// Automatic range: widened to include 0 and to whole steps on both ends.
AxisScale autoScale(double dataMin, double dataMax, int maxIntervals);

// A given range (axis zoom, or the X axis' category range): kept as it is, with round ticks
// inside it. `minStep` keeps ticks at whole point numbers on a numbered X axis.
AxisScale fixedScale(double min, double max, int maxIntervals, double minStep = 0);

// A tick value as text: as many decimals as the step needs, no trailing zeros, no "-0".
QString tickText(double value, double step);

}  // namespace kg::control
