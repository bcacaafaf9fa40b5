// Graphics zoom, axis zoom, Escape and the "r" key on the chart control's view.
#include <QRubberBand>
#include <algorithm>
#include <cmath>
#include <ostream>

#include "chart/control/render/ChartExport.h"
#include "view/ViewFixture.h"

namespace kg::control::test {
namespace {

const Qt::KeyboardModifiers kCtrl = Qt::ControlModifier;
const Qt::KeyboardModifiers kShift = Qt::ShiftModifier;

// ---- graphics zoom ----

struct GraphicsZoomCase {
    const char* name;
    QPoint from, to;  // from the chart area's centre
    bool zooms;
    bool scaledFirst;  // scale and move before the zoom
};

std::ostream& operator<<(std::ostream& os, const GraphicsZoomCase& c) { return os << c.name; }

class GraphicsZoomTest : public ViewFixture, public ::testing::WithParamInterface<GraphicsZoomCase> {};

TEST_P(GraphicsZoomTest, SelectionFillsTheChartArea)
{
    const GraphicsZoomCase& c = GetParam();
    fillMonthlyBars(*chart, kBar);
    makeView();
    const ChartLayout first = layout();
    const QPoint centre = first.chartContent.center().toPoint();
    if (c.scaledFirst) {
        drag({Qt::MiddleButton}, kShift, centre, centre + QPoint(30, 20));
        drag({Qt::MiddleButton}, kCtrl, centre, centre + QPoint(0, 40));
    }
    const ViewState before = chart->view;
    const QRectF frame = first.chartContent;
    const QRectF selected = QRectF(QPointF(centre + c.from), QPointF(centre + c.to)).normalized().intersected(frame);
    const QTransform oldView = viewTransform(before, frame);

    drag({Qt::LeftButton}, kCtrl, centre + c.from, centre + c.to);

    if (!c.zooms) {
        EXPECT_EQ(chart->view.scale, before.scale);
        EXPECT_EQ(chart->view.offsetX, before.offsetX);
        EXPECT_EQ(chart->view.offsetY, before.offsetY);
        return;
    }
    // What was shown in the selection is now shown enlarged, centred, touching two sides.
    const QTransform shownNow = oldView.inverted() * viewTransform(chart->view, frame);
    const QRectF now = shownNow.mapRect(selected);
    EXPECT_NEAR(now.center().x(), frame.center().x(), 1e-6);
    EXPECT_NEAR(now.center().y(), frame.center().y(), 1e-6);
    const double factor = std::min(frame.width() / selected.width(), frame.height() / selected.height());
    const double expectedScale = std::min(before.scale * factor, ChartInteraction::kMaxScale);
    EXPECT_NEAR(chart->view.scale, expectedScale, 1e-9);
    if (expectedScale < ChartInteraction::kMaxScale) {
        EXPECT_TRUE(std::fabs(now.width() - frame.width()) < 1e-6 || std::fabs(now.height() - frame.height()) < 1e-6);
        EXPECT_LE(now.width(), frame.width() + 1e-6);
        EXPECT_LE(now.height(), frame.height() + 1e-6);
    }
    EXPECT_FALSE(chart->chartArea.x.hasFixedRange);
    EXPECT_FALSE(chart->chartArea.y.hasFixedRange);
}

INSTANTIATE_TEST_SUITE_P(
    Selections, GraphicsZoomTest,
    ::testing::Values(GraphicsZoomCase{"centred", {-100, -50}, {100, 50}, true, false},
                      GraphicsZoomCase{"offCentre", {20, 10}, {120, 60}, true, false},
                      GraphicsZoomCase{"draggedUpLeft", {120, 60}, {20, 10}, true, false},
                      GraphicsZoomCase{"tallSelection", {-30, -150}, {10, 100}, true, false},
                      GraphicsZoomCase{"beyondTheArea", {0, 0}, {2000, 2000}, true, false},
                      GraphicsZoomCase{"afterScaleAndMove", {-60, -20}, {40, 50}, true, true},
                      GraphicsZoomCase{"tinyStopsAt20", {0, 0}, {5, 5}, true, false},
                      GraphicsZoomCase{"narrowerThan4Nothing", {0, 0}, {3, 80}, false, false},
                      GraphicsZoomCase{"lowerThan4Nothing", {0, 0}, {80, 3}, false, false},
                      GraphicsZoomCase{"clickNothing", {0, 0}, {0, 0}, false, false}),
    [](const auto& info) { return std::string(info.param.name); });

// A second zoom enlarges what the first one shows.
TEST_F(ViewFixture, GraphicsZoomTwiceMultiplies)
{
    fillMonthlyBars(*chart, kBar);
    makeView();
    const QRectF frame = layout().chartContent;
    const QPoint c = frame.center().toPoint();
    const QPoint half(int(frame.width() / 4), int(frame.height() / 4));
    drag({Qt::LeftButton}, kCtrl, c - half, c + half);
    const double once = chart->view.scale;
    drag({Qt::LeftButton}, kCtrl, c - half, c + half);
    EXPECT_NEAR(once, std::min(frame.width() / (2 * half.x()), frame.height() / (2 * half.y())), 1e-9);
    EXPECT_NEAR(chart->view.scale, once * once, 1e-9);
}

// ---- axis zoom ----

struct AxisZoomCase {
    const char* name;
    int16_t chartType;
    int32_t depth;
    QPointF fromValue, toValue;  // data values (X in point positions) of the drag's ends
    bool scaledFirst;
    bool zooms;
};

std::ostream& operator<<(std::ostream& os, const AxisZoomCase& c) { return os << c.name; }

class AxisZoomTest : public ViewFixture, public ::testing::WithParamInterface<AxisZoomCase> {};

TEST_P(AxisZoomTest, AxesTakeTheSelectionsValues)
{
    const AxisZoomCase& c = GetParam();
    fillMonthlyBars(*chart, c.chartType);
    chart->chartArea.view3D.depth = c.depth;
    makeView();
    if (c.scaledFirst) {
        const QPoint centre = areaCentre();
        drag({Qt::MiddleButton}, kCtrl, centre, centre + QPoint(0, 40));
        drag({Qt::MiddleButton}, kShift, centre, centre + QPoint(-25, 15));
    }
    const ChartLayout before = layout();
    const QPoint from = before.toScreen(c.fromValue.x(), c.fromValue.y()).toPoint();
    const QPoint to = before.toScreen(c.toValue.x(), c.toValue.y()).toPoint();
    const ViewState viewBefore = chart->view;
    drag({Qt::LeftButton}, kShift, from, to);

    const Axis& x = chart->chartArea.x;
    const Axis& y = chart->chartArea.y;
    if (!c.zooms) {
        EXPECT_FALSE(x.hasFixedRange);
        EXPECT_FALSE(y.hasFixedRange);
        EXPECT_EQ(chart->view.scale, viewBefore.scale);
        return;
    }
    ASSERT_TRUE(x.hasFixedRange);
    ASSERT_TRUE(y.hasFixedRange);
    // The drag's ends are whole pixels: one pixel's worth of value either way.
    const double xPixel = (before.mapping.xMax - before.mapping.xMin) / before.mapping.plot.width() / viewBefore.scale;
    const double yPixel = (before.mapping.yMax - before.mapping.yMin) / before.mapping.plot.height() / viewBefore.scale;
    EXPECT_NEAR(x.min, std::min(c.fromValue.x(), c.toValue.x()), xPixel);
    EXPECT_NEAR(x.max, std::max(c.fromValue.x(), c.toValue.x()), xPixel);
    EXPECT_NEAR(y.min, std::min(c.fromValue.y(), c.toValue.y()), yPixel);
    EXPECT_NEAR(y.max, std::max(c.fromValue.y(), c.toValue.y()), yPixel);
    // Redrawn with its axes: unscaled, the plot runs over the new range, the ticks inside it.
    EXPECT_TRUE(chart->view.isIdentity());
    const ChartLayout after = layout();
    EXPECT_DOUBLE_EQ(after.mapping.xMin, x.min);
    EXPECT_DOUBLE_EQ(after.mapping.xMax, x.max);
    EXPECT_DOUBLE_EQ(after.mapping.yMin, y.min);
    EXPECT_DOUBLE_EQ(after.mapping.yMax, y.max);
    ASSERT_FALSE(after.yLabels.empty());
    for (const AxisLabel& t : after.yLabels) {
        EXPECT_GE(t.value, y.min - 1e-9);
        EXPECT_LE(t.value, y.max + 1e-9);
    }
    EXPECT_NE(after.yLabels.front().value, before.yLabels.front().value);
}

INSTANTIATE_TEST_SUITE_P(
    Selections, AxisZoomTest,
    ::testing::Values(AxisZoomCase{"flatBars", kBar, 0, {2, 20}, {4, 60}, false, true},
                      AxisZoomCase{"draggedUpLeft", kBar, 0, {4.5, 70}, {1.5, 15}, false, true},
                      AxisZoomCase{"bars3D", kBar, 10, {2, 20}, {5, 80}, false, true},
                      AxisZoomCase{"plot", kPlot, 10, {1.5, 30}, {3.5, 50}, false, true},
                      AxisZoomCase{"area", kArea, 0, {3, 10}, {6, 40}, false, true},
                      AxisZoomCase{"throughScaleAndMove", kBar, 0, {2.5, 35}, {3.5, 55}, true, true},
                      AxisZoomCase{"pieHasNoAxes", kPie, 0, {2, 20}, {4, 60}, false, false}),
    [](const auto& info) { return std::string(info.param.name); });

TEST_F(ViewFixture, AxisZoomInsideAnAxisZoomNarrowsIt)
{
    fillMonthlyBars(*chart, kBar);
    chart->chartArea.view3D.depth = 0;
    makeView();
    drag({Qt::LeftButton}, kShift, layout().toScreen(1.5, 10).toPoint(), layout().toScreen(5.5, 90).toPoint());
    const double firstMin = chart->chartArea.y.min;
    drag({Qt::LeftButton}, kShift, layout().toScreen(2.5, 30).toPoint(), layout().toScreen(3.5, 50).toPoint());
    EXPECT_GT(chart->chartArea.y.min, firstMin);
    EXPECT_NEAR(chart->chartArea.x.min, 2.5, 0.05);
    EXPECT_NEAR(chart->chartArea.x.max, 3.5, 0.05);
    EXPECT_NEAR(chart->chartArea.y.min, 30, 0.5);
    EXPECT_NEAR(chart->chartArea.y.max, 50, 0.5);
}

// ---- the selection's marker and Escape ----

struct SelectionCase {
    const char* name;
    Qt::KeyboardModifiers modifiers;
};

class SelectionTest : public ViewFixture, public ::testing::WithParamInterface<SelectionCase> {};

TEST_P(SelectionTest, MarkerFollowsTheMouseAndEscapeCancels)
{
    fillMonthlyBars(*chart, kBar);
    makeView();
    const QPoint c = areaCentre();
    const uint64_t revision = chart->revision();
    press(Qt::LeftButton, GetParam().modifiers, c);
    moveTo(c + QPoint(120, 80));
    ASSERT_TRUE(view->selectionMarker()->isVisible());
    EXPECT_EQ(view->selectionMarker()->geometry(), QRect(c, QSize(120, 80)));
    key(Qt::Key_Escape);
    EXPECT_FALSE(view->selectionMarker()->isVisible());
    moveTo(c + QPoint(200, 100));
    release(Qt::LeftButton, c + QPoint(200, 100));
    EXPECT_TRUE(chart->view.isIdentity());
    EXPECT_FALSE(chart->chartArea.x.hasFixedRange);
    EXPECT_FALSE(chart->chartArea.y.hasFixedRange);
    EXPECT_EQ(chart->revision(), revision);
}

INSTANTIATE_TEST_SUITE_P(Zooms, SelectionTest,
                         ::testing::Values(SelectionCase{"graphicsZoom", kCtrl}, SelectionCase{"axisZoom", kShift}),
                         [](const auto& info) { return std::string(info.param.name); });

TEST_F(ViewFixture, MarkerStaysInsideTheChartArea)
{
    fillMonthlyBars(*chart, kBar);
    makeView();
    const QRectF frame = layout().chartContent;
    press(Qt::LeftButton, kCtrl, frame.center().toPoint());
    moveTo(QPoint(view->width() - 1, view->height() - 1));
    EXPECT_TRUE(frame.toAlignedRect().contains(view->selectionMarker()->geometry()));
    release(Qt::LeftButton, QPoint(view->width() - 1, view->height() - 1));
    EXPECT_FALSE(view->selectionMarker()->isVisible());
}

TEST_F(ViewFixture, EscapeWithoutASelectionIsLeftToTheWindow)
{
    fillMonthlyBars(*chart, kBar);
    makeView();
    QKeyEvent escape(QEvent::KeyPress, Qt::Key_Escape, Qt::NoModifier);
    QApplication::sendEvent(view.get(), &escape);
    EXPECT_FALSE(escape.isAccepted());
}

// ---- "r" ----

struct ResetCase {
    const char* name;
    bool scale, move, graphicsZoom, axisZoom, rotate;
};

std::ostream& operator<<(std::ostream& os, const ResetCase& c) { return os << c.name; }

class ResetTest : public ViewFixture, public ::testing::WithParamInterface<ResetCase> {};

TEST_P(ResetTest, RKeyRestoresTheInitialPicture)
{
    const ResetCase& c = GetParam();
    fillMonthlyBars(*chart, kBar);
    makeView();
    const QPoint centre = areaCentre();
    const ChartLayout start = layout();
    if (c.rotate) drag({Qt::MiddleButton}, {}, centre, centre + QPoint(16, -12));
    const View3D rotated = chart->chartArea.view3D;
    const QImage initial = renderImage(*chart, view->size());
    if (c.scale) drag({Qt::MiddleButton}, kCtrl, centre, centre + QPoint(0, 55));
    if (c.move) drag({Qt::MiddleButton}, Qt::ShiftModifier, centre, centre + QPoint(-70, 35));
    if (c.axisZoom)
        drag({Qt::LeftButton}, Qt::ShiftModifier, start.toScreen(2, 20).toPoint(), start.toScreen(4, 60).toPoint());
    if (c.graphicsZoom) drag({Qt::LeftButton}, kCtrl, centre - QPoint(50, 40), centre + QPoint(60, 20));
    ASSERT_NE(renderImage(*chart, view->size()), initial);

    key(Qt::Key_R);

    EXPECT_EQ(chart->view.scale, 1.0);
    EXPECT_EQ(chart->view.offsetX, 0.0);
    EXPECT_EQ(chart->view.offsetY, 0.0);
    EXPECT_FALSE(chart->chartArea.x.hasFixedRange);
    EXPECT_FALSE(chart->chartArea.y.hasFixedRange);
    // The 3-D view is the style's, not a zoom: it stays.
    EXPECT_EQ(chart->chartArea.view3D.rotation, rotated.rotation);
    EXPECT_EQ(chart->chartArea.view3D.elevation, rotated.elevation);
    EXPECT_EQ(renderImage(*chart, view->size()), initial);
}

INSTANTIATE_TEST_SUITE_P(Resets, ResetTest,
                         ::testing::Values(ResetCase{"scale", true, false, false, false, false},
                                           ResetCase{"move", false, true, false, false, false},
                                           ResetCase{"graphicsZoom", false, false, true, false, false},
                                           ResetCase{"axisZoom", false, false, false, true, false},
                                           ResetCase{"everything", true, true, true, true, false},
                                           ResetCase{"everythingAfterRotate", true, true, true, true, true}),
                         [](const auto& info) { return std::string(info.param.name); });

struct ResetKeyCase {
    const char* name;
    int key;
    Qt::KeyboardModifiers modifiers;
    bool resets;
};

class ResetKeyTest : public ViewFixture, public ::testing::WithParamInterface<ResetKeyCase> {};

TEST_P(ResetKeyTest, OnlyTheRKeyResets)
{
    fillMonthlyBars(*chart, kBar);
    makeView();
    const QPoint centre = areaCentre();
    drag({Qt::MiddleButton}, kCtrl, centre, centre + QPoint(0, 55));
    key(GetParam().key, GetParam().modifiers);
    EXPECT_EQ(chart->view.isIdentity(), GetParam().resets);
}

INSTANTIATE_TEST_SUITE_P(Keys, ResetKeyTest,
                         ::testing::Values(ResetKeyCase{"r", Qt::Key_R, Qt::NoModifier, true},
                                           ResetKeyCase{"shiftR", Qt::Key_R, Qt::ShiftModifier, true},
                                           ResetKeyCase{"ctrlR", Qt::Key_R, Qt::ControlModifier, false},
                                           ResetKeyCase{"altR", Qt::Key_R, Qt::AltModifier, false},
                                           ResetKeyCase{"t", Qt::Key_T, Qt::NoModifier, false},
                                           ResetKeyCase{"escape", Qt::Key_Escape, Qt::NoModifier, false}),
                         [](const auto& info) { return std::string(info.param.name); });

}  // namespace
}  // namespace kg::control::test
