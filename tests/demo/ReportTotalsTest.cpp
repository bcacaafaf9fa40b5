// The host's arithmetic on its grids: number texts, the totals passed as vTotal, and the figures
// kept in step when a cell is edited on the screen.
#include <gtest/gtest.h>

#include <QTableWidget>

#include "apps/demo/ReportData.h"
#include "apps/demo/ReportForm.h"
#include "apps/demo/ReportTotals.h"

namespace {

using namespace kg::demo;

struct TextCase {
    const char* name;
    double value;
    const char* text;
};

void PrintTo(const TextCase& c, std::ostream* os) { *os << c.name; }

class NumberCellTextTest : public ::testing::TestWithParam<TextCase> {};

TEST_P(NumberCellTextTest, WritesAtMostTwoDecimalsWithoutTrailingZeros)
{
    EXPECT_EQ(numberCellText(GetParam().value).toStdString(), GetParam().text);
}

// One decimal without its trailing zero is in "Negative" and "NoGrouping"; zero in "TinyNegativeIsZero".
const TextCase kTexts[] = {
    {"Whole", 1234, "1234"}, {"TwoDecimals", 0.07, "0.07"}, {"RoundsUp", 2.675000001, "2.68"},
    {"Negative", -3.1, "-3.1"}, {"TinyNegativeIsZero", -0.001, "0"}, {"NoGrouping", 1234567.8, "1234567.8"},
};
INSTANTIATE_TEST_SUITE_P(Texts, NumberCellTextTest, ::testing::ValuesIn(kTexts),
                         [](const auto& info) { return std::string(info.param.name); });

// A grid from rows of texts, row 0 the captions.
GridCells gridOf(const std::vector<std::vector<const char*>>& rows, int fixedRows = 1)
{
    GridCells g;
    g.rows = int(rows.size());
    g.cols = rows.empty() ? 0 : int(rows.front().size());
    g.fixedRows = fixedRows;
    g.text = [rows](int r, int c) { return QString::fromUtf8(rows[size_t(r)][size_t(c)]); };
    return g;
}

struct TotalsCase {
    const char* name;
    GridCells grid1, grid2;
    double quantity, value, average;
};

void PrintTo(const TotalsCase& c, std::ostream* os) { *os << c.name; }

class ReportTotalsTest : public ::testing::TestWithParam<TotalsCase> {};

TEST_P(ReportTotalsTest, SumsTheMonthsOfTheDataRows)
{
    const TotalsCase& c = GetParam();
    const ReportTotals t = reportTotals(c.grid1, c.grid2);
    EXPECT_DOUBLE_EQ(t.quantity, c.quantity);
    EXPECT_DOUBLE_EQ(t.value, c.value);
    EXPECT_DOUBLE_EQ(t.average, c.average);
}

const TotalsCase kTotals[] = {
    {"TotalColumnIsNotCounted",
     gridOf({{"", "Jan", "Feb", "Total"}, {"A", "2", "3", "5"}, {"B", "1", "4", "5"}}),
     gridOf({{"", "Jan", "Feb", "Total"}, {"A", "20.5", "30", "50.5"}, {"B", "10", "40", "50"}}), 10, 100.5, 10.05},
    {"CaptionRowsAreNotCounted",
     gridOf({{"", "Jan", "Total"}, {"", "9", "9"}, {"A", "4", "4"}}, 2),
     gridOf({{"", "Jan", "Total"}, {"", "99", "99"}, {"A", "10", "10"}}, 2), 4, 10, 2.5},
    {"TextsAndBlanksCountAsNothing",
     gridOf({{"", "Jan", "Feb", "Total"}, {"A", "n/a", " 3 ", ""}}),
     gridOf({{"", "Jan", "Feb", "Total"}, {"A", "", "7", ""}}), 3, 7, 2.33},
    {"NoBookingsGiveNoAverage",
     gridOf({{"", "Jan", "Total"}, {"A", "0", "0"}}), gridOf({{"", "Jan", "Total"}, {"A", "0", "0"}}), 0, 0, 0},
    {"OnlyTwelveMonthsEvenWithoutATotalColumn",
     gridOf({{"", "1", "2", "3", "4", "5", "6", "7", "8", "9", "10", "11", "12", "13"},
             {"A", "1", "1", "1", "1", "1", "1", "1", "1", "1", "1", "1", "1", "100"}}),
     gridOf({{"", "Jan", "Total"}, {"A", "6", "6"}}), 12, 6, 0.5},
    {"NoDataRows", gridOf({{"", "Jan", "Total"}}), gridOf({{"", "Jan", "Total"}}), 0, 0, 0},
};
INSTANTIATE_TEST_SUITE_P(Grids, ReportTotalsTest, ::testing::ValuesIn(kTotals),
                         [](const auto& info) { return std::string(info.param.name); });

// --- Editing on the screen ----------------------------------------------------------------------

ReportData smallReport()
{
    ReportData d;
    const QStringList head{"Agent", "Jan", "Feb", "Total"};
    d.grids["grid1"].cells = {head, {"A", "2", "4", "6"}, {"B", "1", "1", "2"}};
    d.grids["grid2"].cells = {head, {"A", "20", "60", "80"}, {"B", "5", "7", "12"}};
    d.grids["grid3"].cells = {head, {"A", "10", "15", "13.33"}, {"B", "5", "7", "6"}};
    d.grids["gridsettings1"].cells = {{"Quote Type", "Qty"}, {"Retail", "3"}};
    d.fromDate = QDate(2026, 1, 1);
    d.toDate = QDate(2026, 3, 31);
    d.fields = {"Unconfirmed", "Unscheduled"};
    return d;
}

struct EditCase {
    const char* name;
    const char* grid;
    int row, col;
    const char* text;
    double quantity, value, average;        // the totals afterwards
    std::vector<const char*> rowOfGrid1;    // the edited row of each grid afterwards (columns 1..3)
    std::vector<const char*> rowOfGrid2;
    std::vector<const char*> rowOfGrid3;
};

void PrintTo(const EditCase& c, std::ostream* os) { *os << c.name; }

class EditTest : public ::testing::TestWithParam<EditCase> {};

TEST_P(EditTest, KeepsTotalsAndAveragesInStep)
{
    const EditCase& c = GetParam();
    ReportForm form;
    form.fill(smallReport());
    form.grid(c.grid)->item(c.row, c.col)->setText(c.text);

    const ReportTotals t = form.totals();
    EXPECT_DOUBLE_EQ(t.quantity, c.quantity);
    EXPECT_DOUBLE_EQ(t.value, c.value);
    EXPECT_DOUBLE_EQ(t.average, c.average);
    const std::pair<const char*, const std::vector<const char*>*> expected[] = {
        {"grid1", &c.rowOfGrid1}, {"grid2", &c.rowOfGrid2}, {"grid3", &c.rowOfGrid3}};
    for (const auto& [name, cells] : expected)
        for (int col = 1; col <= 3; ++col)
            EXPECT_EQ(form.grid(name)->item(c.row, col)->text().toStdString(), (*cells)[size_t(col - 1)])
                << name << " column " << col;
}

const EditCase kEdits[] = {
    {"MoreBookings", "grid1", 1, 2, "8", 12, 92, 7.67, {"2", "8", "10"}, {"20", "60", "80"}, {"10", "7.5", "8"}},
    {"LessValue", "grid2", 2, 1, "2.5", 8, 89.5, 11.19, {"1", "1", "2"}, {"2.5", "7", "9.5"}, {"2.5", "7", "4.75"}},
    {"MonthCleared", "grid1", 1, 1, "", 6, 92, 15.33, {"", "4", "4"}, {"20", "60", "80"}, {"0", "15", "20"}},
    // The Total column and grid3 are figures of their own: the totals do not follow them.
    {"TotalColumnEdited", "grid1", 1, 3, "100", 8, 92, 11.5, {"2", "4", "100"}, {"20", "60", "80"},
     {"10", "15", "13.33"}},
    {"AverageEdited", "grid3", 1, 1, "99", 8, 92, 11.5, {"2", "4", "6"}, {"20", "60", "80"}, {"99", "15", "13.33"}},
};
INSTANTIATE_TEST_SUITE_P(Cells, EditTest, ::testing::ValuesIn(kEdits),
                         [](const auto& info) { return std::string(info.param.name); });

}  // namespace
