// The chart model against the control state it must leave: Initialize, InitChart, DrawChart and
// the single-series pie path, including the order-sensitive cases.
#include "ChartSupport.h"
#include "chart/c2dChart.h"
#include "support/FakeHost.h"

namespace kg {
namespace {

using test::expectError;

struct ChartFixture : ::testing::Test {
    Ref<test::FakeAppServices> services = makeRef<test::FakeAppServices>();
    Ref<test::FakeSettings> settings = makeRef<test::FakeSettings>();
    Ref<control::ChartControl> control = makeRef<control::ChartControl>();
    Ref<c2dChart> chart = makeRef<c2dChart>([this] { return Variant(services); }, [this] { return Variant(settings); });

    void SetUp() override
    {
        c2dChart::setShowLegend(false);
        c2dChart::setView3D(false);
    }
    void initialize(int32_t series, int32_t points)
    {
        chart->Initialize(control.get(), "Header", "Footer", "X", "Y");
        chart->setNumSeries(series);
        chart->setXMinData(1);
        chart->setXMaxData(points);
        chart->InitChart();
    }
    static VariantArray table(int32_t series, int32_t points)
    {
        VariantArray a;
        a.redim(series, points);
        return a;
    }
};

TEST_F(ChartFixture, InitializeSetsTheControlsLookAndHelpFile)
{
    chart->setChartType(5);
    chart->Initialize(control.get(), "H", "F", "XT", "YT");
    EXPECT_EQ(chart->ChartType(), 2);
    EXPECT_EQ(control->header.text, "H");
    EXPECT_EQ(control->header.font.size, 10);
    EXPECT_TRUE(control->header.font.bold);
    EXPECT_EQ(control->footer.text, "F");
    EXPECT_EQ(control->backgroundColor, 12763842u);
    EXPECT_EQ(control->border.style, 6);
    EXPECT_EQ(control->border.width, 7);
    EXPECT_EQ(control->chartArea.backgroundColor, 11788021u);
    EXPECT_EQ(control->chartArea.plotArea.backgroundColor, 13495295u);
    EXPECT_TRUE(control->chartArea.plotArea.isShown);
    EXPECT_EQ(control->chartArea.border.style, 4);
    EXPECT_EQ(control->chartArea.border.width, 2);
    EXPECT_EQ(control->chartArea.x.title, "XT");
    EXPECT_EQ(control->chartArea.y.title, "YT");
    EXPECT_EQ(control->chartArea.y.presentationCode, 2);
    EXPECT_EQ(control->helpFile, "/opt/tavix/Help/chartctl.hlp");

    services->folder = "/opt/tavix/";  // used as returned: the separator doubles
    chart->Initialize(control.get(), "H", "F", "XT", "YT");
    EXPECT_EQ(control->helpFile, "/opt/tavix//Help/chartctl.hlp");
}

TEST_F(ChartFixture, OperationsThatNeedTheControlFailBeforeInitialize)
{
    expectError([&] { chart->InitChart(); }, errc::ObjectNotSet);
    expectError([&] { chart->PrintChart(); }, errc::ObjectNotSet);
    expectError([&] { (void)chart->Rotation(); }, errc::ObjectNotSet);
    chart->setYMaxData(7);  // pure store properties work at any time
    EXPECT_EQ(chart->YMaxData(), 7);
}

struct StoredStyle {
    const char* name;
    std::map<std::string, std::string> stored;
    bool view3D;
    int32_t rotation, elevation, depth;
    int16_t chartType = 2;
    bool pointLabels = false;
    const char* logged = nullptr;  // the key whose stored value is out of range and is logged
};

class InitChartStyles : public ChartFixture, public ::testing::WithParamInterface<StoredStyle> {};

TEST_P(InitChartStyles, AppliesTheStoredStyle)
{
    const StoredStyle& c = GetParam();
    for (const auto& [k, v] : c.stored) settings->values["2dCharts\\" + k] = v;
    chart->setPointLabels(true);  // to see whether LabelsOnDefault changes it
    initialize(2, 12);
    EXPECT_EQ(c2dChart::View3D(), c.view3D);
    EXPECT_EQ(chart->Rotation(), c.rotation);
    EXPECT_EQ(chart->Elevation(), c.elevation);
    EXPECT_EQ(chart->Depth(), c.depth);
    EXPECT_EQ(chart->ChartType(), c.chartType);
    EXPECT_EQ(chart->PointLabels(), c.pointLabels);
    if (!c.logged) {
        EXPECT_TRUE(services->events.empty()) << services->events.front();
        return;
    }
    ASSERT_EQ(services->events.size(), 1u);
    EXPECT_NE(services->events[0].find(c.logged), std::string::npos) << services->events[0];
    EXPECT_NE(services->events[0].find(c.stored.at(c.logged)), std::string::npos) << services->events[0];
}

INSTANTIATE_TEST_SUITE_P(
    Table, InitChartStyles,
    ::testing::Values(
        StoredStyle{"nothingStored", {}, true, 10, 10, 10},
        StoredStyle{"view3DOff", {{"View3D", "0"}, {"Rotation", "30"}}, false, 0, 0, 0},
        StoredStyle{"view3DWrittenByDialog", {{"View3D", " 1"}, {"Rotation", " -20"}, {"Depth", " 5"}}, true, -20, 10, 5},
        StoredStyle{"view3D1point4RoundsTo1", {{"View3D", "1.4"}}, true, 10, 10, 10},
        StoredStyle{"view3D1point5RoundsTo2", {{"View3D", "1.5"}}, false, 0, 0, 0},
        StoredStyle{"view3D0point5RoundsTo0", {{"View3D", "0.5"}}, false, 0, 0, 0},
        StoredStyle{"halvesToEven", {{"Rotation", "12.5"}, {"Elevation", "13.5"}, {"Depth", "-2.5"}}, true, 12, 14, -2},
        StoredStyle{"noNumberReadsZero", {{"Rotation", "abc"}, {"Elevation", ""}}, true, 0, 0, 10},
        StoredStyle{"leadingNumberOnly", {{"Rotation", "1,5"}, {"Elevation", "2 5x"}}, true, 1, 25, 10},
        StoredStyle{"hexadecimal", {{"Depth", "&H1F"}}, true, 10, 10, 31},
        StoredStyle{"stylePie", {{"Style", "Pie"}}, true, 10, 10, 10, 3},
        StoredStyle{"stylePlot", {{"Style", "Plot"}}, true, 10, 10, 10, 1},
        StoredStyle{"styleArea", {{"Style", "Area"}}, true, 10, 10, 10, 5},
        StoredStyle{"styleOtherCaseIgnored", {{"Style", "pie"}}, true, 10, 10, 10},
        StoredStyle{"styleTrailingBlankIgnored", {{"Style", "Pie "}}, true, 10, 10, 10},
        StoredStyle{"labelsOn", {{"LabelsOnDefault", "1"}}, true, 10, 10, 10, 2, true},
        StoredStyle{"labelsOtherTextUnchanged", {{"LabelsOnDefault", "2"}}, true, 10, 10, 10, 2, true},
        StoredStyle{"labelsBlankOneUnchanged", {{"LabelsOnDefault", " 1"}}, true, 10, 10, 10, 2, true},
        // Too large for the whole-number width: logged, the key's default, and the chart still draws.
        StoredStyle{"rotationTooLarge", {{"Rotation", "9E+99"}}, true, 10, 10, 10, 2, false, "Rotation"},
        StoredStyle{"depthTooLarge", {{"Depth", "2147483648"}}, true, 10, 10, 10, 2, false, "Depth"},
        StoredStyle{"view3DTooLarge", {{"View3D", "40000"}}, true, 10, 10, 10, 2, false, "View3D"},
        StoredStyle{"depthAtLimit", {{"Depth", "2147483647"}}, true, 10, 10, 2147483647}),
    [](const auto& info) { return std::string(info.param.name); });

TEST_F(ChartFixture, InitChartReadsInOrderWithAFreshOwnerEachTime)
{
    initialize(1, 3);
    EXPECT_EQ(settings->reads, (std::vector<std::string>{"View3D", "Rotation", "Elevation", "Depth", "Style",
                                                         "LabelsOnDefault"}));
    int owners = 0;
    for (const auto& c : services->calls) owners += c == "GetSettingsOwner";
    EXPECT_EQ(owners, 6);
    EXPECT_EQ(settings->owners.front(), "Tavix");

    settings->reads.clear();
    settings->values["2dCharts\\View3D"] = "0";
    initialize(1, 3);
    EXPECT_EQ(settings->reads, (std::vector<std::string>{"View3D", "Style", "LabelsOnDefault"}));
}

TEST_F(ChartFixture, InitChartDerivesThePointCount)
{
    initialize(3, 12);
    EXPECT_EQ(chart->NumPoints(), 12);
    EXPECT_EQ(control->data().seriesCount(), 3);
    EXPECT_EQ(control->data().pointCount(3), 12);

    chart->setXMinData(5);
    chart->setXMaxData(2);  // a negative count is stored and passed on
    chart->InitChart();
    EXPECT_EQ(chart->NumPoints(), -2);
    EXPECT_EQ(control->data().pointCount(1), 0);

    chart->setXMinData(INT32_MIN);
    chart->setXMaxData(INT32_MAX);
    EXPECT_THROW(chart->InitChart(), Error);

    chart->setNumSeries(0);
    chart->setXMinData(1);
    chart->setXMaxData(4);
    chart->InitChart();
    EXPECT_EQ(control->data().seriesCount(), 0);
}

TEST_F(ChartFixture, DrawChartWritesZeroIntoEmptyCellsAndKeepsTexts)
{
    initialize(2, 3);
    VariantArray t = table(2, 3);
    t.at(1, 1) = Variant("7");
    t.at(1, 2) = Variant(12.5);
    t.at(1, 3) = Variant::null();
    t.at(2, 1) = Variant("");
    t.at(2, 2) = Variant(int16_t(-3));
    chart->DrawChart(t);
    const control::ChartData& d = control->data();
    EXPECT_EQ(d.y(1, 1), 7);
    EXPECT_EQ(d.y(1, 2), 12.5);
    EXPECT_EQ(d.y(1, 3), 0);
    EXPECT_EQ(d.y(2, 1), 0);
    EXPECT_EQ(d.y(2, 2), -3);
    EXPECT_EQ(d.y(2, 3), 0);
    EXPECT_EQ(t.at(1, 1).type(), VarType::String);  // a text keeps its text
    for (auto [s, p] : {std::pair{1, 3}, {2, 1}, {2, 3}}) {
        EXPECT_EQ(t.at(s, p).type(), VarType::Integer) << s << "," << p;
        EXPECT_EQ(t.at(s, p).integer(), 0);
    }
    EXPECT_EQ(d.x(1, 3), 3);
    EXPECT_FALSE(d.isBatched());
    EXPECT_EQ(control->chartArea.x.presentationCode, 1);
    EXPECT_EQ(control->chartArea.x.annotationMethod, 2);
    EXPECT_EQ(control->legend.placement, 17);
    EXPECT_EQ(control->legend.gapToPlot, 10);
    EXPECT_EQ(control->legend.gapBetween, 10);

    chart->DrawChart(t);  // a second draw sees the zeros and draws the same chart
    EXPECT_EQ(d.y(2, 3), 0);
}

struct LabelCase {
    const char* name;
    Variant cell;
    const char* text;
};

class ValueLabels : public ChartFixture, public ::testing::WithParamInterface<LabelCase> {};

TEST_P(ValueLabels, NameAndTextFollowTheNumberText)
{
    initialize(1, 1);
    chart->setPointLabels(true);
    VariantArray t = table(1, 1);
    t.at(1, 1) = GetParam().cell;
    chart->DrawChart(t);
    ASSERT_EQ(control->chartLabels.size(), 1u);
    const control::ChartLabel& l = control->chartLabels[0];
    EXPECT_EQ(l.text, GetParam().text);
    EXPECT_EQ(l.name, std::string("LB ") + GetParam().text);
    EXPECT_EQ(l.attachMethod, 2);
    EXPECT_EQ(l.series, 1);
    EXPECT_EQ(l.point, 1);
    EXPECT_EQ(l.offset, 20);
    EXPECT_TRUE(l.isConnected);
    EXPECT_EQ(l.border, 4);
    EXPECT_EQ(l.borderWidth, 1);
    EXPECT_EQ(l.backgroundColor, 65535u);
}

INSTANTIATE_TEST_SUITE_P(Table, ValueLabels,
                         ::testing::Values(LabelCase{"decimal", Variant(12.5), " 12.5"},
                                           LabelCase{"text", Variant("7"), " 7"},
                                           LabelCase{"negative", Variant(int16_t(-3)), "-3"},
                                           LabelCase{"emptyReplacedByZero", Variant(), " 0"},
                                           LabelCase{"sum", Variant(0.1 + 0.2), " 0.3"}),
                         [](const auto& info) { return std::string(info.param.name); });

TEST_F(ChartFixture, LabelsFollowPointLabelsOnEveryDraw)
{
    initialize(3, 4);
    VariantArray t = table(3, 4);
    chart->setPointLabels(true);
    chart->DrawChart(t);
    EXPECT_EQ(control->chartLabels.size(), 12u);
    EXPECT_EQ(control->chartLabels[5].name, "LB  0");  // equal values, equal names
    EXPECT_EQ(control->chartLabels[5].series, 2);
    EXPECT_EQ(control->chartLabels[5].point, 2);
    chart->setPointLabels(false);
    chart->DrawChart(t);
    EXPECT_TRUE(control->chartLabels.empty());
}

TEST_F(ChartFixture, XAxisLabelsNumberThePoints)
{
    initialize(1, 3);
    control->group1.pointLabels = {"Jan", "Feb", "Mar"};
    control->group1.seriesLabels = {"kept"};
    VariantArray t = table(1, 3);
    chart->setXAxisLabels(true);
    chart->DrawChart(t);
    EXPECT_EQ(control->group1.pointLabels, (std::vector<std::string>{" 1", " 2", " 3"}));
    EXPECT_EQ(control->group1.seriesLabels, std::vector<std::string>{"kept"});

    chart->setXAxisLabels(false);
    control->group1.pointLabels = {"Jan"};
    chart->DrawChart(t);
    EXPECT_EQ(control->group1.pointLabels, std::vector<std::string>{"Jan"});
}

TEST_F(ChartFixture, LegendFollowsTheSeriesCountAndType)
{
    c2dChart::setShowLegend(true);
    initialize(1, 2);
    VariantArray t = table(1, 2);
    chart->DrawChart(t);  // one bar series: no legend, and the switch stays off
    EXPECT_FALSE(control->legend.isShown);
    EXPECT_FALSE(c2dChart::ShowLegend());

    chart->setChartType(control::kPie);
    chart->DrawChart(t);
    EXPECT_TRUE(control->legend.isShown);
    EXPECT_TRUE(c2dChart::ShowLegend());

    c2dChart::setShowLegend(false);
    initialize(2, 2);  // two series with a pie type take the general path
    chart->setChartType(control::kPie);
    VariantArray t2 = table(2, 2);
    chart->DrawChart(t2);
    EXPECT_FALSE(control->legend.isShown);
    EXPECT_EQ(control->data().seriesCount(), 2);
}

TEST_F(ChartFixture, PieMakesEveryPointASlice)
{
    initialize(1, 4);
    chart->setChartType(control::kPie);
    chart->setPointLabels(true);
    VariantArray t = table(1, 4);
    t.at(1, 1) = Variant(3.0);
    t.at(1, 2) = Variant("");           // blank counts as 0
    t.at(1, 3) = Variant::null();       // as does Null
    t.at(1, 4) = Variant("5");
    chart->DrawChart(t);
    const control::ChartData& d = control->data();
    ASSERT_EQ(d.seriesCount(), 4);
    EXPECT_EQ(d.y(1, 1), 3);
    EXPECT_EQ(d.y(2, 1), 0);
    EXPECT_EQ(d.y(3, 1), 0);
    EXPECT_EQ(d.y(4, 1), 5);
    EXPECT_EQ(control->group1.chartType, control::kPie);
    ASSERT_EQ(control->chartLabels.size(), 4u);
    EXPECT_EQ(control->chartLabels[3].series, 4);
    EXPECT_EQ(control->chartLabels[3].point, 1);
    EXPECT_EQ(control->chartLabels[3].text, " 5");
    // The pie path leaves the table as it found it.
    EXPECT_TRUE(t.at(1, 2).isString());
    EXPECT_TRUE(t.at(1, 3).isNull());
}

TEST_F(ChartFixture, PieRefusesTextThatIsNoNumber)
{
    initialize(1, 2);
    chart->setChartType(control::kPie);
    VariantArray t = table(1, 2);
    t.at(1, 1) = Variant("abc");
    expectError([&] { chart->DrawChart(t); }, errc::TypeMismatch, "abc");
    EXPECT_TRUE(control->data().isBatched());  // drawing stopped where it failed
}

TEST_F(ChartFixture, ATableTooSmallStopsWithSubscriptError)
{
    initialize(2, 3);
    VariantArray t = table(1, 3);
    expectError([&] { chart->DrawChart(t); }, errc::SubscriptOutOfRange);
    EXPECT_EQ(control->data().y(1, 3), 0);
}

TEST_F(ChartFixture, NoPointsStillSetsUpTheLegend)
{
    c2dChart::setShowLegend(true);
    initialize(2, 0);
    VariantArray t = table(2, 0);
    chart->setPointLabels(true);
    chart->DrawChart(t);
    EXPECT_TRUE(control->chartLabels.empty());
    EXPECT_TRUE(control->legend.isShown);
    EXPECT_EQ(control->data().pointCount(1), 0);
}

TEST_F(ChartFixture, PrintChartPassesTheFixedOptions)
{
    initialize(1, 1);
    control::PrintRequest seen;
    int calls = 0;
    control->setPrintHandler([&](const control::ChartControl&, const control::PrintRequest& r) {
        seen = r;
        ++calls;
    });
    chart->PrintChart();
    EXPECT_EQ(calls, 1);
    EXPECT_EQ(seen.format, 3);
    EXPECT_EQ(seen.scale, 4);
    EXPECT_EQ(seen.left + seen.top + seen.width + seen.height, 0);

    control->setPrintHandler(nullptr);
    expectError([&] { chart->PrintChart(); }, errc::PrinterError);
}

}  // namespace
}  // namespace kg
