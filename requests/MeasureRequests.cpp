#include "builders/BookingsBuilders.h"
#include "builders/LateBoundGrid.h"
#include "requests/Measures.h"
#include "requests/Requests.h"
#include "requests/Services.h"
#include "requests/modMain.h"

namespace kg::requests {

using namespace modMain;

namespace {

void measureRequest(int16_t requestKind)
{
    GraphInitialize();
    builders::LateBoundGrid grid(call(gvSourceForm, "gridsettings1"));
    const int32_t rows = grid.Rows();
    if (rows == grid.FixedRows()) {
        services().prompter->showMessage(kNoData);
        return;
    }
    // Stored before the dialog: a cancelled choice still leaves the code.
    giChartKind = requestKind;
    chooseAndDrawMeasure(requestKind);
}

}  // namespace

bool chooseAndDrawMeasure(int16_t requestKind)
{
    const bool quoteTypes = requestKind == kBookingsRequest;
    const int16_t choice = services().prompter->chooseData(quoteTypes ? ChoiceDialog::QuoteType : ChoiceDialog::Category);
    if (choice == kChoiceCancelled) return false;
    HourglassOn();
    // No row of the table matches: nothing is drawn.
    if (choice < 0 || choice >= int16_t(kMeasures.size())) return true;
    const Measure& m = kMeasures[size_t(choice)];
    const std::string header = quoteTypes ? m.quoteTypeHeader : m.categoryHeader;
    if (m.column2 == 0)
        builders::DrawBookingsGraph(buildContext(), header, m.yTitle, m.column1);
    else
        builders::DrawBookingsDualGraph(buildContext(), header, m.column1, m.column2);
    return true;
}

void GenerateChart_BookingsReport() { measureRequest(kBookingsRequest); }
void GenerateChart_SalesDeclaration() { measureRequest(kCategoryRequest); }
void GenerateChart_ServCatSumm() { measureRequest(kCategoryRequest); }

}  // namespace kg::requests
