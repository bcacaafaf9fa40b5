#pragma once
// The data choice charts over the settings grid `gridsettings1`: each data row is a point labelled
// with its caption, the chosen measure column (or pair of columns) the series, and the report's
// date range the X title. The values go into the table exactly as the grid gives them.
#include <cstdint>
#include <string>

#include "builders/BuildContext.h"

namespace kg::builders {

// One measure as one series, no legend.
void DrawBookingsGraph(BuildContext& context, const std::string& header, const std::string& yTitle,
                       int32_t measureColumn);
// Two measures side by side, with the grid's captions of the two columns in the legend.
void DrawBookingsDualGraph(BuildContext& context, const std::string& header, int32_t measureColumn1,
                           int32_t measureColumn2);

// "DD/MM/YYYY - DD/MM/YYYY" of the source form's two date pickers.
std::string dateRange(const Variant& sourceForm);

}  // namespace kg::builders
