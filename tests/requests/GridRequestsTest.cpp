// The nine grid requests end to end through the dispatch ids of _cTavixGraph.
#include "support/RequestFixture.h"

#include "core/Convert.h"

namespace kg {
namespace {

using Fixture = test::RequestFixture;

std::string formWithAllGrids(int fixedRows, int dataRows, int cols)
{
    const std::string g = test::gridJson(fixedRows, dataRows, cols);
    return "{\"grid1\": " + g + ", \"grid2\": " + g + ", \"grid3\": " + g + "}";
}

// The request's two arguments: the series count and the total for the header.
Args seriesAndTotal(int32_t series, Variant total = Variant(1.0)) { return {Variant(series), std::move(total)}; }

struct HeaderCase {
    const char* name;
    const char* request;  // GenerateChart_ and this
    Variant total;
    const char* header;
    int16_t chartKind;
    const char* yTitle;
};

class Headers : public Fixture, public ::testing::WithParamInterface<HeaderCase> {};

TEST_P(Headers, TotalIsWrittenByTheRequestsRule)
{
    const HeaderCase& c = GetParam();
    setForm(formWithAllGrids(1, 2, 14));
    const DispId id = findOperation(std::string("GenerateChart_") + c.request)->id;
    ASSERT_EQ(request(id, seriesAndTotal(2, c.total)), 0) << lastError;
    EXPECT_EQ(modMain::goChart->ChartHeader(), c.header);
    EXPECT_EQ(chart1().header.text, c.header);
    EXPECT_EQ(modMain::giChartKind, c.chartKind);
    EXPECT_EQ(chart1().chartArea.y.title, c.yTitle);
    EXPECT_EQ(chart1().chartArea.x.title, "Month");
    EXPECT_EQ(mousePointer(), kPointerDefault);
    EXPECT_TRUE(modMain::gfChart->isShown());
    EXPECT_FALSE(modMain::gfChart->isRedrawVisible());
}

INSTANTIATE_TEST_SUITE_P(
    Table, Headers,
    ::testing::Values(
        HeaderCase{"hourly1Negative", "HourlyGraph1", Variant(-3.5), "Qty of Bookings: Total = -3.5", 5, "Quantity"},
        HeaderCase{"hourly1Text", "HourlyGraph1", Variant("1234.5"), "Qty of Bookings: Total =  1234.5", 5, "Quantity"},
        HeaderCase{"hourly2Zero", "HourlyGraph2", Variant(0.0), "Value of Bookings: Total = $0.00", 5, "Value"},
        HeaderCase{"hourly2Rounded", "HourlyGraph2", Variant(2.675), "Value of Bookings: Total = $2.68", 5, "Value"},
        HeaderCase{"hourly3Negative", "HourlyGraph3", Variant(-3.5), "Average Value of Bookings: Total = -$3.50", 5,
                   "Value"},
        HeaderCase{"prop1Decimal", "PropGraph1", Variant(1234.5), "New Bookings: Total =  1234.5", 4, "Quantity"},
        HeaderCase{"prop2Zero", "PropGraph2", Variant(int16_t(0)), "Continuing Jobs: Total = 0", 4, "Value"},
        HeaderCase{"prop2Half", "PropGraph2", Variant(2.675), "Continuing Jobs: Total = 3", 4, "Value"},
        HeaderCase{"prop3Negative", "PropGraph3", Variant(-3.5), "Nett Jobs By Month: Total = -4", 4, "Value"},
        HeaderCase{"yearly1", "YearlyRpt1", Variant(int32_t(1234)), "Quantity of Bookings: Total =  1234", 3,
                   "Quantity"},
        HeaderCase{"yearly2", "YearlyRpt2", Variant(1234.5), "Total Value of Jobs: Total = $1234.50", 3, "Value"},
        HeaderCase{"yearly3", "YearlyRpt3", Variant(2.675), "Average Value of Jobs: Total = $2.68", 3, "Value"}),
    [](const auto& info) { return std::string(info.param.name); });

TEST_F(Fixture, HourlyFillsTableAndLabelsFromTheGrid)
{
    setForm(formWithAllGrids(1, 3, 14));
    Args args = seriesAndTotal(3);
    ASSERT_EQ(request(KG_DISPID_GENERATECHART_HOURLYGRAPH1, args), 0) << lastError;
    control::ChartControl& c = chart1();
    EXPECT_EQ(c.group1.seriesLabels, (std::vector<std::string>{"Row 1", "Row 2", "Row 3"}));
    ASSERT_EQ(c.group1.pointLabels.size(), 12u);  // columns 1..cols-2
    EXPECT_EQ(c.group1.pointLabels.front(), "C1");
    EXPECT_EQ(c.group1.pointLabels.back(), "C12");
    EXPECT_EQ(c.chartArea.x.annotationMethod, 2);
    EXPECT_EQ(modMain::goChart->NumPoints(), 12);
    EXPECT_EQ(modMain::gvArray.upper(0), 3);
    EXPECT_EQ(modMain::gvArray.upper(1), 12);
    EXPECT_EQ(toText(modMain::gvArray.at(2, 5)), "25");
    EXPECT_TRUE(modMain::gvArray.at(2, 5).isString());  // stored as the grid's text
    EXPECT_EQ(c.data().y(3, 12), 42);
    EXPECT_TRUE(c.legend.isShown);
    // The arguments are read, never written.
    EXPECT_EQ(args[0].longValue(), 3);
    EXPECT_EQ(args[1].dbl(), 1.0);
}

TEST_F(Fixture, PropAndYearlyLeaveTheSameChart)
{
    setForm(formWithAllGrids(1, 2, 16));
    ASSERT_EQ(request(KG_DISPID_GENERATECHART_PROPGRAPH1, seriesAndTotal(2)), 0) << lastError;
    const auto labels = chart1().group1.pointLabels;
    const double last = chart1().data().y(2, 12);
    ASSERT_EQ(request(KG_DISPID_GENERATECHART_YEARLYRPT1, seriesAndTotal(2)), 0) << lastError;
    EXPECT_EQ(chart1().group1.pointLabels, labels);
    EXPECT_EQ(labels.size(), 12u);  // twelve months whatever the column count
    EXPECT_EQ(chart1().data().y(2, 12), last);
    EXPECT_EQ(modMain::goChart->NumPoints(), 12);
}

TEST_F(Fixture, SeveralFixedRowsKeepCaptionsWithTheirValues)
{
    setForm(formWithAllGrids(2, 2, 14));
    ASSERT_EQ(request(KG_DISPID_GENERATECHART_HOURLYGRAPH1, seriesAndTotal(2)), 0) << lastError;
    EXPECT_EQ(chart1().group1.seriesLabels, (std::vector<std::string>{"Row 1", "Row 2"}));
    EXPECT_EQ(chart1().data().y(1, 1), 11);  // "Row 1" values in series 1
    EXPECT_EQ(chart1().data().y(2, 1), 21);
}

// How a request ends for its form and arguments: the error number, a word its description must
// name, the chart kind stored before it failed (-1: not checked), and whether the chart was
// loaded before the form was needed. The mouse pointer is back to default whatever happened.
struct OutcomeCase {
    const char* name;
    std::string form;  // empty: no source form set
    DispId id;
    Args args;
    int32_t error;
    const char* detail = "";
    int16_t kind = -1;
    bool loadedFirst = false;
};

void PrintTo(const OutcomeCase& c, std::ostream* os) { *os << c.name; }

class Outcomes : public Fixture, public ::testing::WithParamInterface<OutcomeCase> {};

TEST_P(Outcomes, EndAsTheArgumentsAndFormDecide)
{
    const OutcomeCase& c = GetParam();
    if (!c.form.empty()) setForm(c.form);
    EXPECT_EQ(request(c.id, c.args), c.error) << lastError;
    EXPECT_NE(lastError.find(c.detail), std::string::npos) << lastError;
    if (c.kind >= 0) {
        EXPECT_EQ(modMain::giChartKind, c.kind);
    }
    if (c.loadedFirst) {
        EXPECT_TRUE(modMain::goChart && modMain::gfChart);
    }
    EXPECT_EQ(mousePointer(), kPointerDefault);
}

const std::string kThreeRows = formWithAllGrids(1, 3, 14);

INSTANTIATE_TEST_SUITE_P(
    Table, Outcomes,
    ::testing::Values(
        // The series count against three data rows.
        OutcomeCase{"fewerSeriesThanRows", kThreeRows, KG_DISPID_GENERATECHART_PROPGRAPH1, seriesAndTotal(2),
                    errc::SubscriptOutOfRange},
        OutcomeCase{"seriesEqualToRows", kThreeRows, KG_DISPID_GENERATECHART_PROPGRAPH1, seriesAndTotal(3), 0},
        // Bad totals fail after the chart kind is stored.
        OutcomeCase{"totalText", kThreeRows, KG_DISPID_GENERATECHART_HOURLYGRAPH1, seriesAndTotal(2, Variant("abc")),
                    errc::TypeMismatch, "", 5},
        OutcomeCase{"totalNull", kThreeRows, KG_DISPID_GENERATECHART_PROPGRAPH2, seriesAndTotal(2, Variant::null()),
                    errc::InvalidUseOfNull, "", 4},
        OutcomeCase{"noSourceForm", "", KG_DISPID_GENERATECHART_HOURLYGRAPH1, seriesAndTotal(2), errc::ObjectNotSet,
                    "", -1, true},
        OutcomeCase{"oneArgument", kThreeRows, KG_DISPID_GENERATECHART_HOURLYGRAPH1, {Variant(int32_t(2))},
                    errc::WrongArgumentCount}),
    [](const auto& info) { return std::string(info.param.name); });

TEST_F(Fixture, ExtraSeriesDrawAsZero)
{
    setForm(formWithAllGrids(1, 1, 14));
    ASSERT_EQ(request(KG_DISPID_GENERATECHART_YEARLYRPT2, seriesAndTotal(3)), 0) << lastError;
    EXPECT_EQ(chart1().data().seriesCount(), 3);
    EXPECT_EQ(chart1().data().y(3, 4), 0);
    EXPECT_EQ(modMain::gvArray.at(3, 4).type(), VarType::Integer);
}

TEST_F(Fixture, NoDataShowsTheMessageAndChangesNothing)
{
    setForm("{\"grid1\": " + test::gridJson(1, 0, 14) + ", \"grid2\": " + test::gridJson(1, 2, 14) + "}");
    modMain::giChartKind = 4;
    EXPECT_EQ(request(KG_DISPID_GENERATECHART_HOURLYGRAPH1, seriesAndTotal(2)), 0);  // caption rows only
    EXPECT_EQ(request(KG_DISPID_GENERATECHART_HOURLYGRAPH2, seriesAndTotal(2, Variant())),
              0);  // Empty total with a full grid
    EXPECT_EQ(prompts.messages, (std::vector<std::string>{"There is no data to work with",
                                                      "There is no data to work with"}));
    EXPECT_EQ(modMain::giChartKind, 4);
    EXPECT_EQ(mousePointer(), kPointerDefault);
    EXPECT_FALSE(modMain::gfChart->isShown());  // loaded by GraphInitialize, not shown
}

TEST_F(Fixture, TwoColumnGridHasNoPoints)
{
    setForm("{\"grid1\": " + test::gridJson(1, 2, 2) + "}");
    ASSERT_EQ(request(KG_DISPID_GENERATECHART_HOURLYGRAPH1, seriesAndTotal(2)), 0) << lastError;
    EXPECT_EQ(modMain::goChart->NumPoints(), 0);
    EXPECT_TRUE(chart1().group1.pointLabels.empty());
}

TEST_F(Fixture, TwoRequestsInARowReplaceEverything)
{
    setForm("{\"grid1\": " + test::gridJson(1, 3, 14) + ", \"grid2\": " + test::gridJson(1, 1, 14) + "}");
    ASSERT_EQ(request(KG_DISPID_GENERATECHART_HOURLYGRAPH1, seriesAndTotal(3)), 0);
    const Ref<c2dChart> firstChart = modMain::goChart;
    const Ref<ChartWindowPort> window = modMain::gfChart;
    ASSERT_EQ(request(KG_DISPID_GENERATECHART_HOURLYGRAPH2, seriesAndTotal(1, Variant(2.0))), 0);
    EXPECT_NE(modMain::goChart, firstChart);   // a fresh chart object
    EXPECT_EQ(modMain::gfChart, window);        // the same window
    EXPECT_EQ(chart1().group1.seriesLabels, std::vector<std::string>{"Row 1"});
    EXPECT_EQ(modMain::gvArray.upper(0), 1);
}

}  // namespace
}  // namespace kg
