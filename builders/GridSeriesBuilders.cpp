#include "builders/GridSeriesBuilders.h"

#include "builders/ChartFrame.h"
#include "builders/LateBoundGrid.h"
#include "component/modMain.h"
#include "core/Convert.h"

namespace kg::builders {

using namespace modMain;

namespace {

// Where a builder's points come from: the grid's column count less 2, or twelve months.
enum class Points { FromColumns, TwelveMonths };

int32_t lastPoint(LateBoundGrid& grid, Points points)
{
    return points == Points::FromColumns ? toLong(Variant(double(grid.cols()) - 2)) : 12;
}

void drawGridSeries(const Variant& vGrid, const std::string& sHeader, const std::string& sYTitle,
                    int32_t lNumSeries, Points points)
{
    LateBoundGrid grid(vGrid);
    HourglassOn();
    ChartWindowPort& window = chartWindow();
    c2dChart& c = prepareChart(window, {sHeader, "Month", sYTitle, lNumSeries, true},
                               [&] { return lastPoint(grid, points); });

    control::ChartControl& chart1 = window.Chart1();
    chart1.group1.seriesLabels.clear();
    {
        const int32_t fixedRows = grid.FixedRows(), rows = grid.Rows();
        for (int32_t r = fixedRows; r < rows; ++r) chart1.group1.seriesLabels.push_back(grid.textmatrix(r, 0));
    }
    for (int32_t col = 1, last = lastPoint(grid, points); col <= last; ++col)
        chart1.group1.pointLabels.push_back(grid.textmatrix(0, col));
    chart1.chartArea.x.annotationMethod = 2;

    const int32_t fixedRows = grid.FixedRows(), rows = grid.Rows();
    for (int32_t r = fixedRows; r < rows; ++r) {
        // Each row's values go to the series its caption names, however many caption rows there are.
        const int32_t series = r - fixedRows + 1;
        for (int32_t col = 1, last = lastPoint(grid, points); col <= last; ++col)
            gvArray.at(series, col) = Variant(grid.textmatrix(r, col));
    }
    showChart(window, c, false);
}

}  // namespace

void DrawHourlyGraph(const Variant& vGrid, const std::string& sHeader, const std::string& sYTitle,
                     const int32_t& lNumSeries)
{
    drawGridSeries(vGrid, sHeader, sYTitle, lNumSeries, Points::FromColumns);
}

void DrawPropGraph(const Variant& vGrid, const std::string& sHeader, const std::string& sYTitle,
                   const int32_t& lNumSeries)
{
    drawGridSeries(vGrid, sHeader, sYTitle, lNumSeries, Points::TwelveMonths);
}

void DrawYearlyRpt(const Variant& vGrid, const std::string& sHeader, const std::string& sYTitle,
                   const int32_t& lNumSeries)
{
    drawGridSeries(vGrid, sHeader, sYTitle, lNumSeries, Points::TwelveMonths);
}

}  // namespace kg::builders
