#pragma once
// The grid series builders: a host grid becomes a multi-series chart, each data row a series
// (its caption in the legend) and each value column a point (its caption on the X axis).
//   DrawHourlyGraph: the grid's columns 1 to cols - 2 are the points.
//   DrawPropGraph, DrawYearlyRpt: months 1 to 12 are the points, whatever the column count.
#include <cstdint>
#include <string>

#include "builders/BuildContext.h"

namespace kg::builders {

struct GridChart {
    Variant grid;
    std::string header, yTitle;
    int32_t numSeries = 0;
};

void DrawHourlyGraph(BuildContext& context, const GridChart& chart);
void DrawPropGraph(BuildContext& context, const GridChart& chart);
void DrawYearlyRpt(BuildContext& context, const GridChart& chart);

}  // namespace kg::builders
