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
#include "render/RenderSamples.h"

namespace kg::control {
namespace {

QSet<QRgb> coloursOf(const QImage& image, int step)
{
    QSet<QRgb> seen;
    for (int y = 0; y < image.height(); y += step)
        for (int x = 0; x < image.width(); x += step) seen.insert(image.pixel(x, y));
    return seen;
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
    EXPECT_GE(coloursOf(image, 3).size(), 12);
    // The series colours are drawn: the first series' blue is somewhere on the picture.
    EXPECT_TRUE(coloursOf(image, 1).contains(qRgb(0x4E, 0x79, 0xA7)));
}

INSTANTIATE_TEST_SUITE_P(
    Types, ChartLookTest,
    // One look of each type; the gallery draws every type flat and in 3-D.
    ::testing::Values(Look{"barFlat", kBar, {0, 0, 0}, false}, Look{"plotFlat", kPlot, {0, 0, 0}, true},
                      Look{"area3D", kArea, {30, 20, 40}, true}, Look{"pie3D", kPie, {10, 45, 30}, true},
                      Look{"unknownTypeAsBar", 7, {0, 0, 0}, false}, Look{"bar3DLeftAndBelow", kBar, {-30, -20, 50}, true}),
    samples::rowName);

// Content that a careless painter would crash on or loop over.
struct OddCase {
    const char* name;
    std::function<void(ChartControl&)> setUp;
    QSize size{800, 600};
};

class OddContentTest : public ::testing::TestWithParam<OddCase> {};

TEST_P(OddContentTest, RendersWithoutFailing)
{
    ChartControl chart;
    samples::styleLikeTheChartObject(chart);
    GetParam().setUp(chart);
    EXPECT_EQ(renderImage(chart, GetParam().size).size(), GetParam().size);
}

const double kNaN = std::numeric_limits<double>::quiet_NaN();
const double kInf = std::numeric_limits<double>::infinity();
using C = ChartControl;
const auto table = samples::fillTable;

// clang-format off
INSTANTIATE_TEST_SUITE_P(Content, OddContentTest, ::testing::Values(
    OddCase{"noSeries", [](C&) {}},
    OddCase{"noPointsWithALabel", [](C& c) { table(c, 3, 0, kPlot); samples::addValueLabel(c, 1, 1, " 1"); }},
    OddCase{"pieNoSeries", [](C& c) { c.group1.chartType = kPie; }},
    OddCase{"pieZeroAndNegative", [](C& c) { samples::fillPie(c, {0, -4, 5, 0, kNaN});
                                             samples::addValueLabel(c, 2, 1, "-4"); }},
    OddCase{"pieAllZero", [](C& c) { samples::fillPie(c, {0, 0, 0}); }},
    OddCase{"pieSeriesWithoutPoints", [](C& c) { c.group1.chartType = kPie; c.data().setSeriesCount(4); }},
    OddCase{"pieHugeValues", [](C& c) { samples::fillPie(c, {1e308, 1e308, 1}); }},
    OddCase{"notFiniteValues", [](C& c) { table(c, 2, 5, kPlot); c.data().setY(1, 2, kNaN);
                                          c.data().setY(2, 3, kInf); c.data().setY(2, 4, -kInf); }},
    OddCase{"hugeValues", [](C& c) { table(c, 2, 3, kBar); c.data().setY(1, 1, 1e308); c.data().setY(2, 1, -1e308); }},
    OddCase{"allNegative", [](C& c) { table(c, 2, 3, kArea);
                                      for (int p = 1; p <= 3; ++p) c.data().setY(1, p, -p * 10); }},
    OddCase{"xValuesOutOfOrder", [](C& c) { table(c, 2, 4, kBar); c.data().setX(1, 3, -7); }},
    OddCase{"invertedAxisZoom", [](C& c) { table(c, 2, 4, kBar); c.chartArea.y = {"Y", 2, 0, true, 90, 10};
                                           c.chartArea.x = {"X", 1, 2, true, 3, 3}; }},
    OddCase{"labelsEverywhere", [](C& c) { table(c, 20, 30, kBar); for (int s = 1; s <= 20; ++s)
                                           for (int p = 1; p <= 30; ++p) samples::addValueLabel(c, s, p, " 17"); }},
    OddCase{"labelOddSettings", [](C& c) { table(c, 1, 3, kBar); ChartLabel& l = samples::addValueLabel(c, 1, 2, "x");
                                           l.offset = -50; l.borderWidth = 1000; l.border = 6; }},
    OddCase{"hugeFonts", [](C& c) { table(c, 2, 3, kBar); c.header.font.size = 1e9;
                                    c.footer = {"Footer", {-5, true}}; }},
    OddCase{"oddBorders", [](C& c) { table(c, 2, 3, kBar); c.border = {6, 100000}; c.chartArea.border = {99, -3}; }},
    OddCase{"extremeView", [](C& c) { table(c, 2, 3, kBar); c.view = {1e12, kNaN, -1e9}; }},
    OddCase{"extreme3D", [](C& c) { table(c, 2, 3, kBar); c.chartArea.view3D = {INT32_MIN, INT32_MAX, INT32_MAX}; }},
    OddCase{"controlCharacters", [](C& c) { table(c, 1, 2, kBar); c.header.text = std::string("a\0b\nc\x01", 6); }},
    OddCase{"onePixel", [](C& c) { table(c, 3, 5, kBar); }, {1, 1}},
    OddCase{"smallerThanItsBorders", [](C& c) { table(c, 3, 5, kPie); }, {30, 20}}),
    samples::rowName);
// clang-format on

struct BadSize {
    const char* name;
    QSize size;
};

class RenderSizeTest : public ::testing::TestWithParam<BadSize> {};

TEST_P(RenderSizeTest, SizeOutsideTheLimitsIsAnInvalidCall)
{
    ChartControl chart;
    samples::expectError([&] { renderImage(chart, GetParam().size); }, errc::InvalidProcedureCall, "size");
}

INSTANTIATE_TEST_SUITE_P(Sizes, RenderSizeTest,
                         ::testing::Values(BadSize{"zero", {0, 0}}, BadSize{"negative", {-5, 100}},
                                           BadSize{"tooWide", {kMostExportSide + 1, 10}}),
                         samples::rowName);

}  // namespace
}  // namespace kg::control
