#pragma once
// What every builder does around filling the value table: the chart set up on the chart window's
// control with its titles, series count and legend, the table sized to it, and at the end the
// pointer handed back, the window shown and the table drawn.
#include <cstdint>
#include <functional>
#include <string>

#include "builders/BuildContext.h"

namespace kg::builders {

struct ChartFrame {
    std::string header, xTitle, yTitle;
    int32_t numSeries = 1;
    bool showLegend = true;
    // The table has at least this many points, however few the chart's X range gives; 0: no
    // minimum, a negative count still fails when the table is sized.
    int32_t minPoints = 0;
};

// Points run from 1 to `lastPoint()`, asked of the grid only once the chart is initialised: the
// host sees its calls in this order. The control's point labels are cleared for the builder.
c2dChart& prepareChart(BuildContext& context, const ChartFrame& frame, const std::function<int32_t()>& lastPoint);

// The pointer back, the window (with or without its Redraw command) shown, the table drawn.
void showChart(BuildContext& context, bool redrawVisible);

}  // namespace kg::builders
