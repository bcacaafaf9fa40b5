// roundToInteger / roundToLong: halves to the even neighbour, Error 6 outside the range.
#include <cmath>
#include <limits>

#include "RowSupport.h"
#include "core/Convert.h"
#include "core/Dispatch.h"  // completes Object for Variant

namespace kg {
namespace {

using test::kOverflow;

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInf = std::numeric_limits<double>::infinity();

// One value rounded to both widths.
struct RoundRow : test::Named {
    double value;
    test::Outcome<int64_t> integer, wide;
};

const RoundRow kRounds[] = {
    {"NegativeZero", -0.0, 0, 0},
    {"HalfToEvenZero", 0.5, 0, 0},
    {"OnePointFiveUp", 1.5, 2, 2},
    {"TwoPointFiveDown", 2.5, 2, 2},
    {"MinusHalfToZero", -0.5, 0, 0},
    {"MinusOnePointFive", -1.5, -2, -2},
    {"MinusTwoPointFive", -2.5, -2, -2},
    {"JustBelowHalf", 2.4999999, 2, 2},
    {"JustAboveHalf", 2.5000001, 3, 3},
    {"IntegerMax", 32767.0, 32767, 32767},
    {"IntegerMaxPlusPointFour", 32767.4, 32767, 32767},
    {"EvenHalfBelowIntegerMax", 32766.5, 32766, 32766},
    {"IntegerMaxPlusHalf", 32767.5, kOverflow, 32768},
    {"IntegerMin", -32768.0, -32768, -32768},
    {"IntegerMinMinusHalf", -32768.5, -32768, -32768},
    {"IntegerMinMinusPointSix", -32768.6, kOverflow, -32769},
    {"LongMax", 2147483647.0, kOverflow, 2147483647},
    {"LongMaxPlusPointFour", 2147483647.4, kOverflow, 2147483647},
    {"EvenHalfBelowLongMax", 2147483646.5, kOverflow, 2147483646},
    {"LongMaxPlusHalf", 2147483647.5, kOverflow, kOverflow},
    {"LongMin", -2147483648.0, kOverflow, -2147483648LL},
    {"LongMinMinusPointFour", -2147483648.4, kOverflow, -2147483648LL},
    {"LongMinMinusHalf", -2147483648.5, kOverflow, -2147483648LL},
    {"LongMinMinusPointSix", -2147483648.6, kOverflow, kOverflow},
    {"Huge", 1e300, kOverflow, kOverflow},
    {"NotANumber", kNaN, kOverflow, kOverflow},
    {"PlusInfinity", kInf, kOverflow, kOverflow},
    {"MinusInfinity", -kInf, kOverflow, kOverflow},
};

class Rounding : public testing::TestWithParam<RoundRow> {};

TEST_P(Rounding, HalvesToEvenWithinSixteenAndThirtyTwoBits)
{
    const double value = GetParam().value;
    test::expectOutcome(GetParam().integer, [&] { return int64_t(roundToInteger(value)); });
    test::expectOutcome(GetParam().wide, [&] { return int64_t(roundToLong(value)); });
}

INSTANTIATE_TEST_SUITE_P(Core, Rounding, testing::ValuesIn(kRounds), test::RowName{});

TEST(RoundingOverflow, NamesTheValueAndTheType)
{
    const test::Raised integer = test::raisedBy([] { roundToInteger(32767.5); });
    EXPECT_NE(integer.description.find("32767.5"), std::string::npos) << integer.description;
    EXPECT_NE(integer.description.find("Integer"), std::string::npos) << integer.description;
    const test::Raised wide = test::raisedBy([] { roundToLong(-2147483649.0); });
    EXPECT_NE(wide.description.find("-2147483649"), std::string::npos) << wide.description;
    EXPECT_NE(wide.description.find("Long"), std::string::npos) << wide.description;
}

}  // namespace
}  // namespace kg
