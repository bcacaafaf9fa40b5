#include "builders/BookingsBuilders.h"

#include "builders/ChartFrame.h"
#include "builders/LateBoundGrid.h"
#include "component/modMain.h"
#include "core/Convert.h"

namespace kg::builders {

using namespace modMain;

namespace {

std::string dateRange()
{
    return formatPattern(datePickerValue(gvSourceForm, "dtpFromDate"), "DD/MM/YYYY") + " - " +
           formatPattern(datePickerValue(gvSourceForm, "dtpToDate"), "DD/MM/YYYY");
}

// One point per data row of the settings grid.
std::function<int32_t()> dataRowsOf(LateBoundGrid& grid)
{
    return [&grid] { return toLong(Variant(double(grid.Rows()) - grid.FixedRows())); };
}

}  // namespace

void DrawBookingsGraph(const std::string& sHeader, const std::string& sYTitle, const int32_t& lMeasureCol)
{
    HourglassOn();
    LateBoundGrid grid(call(gvSourceForm, "gridsettings1"));
    const std::string xTitle = dateRange();
    ChartWindowPort& window = chartWindow();
    c2dChart& c = prepareChart(window, {sHeader, xTitle, sYTitle, 1, false}, dataRowsOf(grid));

    control::ChartControl& chart1 = window.Chart1();
    for (int32_t r = grid.FixedRows(), rows = grid.Rows(); r < rows; ++r)
        chart1.group1.pointLabels.push_back(toText(grid.GetValueFromCell(r, 0)));
    chart1.chartArea.x.annotationMethod = 2;
    for (int32_t r = grid.FixedRows(), rows = grid.Rows(); r < rows; ++r)
        gvArray.at(1, r - grid.FixedRows() + 1) = grid.GetValueFromCell(r, lMeasureCol);
    showChart(window, c, true);
}

void DrawBookingsDualGraph(const std::string& sHeader, const int32_t& lMeasureCol1, const int32_t& lMeasureCol2)
{
    HourglassOn();
    LateBoundGrid grid(call(gvSourceForm, "gridsettings1"));
    const std::string xTitle = dateRange();
    ChartWindowPort& window = chartWindow();
    c2dChart& c = prepareChart(window, {sHeader, xTitle, "", 2, true}, dataRowsOf(grid));

    control::ChartControl& chart1 = window.Chart1();
    chart1.group1.seriesLabels.clear();
    chart1.group1.seriesLabels.push_back(toText(grid.GetValueFromCell(0, lMeasureCol1)));
    chart1.group1.seriesLabels.push_back(toText(grid.GetValueFromCell(0, lMeasureCol2)));
    for (int32_t r = grid.FixedRows(), rows = grid.Rows(); r < rows; ++r)
        chart1.group1.pointLabels.push_back(toText(grid.GetValueFromCell(r, 0)));
    chart1.chartArea.x.annotationMethod = 2;
    for (int32_t r = grid.FixedRows(), rows = grid.Rows(); r < rows; ++r) {
        gvArray.at(1, r - grid.FixedRows() + 1) = grid.GetValueFromCell(r, lMeasureCol1);
        gvArray.at(2, r - grid.FixedRows() + 1) = grid.GetValueFromCell(r, lMeasureCol2);
    }
    showChart(window, c, true);
}

}  // namespace kg::builders
