// Graphics zoom, axis zoom, Escape and the "r" key on the chart control's view.
#include <QRubberBand>
#include <algorithm>
#include <cmath>

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

class GraphicsZoomTest : public ViewFixture, public ::testing::WithParamInterface<GraphicsZoomCase> {};

TEST_P(GraphicsZoomTest, SelectionFillsTheChartArea)
{
    const GraphicsZoomCase& c = GetParam();
    showMonthly();
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
    EXPECT_FALSE(view->selectionMarker()->isVisible());

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
    ::testing::Values(GraphicsZoomCase{"offCentre", {20, 10}, {120, 60}, true, false},
                      GraphicsZoomCase{"draggedUpLeft", {120, 60}, {20, 10}, true, false},
                      GraphicsZoomCase{"tallSelection", {-30, -150}, {10, 100}, true, false},
                      GraphicsZoomCase{"beyondTheArea", {0, 0}, {2000, 2000}, true, false},
                      GraphicsZoomCase{"afterScaleAndMove", {-60, -20}, {40, 50}, true, true},
                      GraphicsZoomCase{"tinyStopsAt20", {0, 0}, {5, 5}, true, false},
                      GraphicsZoomCase{"narrowerThan4Nothing", {0, 0}, {3, 80}, false, false},
                      GraphicsZoomCase{"lowerThan4Nothing", {0, 0}, {80, 3}, false, false}),
    rowName);

// ---- axis zoom ----

enum class First { Nothing, ScaleAndMove, AxisZoom };

struct AxisZoomCase {
    const char* name;
    int16_t chartType;
    int32_t depth;
    QPointF fromValue, toValue;  // data values (X in point positions) of the drag's ends
    First first;
    bool zooms;
};

class AxisZoomTest : public ViewFixture, public ::testing::WithParamInterface<AxisZoomCase> {};

