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
        {kHourlyRequest, "Qty of Bookings: Total = ", TotalForm::Plain, "Quantity", DrawHourlyGraph},
        {kHourlyRequest, "Value of Bookings: Total = ", TotalForm::Dollars, "Value", DrawHourlyGraph},
        {kHourlyRequest, "Average Value of Bookings: Total = ", TotalForm::Dollars, "Value", DrawHourlyGraph},
        {kPropGraphRequest, "New Bookings: Total = ", TotalForm::Plain, "Quantity", DrawPropGraph},
        {kPropGraphRequest, "Continuing Jobs: Total = ", TotalForm::Whole, "Value", DrawPropGraph},
        {kPropGraphRequest, "Nett Jobs By Month: Total = ", TotalForm::Whole, "Value", DrawPropGraph},
        {kYearlyRequest, "Quantity of Bookings: Total = ", TotalForm::Plain, "Quantity", DrawYearlyRpt},
        {kYearlyRequest, "Total Value of Jobs: Total = ", TotalForm::Dollars, "Value", DrawYearlyRpt},
        {kYearlyRequest, "Average Value of Jobs: Total = ", TotalForm::Dollars, "Value", DrawYearlyRpt},
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

void generateGridChart(GridRequest request, const char* gridName, int32_t numSeries, const Variant& total)
{
    const GridRequestRow& row = rowOf(request);
    GraphInitialize();
    const Variant gridObject = call(gvSourceForm, gridName);
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
