#pragma once
// The chart requests of cTavixGraph. Each begins with GraphInitialize and ends with a chart shown,
// a message box, or an error for the host.
#include <cstdint>

#include "core/Variant.h"

namespace kg::requests {

// The nine grid series requests, told apart by their row of the request table.
enum class GridRequest {
    HourlyGraph1, HourlyGraph2, HourlyGraph3,
    PropGraph1, PropGraph2, PropGraph3,
    YearlyRpt1, YearlyRpt2, YearlyRpt3,
};
// `grid`: the source form member the request charts.
void generateGridChart(GridRequest request, const char* grid, int32_t numSeries, const Variant& total);

// The measure-choice requests: bookings by quote type, and sales declaration / service categories.
void GenerateChart_BookingsReport();
void GenerateChart_SalesDeclaration();
void GenerateChart_ServCatSumm();
// Shows the data choice dialog of a measure request (kBookingsRequest or kCategoryRequest) and draws
// the chosen measure; the window's Redraw repeats exactly this. Returns false when the user cancelled.
bool chooseAndDrawMeasure(int16_t requestKind);

void GenerateChart_JobStatusReport();

// The fixed texts of the component's own message boxes.
constexpr const char* kNoData = "There is no data to work with";
constexpr const char* kDatesReversed = "The FromDate must be less than or equal to the ToDate";
constexpr const char* kNoJobs = "No jobs were found in that date range";

}  // namespace kg::requests
