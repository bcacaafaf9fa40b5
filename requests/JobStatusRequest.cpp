#include "builders/LateBoundGrid.h"
#include "requests/Requests.h"
#include "requests/Services.h"
#include "requests/modMain.h"
#include "core/Convert.h"
#include "core/Error.h"

namespace kg::requests {

using namespace modMain;

namespace {

constexpr int32_t kCategories = 13;

// Counts are Integers until they outgrow 16 bits, as adding 1 to a Variant does.
void addOne(Variant& cell)
{
    switch (cell.type()) {
    case VarType::Empty: cell = Variant(int16_t(1)); break;
    case VarType::Integer:
        cell = cell.integer() < INT16_MAX ? Variant(int16_t(cell.integer() + 1)) : Variant(int32_t(INT16_MAX) + 1);
        break;
    case VarType::Long:
        cell = cell.longValue() < INT32_MAX ? Variant(cell.longValue() + 1) : Variant(double(INT32_MAX) + 1);
        break;
    default: cell = Variant(toDouble(cell) + 1); break;
    }
}

// The host's cell conversions, late-bound, with their dispatch ids kept for the row loop.
class CellTexts {
public:
    explicit CellTexts(const Variant& appServices) : services_(appServices) {}

    std::string statusText(const Variant& cell)
    {
        Args a{Variant(int32_t(0)), Variant(int32_t(0)), cell, std::string()};
        invoke("CellToText", toTextId_, a);
        return toText(a[3]);
    }
    double number(const Variant& cell)
    {
        Args a{Variant(int32_t(1)), cell, std::string()};
        invoke("CellToNumberText", toNumberId_, a);
        return readNumber(toText(a[2]));
    }

private:
    void invoke(const char* member, DispId& id, Args& a)
    {
        if (!services_.isObject() || !services_.object()) throw Error::objectNotSet("goAppServices");
        if (id == INT32_MIN) id = services_.object()->idOfName(member);
        services_.object()->invoke(id, kMethod, a);
    }
    Variant services_;
    DispId toTextId_ = INT32_MIN, toNumberId_ = INT32_MIN;
};

void countRow(CellTexts& texts, const VariantArray& rows, int32_t r, VariantArray& table)
{
    const Variant& status = rows.at(26, r);
    auto field = [&](int32_t f) { return texts.number(rows.at(f, r)); };
    auto hit = [&](int32_t point) { addOne(table.at(1, point)); };
    if (texts.statusText(status) == "Unconfirmed") hit(1);
    if (texts.statusText(status) == "Unscheduled") hit(2);
    if (texts.statusText(status) == "Cancelled") hit(3);
    if (texts.statusText(status) == "Postponed") hit(4);
    if (texts.statusText(status) == "Confirmed") hit(5);
    if (field(44) == 1) hit(6);
    if (field(64) == 1) hit(7);
    if (field(59) == 1) hit(8);
    if (field(45) == 1) hit(9);
    if (field(52) == 1) hit(10);
    // Both halves are read (no short-circuit), as the host expects each field number to be asked for.
    const bool cleared = field(64) == 0, flagged = field(46) == 1;
    if (cleared && flagged) hit(11);
    const bool closed = field(64) == 1, flaggedAgain = field(46) == 1;
    if (closed && flaggedAgain) hit(12);
    if (texts.statusText(status) == "Imported") hit(13);
}

}  // namespace

void GenerateChart_JobStatusReport()
{
    GraphInitialize();
    const Variant from = builders::datePickerValue(gvSourceForm, "dtpFromDate");
    const Variant to = builders::datePickerValue(gvSourceForm, "dtpToDate");
    if (toDouble(to) < toDouble(from)) {
        services().prompter->showMessage(kDatesReversed);
        return;
    }
    HourglassOn();
    {
        Args a{builders::datePickerValue(gvSourceForm, "dtpFromDate")};
        call(goJobData, "SetFromDate", a);
        Args b{builders::datePickerValue(gvSourceForm, "dtpToDate")};
        call(goJobData, "SetToDate", b);
    }
    ChartWindowPort& window = chartWindow();
    control::ChartControl& chart1 = window.Chart1();
    const std::string xTitle = formatPattern(builders::datePickerValue(gvSourceForm, "dtpFromDate"), "DD/MM/YYYY") +
                               " - " +
                               formatPattern(builders::datePickerValue(gvSourceForm, "dtpToDate"), "DD/MM/YYYY");
    c2dChart& c = chart();
    c.Initialize(&chart1, "Tavix Job Status Chart", "", xTitle, "Quantity");

    const Variant fields = call(gvSourceForm, "cboFields", {Variant(int16_t(1))});
    c.setNumSeries(1);
    c2dChart::setShowLegend(false);
    c.setXMinData(1);
    c.setXMaxData(toLong(call(fields, "ListCount")));
    c.InitChart();
    // Every category gets its point even when the field list is shorter: a count must never fall
    // outside the table. Points beyond the list carry no label.
    if (c.NumPoints() < kCategories) c.setNumPoints(kCategories);
    gvArray.redim(c.NumSeries(), c.NumPoints());
    c.setXAxisLabels(false);

    chart1.group1.pointLabels.clear();
    for (int32_t i = 0, n = toLong(call(fields, "ListCount")); i < n; ++i)
        chart1.group1.pointLabels.push_back(toText(call(fields, "List", {Variant(i)})));
    chart1.chartArea.x.annotationMethod = 2;

    Args query{Variant(int32_t(255)), std::string()};
    call(goJobData, "GetJobQuery", query);
    Args fetch{query[1], Variant(), Variant(int32_t(0)), std::string(), Variant(int32_t(0))};
    call(goJobData, "FetchJobRows", fetch);
    const int32_t count = toLong(fetch[4]);
    if (count < 1) {
        HourglassOff();
        services().prompter->showMessage(kNoJobs);
        return;
    }
    if (!fetch[1].isArray()) throw Error::typeMismatch("FetchJobRows returned no table of job rows");
    const VariantArray& rows = fetch[1].array();
    CellTexts texts(goAppServices);
    for (int32_t r = 0; r < count; ++r) countRow(texts, rows, r, gvArray);

    HourglassOff();
    window.setRedrawVisible(false);
    window.Show();
    c.DrawChart(gvArray);
}

}  // namespace kg::requests
