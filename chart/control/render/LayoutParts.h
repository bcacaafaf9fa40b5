#pragma once
// The parts of computeLayout, one file each: the legend, the pie, the axes and plot of the
// other chart types. Shared by those files only.
#include <QRectF>

#include "chart/control/render/ChartLayout.h"
#include "chart/control/render/ChartText.h"

namespace kg::control::layout {

constexpr double kContentPad = 10;  // inside the chart area
constexpr double kTickMark = 4;     // length of an axis tick
constexpr double kTickGap = 3;      // between a tick mark and its text

// Room that the value labels need around the data points.
struct LabelRoom {
    double above = 0, below = 0;  // pixels needed beyond the highest and lowest data value
    double width = 0;             // widest label box (when measured)
    double height = 0;
    bool any = false;
};
LabelRoom valueLabelRoom(const ChartControl& chart, const ChartFonts& fonts, bool measureWidths);

// Places the legend at the east side of `inner` and takes its room (and the gap) from it.
void placeLegend(const ChartControl& chart, ChartLayout& L, const ChartFonts& fonts, QRectF& inner);
void placePie(const ChartControl& chart, ChartLayout& L, const ChartFonts& fonts);
void placeAxesAndPlot(const ChartControl& chart, ChartLayout& L, const ChartFonts& fonts);

}  // namespace kg::control::layout
