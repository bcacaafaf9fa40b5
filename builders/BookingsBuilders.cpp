#include "builders/BookingsBuilders.h"

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

}  // namespace

void DrawBookingsGraph(const std::string& sHeader, const std::string& sYTitle, const int32_t& lMeasureCol)
{
    HourglassOn();
    LateBoundGrid grid(call(gvSourceForm, "gridsettings1"));
    const std::string xTitle = dateRange();
    c2dChart& c = chart();
    ChartWindowPort& window = chartWindow();
    c.Initialize(&window.Chart1(), sHeader, "", xTitle, sYTitle);
    c2dChart::setShowLegend(false);
    c.setNumSeries(1);
    c.setXMinData(1);
    c.setXMaxData(toLong(Variant(double(grid.Rows()) - grid.FixedRows())));
    c.InitChart();
    gvArray.redim(c.NumSeries(), c.NumPoints());
    c.setXAxisLabels(false);

    control::ChartControl& chart1 = window.Chart1();
    chart1.group1.pointLabels.clear();
    for (int32_t r = grid.FixedRows(), rows = grid.Rows(); r < rows; ++r)
        chart1.group1.pointLabels.push_back(toText(grid.GetValueFromCell(r, 0)));
    chart1.chartArea.x.annotationMethod = 2;
    for (int32_t r = grid.FixedRows(), rows = grid.Rows(); r < rows; ++r)
        gvArray.at(1, r - grid.FixedRows() + 1) = grid.GetValueFromCell(r, lMeasureCol);
    HourglassOff();
    window.setRedrawVisible(true);
    window.Show();
    c.DrawChart(gvArray);
}

void DrawBookingsDualGraph(const std::string& sHeader, const int32_t& lMeasureCol1, const int32_t& lMeasureCol2)
{
    HourglassOn();
    LateBoundGrid grid(call(gvSourceForm, "gridsettings1"));
    const std::string xTitle = dateRange();
    c2dChart& c = chart();
    ChartWindowPort& window = chartWindow();
    c.Initialize(&window.Chart1(), sHeader, "", xTitle, "");
    c.setNumSeries(2);
    c2dChart::setShowLegend(true);
    c.setXMinData(1);
    c.setXMaxData(toLong(Variant(double(grid.Rows()) - grid.FixedRows())));
    c.InitChart();
    gvArray.redim(c.NumSeries(), c.NumPoints());
    c.setXAxisLabels(false);

    control::ChartControl& chart1 = window.Chart1();
    chart1.group1.pointLabels.clear();
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
    HourglassOff();
    window.setRedrawVisible(true);
    window.Show();
    c.DrawChart(gvArray);
}

}  // namespace kg::builders
