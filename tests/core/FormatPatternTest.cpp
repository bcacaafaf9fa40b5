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

class Thing : public TableObject {
public:
    Variant invoke(DispId, uint16_t, Args&) override { return {}; }
    std::string objectName() const override { return "Thing"; }

protected:
    const std::vector<MemberInfo>& members() const override
    {
        static const std::vector<MemberInfo> none;
        return none;
    }
};

constexpr int kNoError = 0;
const char* const kDollars = "$0.00";
const char* const kWhole = "0";
const char* const kDate = "DD/MM/YYYY";

struct PatternRow {
    const char* name;
    Variant value;
    const char* pattern;
    std::string expected;
    int error;
    friend void PrintTo(const PatternRow& r, std::ostream* os) { *os << r.name; }
};

const std::vector<PatternRow>& patternRows()
{
    static const std::vector<PatternRow> rows = {
        // "$0.00": a dollar, at least one integer digit, exactly two decimals, halves away from zero
        {"DollarsZero", Variant(0.0), kDollars, "$0.00", kNoError},
        {"DollarsWhole", Variant(int16_t(7)), kDollars, "$7.00", kNoError},
        {"DollarsOneDecimal", Variant(12.5), kDollars, "$12.50", kNoError},
        {"DollarsBinaryBelowHalf", Variant(2.675), kDollars, "$2.68", kNoError},
        {"DollarsHalfCent", Variant(0.005), kDollars, "$0.01", kNoError},
        {"DollarsOnePointZeroZeroFive", Variant(1.005), kDollars, "$1.01", kNoError},
        {"DollarsCarryIntoThousands", Variant(999.995), kDollars, "$1000.00", kNoError},
        {"DollarsFifteenDigitSum", Variant(0.1 + 0.2), kDollars, "$0.30", kNoError},
        {"DollarsNoGrouping", Variant(1234567.891), kDollars, "$1234567.89", kNoError},
        {"DollarsLong", Variant(int32_t(100000)), kDollars, "$100000.00", kNoError},
        {"DollarsNegative", Variant(-3.25), kDollars, "-$3.25", kNoError},
        {"DollarsNegativeHalfCent", Variant(-0.005), kDollars, "-$0.01", kNoError},
        {"DollarsNegativeRoundsToZero", Variant(-0.004), kDollars, "$0.00", kNoError},
        {"DollarsNegativeZero", Variant(-0.0), kDollars, "$0.00", kNoError},
        {"DollarsLarge", Variant(1e20), kDollars, "$100000000000000000000.00", kNoError},
        {"DollarsEmpty", Variant(), kDollars, "$0.00", kNoError},
        {"DollarsTrue", Variant(true), kDollars, "-$1.00", kNoError},
        {"DollarsNumericText", Variant("12.5"), kDollars, "$12.50", kNoError},
        {"DollarsNumericTextWithBlanks", Variant(" 3 "), kDollars, "$3.00", kNoError},
        {"DollarsOtherText", Variant("n/a"), kDollars, "n/a", kNoError},
        {"DollarsEmptyText", Variant(""), kDollars, "", kNoError},
        // "0": a whole number without grouping
        {"WholeHalfUp", Variant(2.5), kWhole, "3", kNoError},
        {"WholeHalfFromZero", Variant(0.5), kWhole, "1", kNoError},
        {"WholeOnePointFive", Variant(1.5), kWhole, "2", kNoError},
        {"WholeNegative", Variant(-7.6), kWhole, "-8", kNoError},
        {"WholeNegativeHalf", Variant(-0.5), kWhole, "-1", kNoError},
        {"WholeNegativeRoundsToZero", Variant(-0.4), kWhole, "0", kNoError},
        {"WholeBelowHalf", Variant(0.4999999), kWhole, "0", kNoError},
        {"WholeTiny", Variant(1e-20), kWhole, "0", kNoError},
        {"WholeNoGrouping", Variant(1234567.0), kWhole, "1234567", kNoError},
        {"WholeIntegerMin", Variant(int16_t(-32768)), kWhole, "-32768", kNoError},
        {"WholeLongMaxPlusHalf", Variant(2147483647.5), kWhole, "2147483648", kNoError},
        {"WholeLarge", Variant(1e20), kWhole, "100000000000000000000", kNoError},
        {"WholeFifteenDigitsKept", Variant(123456789012345678.0), kWhole, "123456789012346000", kNoError},
        {"WholeEmpty", Variant(), kWhole, "0", kNoError},
        {"WholeTrue", Variant(true), kWhole, "-1", kNoError},
        {"WholeNumericText", Variant("12.5"), kWhole, "13", kNoError},
        {"WholeDateSerial", Variant::date(41456.75), kWhole, "41457", kNoError},
        {"WholeOtherText", Variant("abc"), kWhole, "abc", kNoError},
        // "DD/MM/YYYY", letters in any case
        {"DateOfDate", Variant::date(41456), kDate, "01/07/2013", kNoError},
        {"DateDropsTime", Variant::date(41820.75), kDate, "30/06/2014", kNoError},
        {"DateLowerCasePattern", Variant::date(41456), "dd/mm/yyyy", "01/07/2013", kNoError},
        {"DateMixedCasePattern", Variant::date(41456), "Dd/mM/yYyY", "01/07/2013", kNoError},
        {"DateSerialZero", Variant::date(0), kDate, "30/12/1899", kNoError},
        {"DateNegativeSerial", Variant::date(-1.25), kDate, "29/12/1899", kNoError},
        {"DateFirst", Variant::date(kMinDateSerial), kDate, "01/01/0100", kNoError},
        {"DateLast", Variant::date(kMaxDateSerial), kDate, "31/12/9999", kNoError},
        {"DateOfNumber", Variant(41456.0), kDate, "01/07/2013", kNoError},
        {"DateOfLong", Variant(int32_t(41456)), kDate, "01/07/2013", kNoError},
        {"DateOfNumericText", Variant("41456"), kDate, "01/07/2013", kNoError},
        {"DateOfOtherText", Variant("not a date"), kDate, "not a date", kNoError},
        {"DateOfNumberBeyondRange", Variant(1e7), kDate, "", errc::Overflow},
        {"DateOfNumberBeforeRange", Variant(-1e6), kDate, "", errc::Overflow},
        {"DateOfTextBeyondRange", Variant("3000000"), kDate, "", errc::Overflow},
        // failures
        {"NullDollars", Variant::null(), kDollars, "", errc::InvalidUseOfNull},
        {"NullWhole", Variant::null(), kWhole, "", errc::InvalidUseOfNull},
        {"NullDate", Variant::null(), kDate, "", errc::InvalidUseOfNull},
        {"ObjectDollars", Variant(makeRef<Thing>()), kDollars, "", errc::TypeMismatch},
        {"ArrayWhole", Variant(VariantArray(0, 0, 0, 0)), kWhole, "", errc::TypeMismatch},
        {"NumericTextBeyondDoubleRange", Variant("1e400"), kWhole, "", errc::Overflow},
        {"UnknownPatternGrouped", Variant(1.0), "#,##0", "", errc::InvalidProcedureCall},
        {"UnknownPatternEmpty", Variant(1.0), "", "", errc::InvalidProcedureCall},
        {"UnknownPatternTwoDecimals", Variant(1.0), "0.00", "", errc::InvalidProcedureCall},
        {"UnknownPatternTrailingBlank", Variant(1.0), "$0.00 ", "", errc::InvalidProcedureCall},
        {"UnknownPatternShortYear", Variant::date(41456), "DD/MM/YY", "", errc::InvalidProcedureCall},
    };
    return rows;
}

class FormatPattern : public testing::TestWithParam<PatternRow> {};

TEST_P(FormatPattern, FormatsAsThePatternSays)
{
    std::string result;
    const test::Raised raised = test::raisedBy([&] { result = formatPattern(GetParam().value, GetParam().pattern); });
    EXPECT_EQ(raised.number, GetParam().error) << raised.description;
    if (GetParam().error == kNoError) EXPECT_EQ(result, GetParam().expected);
}

INSTANTIATE_TEST_SUITE_P(Core, FormatPattern, testing::ValuesIn(patternRows()), test::rowName<PatternRow>);

TEST(FormatPatternFailure, UnknownPatternIsNamed)
{
    const test::Raised raised = test::raisedBy([] { formatPattern(Variant(1.0), "#,##0.0"); });
    EXPECT_EQ(raised.number, errc::InvalidProcedureCall);
    EXPECT_NE(raised.description.find("#,##0.0"), std::string::npos) << raised.description;
}

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
