// numberText(double): the one rule for plain totals, value labels, X point labels and stored settings.
#include <cmath>
#include <limits>

#include "RowSupport.h"
#include "core/Convert.h"
#include "core/Dispatch.h"  // completes Object for Variant

namespace kg {
namespace {

struct NumberTextRow : test::Named {
    double value;
    const char* expected;
};

constexpr double kInf = std::numeric_limits<double>::infinity();

const NumberTextRow kNumberTexts[] = {
    // sign position
    {"Zero", 0.0, " 0"},
    {"NegativeZero", -0.0, " 0"},
    {"One", 1.0, " 1"},
    // decimals as the value needs, a 0 before the point
    {"Half", 0.5, " 0.5"},
    {"MinusHalf", -0.5, "-0.5"},
    {"NinetyNinePointNineNine", 99.99, " 99.99"},
    // 15 significant digits, trailing zeros dropped
    {"PointOnePlusPointTwo", 0.1 + 0.2, " 0.3"},
    {"OneThird", 1.0 / 3.0, " 0.333333333333333"},
    {"TwoThirds", 2.0 / 3.0, " 0.666666666666667"},
    {"NineDigitsAndFraction", 123456789.123456789, " 123456789.123457"},
    {"FifteenDigitFraction", 0.123456789012345, " 0.123456789012345"},
    // 32-bit limits
    {"LongMax", 2147483647.0, " 2147483647"},
    {"LongMin", -2147483648.0, "-2147483648"},
    // plain as long as 15 integer digits suffice
    {"FifteenNines", 999999999999999.0, " 999999999999999"},
    {"OneE15NeedsSixteenDigits", 1e15, " 1E+15"},
    {"RoundsUpToOneE15", 999999999999999.9, " 1E+15"},
    {"SixteenDigitInteger", 1234567890123456.0, " 1.23456789012346E+15"},
    {"OnePointFiveE20", 1.5e20, " 1.5E+20"},
    {"ThreeDigitExponent", 1e100, " 1E+100"},
    {"LargestDouble", std::numeric_limits<double>::max(), " 1.79769313486232E+308"},
    // plain as long as 15 digits after the point suffice
    {"OnePointFiveE_5", 1.5e-5, " 0.000015"},
    {"OneE_15", 1e-15, " 0.000000000000001"},
    {"OneE_16", 1e-16, " 1E-16"},
    {"SixteenPlacesNeeded", 0.0123456789012345, " 1.23456789012345E-02"},
    {"SmallWithTwelveDigits", 1.23456789012e-5, " 1.23456789012E-05"},
    {"SmallestDenormal", std::numeric_limits<double>::denorm_min(), " 4.94065645841247E-324"},
    // cannot come from the readers, must not crash
    {"NotANumber", std::numeric_limits<double>::quiet_NaN(), " NaN"},
    {"PlusInfinity", kInf, " Inf"},
    {"MinusInfinity", -kInf, "-Inf"},
};

class NumberText : public testing::TestWithParam<NumberTextRow> {};

TEST_P(NumberText, WritesTheValueWithItsSignPosition)
{
    EXPECT_EQ(numberText(GetParam().value), GetParam().expected);
}

INSTANTIATE_TEST_SUITE_P(Core, NumberText, testing::ValuesIn(kNumberTexts), test::RowName{});

}  // namespace
}  // namespace kg
