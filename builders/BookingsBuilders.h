#pragma once
// The data choice charts over the settings grid `gridsettings1`: each data row is a point labelled
// with its caption, the chosen measure column (or pair of columns) the series, and the report's
// date range the X title. The values go into the table exactly as the grid gives them.
#include <cstdint>
#include <string>

namespace kg::builders {

// One measure as one series, no legend.
void DrawBookingsGraph(const std::string& sHeader, const std::string& sYTitle, const int32_t& lMeasureCol);
// Two measures side by side, with the grid's captions of the two columns in the legend.
void DrawBookingsDualGraph(const std::string& sHeader, const int32_t& lMeasureCol1, const int32_t& lMeasureCol2);

}  // namespace kg::builders
