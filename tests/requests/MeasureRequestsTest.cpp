// The three measure-choice requests through their dispatch ids, every choice, on a settings grid
// with numbers, a blank cell, a Null cell and a text cell.
#include "support/RequestFixture.h"

#include "core/Convert.h"

namespace kg {
namespace {

const char* kSettingsGrid =
    "{\"gridsettings1\": {\"fixedRows\": 1, \"cells\": ["
    "[\"Quote Type\", \"Qty\", \"Value\", \"Avg Value\", \"Pct Jobs\", \"Pct Value\"],"
    "[\"Retail\", 12, 1200.5, 100.04, 40, 35.5],"
    "[\"Corporate\", \"\", 800, null, 25, \"20.5\"],"
    "[\"Online\", null, \"\", 50, \"7\", 44]]},"
    " \"dtpFromDate\": \"2013-07-01\", \"dtpToDate\": \"2014-06-30\"}";

// A cell as DrawChart leaves it: numbers as they came, texts kept, blanks and Null made Integer 0.
struct Cell {
    VarType type;
    double value;
};
constexpr Cell N(double v) { return {VarType::Double, v}; }
constexpr Cell T(double v) { return {VarType::String, v}; }
constexpr Cell Z = {VarType::Integer, 0};

struct ChoiceCase {
    std::string name;
    DispId request;
    int16_t choice;
    const char* header;
    const char* yTitle;
    std::vector<std::string> seriesLabels;  // empty: left as they were (one measure)
    std::vector<std::vector<Cell>> series;  // per series, per point
};

using MeasureFixture = test::RequestFixture;

class Choices : public test::RequestFixture, public ::testing::WithParamInterface<ChoiceCase> {};

TEST_P(Choices, DrawTheChosenMeasure)
{
    const ChoiceCase& c = GetParam();
    setForm(kSettingsGrid);
    prompts.choices.push_back(c.choice);
    ASSERT_EQ(request(c.request), 0) << lastError;
    control::ChartControl& chart = chart1();
    EXPECT_EQ(chart.header.text, c.header);
    EXPECT_EQ(chart.chartArea.y.title, c.yTitle);
    EXPECT_EQ(chart.chartArea.x.title, "01/07/2013 - 30/06/2014");
    EXPECT_EQ(chart.group1.pointLabels, (std::vector<std::string>{"Retail", "Corporate", "Online"}));
    if (!c.seriesLabels.empty()) {
        EXPECT_EQ(chart.group1.seriesLabels, c.seriesLabels);
    }
    EXPECT_EQ(chart.legend.isShown, c.series.size() == 2);
    EXPECT_TRUE(modMain::gfChart->isRedrawVisible());
    EXPECT_EQ(modMain::giChartKind, c.request == KG_DISPID_GENERATECHART_BOOKINGSREPORT ? 1 : 2);
    ASSERT_EQ(modMain::gvArray.upper(0), int32_t(c.series.size()));
    for (size_t s = 0; s < c.series.size(); ++s)
        for (size_t p = 0; p < 3; ++p) {
            const Variant& cell = modMain::gvArray.at(int32_t(s + 1), int32_t(p + 1));
            EXPECT_EQ(cell.type(), c.series[s][p].type) << "series " << s + 1 << " point " << p + 1;
            EXPECT_EQ(toDouble(cell), c.series[s][p].value) << "series " << s + 1 << " point " << p + 1;
            EXPECT_EQ(chart.data().y(int32_t(s + 1), int32_t(p + 1)), c.series[s][p].value);
        }
    EXPECT_EQ(mousePointer(), kPointerDefault);
}

std::vector<ChoiceCase> choiceCases()
{
    const std::vector<std::vector<Cell>> columns[] = {
        {}, {{N(12), Z, Z}}, {{N(1200.5), N(800), Z}}, {{N(100.04), Z, N(50)}}, {{N(40), N(25), T(7)}},
        {{N(35.5), T(20.5), N(44)}}};
    struct Row {
        const char* yTitle;
        int c1, c2;
        const char* quoteType;
        const char* category;
    };
    const Row rows[] = {
        {"Quantity", 1, 0, "Quote Type by Quantity", "Category by Quantity"},
        {"$Value", 2, 0, "Quote Type by $Value", "Category by $Value"},
        {"Average $Value", 3, 0, "Quote Type by Average Value", "Category by Average Value"},
        {"% Jobs", 4, 0, "Quote Type by Percent of Jobs", "Category by Percent of Jobs"},
        {"% by $Value", 5, 0, "Quote Type by Percent of $Value", "Category by Percent of $Value"},
        {"", 2, 3, "Quote Type by $Value and Average $Value", "Category by $Value and Average $Value"},
        {"", 4, 5, "Quote Type by %Jobs and % $Value", "Category by %Jobs and % $Value"},
    };
    const char* captions[] = {"Quote Type", "Qty", "Value", "Avg Value", "Pct Jobs", "Pct Value"};
    std::vector<ChoiceCase> cases;
    const std::pair<DispId, const char*> requests[] = {{KG_DISPID_GENERATECHART_BOOKINGSREPORT, "bookings"},
                                                       {KG_DISPID_GENERATECHART_SALESDECLARATION, "sales"},
                                                        {KG_DISPID_GENERATECHART_SERVCATSUMM, "servCat"}};
    for (const auto& [id, name] : requests)
        for (int16_t choice = 0; choice < 7; ++choice) {
            const Row& r = rows[choice];
            ChoiceCase c{std::string(name) + "Choice" + std::to_string(choice), id, choice,
                         id == KG_DISPID_GENERATECHART_BOOKINGSREPORT ? r.quoteType : r.category, r.yTitle, {}, {}};
            c.series.push_back(columns[r.c1][0]);
            if (r.c2) {
                c.series.push_back(columns[r.c2][0]);
                c.seriesLabels = {captions[r.c1], captions[r.c2]};
            }
            cases.push_back(c);
        }
    return cases;
}

INSTANTIATE_TEST_SUITE_P(Table, Choices, ::testing::ValuesIn(choiceCases()),
                         [](const auto& info) { return info.param.name; });

TEST_F(MeasureFixture, CancelledChoiceDrawsNothingButKeepsTheCode)
{
    setForm(kSettingsGrid);
    modMain::giChartKind = 5;
    prompts.choices.push_back(kChoiceCancelled);
    ASSERT_EQ(request(KG_DISPID_GENERATECHART_SALESDECLARATION), 0) << lastError;
    EXPECT_EQ(modMain::giChartKind, 2);
    EXPECT_FALSE(modMain::gfChart->isShown());
    EXPECT_EQ(mousePointer(), kPointerDefault);
    EXPECT_EQ(prompts.dialogsShown, std::vector<std::string>{"frmChoose2"});
}

TEST_F(MeasureFixture, GridWithoutDataRowsShowsTheMessageBeforeAnyDialog)
{
    setForm("{\"gridsettings1\": {\"fixedRows\": 1, \"cells\": [[\"Quote Type\", \"Qty\", \"Value\", \"Avg\", \"P1\", "
            "\"P2\"]]}}");
    modMain::giChartKind = 4;
    ASSERT_EQ(request(KG_DISPID_GENERATECHART_BOOKINGSREPORT), 0) << lastError;
    EXPECT_EQ(prompts.messages, std::vector<std::string>{"There is no data to work with"});
    EXPECT_TRUE(prompts.dialogsShown.empty());
    EXPECT_EQ(modMain::giChartKind, 4);
}

TEST_F(MeasureFixture, TwoFixedRowsStartAtTheSecondRow)
{
    setForm("{\"gridsettings1\": {\"fixedRows\": 2, \"cells\": [[\"T\", \"Qty\", \"V\", \"A\", \"P\", \"Q\"],"
            "[\"never read\", 99, 99, 99, 99, 99], [\"Retail\", 3, 1, 1, 1, 1], [\"Online\", 7, 1, 1, 1, 1]]},"
            " \"dtpFromDate\": \"2026-01-01\", \"dtpToDate\": \"2026-01-31\"}");
    prompts.choices.push_back(0);
    ASSERT_EQ(request(KG_DISPID_GENERATECHART_BOOKINGSREPORT), 0) << lastError;
    EXPECT_EQ(chart1().group1.pointLabels, (std::vector<std::string>{"Retail", "Online"}));
    EXPECT_EQ(chart1().data().y(1, 1), 3);
    EXPECT_EQ(chart1().data().y(1, 2), 7);
}

}  // namespace
}  // namespace kg
