// Geometry of the chart: where titles, legend and plot go, how the axes are annotated, the 3-D
// offset and the mapping between data values and pixels.
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <functional>

#include "chart/control/render/ChartLayout.h"
#include "chart/control/render/ChartText.h"
#include "render/RenderSamples.h"

namespace kg::control {
namespace {

const QRectF kTarget(0, 0, 800, 600);

ChartControl& barChart(ChartControl& c, int series, int points)
{
    samples::styleLikeTheChartObject(c);
    samples::fillTable(c, series, points, kBar);
    samples::addSeriesLabels(c, series);
    return c;
}

struct DisplayTextCase {
    const char* name;
    std::string stored;
    QString shown;
};

class DisplayTextTest : public ::testing::TestWithParam<DisplayTextCase> {};

TEST_P(DisplayTextTest, ShowsTheStoredTextWithoutWhatHasNoGlyph)
{
    EXPECT_EQ(displayText(GetParam().stored), GetParam().shown);
}

const std::string kLongCaption(1 << 20, 'x');
// 1999 letters and a character outside the basic plane (two UTF-16 units) across the cut.
const std::string kCutInAPair = std::string(1999, 'a') + "\xF0\x9F\x98\x80" + "tail";

INSTANTIATE_TEST_SUITE_P(
    Texts, DisplayTextTest,
    ::testing::Values(DisplayTextCase{"leadingBlanksKept", "  Total ", "  Total "},
                      DisplayTextCase{"lineBreaksAndTabsAsBlanks", "a\r\nb\tc", "a  b c"},
                      DisplayTextCase{"megabyteCutToWhatAPageShows", kLongCaption, QString(2000, QLatin1Char('x'))},
                      DisplayTextCase{"cutNeverSplitsACharacter", kCutInAPair, QString(1999, QLatin1Char('a'))}),
    samples::rowName);

// Header and footer are centred at the ends; an empty footer takes no room.
TEST(LayoutTest, HeaderAndFooterAreCentredAtTheEnds)
{
    ChartControl c;
    const ChartLayout without = computeLayout(barChart(c, 2, 3), kTarget);
    c.footer.text = "Footer";
    const ChartLayout L = computeLayout(c, kTarget);
    EXPECT_NEAR(L.header.center().x(), 400, 0.5);
    EXPECT_NEAR(L.footer.center().x(), 400, 0.5);
    EXPECT_LT(L.header.bottom(), L.chartArea.top());
    EXPECT_GT(L.footer.top(), L.chartArea.bottom());
    EXPECT_TRUE(without.footer.isEmpty());
    EXPECT_GT(without.chartArea.bottom(), L.chartArea.bottom());
}

struct LegendCase {
    const char* name;
    int series;
    bool shown, labelled;  // a legend only when both
    bool truncated;        // more entries than room: the last one says so
    QRectF target = kTarget;
};

class LegendPlacementTest : public ::testing::TestWithParam<LegendCase> {};

TEST_P(LegendPlacementTest, EastOfThePlotVerticallyCentredWithoutOverlaps)
{
    ChartControl c;
    barChart(c, GetParam().series, 4).legend.isShown = GetParam().shown;
    if (!GetParam().labelled) c.group1.seriesLabels.clear();
    const ChartLayout L = computeLayout(c, GetParam().target);
    ASSERT_EQ(!L.legend.isEmpty(), GetParam().shown && GetParam().labelled);
    EXPECT_EQ(L.legendTruncated, GetParam().truncated);
    if (L.legend.isEmpty()) return;
    EXPECT_EQ(L.legendItems.size() < size_t(GetParam().series), GetParam().truncated);
    EXPECT_EQ(L.legendItems.back().text == QStringLiteral("\u2026"), GetParam().truncated);
    EXPECT_GE(L.legend.left(), L.chartArea.right() + c.legend.gapToPlot - 0.5);
    EXPECT_NEAR(L.legend.center().y(), L.chartArea.center().y(), 0.5);
    EXPECT_LE(L.legend.right(), GetParam().target.right());
    EXPECT_GE(L.legend.top(), L.chartArea.top() - 0.5);
    const ChartFonts fonts(c);
    for (size_t i = 0; i < L.legendItems.size(); ++i) {
        const LegendItem& a = L.legendItems[i];
        const QRectF ra(a.swatch.topLeft(), QPointF(a.textOrigin.x() + fonts.legend.width(a.text), a.swatch.bottom()));
        EXPECT_TRUE(L.legend.contains(ra)) << i;
        for (size_t j = i + 1; j < L.legendItems.size(); ++j) {
            const LegendItem& b = L.legendItems[j];
            const QRectF rb(b.swatch.topLeft(),
                            QPointF(b.textOrigin.x() + fonts.legend.width(b.text), b.swatch.bottom()));
            EXPECT_FALSE(ra.intersects(rb)) << i << " and " << j;
        }
    }
}

INSTANTIATE_TEST_SUITE_P(Legends, LegendPlacementTest,
                         ::testing::Values(LegendCase{"tenSeries", 10, true, true, false},
                                           LegendCase{"hidden", 10, false, true, false},
                                           LegendCase{"withoutAnyText", 3, true, false, false},
                                           LegendCase{"oneSeries", 1, true, true, false},
                                           LegendCase{"twoHundredSeries", 200, true, true, true},
                                           LegendCase{"sixHundredInASmallWindow", 600, true, true, true,
                                                      QRectF(0, 0, 400, 300)}),
                         samples::rowName);

struct LegendTextCase {
    const char* name;
    int16_t chartType;
    std::vector<std::string> seriesLabels, pointLabels;
    std::vector<std::string> expected;
};

class LegendTextTest : public ::testing::TestWithParam<LegendTextCase> {};

TEST_P(LegendTextTest, PicksTheListThatNamesTheEntries)
{
    ChartControl c;
    samples::fillPie(c, {1, 2, 3});
    c.group1.chartType = GetParam().chartType;
    c.group1.seriesLabels = GetParam().seriesLabels;
    c.group1.pointLabels = GetParam().pointLabels;
    std::vector<std::string> got;
    for (const QString& t : legendTexts(c, chartKindOf(c.group1.chartType))) got.push_back(t.toStdString());
    EXPECT_EQ(got, GetParam().expected);
}

INSTANTIATE_TEST_SUITE_P(
    Texts, LegendTextTest,
    ::testing::Values(LegendTextCase{"barSeriesLabels", kBar, {"a", "b", "c"}, {"x", "y", "z"}, {"a", "b", "c"}},
                      LegendTextCase{"barIgnoresPointLabels", kBar, {}, {"x", "y", "z"}, {"", "", ""}},
                      LegendTextCase{"pieSeriesLabels", kPie, {"a", "b", "c"}, {"x", "y", "z"}, {"a", "b", "c"}},
                      LegendTextCase{"piePointLabelsWhenNoSeriesLabels", kPie, {}, {"x", "y", "z"}, {"x", "y", "z"}},
                      LegendTextCase{"piePointLabelsCoverMore", kPie, {"Bookings"}, {"x", "y", "z"}, {"x", "y", "z"}},
                      LegendTextCase{"pieMissingEntriesEmpty", kPie, {"a", "b"}, {}, {"a", "b", ""}},
                      LegendTextCase{"leadingBlankKept", kBar, {" 5", "b", "c"}, {}, {" 5", "b", "c"}}),
    samples::rowName);

struct XLabelCase {
    const char* name;
    int points;
    std::string stem;
    QRectF target;
    bool allShown;
    int16_t annotationMethod = 2;  // 2: the point labels; otherwise the point numbers
};

class XLabelTest : public ::testing::TestWithParam<XLabelCase> {};

// The X axis shows whole point numbers or the point labels; its texts never overlap: side by side
// they keep apart, turned ones keep a line apart.
TEST_P(XLabelTest, PointTextsNeverOverlap)
{
    ChartControl c;
    barChart(c, 10, GetParam().points).chartArea.x.annotationMethod = GetParam().annotationMethod;
    samples::addPointLabels(c, GetParam().points, GetParam().stem);
    const ChartLayout L = computeLayout(c, GetParam().target);
    const ChartFonts fonts(c);
    ASSERT_FALSE(L.xLabels.empty());
    EXPECT_EQ(L.xLabels.size() == size_t(GetParam().points), GetParam().allShown);
    const std::string stem = GetParam().annotationMethod == 2 ? GetParam().stem : "";
    for (const AxisLabel& a : L.xLabels) {
        EXPECT_EQ(a.value, std::floor(a.value));
        EXPECT_EQ(a.text.toStdString(), stem + QString::number(a.value).toStdString());
    }
    for (size_t i = 1; i < L.xLabels.size(); ++i) {
        const double gap = L.mapping.xPixel(L.xLabels[i].value) - L.mapping.xPixel(L.xLabels[i - 1].value);
        if (L.xLabelsRotated) {
            EXPECT_GE(gap * std::sqrt(0.5), fonts.tick.height * 0.8) << i;
        } else {
            const double halfWidths =
                (fonts.tick.width(L.xLabels[i].text) + fonts.tick.width(L.xLabels[i - 1].text)) / 2;
            EXPECT_GE(gap, halfWidths) << i;
        }
    }
}

INSTANTIATE_TEST_SUITE_P(Labels, XLabelTest,
                         ::testing::Values(XLabelCase{"shortSideBySide", 12, "M", kTarget, true},
                                           XLabelCase{"monthNames", 12, "September ", kTarget, true},
                                           XLabelCase{"thousandPoints", 1000, "Hour ", QRectF(0, 0, 1600, 1000), false},
                                           XLabelCase{"narrowWindow", 31, "Day ", QRectF(0, 0, 300, 240), false},
                                           XLabelCase{"numbers", 12, "Week ", kTarget, true, 1},
                                           XLabelCase{"notSetNumbers", 12, "Week ", kTarget, true, 0}),
                         samples::rowName);


TEST(LayoutTest, ValueLabelsGetRoomAboveTheHighestBar)
{
    ChartControl c;
    barChart(c, 1, 3);
    c.data().setY(1, 2, 97);  // just below a round top of 100
    const double without = computeLayout(c, kTarget).mapping.yMax;
    samples::addValueLabel(c, 1, 2, " 97");
    const ChartLayout L = computeLayout(c, kTarget);
    EXPECT_GT(L.mapping.yMax, without);
    EXPECT_GE(L.mapping.yPixel(97) - L.plotArea.top(), 20 + ChartFonts(c).label.height);
}

struct DepthCase {
    const char* name;
    View3D view;
    bool flat;
};

class DepthTest : public ::testing::TestWithParam<DepthCase> {};

TEST_P(DepthTest, FlatWhenDepthOrBothAnglesAreZero)
{
    ChartControl c;
    barChart(c, 3, 12).chartArea.view3D = GetParam().view;
    const ChartLayout L = computeLayout(c, kTarget);
    EXPECT_EQ(L.depth.isNull(), GetParam().flat);
    // The back plane stays inside the chart area.
    EXPECT_TRUE(L.chartContent.contains(L.plotArea.translated(L.depth)));
}

INSTANTIATE_TEST_SUITE_P(Views, DepthTest,
                         ::testing::Values(DepthCase{"noDepth", {10, 10, 0}, true},
                                           DepthCase{"noAngles", {0, 0, 30}, true},
                                           DepthCase{"defaults", {10, 10, 10}, false},
                                           DepthCase{"rotationOnly", {20, 0, 10}, false},
                                           DepthCase{"elevationOnly", {0, 20, 10}, false},
                                           DepthCase{"negativeAngles", {-20, -20, 60}, false}),
                         samples::rowName);

struct PieCase {
    const char* name;
    std::vector<double> values;
    std::vector<int32_t> slices;
    View3D view{0, 0, 0};  // a 3-D view tilts the pie and gives it a rim
};

class PieSliceTest : public ::testing::TestWithParam<PieCase> {};

TEST_P(PieSliceTest, PositiveValuesShareTheCircle)
{
    ChartControl c;
    samples::fillPie(c, GetParam().values);
    c.chartArea.view3D = GetParam().view;
    const ChartLayout L = computeLayout(c, kTarget);
    if (GetParam().view.depth == 0) {
        EXPECT_EQ(L.pie.rx, L.pie.ry);
        EXPECT_EQ(L.pie.rim, 0);
    } else {
        EXPECT_LT(L.pie.ry, L.pie.rx * 0.75);
        EXPECT_GT(L.pie.rim, 0);
    }
    std::vector<int32_t> series;
    double total = 0;
    for (const PieSlice& s : L.pie.slices) {
        series.push_back(s.series);
        total += s.spanAngle;
    }
    EXPECT_EQ(series, GetParam().slices);
    if (!series.empty()) {
        EXPECT_NEAR(total, -360, 1e-9);
        EXPECT_NEAR(L.pie.slices.front().startAngle, 90, 1e-9);  // the first slice starts at the top
    }
}

INSTANTIATE_TEST_SUITE_P(Pies, PieSliceTest,
                         ::testing::Values(PieCase{"allPositive", {1, 2, 3}, {1, 2, 3}},
                                           PieCase{"zeroSkipped", {1, 0, 3}, {1, 3}},
                                           PieCase{"negativeSkipped", {-1, 2, 3}, {2, 3}},
                                           PieCase{"nothingPositive", {0, -2}, {}}, PieCase{"none", {}, {}},
                                           PieCase{"tilted3D", {1, 2, 3}, {1, 2, 3}, {0, 45, 20}}),
                         samples::rowName);

}  // namespace
}  // namespace kg::control
