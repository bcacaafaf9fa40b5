#include "builders/GridSeriesBuilders.h"
#include "builders/LateBoundGrid.h"
#include "requests/Requests.h"
#include "requests/Services.h"
#include "requests/modMain.h"
#include "core/Convert.h"

namespace kg::requests {

using namespace modMain;

namespace {

enum class TotalForm { Plain, Dollars, Whole };
using Builder = void (*)(builders::BuildContext&, const builders::GridChart&);

struct GridRequestRow {
    const char* grid;
    int16_t requestKind;
    const char* header;
    TotalForm total;
    const char* yTitle;
    Builder builder;
};

const GridRequestRow& rowOf(GridRequest r)
{
    using namespace builders;
    static const GridRequestRow rows[] = {
        {"grid1", kHourlyRequest, "Qty of Bookings: Total = ", TotalForm::Plain, "Quantity", DrawHourlyGraph},
        {"grid2", kHourlyRequest, "Value of Bookings: Total = ", TotalForm::Dollars, "Value", DrawHourlyGraph},
        {"grid3", kHourlyRequest, "Average Value of Bookings: Total = ", TotalForm::Dollars, "Value", DrawHourlyGraph},
        {"grid1", kPropGraphRequest, "New Bookings: Total = ", TotalForm::Plain, "Quantity", DrawPropGraph},
        {"grid2", kPropGraphRequest, "Continuing Jobs: Total = ", TotalForm::Whole, "Value", DrawPropGraph},
        {"grid3", kPropGraphRequest, "Nett Jobs By Month: Total = ", TotalForm::Whole, "Value", DrawPropGraph},
        {"grid1", kYearlyRequest, "Quantity of Bookings: Total = ", TotalForm::Plain, "Quantity", DrawYearlyRpt},
        {"grid2", kYearlyRequest, "Total Value of Jobs: Total = ", TotalForm::Dollars, "Value", DrawYearlyRpt},
        {"grid3", kYearlyRequest, "Average Value of Jobs: Total = ", TotalForm::Dollars, "Value", DrawYearlyRpt},
    };
    return rows[static_cast<int>(r)];
}

std::string writeTotal(const Variant& total, TotalForm form)
{
    switch (form) {
    case TotalForm::Plain: return numberText(total);
    case TotalForm::Dollars: return formatPattern(total, "$0.00");
    case TotalForm::Whole: return formatPattern(total, "0");
    }
    return {};
}

}  // namespace

void generateGridChart(GridRequest request, int32_t numSeries, const Variant& total)
{
    const GridRequestRow& row = rowOf(request);
    GraphInitialize();
    const Variant gridObject = call(gvSourceForm, row.grid);
    builders::LateBoundGrid grid(gridObject);
    // Both halves are evaluated, the grid's Rows before its FixedRows.
    const bool noTotal = total.isEmpty();
    const int32_t rows = grid.Rows();
    const bool noRows = rows == grid.FixedRows();
    if (noTotal || noRows) {
        services().prompter->showMessage(kNoData);
        return;
    }
    giChartKind = row.requestKind;
    HourglassOn();
    row.builder(buildContext(), {gridObject, row.header + writeTotal(total, row.total), row.yTitle, numSeries});
}

}  // namespace kg::requests
