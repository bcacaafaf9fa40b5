// The interaction rules without a widget: which gesture buttons and keys choose, how a second
// button changes it, and that odd input (no room, a broken view state) leaves the chart sane.
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "chart/control/view/ChartInteraction.h"
#include "render/RenderSamples.h"

namespace kg::control {
namespace {

const Qt::MouseButtons kBoth = Qt::LeftButton | Qt::RightButton;

struct ChoiceCase {
    const char* name;
    int16_t chartType;
    int32_t depth;
    Qt::MouseButtons buttons;
    Qt::KeyboardModifiers modifiers;
    Gesture gesture;
};

class GestureChoiceTest : public ::testing::TestWithParam<ChoiceCase> {};

TEST_P(GestureChoiceTest, ButtonsAndKeysChooseTheGesture)
{
    ChartControl chart;
    chart.group1.chartType = GetParam().chartType;
    chart.chartArea.view3D = {10, 10, GetParam().depth};
    EXPECT_EQ(ChartInteraction::gestureFor(chart, GetParam().buttons, GetParam().modifiers), GetParam().gesture);
}

// The view tests drive the common choices with real mouse events; here the rest of the table.
INSTANTIATE_TEST_SUITE_P(
    Table, GestureChoiceTest,
    ::testing::Values(
        ChoiceCase{"ctrlMiddleScale", kPlot, 0, Qt::MiddleButton, Qt::ControlModifier, Gesture::Scale},
        ChoiceCase{"ctrlBothAndMiddleScale", kBar, 10, kBoth | Qt::MiddleButton, Qt::ControlModifier, Gesture::Scale},
        ChoiceCase{"shiftMiddleMove", kArea, 0, Qt::MiddleButton, Qt::ShiftModifier, Gesture::Move},
        ChoiceCase{"unknownTypeDrawnAsBars", 7, 10, Qt::MiddleButton, Qt::NoModifier, Gesture::Rotate},
        ChoiceCase{"altDoesNotMatter", kBar, 10, kBoth, Qt::AltModifier, Gesture::Rotate},
        ChoiceCase{"plotNoRotate", kPlot, 10, kBoth, Qt::NoModifier, Gesture::None},
        ChoiceCase{"areaNoRotate", kArea, 10, Qt::MiddleButton, Qt::NoModifier, Gesture::None},
        ChoiceCase{"leftAloneNothing", kBar, 10, Qt::LeftButton, Qt::NoModifier, Gesture::None},
        ChoiceCase{"ctrlRightNothing", kBar, 10, Qt::RightButton, Qt::ControlModifier, Gesture::None},
        ChoiceCase{"shiftLeftAndMiddleMove", kBar, 10, Qt::LeftButton | Qt::MiddleButton, Qt::ShiftModifier,
                   Gesture::Move},
        ChoiceCase{"ctrlShiftBothNothing", kBar, 10, kBoth, Qt::ControlModifier | Qt::ShiftModifier, Gesture::None},
        ChoiceCase{"ctrlShiftLeftNothing", kBar, 10, Qt::LeftButton, Qt::ControlModifier | Qt::ShiftModifier,
                   Gesture::None},
        ChoiceCase{"noButtonNothing", kBar, 10, Qt::NoButton, Qt::ControlModifier, Gesture::None}),
    samples::rowName);

class InteractionTest : public ::testing::Test {
protected:
    void SetUp() override
    {
        samples::styleLikeTheChartObject(chart);
        samples::fillTable(chart, 2, 4, kBar);
        chart.chartArea.view3D = {10, 10, 10};
        interaction.setTarget(QRectF(0, 0, 800, 500));
        centre = computeLayout(chart, interaction.target()).chartContent.center();
    }
    ChartControl chart;
    ChartInteraction interaction{chart};
    QPointF centre;
};

// Ctrl + left starts a selection; the right button joining it turns it into scaling.
TEST_F(InteractionTest, SecondButtonTurnsASelectionIntoScaling)
{
    ASSERT_TRUE(interaction.press(centre, Qt::LeftButton, Qt::ControlModifier));
    interaction.move(centre + QPointF(40, 40));
    EXPECT_EQ(interaction.gesture(), Gesture::GraphicsZoom);
    EXPECT_EQ(interaction.selection(), QRectF(centre, QSizeF(40, 40)));
    ASSERT_TRUE(interaction.press(centre + QPointF(40, 40), kBoth, Qt::ControlModifier));
    EXPECT_EQ(interaction.gesture(), Gesture::Scale);
    EXPECT_TRUE(interaction.selection().isEmpty());
    interaction.move(centre + QPointF(40, 140));
    EXPECT_NEAR(chart.view.scale, std::exp(1.0), 1e-9);
    interaction.release(centre + QPointF(40, 140), Qt::LeftButton);
    EXPECT_EQ(interaction.gesture(), Gesture::None);
}

TEST_F(InteractionTest, WheelWaitsForAGestureToEnd)
{
    interaction.press(centre, Qt::MiddleButton, Qt::ShiftModifier);
    EXPECT_FALSE(interaction.wheel(centre, 120, Qt::ControlModifier));
    EXPECT_EQ(chart.view.scale, 1.0);
}

// Without room or at a position that is no number, nothing starts.
TEST_F(InteractionTest, NoRoomOrNoNumberNoGesture)
{
    const double nan = std::numeric_limits<double>::quiet_NaN();
    EXPECT_FALSE(interaction.press(QPointF(nan, nan), kBoth, Qt::ControlModifier));
    interaction.setTarget(QRectF());
    EXPECT_FALSE(interaction.press(QPointF(0, 0), kBoth, Qt::ControlModifier));
    EXPECT_FALSE(interaction.wheel(QPointF(0, 0), 120, Qt::ControlModifier));
    EXPECT_EQ(interaction.gesture(), Gesture::None);
}

struct BrokenViewCase {
    const char* name;
    ViewState view;
};

class BrokenViewTest : public InteractionTest, public ::testing::WithParamInterface<BrokenViewCase> {};

// A view state that no gesture makes (set by hand) still gives finite, bounded results.
TEST_P(BrokenViewTest, GesturesMendIt)
{
    chart.view = GetParam().view;
    interaction.press(centre, Qt::MiddleButton, Qt::ControlModifier);
    interaction.move(centre + QPointF(0, 30));
    interaction.release(centre + QPointF(0, 30), Qt::NoButton);
    interaction.press(centre, Qt::LeftButton, Qt::ControlModifier);
    interaction.move(centre + QPointF(50, 30));
    interaction.release(centre + QPointF(50, 30), Qt::NoButton);
    for (double v : {chart.view.scale, chart.view.offsetX, chart.view.offsetY}) EXPECT_TRUE(std::isfinite(v));
    EXPECT_GE(chart.view.scale, ChartInteraction::kMinScale);
    EXPECT_LE(chart.view.scale, ChartInteraction::kMaxScale);
    EXPECT_LE(std::fabs(chart.view.offsetX), ChartInteraction::kMostOffset);
    EXPECT_LE(std::fabs(chart.view.offsetY), ChartInteraction::kMostOffset);
}

const double kInf = std::numeric_limits<double>::infinity();
const double kNan = std::numeric_limits<double>::quiet_NaN();

INSTANTIATE_TEST_SUITE_P(Views, BrokenViewTest,
                         ::testing::Values(BrokenViewCase{"scaleNaN", {kNan, 0, 0}},
                                           BrokenViewCase{"scaleZero", {0, 0, 0}},
                                           BrokenViewCase{"scaleNegative", {-3, 0, 0}},
                                           BrokenViewCase{"scaleHuge", {1e300, 0, 0}},
                                           BrokenViewCase{"offsetInfinite", {1, kInf, -kInf}},
                                           BrokenViewCase{"offsetNaN", {2, kNan, kNan}}),
                         samples::rowName);

}  // namespace
}  // namespace kg::control
