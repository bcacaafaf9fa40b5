// Scale (drag or wheel), move and rotate on the chart control's view: QTest mouse events on a
// drawn chart, and the view state, the 3-D view and what stays untouched outside the chart area.
#include <cmath>
#include <vector>

#include "view/ViewFixture.h"

namespace kg::control::test {
namespace {

enum class Where { AreaCentre, Header, Legend, ControlMargin };

struct DragCase {
    const char* name;
    int16_t chartType;
    int32_t depth;  // the 3-D look: 10; flat: 0
    std::vector<Qt::MouseButton> buttons;
    Qt::KeyboardModifiers modifiers;
    Where where;
    QPoint by;
    // Expected afterwards (the chart starts at scale 1, no offset, rotation 10, elevation 10).
    double scale;
    QPointF offsetPixels;  // offsets times the chart area's size
    int32_t rotation, elevation;
    int wheelDelta = 0;  // not 0: the wheel turned at the place instead of a drag
};

const Qt::KeyboardModifiers kCtrl = Qt::ControlModifier;
const Qt::KeyboardModifiers kShift = Qt::ShiftModifier;
const Qt::KeyboardModifiers kNone = Qt::NoModifier;
const Qt::MouseButton L = Qt::LeftButton, R = Qt::RightButton, M = Qt::MiddleButton;
const double e = std::exp(1.0);

class DragTest : public ViewFixture, public ::testing::WithParamInterface<DragCase> {};

QPoint placeOf(const ChartLayout& l, Where where)
{
    switch (where) {
    case Where::AreaCentre: return l.chartContent.center().toPoint();
    case Where::Header: return l.header.center().toPoint();
    case Where::Legend: return l.legend.center().toPoint();
    case Where::ControlMargin: return QPoint(2, int(l.bounds.center().y()));
    }
    return {};
}

TEST_P(DragTest, ChangesTheViewAsTheGestureSays)
{
    const DragCase& c = GetParam();
    fillMonthlyBars(*chart, c.chartType);
    chart->chartArea.view3D = {10, 10, c.depth};
    makeView();
    const ChartLayout before = layout();
    ASSERT_FALSE(before.legend.isEmpty());
    const QPoint from = placeOf(before, c.where);
    if (c.wheelDelta)
        wheel(from, c.wheelDelta, c.modifiers);
    else
        drag(c.buttons, c.modifiers, from, from + c.by);
    EXPECT_NEAR(chart->view.scale, c.scale, 1e-9);
    EXPECT_NEAR(chart->view.offsetX * before.chartContent.width(), c.offsetPixels.x(), 1e-9);
    EXPECT_NEAR(chart->view.offsetY * before.chartContent.height(), c.offsetPixels.y(), 1e-9);
    EXPECT_EQ(chart->chartArea.view3D.rotation, c.rotation);
    EXPECT_EQ(chart->chartArea.view3D.elevation, c.elevation);
    EXPECT_EQ(chart->chartArea.view3D.depth, c.depth);
    EXPECT_FALSE(chart->chartArea.x.hasFixedRange);
    EXPECT_FALSE(chart->chartArea.y.hasFixedRange);
    EXPECT_EQ(view->interaction().gesture(), Gesture::None);
    // Titles and legend stay where they were.
    const ChartLayout after = layout();
    EXPECT_EQ(after.header, before.header);
    EXPECT_EQ(after.legend, before.legend);
    EXPECT_EQ(after.chartArea, before.chartArea);
}

INSTANTIATE_TEST_SUITE_P(
    Gestures, DragTest,
    ::testing::Values(
        DragCase{"scaleCtrlBothDown", kBar, 10, {L, R}, kCtrl, Where::AreaCentre, {0, 100}, e, {}, 10, 10},
        DragCase{"scaleCtrlRightThenLeft", kBar, 10, {R, L}, kCtrl, Where::AreaCentre, {0, 100}, e, {}, 10, 10},
        DragCase{"scaleCtrlMiddleUp", kBar, 10, {M}, kCtrl, Where::AreaCentre, {0, -100}, 1 / e, {}, 10, 10},
        DragCase{"scaleSidewaysKeepsScale", kBar, 10, {L, R}, kCtrl, Where::AreaCentre, {120, 0}, 1, {}, 10, 10},
        DragCase{"scaleOnPie", kPie, 10, {M}, kCtrl, Where::AreaCentre, {0, 50}, std::exp(0.5), {}, 10, 10},
        DragCase{"scaleStopsAt20", kBar, 10, {M}, kCtrl, Where::AreaCentre, {0, 400}, 20, {}, 10, 10},
        DragCase{"scaleStopsAtATenth", kBar, 10, {M}, kCtrl, Where::AreaCentre, {0, -300}, 0.1, {}, 10, 10},
        DragCase{"moveShiftBoth", kBar, 10, {L, R}, kShift, Where::AreaCentre, {80, -40}, 1, {80, -40}, 10, 10},
        DragCase{"moveShiftMiddle", kPlot, 10, {M}, kShift, Where::AreaCentre, {-50, 30}, 1, {-50, 30}, 10, 10},
        DragCase{"rotateBarBoth", kBar, 10, {L, R}, kNone, Where::AreaCentre, {20, 30}, 1, {}, 20, 25},
        DragCase{"rotateBarMiddleUpLeft", kBar, 10, {M}, kNone, Where::AreaCentre, {-21, -31}, 1, {}, 0, -5},
        DragCase{"rotateKeptWithin45", kBar, 10, {M}, kNone, Where::AreaCentre, {200, -200}, 1, {}, 45, -45},
        DragCase{"rotateKeptWithinMinus45", kBar, 10, {L, R}, kNone, Where::AreaCentre, {-200, 200}, 1, {}, -45, 45},
        DragCase{"rotatePieElevationOnly", kPie, 10, {M}, kNone, Where::AreaCentre, {20, 30}, 1, {}, 10, 25},
        DragCase{"rotateFlatBarNothing", kBar, 0, {M}, kNone, Where::AreaCentre, {20, 30}, 1, {}, 10, 10},
        DragCase{"scaleFromHeaderNothing", kBar, 10, {L, R}, kCtrl, Where::Header, {0, 100}, 1, {}, 10, 10},
        DragCase{"moveFromLegendNothing", kBar, 10, {M}, kShift, Where::Legend, {-80, 40}, 1, {}, 10, 10},
        DragCase{"scaleFromMarginNothing", kBar, 10, {M}, kCtrl, Where::ControlMargin, {0, 100}, 1, {}, 10, 10},
        // Ctrl + wheel scales inside the chart area, by 1.2 a notch.
        DragCase{"wheelCtrlAway", kBar, 10, {}, kCtrl, Where::AreaCentre, {}, 1.2, {}, 10, 10, 120},
        DragCase{"wheelCtrlTowards", kBar, 10, {}, kCtrl, Where::AreaCentre, {}, 1 / 1.2, {}, 10, 10, -120},
        DragCase{"wheelCtrlHalfNotch", kBar, 10, {}, kCtrl, Where::AreaCentre, {}, std::sqrt(1.2), {}, 10, 10, 60},
        DragCase{"wheelNoKeyNothing", kBar, 10, {}, kNone, Where::AreaCentre, {}, 1, {}, 10, 10, 120},
        DragCase{"wheelShiftNothing", kBar, 10, {}, kShift, Where::AreaCentre, {}, 1, {}, 10, 10, 120},
        DragCase{"wheelCtrlOnLegendNothing", kBar, 10, {}, kCtrl, Where::Legend, {}, 1, {}, 10, 10, 120}),
    rowName);

// Scaling keeps the chart area's centre in place even when the chart was moved: the data shown
// there before is shown there after.
TEST_F(ViewFixture, ScaleAfterAMoveKeepsWhatTheCentreShows)
{
    showMonthly();
    const QPoint c = areaCentre();
    const QPointF exactCentre = layout().chartContent.center();
    drag({Qt::MiddleButton}, kShift, c, c + QPoint(90, -60));
    QPointF shownAtCentre;
    ASSERT_TRUE(layout().toValue(exactCentre, shownAtCentre));
    drag({Qt::MiddleButton}, kCtrl, c, c + QPoint(0, 70));
    EXPECT_NEAR(chart->view.scale, std::exp(0.7), 1e-9);
    const QPointF stillThere = layout().toScreen(shownAtCentre.x(), shownAtCentre.y());
    EXPECT_NEAR(stillThere.x(), exactCentre.x(), 1e-6);
    EXPECT_NEAR(stillThere.y(), exactCentre.y(), 1e-6);
}

// Rotation moves in whole degrees, 2 pixels each: a smaller move neither changes nor repaints.
TEST_F(ViewFixture, RotateRepaintsOnceAMoveChangesADegree)
{
    showMonthly();
    const QPoint c = areaCentre();
    press(Qt::MiddleButton, kNone, c);
    moveTo(c + QPoint(1, 1));  // half a degree: no change
    EXPECT_EQ(chart->chartArea.view3D.rotation, 10);
    moveTo(c + QPoint(2, 0));
    EXPECT_EQ(chart->chartArea.view3D.rotation, 11);
    release(Qt::MiddleButton, c + QPoint(2, 0));
}

// Letting go of one of the two buttons ends the gesture: later moves change nothing.
TEST_F(ViewFixture, ReleasingOneOfBothButtonsEndsTheGesture)
{
    showMonthly();
    const QPoint c = areaCentre();
    press(Qt::LeftButton, kCtrl, c);
    press(Qt::RightButton, kCtrl, c);
    moveTo(c + QPoint(0, 50));
    release(Qt::RightButton, c + QPoint(0, 50));
    const double scaled = chart->view.scale;
    moveTo(c + QPoint(0, 150));
    release(Qt::LeftButton, c + QPoint(0, 150));
    EXPECT_NEAR(scaled, std::exp(0.5), 1e-9);
    EXPECT_EQ(chart->view.scale, scaled);
}

}  // namespace
}  // namespace kg::control::test
