// The nine grid requests end to end through the dispatch ids of _cTavixGraph.
#include "support/RequestFixture.h"

#include "core/Convert.h"

namespace kg {
namespace {

constexpr DispId kYearly1 = 0x60030009, kYearly2 = 0x6003000A, kYearly3 = 0x6003000B;
constexpr DispId kProp1 = 0x60030011, kProp2 = 0x60030012, kProp3 = 0x60030013;
constexpr DispId kHourly1 = 0x60030014, kHourly2 = 0x60030015, kHourly3 = 0x60030016;

using Fixture = test::RequestFixture;

std::string formWithAllGrids(int fixedRows, int dataRows, int cols)
{
    const std::string g = test::gridJson(fixedRows, dataRows, cols);
    return "{\"grid1\": " + g + ", \"grid2\": " + g + ", \"grid3\": " + g + "}";
}

struct HeaderCase {
    const char* name;
    DispId id;
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
    Args args{Variant(int32_t(2)), c.total};
    ASSERT_EQ(request(c.id, args), 0) << lastError;
    EXPECT_EQ(modMain::goChart->ChartHeader(), c.header);
    EXPECT_EQ(chart1().header.text, c.header);
    EXPECT_EQ(modMain::giChartKind, c.chartKind);
    EXPECT_EQ(chart1().chartArea.y.title, c.yTitle);
    EXPECT_EQ(chart1().chartArea.x.title, "Month");
    EXPECT_EQ(ui->mousePointer(), kPointerDefault);
    EXPECT_TRUE(modMain::gfChart->isShown());
    EXPECT_FALSE(modMain::gfChart->isRedrawVisible());
}

INSTANTIATE_TEST_SUITE_P(
    Table, Headers,
    ::testing::Values(
        HeaderCase{"hourly1Zero", kHourly1, Variant(0.0), "Qty of Bookings: Total =  0", 5, "Quantity"},
        HeaderCase{"hourly1Negative", kHourly1, Variant(-3.5), "Qty of Bookings: Total = -3.5", 5, "Quantity"},
        HeaderCase{"hourly1Text", kHourly1, Variant("1234.5"), "Qty of Bookings: Total =  1234.5", 5, "Quantity"},
        HeaderCase{"hourly2Zero", kHourly2, Variant(0.0), "Value of Bookings: Total = $0.00", 5, "Value"},
        HeaderCase{"hourly2Rounded", kHourly2, Variant(2.675), "Value of Bookings: Total = $2.68", 5, "Value"},
        HeaderCase{"hourly3Negative", kHourly3, Variant(-3.5), "Average Value of Bookings: Total = -$3.50", 5, "Value"},
        HeaderCase{"prop1Decimal", kProp1, Variant(1234.5), "New Bookings: Total =  1234.5", 4, "Quantity"},
        HeaderCase{"prop2Zero", kProp2, Variant(int16_t(0)), "Continuing Jobs: Total = 0", 4, "Value"},
        HeaderCase{"prop2Half", kProp2, Variant(2.675), "Continuing Jobs: Total = 3", 4, "Value"},
        HeaderCase{"prop3Negative", kProp3, Variant(-3.5), "Nett Jobs By Month: Total = -4", 4, "Value"},
        HeaderCase{"yearly1", kYearly1, Variant(int32_t(1234)), "Quantity of Bookings: Total =  1234", 3, "Quantity"},
        HeaderCase{"yearly2", kYearly2, Variant(1234.5), "Total Value of Jobs: Total = $1234.50", 3, "Value"},
        HeaderCase{"yearly3", kYearly3, Variant(2.675), "Average Value of Jobs: Total = $2.68", 3, "Value"}),
    [](const auto& info) { return std::string(info.param.name); });

TEST_F(Fixture, HourlyFillsTableAndLabelsFromTheGrid)
{
    setForm(formWithAllGrids(1, 3, 14));
    Args args{Variant(int32_t(3)), Variant(1.0)};
    ASSERT_EQ(request(kHourly1, args), 0) << lastError;
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
    Args args{Variant(int32_t(2)), Variant(5.0)};
    ASSERT_EQ(request(kProp1, args), 0) << lastError;
    const auto labels = chart1().group1.pointLabels;
    const double last = chart1().data().y(2, 12);
    ASSERT_EQ(request(kYearly1, args), 0) << lastError;
    EXPECT_EQ(chart1().group1.pointLabels, labels);
    EXPECT_EQ(labels.size(), 12u);  // twelve months whatever the column count
    EXPECT_EQ(chart1().data().y(2, 12), last);
    EXPECT_EQ(modMain::goChart->NumPoints(), 12);
}

TEST_F(Fixture, SeveralFixedRowsKeepCaptionsWithTheirValues)
{
    setForm(formWithAllGrids(2, 2, 14));
    Args args{Variant(int32_t(2)), Variant(1.0)};
    ASSERT_EQ(request(kHourly1, args), 0) << lastError;
    EXPECT_EQ(chart1().group1.seriesLabels, (std::vector<std::string>{"Row 1", "Row 2"}));
    EXPECT_EQ(chart1().data().y(1, 1), 11);  // "Row 1" values in series 1
    EXPECT_EQ(chart1().data().y(2, 1), 21);
}

struct SeriesCountCase {
    const char* name;
    int32_t lNumSeries;
    int32_t error;
};

class SeriesCounts : public Fixture, public ::testing::WithParamInterface<SeriesCountCase> {};

TEST_P(SeriesCounts, AgainstThreeDataRows)
{
    setForm(formWithAllGrids(1, 3, 14));
    Args args{Variant(GetParam().lNumSeries), Variant(1.0)};
    EXPECT_EQ(request(kProp1, args), GetParam().error) << lastError;
    EXPECT_EQ(ui->mousePointer(), kPointerDefault);  // restored even after a failure
}

INSTANTIATE_TEST_SUITE_P(Table, SeriesCounts,
                         ::testing::Values(SeriesCountCase{"fewer", 2, errc::SubscriptOutOfRange},
                                           SeriesCountCase{"equal", 3, 0}, SeriesCountCase{"more", 5, 0},
                                           SeriesCountCase{"negative", -1, errc::InvalidProcedureCall},
                                           SeriesCountCase{"huge", INT32_MAX, errc::InvalidProcedureCall}),
                         [](const auto& info) { return std::string(info.param.name); });

TEST_F(Fixture, ExtraSeriesDrawAsZero)
{
    setForm(formWithAllGrids(1, 1, 14));
    Args args{Variant(int32_t(3)), Variant(1.0)};
    ASSERT_EQ(request(kYearly2, args), 0) << lastError;
    EXPECT_EQ(chart1().data().seriesCount(), 3);
    EXPECT_EQ(chart1().data().y(3, 4), 0);
    EXPECT_EQ(modMain::gvArray.at(3, 4).type(), VarType::Integer);
}

TEST_F(Fixture, NoDataShowsTheMessageAndChangesNothing)
{
    setForm("{\"grid1\": " + test::gridJson(1, 0, 14) + ", \"grid2\": " + test::gridJson(1, 2, 14) + "}");
    modMain::giChartKind = 4;
    Args args{Variant(int32_t(2)), Variant(1.0)};
    EXPECT_EQ(request(kHourly1, args), 0);  // caption rows only
    Args empty{Variant(int32_t(2)), Variant()};
    EXPECT_EQ(request(kHourly2, empty), 0);  // Empty total with a full grid
    EXPECT_EQ(ui->messages, (std::vector<std::string>{"There is no data to work with",
                                                      "There is no data to work with"}));
    EXPECT_EQ(modMain::giChartKind, 4);
    EXPECT_EQ(ui->mousePointer(), kPointerDefault);
    EXPECT_FALSE(modMain::gfChart->isShown());  // loaded by GraphInitialize, not shown
}

TEST_F(Fixture, TwoColumnGridHasNoPoints)
{
    setForm("{\"grid1\": " + test::gridJson(1, 2, 2) + "}");
    Args args{Variant(int32_t(2)), Variant(1.0)};
    ASSERT_EQ(request(kHourly1, args), 0) << lastError;
    EXPECT_EQ(modMain::goChart->NumPoints(), 0);
    EXPECT_TRUE(chart1().group1.pointLabels.empty());

    setForm("{\"grid1\": " + test::gridJson(1, 2, 1) + "}");
    EXPECT_EQ(request(kHourly1, args), errc::SubscriptOutOfRange);
}

TEST_F(Fixture, BadTotalsFailAfterTheCodeIsStored)
{
    setForm(formWithAllGrids(1, 2, 14));
    Args text{Variant(int32_t(2)), Variant("abc")};
    EXPECT_EQ(request(kHourly1, text), errc::TypeMismatch);
    EXPECT_EQ(modMain::giChartKind, 5);
    EXPECT_EQ(ui->mousePointer(), kPointerDefault);
    Args null{Variant(int32_t(2)), Variant::null()};
    EXPECT_EQ(request(kProp2, null), errc::InvalidUseOfNull);
    EXPECT_EQ(modMain::giChartKind, 4);
}

TEST_F(Fixture, RequestBeforeSourceFormFailsAfterGraphInitialize)
{
    Args args{Variant(int32_t(2)), Variant(1.0)};
    EXPECT_EQ(request(kHourly1, args), errc::ObjectNotSet);
    EXPECT_TRUE(modMain::goChart);
    EXPECT_TRUE(modMain::gfChart);
}

TEST_F(Fixture, MissingGridIsMemberNotFound)
{
    setForm("{\"grid2\": " + test::gridJson(1, 2, 14) + "}");
    Args args{Variant(int32_t(2)), Variant(1.0)};
    EXPECT_EQ(request(kHourly1, args), errc::MemberNotFound);
    EXPECT_NE(lastError.find("grid1"), std::string::npos);
}

TEST_F(Fixture, TwoRequestsInARowReplaceEverything)
{
    setForm("{\"grid1\": " + test::gridJson(1, 3, 14) + ", \"grid2\": " + test::gridJson(1, 1, 14) + "}");
    Args first{Variant(int32_t(3)), Variant(1.0)};
    ASSERT_EQ(request(kHourly1, first), 0);
    const Ref<c2dChart> firstChart = modMain::goChart;
    const Ref<ChartWindowPort> window = modMain::gfChart;
    Args second{Variant(int32_t(1)), Variant(2.0)};
    ASSERT_EQ(request(kHourly2, second), 0);
    EXPECT_NE(modMain::goChart, firstChart);   // a fresh chart object
    EXPECT_EQ(modMain::gfChart, window);        // the same window
    EXPECT_EQ(chart1().group1.seriesLabels, std::vector<std::string>{"Row 1"});
    EXPECT_EQ(modMain::gvArray.upper(0), 1);
    EXPECT_EQ(ui->windowLoads, 1);
}

TEST_F(Fixture, StoredStyleAppliesToTheRequest)
{
    writeSetting("Style", "Plot");
    writeSetting("View3D", " 0");
    writeSetting("LabelsOnDefault", "1");
    setForm(formWithAllGrids(1, 2, 14));
    Args args{Variant(int32_t(2)), Variant(1.0)};
    ASSERT_EQ(request(kProp1, args), 0) << lastError;
    EXPECT_EQ(chart1().group1.chartType, control::kPlot);
    EXPECT_EQ(chart1().chartArea.view3D.depth, 0);
    EXPECT_EQ(chart1().chartLabels.size(), 24u);
}

TEST_F(Fixture, WrongArgumentsAreRefusedClearly)
{
    setForm(formWithAllGrids(1, 2, 14));
    EXPECT_EQ(request(kHourly1, {Variant(int32_t(2))}), errc::WrongArgumentCount);
    EXPECT_EQ(request(kHourly1, {Variant("x"), Variant(1.0)}), errc::TypeMismatch);
    EXPECT_EQ(request(kHourly1, {Variant(1e12), Variant(1.0)}), errc::Overflow);
    EXPECT_EQ(request(0x12345678), errc::MemberNotFound);
    EXPECT_EQ(ui->mousePointer(), kPointerDefault);
}

}  // namespace
}  // namespace kg
