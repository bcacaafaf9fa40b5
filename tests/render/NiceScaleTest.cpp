// Axis scales: round steps, ranges that include zero, tick texts without trailing zeros.
#include <gtest/gtest.h>

#include <cmath>

#include "chart/control/render/NiceScale.h"
#include "render/RenderSamples.h"

namespace kg::control {
namespace {

struct StepCase {
    const char* name;
    double span;
    int intervals;
    double step;
};

class NiceStepTest : public ::testing::TestWithParam<StepCase> {};

TEST_P(NiceStepTest, IsTheSmallestRoundStepThatFits)
{
    EXPECT_DOUBLE_EQ(niceStep(GetParam().span, GetParam().intervals), GetParam().step);
}

INSTANTIATE_TEST_SUITE_P(Steps, NiceStepTest,
                         ::testing::Values(StepCase{"hundredInTen", 100, 10, 10},
                                           StepCase{"hundredInEight", 100, 8, 20},
                                           StepCase{"hundredInFive", 100, 5, 20}, StepCase{"tenInFour", 10, 4, 2.5},
                                           StepCase{"sevenInSeven", 7, 7, 1}, StepCase{"oneInThree", 1, 3, 0.5},
                                           StepCase{"smallSpan", 0.003, 6, 0.0005},
                                           StepCase{"largeSpan", 3.2e9, 8, 5e8}, StepCase{"zeroSpan", 0, 5, 1},
                                           StepCase{"infiniteSpanKeptFinite", INFINITY, 5, 2e299},
                                           StepCase{"negativeSpan", -100, 10, 10}),
                         samples::rowName);

struct AutoCase {
    const char* name;
    double dataMin, dataMax;
    int intervals;
    double min, max, step;
};

class AutoScaleTest : public ::testing::TestWithParam<AutoCase> {};

TEST_P(AutoScaleTest, IncludesZeroAndEndsOnWholeSteps)
{
    const AutoCase& c = GetParam();
    const AxisScale s = autoScale(c.dataMin, c.dataMax, c.intervals);
    EXPECT_DOUBLE_EQ(s.min, c.min);
    EXPECT_DOUBLE_EQ(s.max, c.max);
    EXPECT_DOUBLE_EQ(s.step, c.step);
    ASSERT_FALSE(s.ticks.empty());
    EXPECT_DOUBLE_EQ(s.ticks.front(), c.min);
    EXPECT_NEAR(s.ticks.back(), c.max, c.step * 1e-9);
    EXPECT_LE(s.ticks.size(), size_t(c.intervals + 3));
}

INSTANTIATE_TEST_SUITE_P(
    Ranges, AutoScaleTest,
    ::testing::Values(AutoCase{"positive", 17, 160, 10, 0, 160, 20}, AutoCase{"allNegative", -83, -5, 10, -90, 0, 10},
                      AutoCase{"bothSides", -12, 47, 10, -20, 50, 10}, AutoCase{"allZero", 0, 0, 10, 0, 1, 0.1},
                      AutoCase{"oneValue", 5, 5, 5, 0, 5, 1}, AutoCase{"fractions", 0.02, 0.37, 8, 0, 0.4, 0.05},
                      AutoCase{"millions", 1.2e6, 9.7e6, 10, 0, 1e7, 1e6}),
    samples::rowName);

struct FixedCase {
    const char* name;
    double min, max;
    int intervals;
    double minStep;
    std::vector<double> ticks;
};

class FixedScaleTest : public ::testing::TestWithParam<FixedCase> {};

TEST_P(FixedScaleTest, KeepsTheGivenRangeWithRoundTicksInside)
{
    const FixedCase& c = GetParam();
    const AxisScale s = fixedScale(c.min, c.max, c.intervals, c.minStep);
    EXPECT_DOUBLE_EQ(s.min, c.min);
    EXPECT_DOUBLE_EQ(s.max, c.max);
    EXPECT_EQ(s.ticks, c.ticks);
}

INSTANTIATE_TEST_SUITE_P(Ranges, FixedScaleTest,
                         ::testing::Values(FixedCase{"ticksInside", 13, 87, 8, 0, {20, 30, 40, 50, 60, 70, 80}},
                                           FixedCase{"wholeStepsStayWhole", 0.5, 3.5, 20, 1, {1, 2, 3}}),
                         samples::rowName);

struct TextCase {
    const char* name;
    double value, step;
    const char* text;
};

class TickTextTest : public ::testing::TestWithParam<TextCase> {};

TEST_P(TickTextTest, HasNoTrailingZeros)
{
    EXPECT_EQ(tickText(GetParam().value, GetParam().step).toStdString(), GetParam().text);
}

INSTANTIATE_TEST_SUITE_P(
    Texts, TickTextTest,
    ::testing::Values(TextCase{"whole", 40, 20, "40"}, TextCase{"zero", 0, 0.5, "0"}, TextCase{"half", 2.5, 0.5, "2.5"},
                      TextCase{"quarterStep", 0.75, 0.25, "0.75"}, TextCase{"roundingNoise", 0.1 + 0.2, 0.1, "0.3"},
                      TextCase{"negative", -20, 10, "-20"}, TextCase{"negativeNearZero", -1e-17, 0.1, "0"},
                      TextCase{"thousands", 12500, 2500, "12500"}, TextCase{"small", 0.0005, 0.0005, "0.0005"},
                      TextCase{"huge", 2e20, 1e20, "2e+20"}),
    samples::rowName);

}  // namespace
}  // namespace kg::control
