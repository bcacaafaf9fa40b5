// roundToInteger / roundToLong: halves to the even neighbour, Error 6 outside the range.
#include <cmath>
#include <limits>

#include "RowSupport.h"
#include "core/Convert.h"
#include "core/Dispatch.h"  // completes Object for Variant

namespace kg {
namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInf = std::numeric_limits<double>::infinity();
constexpr bool kOverflows = true;

struct RoundRow {
    const char* name;
    double value;
    int64_t expected;
    bool overflows;
    friend void PrintTo(const RoundRow& r, std::ostream* os) { *os << r.name; }
};

const RoundRow kToInteger[] = {
    {"Zero", 0.0, 0, false},
    {"NegativeZero", -0.0, 0, false},
    {"BelowHalf", 0.4, 0, false},
    {"AboveHalf", 1.6, 2, false},
    {"HalfToEvenZero", 0.5, 0, false},
    {"OnePointFiveUp", 1.5, 2, false},
    {"TwoPointFiveDown", 2.5, 2, false},
    {"ThreePointFiveUp", 3.5, 4, false},
    {"MinusHalfToZero", -0.5, 0, false},
    {"MinusOnePointFive", -1.5, -2, false},
    {"MinusTwoPointFive", -2.5, -2, false},
    {"MinusThreePointFive", -3.5, -4, false},
    {"JustBelowHalf", 2.4999999, 2, false},
    {"JustAboveHalf", 2.5000001, 3, false},
    {"View3DOnePointFour", 1.4, 1, false},
    {"Max", 32767.0, 32767, false},
    {"MaxPlusPointFour", 32767.4, 32767, false},
    {"EvenHalfBelowMax", 32766.5, 32766, false},
    {"MaxPlusHalfRoundsTo32768", 32767.5, 0, kOverflows},
    {"OneBeyondMax", 32768.0, 0, kOverflows},
    {"Min", -32768.0, -32768, false},
    {"MinMinusHalfRoundsToEvenMin", -32768.5, -32768, false},
    {"MinMinusPointSix", -32768.6, 0, kOverflows},
    {"OneBeyondMin", -32769.0, 0, kOverflows},
    {"Huge", 1e10, 0, kOverflows},
    {"NotANumber", kNaN, 0, kOverflows},
    {"PlusInfinity", kInf, 0, kOverflows},
    {"MinusInfinity", -kInf, 0, kOverflows},
};

const RoundRow kToLong[] = {
    {"Zero", 0.0, 0, false},
    {"HalfToEvenZero", 0.5, 0, false},
    {"OnePointFiveUp", 1.5, 2, false},
    {"TwoPointFiveDown", 2.5, 2, false},
    {"MinusTwoPointFive", -2.5, -2, false},
    {"BeyondIntegerRange", 32768.5, 32768, false},
    {"IntegerMinMinusHalf", -32768.5, -32768, false},
    {"Max", 2147483647.0, 2147483647, false},
    {"MaxPlusPointFour", 2147483647.4, 2147483647, false},
    {"EvenHalfBelowMax", 2147483646.5, 2147483646, false},
    {"MaxPlusHalfOverflows", 2147483647.5, 0, kOverflows},
    {"OneBeyondMax", 2147483648.0, 0, kOverflows},
    {"Min", -2147483648.0, -2147483648LL, false},
    {"MinMinusPointFour", -2147483648.4, -2147483648LL, false},
    {"MinMinusHalfRoundsToEvenMin", -2147483648.5, -2147483648LL, false},
    {"MinMinusPointSix", -2147483648.6, 0, kOverflows},
    {"OneBeyondMin", -2147483649.0, 0, kOverflows},
    {"Huge", 1e300, 0, kOverflows},
    {"NotANumber", kNaN, 0, kOverflows},
    {"MinusInfinity", -kInf, 0, kOverflows},
};

class RoundToInteger : public testing::TestWithParam<RoundRow> {};
class RoundToLong : public testing::TestWithParam<RoundRow> {};

template <class Round>
void expectRounding(const RoundRow& row, Round round)
{
    int64_t result = 0;
    const test::Raised raised = test::raisedBy([&] { result = round(row.value); });
    if (row.overflows) {
        EXPECT_EQ(raised.number, errc::Overflow) << "gave " << result;
    } else {
        EXPECT_EQ(raised.number, 0) << raised.description;
        EXPECT_EQ(result, row.expected);
    }
}

TEST_P(RoundToInteger, RoundsHalvesToEvenWithinSixteenBits)
{
    expectRounding(GetParam(), [](double v) { return int64_t(roundToInteger(v)); });
}

TEST_P(RoundToLong, RoundsHalvesToEvenWithinThirtyTwoBits)
{
    expectRounding(GetParam(), [](double v) { return int64_t(roundToLong(v)); });
}

INSTANTIATE_TEST_SUITE_P(Core, RoundToInteger, testing::ValuesIn(kToInteger), test::rowName<RoundRow>);
INSTANTIATE_TEST_SUITE_P(Core, RoundToLong, testing::ValuesIn(kToLong), test::rowName<RoundRow>);

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
