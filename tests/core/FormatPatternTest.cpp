// formatPattern: "$0.00" and "0" for the totals in the headers, "DD/MM/YYYY" for the date ranges.
#include <limits>
#include <string>
#include <vector>

#include "RowSupport.h"
#include "core/Convert.h"
#include "core/Date.h"
#include "core/Dispatch.h"

namespace kg {
namespace {

using test::kBadCall;
using test::kMismatch;
using test::kNull;
using test::kOverflow;

const char* const kDollars = "$0.00";
const char* const kWhole = "0";
const char* const kDate = "DD/MM/YYYY";

struct PatternRow : test::Named {
    Variant value;
    const char* pattern;
    test::Outcome<std::string> expected;
};

const std::vector<PatternRow>& patternRows()
{
    static const std::vector<PatternRow> rows = {
        // "$0.00": a dollar, at least one integer digit, exactly two decimals, halves away from zero
        {"DollarsWhole", Variant(int16_t(7)), kDollars, "$7.00"},
        {"DollarsHalfCent", Variant(0.005), kDollars, "$0.01"},
        {"DollarsCarryIntoThousands", Variant(999.995), kDollars, "$1000.00"},
        {"DollarsNoGrouping", Variant(1234567.891), kDollars, "$1234567.89"},
        {"DollarsNegativeHalfCent", Variant(-0.005), kDollars, "-$0.01"},
        {"DollarsNegativeRoundsToZero", Variant(-0.004), kDollars, "$0.00"},
        {"DollarsNegativeZero", Variant(-0.0), kDollars, "$0.00"},
        {"DollarsLarge", Variant(1e20), kDollars, "$100000000000000000000.00"},
        {"DollarsEmpty", Variant(), kDollars, "$0.00"},
        {"DollarsTrue", Variant(true), kDollars, "-$1.00"},
        {"DollarsNumericText", Variant("12.5"), kDollars, "$12.50"},
        {"DollarsOtherText", Variant("n/a"), kDollars, "n/a"},
        {"DollarsEmptyText", Variant(""), kDollars, ""},
        // "0": a whole number without grouping
        {"WholeHalfUp", Variant(2.5), kWhole, "3"},
        {"WholeNegativeHalf", Variant(-0.5), kWhole, "-1"},
        {"WholeNegativeRoundsToZero", Variant(-0.4), kWhole, "0"},
        {"WholeBelowHalf", Variant(0.4999999), kWhole, "0"},
        {"WholeNoGrouping", Variant(1234567.0), kWhole, "1234567"},
        {"WholeLongMaxPlusHalf", Variant(2147483647.5), kWhole, "2147483648"},
        {"WholeFifteenDigitsKept", Variant(123456789012345678.0), kWhole, "123456789012346000"},
        {"WholeNumericText", Variant("12.5"), kWhole, "13"},
        {"WholeDateSerial", Variant::date(41456.75), kWhole, "41457"},
        {"WholeOtherText", Variant("abc"), kWhole, "abc"},
        // "DD/MM/YYYY", letters in any case
        {"DateDropsTime", Variant::date(41820.75), kDate, "30/06/2014"},
        {"DateLowerCasePattern", Variant::date(41456), "dd/mm/yyyy", "01/07/2013"},
        {"DateOfNumber", Variant(41456.0), kDate, "01/07/2013"},
        {"DateOfNumericText", Variant("41456"), kDate, "01/07/2013"},
        {"DateOfOtherText", Variant("not a date"), kDate, "not a date"},
        {"DateOfNumberBeyondRange", Variant(1e7), kDate, kOverflow},
        {"DateOfTextBeyondRange", Variant("3000000"), kDate, kOverflow},
        // failures
        {"NullDollars", Variant::null(), kDollars, kNull},
        {"NullDate", Variant::null(), kDate, kNull},
        {"ObjectDollars", test::anObject(), kDollars, kMismatch},
        {"ArrayWhole", test::anArray(), kWhole, kMismatch},
        {"NumericTextBeyondDoubleRange", Variant("1e400"), kWhole, kOverflow},
        {"UnknownPatternGrouped", Variant(1.0), "#,##0", test::Raises{errc::InvalidProcedureCall, "#,##0"}},
        {"UnknownPatternEmpty", Variant(1.0), "", kBadCall},
        {"UnknownPatternTrailingBlank", Variant(1.0), "$0.00 ", kBadCall},
        {"UnknownPatternShortYear", Variant::date(41456), "DD/MM/YY", kBadCall},
    };
    return rows;
}

class FormatPattern : public testing::TestWithParam<PatternRow> {};

TEST_P(FormatPattern, FormatsAsThePatternSays)
{
    test::expectOutcome(GetParam().expected, [&] { return formatPattern(GetParam().value, GetParam().pattern); });
}

INSTANTIATE_TEST_SUITE_P(Core, FormatPattern, testing::ValuesIn(patternRows()), test::RowName{});

TEST(FormatPatternFailure, NonFiniteValuesDoNotCrash)
{
    for (double v : {std::numeric_limits<double>::quiet_NaN(), std::numeric_limits<double>::infinity(),
                     -std::numeric_limits<double>::infinity()}) {
        EXPECT_NO_THROW(formatPattern(Variant(v), kDollars));
        EXPECT_NO_THROW(formatPattern(Variant(v), kWhole));
        EXPECT_EQ(test::raisedBy([&] { formatPattern(Variant(v), kDate); }).number, errc::Overflow);
    }
}

TEST(FormatPatternLarge, KeepsEveryDigitOfTheLargestDouble)
{
    const std::string text = formatPattern(Variant(std::numeric_limits<double>::max()), kWhole);
    ASSERT_EQ(text.size(), 309u);
    EXPECT_EQ(text.substr(0, 15), "179769313486232");
    EXPECT_EQ(text.find_first_not_of('0', 15), std::string::npos);
}

}  // namespace
}  // namespace kg
