#include "builders/GridSeriesBuilders.h"

#include "builders/ChartFrame.h"
#include "builders/LateBoundGrid.h"
#include "core/Convert.h"

namespace kg::builders {

namespace {

// Where a builder's points come from: the grid's column count less 2, or twelve months.
enum class Points { FromColumns, TwelveMonths };

int32_t lastPoint(LateBoundGrid& grid, Points points)
{
    return points == Points::FromColumns ? toLong(Variant(double(grid.cols()) - 2)) : 12;
}

void drawGridSeries(BuildContext& context, const GridChart& request, Points points)
{
    LateBoundGrid grid(request.grid);
    context.hourglass(true);
    ChartWindowPort& window = context.window();
    prepareChart(context, {request.header, "Month", request.yTitle, request.numSeries, true},
                 [&] { return lastPoint(grid, points); });

    control::ChartControl& chart1 = window.Chart1();
    chart1.group1.seriesLabels.clear();
    {
        const int32_t fixedRows = grid.FixedRows(), rows = grid.Rows();
        for (int32_t r = fixedRows; r < rows; ++r) chart1.group1.seriesLabels.push_back(grid.textmatrix(r, 0));
    }
    for (int32_t col = 1, last = lastPoint(grid, points); col <= last; ++col)
        chart1.group1.pointLabels.push_back(grid.textmatrix(0, col));
    chart1.chartArea.x.annotationMethod = control::kAnnotatePointLabels;

    VariantArray& table = context.table();
    const int32_t fixedRows = grid.FixedRows(), rows = grid.Rows();
    for (int32_t r = fixedRows; r < rows; ++r) {
        // Each row's values go to the series its caption names, however many caption rows there are.
        const int32_t series = r - fixedRows + 1;
        for (int32_t col = 1, last = lastPoint(grid, points); col <= last; ++col)
            table.at(series, col) = Variant(grid.textmatrix(r, col));
    }
    showChart(context, false);
}

}  // namespace

void DrawHourlyGraph(BuildContext& context, const GridChart& chart)
{
    drawGridSeries(context, chart, Points::FromColumns);
}

void DrawPropGraph(BuildContext& context, const GridChart& chart)
{
    drawGridSeries(context, chart, Points::TwelveMonths);
}

void DrawYearlyRpt(BuildContext& context, const GridChart& chart)
{
    drawGridSeries(context, chart, Points::TwelveMonths);
}

}  // namespace kg::builders