TEST_P(AxisZoomTest, AxesTakeTheSelectionsValues)
{
    const AxisZoomCase& c = GetParam();
    fillMonthlyBars(*chart, c.chartType);
    chart->chartArea.view3D.depth = c.depth;
    makeView();
    const QPoint centre = areaCentre();
    if (c.first == First::ScaleAndMove) {
        drag({Qt::MiddleButton}, kCtrl, centre, centre + QPoint(0, 40));
        drag({Qt::MiddleButton}, kShift, centre, centre + QPoint(-25, 15));
    } else if (c.first == First::AxisZoom) {
        drag({Qt::LeftButton}, kShift, layout().toScreen(1.5, 10).toPoint(), layout().toScreen(5.5, 90).toPoint());
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
    ::testing::Values(AxisZoomCase{"flatBars", kBar, 0, {2, 20}, {4, 60}, First::Nothing, true},
                      AxisZoomCase{"draggedUpLeft", kBar, 0, {4.5, 70}, {1.5, 15}, First::Nothing, true},
                      AxisZoomCase{"bars3D", kBar, 10, {2, 20}, {5, 80}, First::Nothing, true},
                      AxisZoomCase{"plot", kPlot, 10, {1.5, 30}, {3.5, 50}, First::Nothing, true},
                      AxisZoomCase{"area", kArea, 0, {3, 10}, {6, 40}, First::Nothing, true},
                      AxisZoomCase{"throughScaleAndMove", kBar, 0, {2.5, 35}, {3.5, 55}, First::ScaleAndMove, true},
                      AxisZoomCase{"insideAnAxisZoom", kBar, 0, {2.5, 30}, {3.5, 50}, First::AxisZoom, true},
                      AxisZoomCase{"pieHasNoAxes", kPie, 0, {2, 20}, {4, 60}, First::Nothing, false}),
    rowName);

// ---- the selection's marker and Escape ----

struct SelectionCase {
    const char* name;
    Qt::KeyboardModifiers modifiers;
};

class SelectionTest : public ViewFixture, public ::testing::WithParamInterface<SelectionCase> {};

// The marker follows the mouse inside the chart area; Escape cancels the selection.
TEST_P(SelectionTest, MarkerFollowsTheMouseAndEscapeCancels)
{
    showMonthly();
    const QPoint c = areaCentre();
    press(Qt::LeftButton, GetParam().modifiers, c);
    moveTo(c + QPoint(120, 80));
    ASSERT_TRUE(view->selectionMarker()->isVisible());
    EXPECT_EQ(view->selectionMarker()->geometry(), QRect(c, QSize(120, 80)));
    moveTo(QPoint(view->width() - 1, view->height() - 1));
    EXPECT_TRUE(layout().chartContent.toAlignedRect().contains(view->selectionMarker()->geometry()));
    key(Qt::Key_Escape);
    EXPECT_FALSE(view->selectionMarker()->isVisible());
    moveTo(c + QPoint(200, 100));
    release(Qt::LeftButton, c + QPoint(200, 100));
    EXPECT_TRUE(chart->view.isIdentity());
    EXPECT_FALSE(chart->chartArea.x.hasFixedRange);
    EXPECT_FALSE(chart->chartArea.y.hasFixedRange);
}

INSTANTIATE_TEST_SUITE_P(Zooms, SelectionTest,
                         ::testing::Values(SelectionCase{"graphicsZoom", kCtrl}, SelectionCase{"axisZoom", kShift}),
                         rowName);

TEST_F(ViewFixture, EscapeWithoutASelectionIsLeftToTheWindow)
{
    showMonthly();
    QKeyEvent escape(QEvent::KeyPress, Qt::Key_Escape, Qt::NoModifier);
    QApplication::sendEvent(view.get(), &escape);
    EXPECT_FALSE(escape.isAccepted());
}

// ---- "r" ----

enum Done { Scale = 1, Move = 2, GraphicsZoom = 4, AxisZoom = 8, Rotate = 16 };

struct ResetCase {
    const char* name;
    int done;  // Done flags: what the mouse did before the key
    int key;
    Qt::KeyboardModifiers modifiers;
    bool resets;
};

class ResetTest : public ViewFixture, public ::testing::WithParamInterface<ResetCase> {};

// "r" (whatever the case) restores the initial picture: no scale, move or zoom; the 3-D view is
// the style's, not a zoom, so a rotation stays. Other keys leave the zoom alone.
TEST_P(ResetTest, RKeyRestoresTheInitialPicture)
{
    const ResetCase& c = GetParam();
    showMonthly();
    const QPoint centre = areaCentre();
    const ChartLayout start = layout();
    if (c.done & Rotate) drag({Qt::MiddleButton}, {}, centre, centre + QPoint(16, -12));
    const View3D rotated = chart->chartArea.view3D;
    const QImage initial = renderImage(*chart, view->size());
    if (c.done & Scale) drag({Qt::MiddleButton}, kCtrl, centre, centre + QPoint(0, 55));
    if (c.done & Move) drag({Qt::MiddleButton}, kShift, centre, centre + QPoint(-70, 35));
    if (c.done & AxisZoom)
        drag({Qt::LeftButton}, kShift, start.toScreen(2, 20).toPoint(), start.toScreen(4, 60).toPoint());
    if (c.done & GraphicsZoom) drag({Qt::LeftButton}, kCtrl, centre - QPoint(50, 40), centre + QPoint(60, 20));
    const ViewState zoomed = chart->view;
    const QImage changed = renderImage(*chart, view->size());
    ASSERT_NE(changed, initial);

    key(c.key, c.modifiers);

    EXPECT_EQ(chart->chartArea.view3D.rotation, rotated.rotation);
    EXPECT_EQ(chart->chartArea.view3D.elevation, rotated.elevation);
    if (!c.resets) {
        EXPECT_EQ(chart->view.scale, zoomed.scale);
        EXPECT_EQ(renderImage(*chart, view->size()), changed);
        return;
    }
    EXPECT_EQ(chart->view.scale, 1.0);
    EXPECT_EQ(chart->view.offsetX, 0.0);
    EXPECT_EQ(chart->view.offsetY, 0.0);
    EXPECT_FALSE(chart->chartArea.x.hasFixedRange);
    EXPECT_FALSE(chart->chartArea.y.hasFixedRange);
    EXPECT_EQ(renderImage(*chart, view->size()), initial);
}

const int kEverything = Scale | Move | GraphicsZoom | AxisZoom | Rotate;

INSTANTIATE_TEST_SUITE_P(Resets, ResetTest,
                         ::testing::Values(ResetCase{"rAfterScale", Scale, Qt::Key_R, Qt::NoModifier, true},
                                           ResetCase{"rAfterAxisZoom", AxisZoom, Qt::Key_R, Qt::NoModifier, true},
                                           ResetCase{"rAfterEverything", kEverything, Qt::Key_R, Qt::NoModifier, true},
                                           ResetCase{"shiftR", Scale, Qt::Key_R, Qt::ShiftModifier, true},
                                           ResetCase{"ctrlRNothing", Scale, Qt::Key_R, Qt::ControlModifier, false},
                                           ResetCase{"escapeNothing", Scale, Qt::Key_Escape, Qt::NoModifier, false}),
                         rowName);

}  // namespace
}  // namespace kg::control::test
