// Conversions of values: toDouble (CDbl), toInteger / toLong (CInt / CLng), toText (CStr),
// numberText of a value, and the drawing's `cell <> ""` test.
#include <cmath>
#include <string>
#include <vector>

#include "RowSupport.h"
#include "core/Convert.h"
#include "core/Dispatch.h"

namespace kg {
namespace {

using test::kMismatch;
using test::kNull;
using test::kOverflow;
using test::Outcome;

Variant i16(int v) { return Variant(int16_t(v)); }
Variant i32(int32_t v) { return Variant(v); }

// ---- toDouble -------------------------------------------------------------------------------

struct ToDoubleRow : test::Named {
    Variant value;
    Outcome<double> expected;
};

const std::vector<ToDoubleRow>& toDoubleRows()
{
    static const std::vector<ToDoubleRow> rows = {
        {"Empty", Variant(), 0.0},
        {"True", Variant(true), -1.0},
        {"Integer", i16(-32768), -32768.0},
        {"Long", i32(-70000), -70000.0},
        {"Double", Variant(2.5), 2.5},
        {"DateSerial", Variant::date(41456.25), 41456.25},
        {"Text", Variant("12.5"), 12.5},
        {"TextWithBlanksAround", Variant(" 12.5 "), 12.5},
        {"TextWithTabAndLineFeed", Variant("\t7\n"), 7.0},
        {"TextNegative", Variant("-3"), -3.0},
        {"TextPlus", Variant("+3"), 3.0},
        {"TextMinusZero", Variant("-0"), 0.0},
        {"TextPointOne", Variant("0.1"), 0.1},
        {"TextNoIntegerDigits", Variant(".5"), 0.5},
        {"TextTrailingPoint", Variant("5."), 5.0},
        {"TextGrouped", Variant("1,234.5"), 1234.5},
        {"TextGroupedTwice", Variant("-1,234,567"), -1234567.0},
        {"TextExponent", Variant("1e3"), 1000.0},
        {"TextExponentD", Variant("1D3"), 1000.0},
        {"TextNegativeExponent", Variant("1.5E-2"), 0.015},
        {"TextBelowDoubleRange", Variant("1e-400"), 0.0},
        {"TextHex", Variant("&HFF"), 255.0},
        {"TextHexAllOnes16", Variant("&HFFFF"), -1.0},
        {"TextOctal", Variant("&O17"), 15.0},
        // not a number in full; the text is named
        {"EmptyText", Variant(""), kMismatch},
        {"BlankText", Variant("   "), kMismatch},
        {"Letters", Variant("abc"), kMismatch},
        {"TrailingWord", Variant("12 apples"), test::Raises{errc::TypeMismatch, "\"12 apples\""}},
        {"TrailingLetters", Variant("1.5f"), kMismatch},
        {"BlankBetweenDigits", Variant("1 2"), kMismatch},
        {"DoubleComma", Variant("1,,2"), kMismatch},
        {"LeadingComma", Variant(",5"), kMismatch},
        {"TrailingComma", Variant("5,"), kMismatch},
        {"CommaInFraction", Variant("1.2,3"), kMismatch},
        {"TwoPoints", Variant("1.2.3"), kMismatch},
        {"ExponentWithoutDigits", Variant("1e"), kMismatch},
        {"ExponentSignWithoutDigits", Variant("1e+"), kMismatch},
        {"ExponentOnly", Variant("e5"), kMismatch},
        {"PointOnly", Variant("."), kMismatch},
        {"SignOnly", Variant("-"), kMismatch},
        {"TwoSigns", Variant("+-5"), kMismatch},
        {"Inf", Variant("inf"), kMismatch},
        {"NaN", Variant("nan"), kMismatch},
        {"CHex", Variant("0x10"), kMismatch},
        {"HexWithoutDigits", Variant("&H"), kMismatch},
        {"HexBadDigit", Variant("&H1G"), kMismatch},
        {"AmpersandOther", Variant("&Z1"), kMismatch},
        // beyond the Double range or 32 bits
        {"TextBeyondDoubleRange", Variant("1e400"), kOverflow},
        {"TextNegativeBeyondDoubleRange", Variant("-1.8e308"), kOverflow},
        {"TextHexBeyond32Bits", Variant("&H100000000"), kOverflow},
        // not convertible at all
        {"Null", Variant::null(), kNull},
        {"Object", test::anObject(), kMismatch},
        {"Nothing", test::nothing(), kMismatch},
        {"Array", test::anArray(), kMismatch},
    };
    return rows;
}

class ToDouble : public testing::TestWithParam<ToDoubleRow> {};

TEST_P(ToDouble, ConvertsAsCDbl)
{
    const double result = test::expectOutcome(GetParam().expected, [&] { return toDouble(GetParam().value); });
    EXPECT_FALSE(result == 0.0 && std::signbit(result)) << "a zero converts to 0, never -0";
}

INSTANTIATE_TEST_SUITE_P(Core, ToDouble, testing::ValuesIn(toDoubleRows()), test::RowName{});

// ---- toInteger / toLong: the same value through CInt and CLng -------------------------------

struct WholeRow : test::Named {
    Variant value;
    Outcome<int64_t> cint, clng;
};

const std::vector<WholeRow>& wholeRows()
{
    static const std::vector<WholeRow> rows = {
        {"Empty", Variant(), 0, 0},
        {"True", Variant(true), -1, -1},
        {"IntegerMin", i16(-32768), -32768, -32768},
        {"LongBeyondInteger", i32(32768), kOverflow, 32768},
        {"LongMin", i32(-2147483647 - 1), kOverflow, -2147483648LL},
        {"DoubleHalfToEven", Variant(2.5), 2, 2},
        {"DoubleIntegerMaxPlusHalf", Variant(32767.5), kOverflow, 32768},
        {"TextHalfToEven", Variant("3.5"), 4, 4},
        {"TextView3D", Variant(" 1"), 1, 1},
        {"TextHexAllOnes", Variant("&HFFFF"), -1, -1},
        {"TextLongMaxPlusHalf", Variant("2147483647.5"), kOverflow, kOverflow},
        {"TextNotANumber", Variant(""), kMismatch, kMismatch},
        {"Date", Variant::date(41456.5), kOverflow, 41456},
        {"Null", Variant::null(), kNull, kNull},
        {"Object", test::anObject(), kMismatch, kMismatch},
        {"Array", test::anArray(), kMismatch, kMismatch},
    };
    return rows;
}

class ToWhole : public testing::TestWithParam<WholeRow> {};

TEST_P(ToWhole, ConvertsAsCIntAndCLng)
{
    test::expectOutcome(GetParam().cint, [&] { return int64_t(toInteger(GetParam().value)); });
    test::expectOutcome(GetParam().clng, [&] { return int64_t(toLong(GetParam().value)); });
}

INSTANTIATE_TEST_SUITE_P(Core, ToWhole, testing::ValuesIn(wholeRows()), test::RowName{});

// ---- one value as CStr, as number text and against "" ---------------------------------------

struct TextRow : test::Named {
    Variant value;
    Outcome<std::string> cstr, number;
    Outcome<bool> differs;
};

const std::vector<TextRow>& textRows()
{
    static const std::vector<TextRow> rows = {
        {"Empty", Variant(), "", " 0", false},
        {"Null", Variant::null(), kNull, kNull, false},
        {"True", Variant(true), "True", "-1", true},
        {"False", Variant(false), "False", " 0", true},
        {"IntegerZero", i16(0), "0", " 0", true},
        {"IntegerMin", i16(-32768), "-32768", "-32768", true},
        {"Long", i32(-70000), "-70000", "-70000", true},
        {"LongMax", i32(2147483647), "2147483647", " 2147483647", true},
        {"Double", Variant(12.5), "12.5", " 12.5", true},
        {"DoubleNegative", Variant(-3.0), "-3", "-3", true},
        {"DoubleNegativeZero", Variant(-0.0), "0", " 0", true},
        {"DoubleFifteenDigits", Variant(0.1 + 0.2), "0.3", " 0.3", true},
        {"DoubleExponent", Variant(1e16), "1E+16", " 1E+16", true},
        {"DoubleSmallExponent", Variant(-1e-16), "-1E-16", "-1E-16", true},
        {"DateZero", Variant::date(0), "30/12/1899", " 0", true},
        {"DateWithTime", Variant::date(41456.5), "01/07/2013 12:00:00", " 41456.5", true},
        {"Text", Variant(" as is "), " as is ", kMismatch, true},
        {"TextZero", Variant("0"), "0", " 0", true},
        {"TextNumber", Variant("12.5"), "12.5", " 12.5", true},
        {"TextNegativeWithBlanks", Variant(" -3 "), " -3 ", "-3", true},
        {"TextGrouped", Variant("1,234"), "1,234", " 1234", true},
        {"EmptyText", Variant(""), "", kMismatch, false},
        {"BlankText", Variant(" "), " ", kMismatch, true},
        {"Object", test::anObject(), kMismatch, kMismatch, kMismatch},
        {"Nothing", test::nothing(), kMismatch, kMismatch, kMismatch},
        {"Array", test::anArray(), kMismatch, kMismatch, kMismatch},
    };
    return rows;
}

class ValueText : public testing::TestWithParam<TextRow> {};

TEST_P(ValueText, ConvertsAsCStrAsNumberTextAndComparesAsTheDrawingDoes)
{
    test::expectOutcome(GetParam().cstr, [&] { return toText(GetParam().value); });
    test::expectOutcome(GetParam().number, [&] { return numberText(GetParam().value); });
    test::expectOutcome(GetParam().differs, [&] { return differsFromEmptyText(GetParam().value); });
}

INSTANTIATE_TEST_SUITE_P(Core, ValueText, testing::ValuesIn(textRows()), test::RowName{});

// ---- CStr of dates: the time is written when there is one -----------------------------------

struct DateTextRow : test::Named {
    double serial;
    Outcome<std::string> expected;
};

const DateTextRow kDateTexts[] = {
    {"DateOnly", 41456, "01/07/2013"},
    {"WithTime", 41456.25, "01/07/2013 06:00:00"},
    {"WithSeconds", 41456 + (13 * 3600 + 5 * 60 + 9) / 86400.0, "01/07/2013 13:05:09"},
    {"NegativeWithTime", -1.25, "29/12/1899 06:00:00"},
    {"MinusHalf", -0.5, "30/12/1899 12:00:00"},
    {"TimeRoundsToMidnight", 41456.9999999999, "02/07/2013"},
    {"BeyondRange", 1e7, kOverflow},
    {"NotANumber", std::nan(""), kOverflow},
};

class DateText : public testing::TestWithParam<DateTextRow> {};

TEST_P(DateText, WritesDayMonthYearAndTheTime)
{
    test::expectOutcome(GetParam().expected, [&] { return toText(Variant::date(GetParam().serial)); });
}

INSTANTIATE_TEST_SUITE_P(Core, DateText, testing::ValuesIn(kDateTexts), test::RowName{});

}  // namespace
}  // namespace kg
