// Pictures: the requested size, not blank, and no failure for any chart type, 3-D setting or
// unusual content.
#include <gtest/gtest.h>

#include <QImage>
#include <QSet>
#include <cmath>
#include <functional>
#include <limits>

#include "chart/control/render/ChartExport.h"
#include "chart/control/render/ChartLayout.h"
#include "core/Error.h"
#include "render/RenderSamples.h"

namespace kg::control {
namespace {

int distinctColours(const QImage& image)
{
    QSet<QRgb> seen;
    for (int y = 0; y < image.height(); y += 3)
        for (int x = 0; x < image.width(); x += 3) seen.insert(image.pixel(x, y));
    return int(seen.size());
}

struct Look {
    const char* name;
    int16_t chartType;
    View3D view3D;
    bool labels;
};

class ChartLookTest : public ::testing::TestWithParam<Look> {};

TEST_P(ChartLookTest, RendersAtTheRequestedSizeWithSeriesColours)
{
    ChartControl chart;
    samples::styleLikeTheChartObject(chart);
    if (GetParam().chartType == kPie) {
        samples::fillPie(chart, {12, 30, 5, 8, 22, 17});
    } else {
        samples::fillTable(chart, 10, 12, GetParam().chartType);
    }
    samples::addSeriesLabels(chart, chart.data().seriesCount());
    samples::addPointLabels(chart, 12);
    chart.chartArea.view3D = GetParam().view3D;
    if (GetParam().labels) samples::addValueLabel(chart, 1, 1, " 42");

    const QImage image = renderImage(chart, QSize(800, 600));
    EXPECT_EQ(image.size(), QSize(800, 600));
    // Background greys, wheat and cream, and at least a few series colours.
    EXPECT_GE(distinctColours(image), 12);
    // The series colours are drawn: the first series' blue is somewhere on the picture.
    bool firstSeriesSeen = false;
    for (int y = 0; y < image.height() && !firstSeriesSeen; ++y)
        for (int x = 0; x < image.width() && !firstSeriesSeen; ++x)
            firstSeriesSeen = image.pixel(x, y) == qRgb(0x4E, 0x79, 0xA7);
    EXPECT_TRUE(firstSeriesSeen);
}

INSTANTIATE_TEST_SUITE_P(
    Types, ChartLookTest,
    ::testing::Values(Look{"barFlat", kBar, {0, 0, 0}, false}, Look{"bar3D", kBar, {10, 10, 10}, true},
                      Look{"plotFlat", kPlot, {0, 0, 0}, true}, Look{"plot3D", kPlot, {10, 10, 10}, false},
                      Look{"areaFlat", kArea, {0, 0, 0}, false}, Look{"area3D", kArea, {30, 20, 40}, true},
                      Look{"pieFlat", kPie, {0, 0, 0}, true}, Look{"pie3D", kPie, {10, 45, 30}, true},
                      Look{"unknownTypeAsBar", 7, {0, 0, 0}, false},
                      Look{"bar3DLeftAndBelow", kBar, {-30, -20, 50}, true}),
    [](const auto& info) { return std::string(info.param.name); });

// Content that a careless painter would crash on or loop over.
struct OddCase {
    const char* name;
    std::function<void(ChartControl&)> setUp;
    QSize size;
};

class OddContentTest : public ::testing::TestWithParam<OddCase> {};

TEST_P(OddContentTest, RendersWithoutFailing)
{
    ChartControl chart;
    samples::styleLikeTheChartObject(chart);
    GetParam().setUp(chart);
    const QImage image = renderImage(chart, GetParam().size);
    EXPECT_EQ(image.size(), GetParam().size);
}

const double kNaN = std::numeric_limits<double>::quiet_NaN();
const double kInf = std::numeric_limits<double>::infinity();

INSTANTIATE_TEST_SUITE_P(
    Content, OddContentTest,
    ::testing::Values(
        OddCase{"noSeries", [](ChartControl&) {}, {800, 600}},
        OddCase{"noPoints",
                [](ChartControl& c) {
                    samples::fillTable(c, 3, 0, kBar);
                    samples::addValueLabel(c, 1, 1, " 1");
                },
                {800, 600}},
        OddCase{"noPointsPlot", [](ChartControl& c) { samples::fillTable(c, 3, 0, kPlot); }, {800, 600}},
        OddCase{"pieNoSeries",
                [](ChartControl& c) {
                    c.group1.chartType = kPie;
                    c.legend.isShown = true;
                },
                {800, 600}},
        OddCase{"pieZeroAndNegative",
                [](ChartControl& c) {
                    samples::fillPie(c, {0, -4, 5, 0, kNaN});
                    samples::addValueLabel(c, 2, 1, "-4");
                },
                {800, 600}},
        OddCase{"pieAllZero",
                [](ChartControl& c) {
                    samples::fillPie(c, {0, 0, 0});
                },
                {800, 600}},
        OddCase{"pieSeriesWithoutPoints",
                [](ChartControl& c) {
                    c.group1.chartType = kPie;
                    c.data().setSeriesCount(4);
                },
                {800, 600}},
        OddCase{"pieHugeValues",
                [](ChartControl& c) {
                    samples::fillPie(c, {1e308, 1e308, 1});
                },
                {800, 600}},
        OddCase{"notFiniteValues",
                [](ChartControl& c) {
                    samples::fillTable(c, 2, 5, kPlot);
                    c.data().setY(1, 2, kNaN);
                    c.data().setY(2, 3, kInf);
                    c.data().setY(2, 4, -kInf);
                },
                {800, 600}},
        OddCase{"hugeValues",
                [](ChartControl& c) {
                    samples::fillTable(c, 2, 3, kBar);
                    c.data().setY(1, 1, 1e308);
                    c.data().setY(2, 1, -1e308);
                },
                {800, 600}},
        OddCase{"tinyValues",
                [](ChartControl& c) {
                    samples::fillTable(c, 1, 3, kArea);
                    c.data().setY(1, 1, 1e-300);
                },
                {800, 600}},
        OddCase{"allNegative",
                [](ChartControl& c) {
                    samples::fillTable(c, 2, 3, kArea);
                    for (int p = 1; p <= 3; ++p) c.data().setY(1, p, -p * 10);
                },
                {800, 600}},
        OddCase{"xValuesOutOfOrder",
                [](ChartControl& c) {
                    samples::fillTable(c, 2, 4, kBar);
                    c.data().setX(1, 3, -7);
                },
                {800, 600}},
        OddCase{"invertedAxisZoom",
                [](ChartControl& c) {
                    samples::fillTable(c, 2, 4, kBar);
                    c.chartArea.y = {"Y", 2, 0, true, 90, 10};
                    c.chartArea.x = {"X", 1, 2, true, 3, 3};
                },
                {800, 600}},
        OddCase{"labelsEverywhere",
                [](ChartControl& c) {
                    samples::fillTable(c, 20, 30, kBar);
                    for (int s = 1; s <= 20; ++s)
                        for (int p = 1; p <= 30; ++p) samples::addValueLabel(c, s, p, " 17");
                },
                {800, 600}},
        OddCase{"labelOddSettings",
                [](ChartControl& c) {
                    samples::fillTable(c, 1, 3, kBar);
                    ChartLabel& l = samples::addValueLabel(c, 1, 2, "x");
                    l.offset = -50;
                    l.borderWidth = 1000;
                    l.border = 6;
                },
                {800, 600}},
        OddCase{"manyLegendEntries",
                [](ChartControl& c) {
                    samples::fillTable(c, 500, 2, kPlot);
                    samples::addSeriesLabels(c, 500, "A rather long series caption ");
                },
                {800, 600}},
        OddCase{"hugeFonts",
                [](ChartControl& c) {
                    samples::fillTable(c, 2, 3, kBar);
                    c.header.font.size = 1e9;
                    c.footer = {"Footer", {-5, true}};
                },
                {800, 600}},
        OddCase{"oddBorders",
                [](ChartControl& c) {
                    samples::fillTable(c, 2, 3, kBar);
                    c.border = {6, 100000};
                    c.chartArea.border = {99, -3};
                },
                {800, 600}},
        OddCase{"extremeView",
                [](ChartControl& c) {
                    samples::fillTable(c, 2, 3, kBar);
                    c.view = {1e12, kNaN, -1e9};
                },
                {800, 600}},
        OddCase{"extreme3D",
                [](ChartControl& c) {
                    samples::fillTable(c, 2, 3, kBar);
                    c.chartArea.view3D = {INT32_MIN, INT32_MAX, INT32_MAX};
                },
                {800, 600}},
        OddCase{"controlCharacters",
                [](ChartControl& c) {
                    samples::fillTable(c, 1, 2, kBar);
                    c.header.text = std::string("a\0b\nc\x01", 6);
                },
                {800, 600}},
        OddCase{"onePixel", [](ChartControl& c) { samples::fillTable(c, 3, 5, kBar); }, {1, 1}},
        OddCase{"smallerThanItsBorders", [](ChartControl& c) { samples::fillTable(c, 3, 5, kPie); }, {30, 20}}),
    [](const auto& info) { return std::string(info.param.name); });

struct BadSize {
    const char* name;
    QSize size;
};

class RenderSizeTest : public ::testing::TestWithParam<BadSize> {};

TEST_P(RenderSizeTest, SizeOutsideTheLimitsIsAnInvalidCall)
{
    ChartControl chart;
    try {
        renderImage(chart, GetParam().size);
        FAIL() << "no error";
    } catch (const Error& e) {
        EXPECT_EQ(e.number(), errc::InvalidProcedureCall);
        EXPECT_NE(e.description().find("size"), std::string::npos) << e.description();
    }
}

INSTANTIATE_TEST_SUITE_P(Sizes, RenderSizeTest,
                         ::testing::Values(BadSize{"zero", {0, 0}}, BadSize{"negative", {-5, 100}},
                                           BadSize{"tooWide", {kMostExportSide + 1, 10}}),
                         [](const auto& info) { return std::string(info.param.name); });

}  // namespace
}  // namespace kg::control
