#pragma once
// The grid series builders: a host grid becomes a multi-series chart, each data row a series
// (its caption in the legend) and each value column a point (its caption on the X axis).
//   DrawHourlyGraph: the grid's columns 1 to cols - 2 are the points.
//   DrawPropGraph, DrawYearlyRpt: months 1 to 12 are the points, whatever the column count.
#include <cstdint>
#include <string>

#include "core/Variant.h"

namespace kg::builders {

void DrawHourlyGraph(const Variant& vGrid, const std::string& sHeader, const std::string& sYTitle,
                     const int32_t& lNumSeries);
void DrawPropGraph(const Variant& vGrid, const std::string& sHeader, const std::string& sYTitle,
                   const int32_t& lNumSeries);
void DrawYearlyRpt(const Variant& vGrid, const std::string& sHeader, const std::string& sYTitle,
                   const int32_t& lNumSeries);

}  // namespace kg::builders
