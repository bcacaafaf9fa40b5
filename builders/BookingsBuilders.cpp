#include "builders/BookingsBuilders.h"

#include "builders/ChartFrame.h"
#include "builders/LateBoundGrid.h"
#include "core/Convert.h"

namespace kg::builders {

namespace {

// One point per data row of the settings grid.
std::function<int32_t()> dataRowsOf(LateBoundGrid& grid)
{
    return [&grid] { return toLong(Variant(double(grid.Rows()) - grid.FixedRows())); };
}

}  // namespace

std::string dateRange(const Variant& sourceForm)
{
    return formatPattern(datePickerValue(sourceForm, "dtpFromDate"), "DD/MM/YYYY") + " - " +
           formatPattern(datePickerValue(sourceForm, "dtpToDate"), "DD/MM/YYYY");
}

void DrawBookingsGraph(BuildContext& context, const std::string& header, const std::string& yTitle,
                       int32_t measureColumn)
{
    context.hourglass(true);
    LateBoundGrid grid(call(context.sourceForm(), "gridsettings1"));
    const std::string xTitle = dateRange(context.sourceForm());
    ChartWindowPort& window = context.window();
    prepareChart(context, {header, xTitle, yTitle, 1, false}, dataRowsOf(grid));

    control::ChartControl& chart1 = window.Chart1();
    for (int32_t r = grid.FixedRows(), rows = grid.Rows(); r < rows; ++r)
        chart1.group1.pointLabels.push_back(toText(grid.GetValueFromCell(r, 0)));
    chart1.chartArea.x.annotationMethod = control::kAnnotatePointLabels;
    VariantArray& table = context.table();
    for (int32_t r = grid.FixedRows(), rows = grid.Rows(); r < rows; ++r)
        table.at(1, r - grid.FixedRows() + 1) = grid.GetValueFromCell(r, measureColumn);
    showChart(context, true);
}

void DrawBookingsDualGraph(BuildContext& context, const std::string& header, int32_t measureColumn1,
                           int32_t measureColumn2)
{
    context.hourglass(true);
    LateBoundGrid grid(call(context.sourceForm(), "gridsettings1"));
    const std::string xTitle = dateRange(context.sourceForm());
    ChartWindowPort& window = context.window();
    prepareChart(context, {header, xTitle, "", 2, true}, dataRowsOf(grid));

    control::ChartControl& chart1 = window.Chart1();
    chart1.group1.seriesLabels.clear();
    chart1.group1.seriesLabels.push_back(toText(grid.GetValueFromCell(0, measureColumn1)));
    chart1.group1.seriesLabels.push_back(toText(grid.GetValueFromCell(0, measureColumn2)));
    for (int32_t r = grid.FixedRows(), rows = grid.Rows(); r < rows; ++r)
        chart1.group1.pointLabels.push_back(toText(grid.GetValueFromCell(r, 0)));
    chart1.chartArea.x.annotationMethod = control::kAnnotatePointLabels;
    VariantArray& table = context.table();
    for (int32_t r = grid.FixedRows(), rows = grid.Rows(); r < rows; ++r) {
        table.at(1, r - grid.FixedRows() + 1) = grid.GetValueFromCell(r, measureColumn1);
        table.at(2, r - grid.FixedRows() + 1) = grid.GetValueFromCell(r, measureColumn2);
    }
    showChart(context, true);
}

}  // namespace kg::builders
