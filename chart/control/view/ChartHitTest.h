#pragma once
// Which data point is under the mouse, and the tip that names it: the bar, marker or pie slice
// drawn at a position of the view (scale, move and zoom included; nothing outside the chart area).
//
//   ChartLayout layout = computeLayout(chart, widget.rect());
//   if (auto hit = hitTest(chart, layout, mousePos)) QToolTip::showText(..., hitText(chart, *hit));
//
// The tip is "<series label>, <point label>:" followed by a blank and the value's number text,
// e.g. "Series 2, Mar:  12.5" (the number text brings its own sign blank). A missing series label
// is written "Series <n>", a missing point label "Point <n>". A pie's slices are the points of
// one series: the tip names the slice as the legend does and, when the slices are named by the
// point labels, the first series label before it ("Bookings, Mar:  4"; "Mar:  4" without one).
#include <QPointF>
#include <QString>
#include <optional>

#include "chart/control/model/ChartControl.h"
#include "chart/control/render/ChartLayout.h"

namespace kg::control {

struct ChartHit {
    int32_t series = 0;  // from 1
    int32_t point = 0;   // from 1 (1 for a pie slice)
    double value = 0;
};

// Markers of plot and area charts answer within this distance (view pixels).
constexpr double kHitRadius = 6;

std::optional<ChartHit> hitTest(const ChartControl& chart, const ChartLayout& layout, QPointF pos);
QString hitText(const ChartControl& chart, const ChartHit& hit);

}  // namespace kg::control
