#include "builders/BookingsBuilders.h"
#include "builders/LateBoundGrid.h"
#include "requests/Requests.h"
#include "requests/Services.h"
#include "requests/modMain.h"

namespace kg::requests {

using namespace modMain;

namespace {

// The choice table: the builder's measure column(s), Y title and the headers of both families.
struct Choice {
    int32_t column1, column2;  // column2 0: one measure
    const char* yTitle;
    const char* quoteTypeHeader;
    const char* categoryHeader;
};

constexpr Choice kChoices[] = {
    {1, 0, "Quantity", "Quote Type by Quantity", "Category by Quantity"},
    {2, 0, "$Value", "Quote Type by $Value", "Category by $Value"},
    {3, 0, "Average $Value", "Quote Type by Average Value", "Category by Average Value"},
    {4, 0, "% Jobs", "Quote Type by Percent of Jobs", "Category by Percent of Jobs"},
    {5, 0, "% by $Value", "Quote Type by Percent of $Value", "Category by Percent of $Value"},
    {2, 3, "", "Quote Type by $Value and Average $Value", "Category by $Value and Average $Value"},
    {4, 5, "", "Quote Type by %Jobs and % $Value", "Category by %Jobs and % $Value"},
};

void measureRequest(int16_t chartKind)
{
    GraphInitialize();
    builders::LateBoundGrid grid(call(gvSourceForm, "gridsettings1"));
    const int32_t rows = grid.Rows();
    if (rows == grid.FixedRows()) {
        services().prompter->showMessage(kNoData);
        return;
    }
    // Stored before the dialog: a cancelled choice still leaves the code.
    giChartKind = chartKind;
    chooseAndDrawMeasure(chartKind);
}

}  // namespace

bool chooseAndDrawMeasure(int16_t chartKind)
{
    const bool quoteTypes = chartKind == kBookings;
    const int16_t iChoice =
        services().prompter->chooseData(quoteTypes ? ChoiceDialog::QuoteType : ChoiceDialog::Category);
    if (iChoice == kChoiceCancelled) return false;
    HourglassOn();
    if (iChoice < 0 || iChoice > 6) return true;  // no row of the table matches: nothing is drawn
    const Choice& c = kChoices[iChoice];
    const std::string header = quoteTypes ? c.quoteTypeHeader : c.categoryHeader;
    if (c.column2 == 0)
        builders::DrawBookingsGraph(buildContext(), header, c.yTitle, c.column1);
    else
        builders::DrawBookingsDualGraph(buildContext(), header, c.column1, c.column2);
    return true;
}

void GenerateChart_BookingsReport() { measureRequest(kBookings); }
void GenerateChart_SalesDeclaration() { measureRequest(kCategories); }
void GenerateChart_ServCatSumm() { measureRequest(kCategories); }

}  // namespace kg::requests
