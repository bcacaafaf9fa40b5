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

// A plain object, for the rows where a value holds an object.
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

Variant anObject() { return Variant(makeRef<Thing>()); }
Variant nothing() { return Variant(Ref<Object>()); }
Variant anArray() { return Variant(VariantArray(0, 1, 0, 1)); }
Variant i16(int v) { return Variant(int16_t(v)); }
Variant i32(int32_t v) { return Variant(v); }

constexpr int kNoError = 0;

// ---- toDouble -------------------------------------------------------------------------------

struct ToDoubleRow {
    const char* name;
    Variant value;
    double expected;
    int error;
    friend void PrintTo(const ToDoubleRow& r, std::ostream* os) { *os << r.name; }
};

const std::vector<ToDoubleRow>& toDoubleRows()
{
    static const std::vector<ToDoubleRow> rows = {
        {"Empty", Variant(), 0, kNoError},
        {"True", Variant(true), -1, kNoError},
        {"False", Variant(false), 0, kNoError},
        {"Integer", i16(-32768), -32768, kNoError},
        {"Long", i32(-70000), -70000, kNoError},
        {"Double", Variant(2.5), 2.5, kNoError},
        {"DateSerial", Variant::date(41456.25), 41456.25, kNoError},
        {"Text", Variant("12.5"), 12.5, kNoError},
        {"TextWithBlanksAround", Variant(" 12.5 "), 12.5, kNoError},
        {"TextWithTabAndLineFeed", Variant("\t7\n"), 7, kNoError},
        {"TextNegative", Variant("-3"), -3, kNoError},
        {"TextPlus", Variant("+3"), 3, kNoError},
        {"TextMinusZero", Variant("-0"), 0, kNoError},
        {"TextPointOne", Variant("0.1"), 0.1, kNoError},
        {"TextNoIntegerDigits", Variant(".5"), 0.5, kNoError},
        {"TextTrailingPoint", Variant("5."), 5, kNoError},
        {"TextGrouped", Variant("1,234.5"), 1234.5, kNoError},
        {"TextGroupedTwice", Variant("1,234,567"), 1234567, kNoError},
        {"TextNegativeGrouped", Variant("-1,000"), -1000, kNoError},
        {"TextExponent", Variant("1e3"), 1000, kNoError},
        {"TextExponentD", Variant("1D3"), 1000, kNoError},
        {"TextNegativeExponent", Variant("1.5E-2"), 0.015, kNoError},
        {"TextBelowDoubleRange", Variant("1e-400"), 0, kNoError},
        {"TextHex", Variant("&HFF"), 255, kNoError},
        {"TextHexAllOnes16", Variant("&HFFFF"), -1, kNoError},
        {"TextOctal", Variant("&O17"), 15, kNoError},
        {"TextLongMax", Variant("2147483647"), 2147483647.0, kNoError},
        // not a number in full
        {"EmptyText", Variant(""), 0, errc::TypeMismatch},
        {"BlankText", Variant("   "), 0, errc::TypeMismatch},
        {"Letters", Variant("abc"), 0, errc::TypeMismatch},
        {"TrailingLetters", Variant("12abc"), 0, errc::TypeMismatch},
        {"BlankBetweenDigits", Variant("1 2"), 0, errc::TypeMismatch},
        {"DoubleComma", Variant("1,,2"), 0, errc::TypeMismatch},
        {"LeadingComma", Variant(",5"), 0, errc::TypeMismatch},
        {"TrailingComma", Variant("5,"), 0, errc::TypeMismatch},
        {"CommaInFraction", Variant("1.2,3"), 0, errc::TypeMismatch},
        {"TwoPoints", Variant("1.2.3"), 0, errc::TypeMismatch},
        {"ExponentWithoutDigits", Variant("1e"), 0, errc::TypeMismatch},
        {"ExponentSignWithoutDigits", Variant("1e+"), 0, errc::TypeMismatch},
        {"ExponentOnly", Variant("e5"), 0, errc::TypeMismatch},
        {"PointOnly", Variant("."), 0, errc::TypeMismatch},
        {"SignOnly", Variant("-"), 0, errc::TypeMismatch},
        {"TwoSigns", Variant("--5"), 0, errc::TypeMismatch},
        {"PlusMinus", Variant("+-5"), 0, errc::TypeMismatch},
        {"Inf", Variant("inf"), 0, errc::TypeMismatch},
        {"NaN", Variant("nan"), 0, errc::TypeMismatch},
        {"NegativeInfinity", Variant("-Infinity"), 0, errc::TypeMismatch},
        {"CHex", Variant("0x10"), 0, errc::TypeMismatch},
        {"HexWithoutDigits", Variant("&H"), 0, errc::TypeMismatch},
        {"HexBadDigit", Variant("&H1G"), 0, errc::TypeMismatch},
        {"AmpersandOther", Variant("&Z1"), 0, errc::TypeMismatch},
        {"FloatSuffix", Variant("1.5f"), 0, errc::TypeMismatch},
        {"Percent", Variant("5%"), 0, errc::TypeMismatch},
        // numbers beyond the Double range or 32 bits
        {"TextBeyondDoubleRange", Variant("1e400"), 0, errc::Overflow},
        {"TextNegativeBeyondDoubleRange", Variant("-1.8e308"), 0, errc::Overflow},
        {"TextHexBeyond32Bits", Variant("&H100000000"), 0, errc::Overflow},
        // not convertible at all
        {"Null", Variant::null(), 0, errc::InvalidUseOfNull},
        {"Object", anObject(), 0, errc::TypeMismatch},
        {"Nothing", nothing(), 0, errc::TypeMismatch},
        {"Array", anArray(), 0, errc::TypeMismatch},
    };
    return rows;
}

class ToDouble : public testing::TestWithParam<ToDoubleRow> {};

TEST_P(ToDouble, ConvertsAsCDbl)
{
    const ToDoubleRow& row = GetParam();
    double result = 0;
    const test::Raised raised = test::raisedBy([&] { result = toDouble(row.value); });
    EXPECT_EQ(raised.number, row.error) << raised.description;
    if (row.error == kNoError) {
        EXPECT_EQ(result, row.expected);
        EXPECT_FALSE(result == 0.0 && std::signbit(result)) << "a zero converts to 0, never -0";
    }
}

INSTANTIATE_TEST_SUITE_P(Core, ToDouble, testing::ValuesIn(toDoubleRows()), test::rowName<ToDoubleRow>);

TEST(ToDoubleMismatch, NamesTheText)
{
    const test::Raised raised = test::raisedBy([] { toDouble(Variant("12 apples")); });
    EXPECT_EQ(raised.number, errc::TypeMismatch);
    EXPECT_NE(raised.description.find("\"12 apples\""), std::string::npos) << raised.description;
}

// ---- toInteger / toLong ---------------------------------------------------------------------

struct WholeRow {
    const char* name;
    Variant value;
    int64_t expected;
    int error;
    friend void PrintTo(const WholeRow& r, std::ostream* os) { *os << r.name; }
};

const std::vector<WholeRow>& toIntegerRows()
{
    static const std::vector<WholeRow> rows = {
        {"Empty", Variant(), 0, kNoError},
        {"True", Variant(true), -1, kNoError},
        {"Integer", i16(-32768), -32768, kNoError},
        {"LongInRange", i32(32767), 32767, kNoError},
        {"LongBeyondRange", i32(32768), 0, errc::Overflow},
        {"DoubleHalfToEven", Variant(2.5), 2, kNoError},
        {"DoubleMaxPlusHalf", Variant(32767.5), 0, errc::Overflow},
        {"DoubleMinMinusHalf", Variant(-32768.5), -32768, kNoError},
        {"TextHalfToEven", Variant("3.5"), 4, kNoError},
        {"TextView3D", Variant(" 1"), 1, kNoError},
        {"TextHexAllOnes", Variant("&HFFFF"), -1, kNoError},
        {"TextNotANumber", Variant("abc"), 0, errc::TypeMismatch},
        {"DateBeyondRange", Variant::date(41456.5), 0, errc::Overflow},
        {"Null", Variant::null(), 0, errc::InvalidUseOfNull},
        {"Object", anObject(), 0, errc::TypeMismatch},
    };
    return rows;
}

const std::vector<WholeRow>& toLongRows()
{
    static const std::vector<WholeRow> rows = {
        {"Empty", Variant(), 0, kNoError},
        {"False", Variant(false), 0, kNoError},
        {"Integer", i16(-5), -5, kNoError},
        {"Long", i32(-2147483647 - 1), -2147483648LL, kNoError},
        {"DoubleHalfToEven", Variant(-2.5), -2, kNoError},
        {"DoubleMaxPlusHalf", Variant(2147483647.5), 0, errc::Overflow},
        {"DoubleMinMinusPointFour", Variant(-2147483648.4), -2147483648LL, kNoError},
        {"DoubleMinMinusHalf", Variant(-2147483648.5), -2147483648LL, kNoError},
        {"TextRotation", Variant("10"), 10, kNoError},
        {"TextMaxPlusHalf", Variant("2147483647.5"), 0, errc::Overflow},
        {"Date", Variant::date(41456.5), 41456, kNoError},
        {"TextNotANumber", Variant(""), 0, errc::TypeMismatch},
        {"Null", Variant::null(), 0, errc::InvalidUseOfNull},
        {"Array", anArray(), 0, errc::TypeMismatch},
    };
    return rows;
}

class ToInteger : public testing::TestWithParam<WholeRow> {};
class ToLong : public testing::TestWithParam<WholeRow> {};

TEST_P(ToInteger, ConvertsAsCInt)
{
    int64_t result = 0;
    const test::Raised raised = test::raisedBy([&] { result = toInteger(GetParam().value); });
    EXPECT_EQ(raised.number, GetParam().error) << raised.description;
    if (GetParam().error == kNoError) EXPECT_EQ(result, GetParam().expected);
}

TEST_P(ToLong, ConvertsAsCLng)
{
    int64_t result = 0;
    const test::Raised raised = test::raisedBy([&] { result = toLong(GetParam().value); });
    EXPECT_EQ(raised.number, GetParam().error) << raised.description;
    if (GetParam().error == kNoError) EXPECT_EQ(result, GetParam().expected);
}

INSTANTIATE_TEST_SUITE_P(Core, ToInteger, testing::ValuesIn(toIntegerRows()), test::rowName<WholeRow>);
INSTANTIATE_TEST_SUITE_P(Core, ToLong, testing::ValuesIn(toLongRows()), test::rowName<WholeRow>);

// ---- toText, numberText of a value ----------------------------------------------------------

struct TextRow {
    const char* name;
    Variant value;
    const char* expected;
    int error;
    friend void PrintTo(const TextRow& r, std::ostream* os) { *os << r.name; }
};

const std::vector<TextRow>& toTextRows()
{
    static const std::vector<TextRow> rows = {
        {"Empty", Variant(), "", kNoError},
        {"True", Variant(true), "True", kNoError},
        {"False", Variant(false), "False", kNoError},
        {"Integer", i16(-3), "-3", kNoError},
        {"IntegerMin", i16(-32768), "-32768", kNoError},
        {"Long", i32(2147483647), "2147483647", kNoError},
        {"Double", Variant(12.5), "12.5", kNoError},
        {"DoubleNegative", Variant(-3.0), "-3", kNoError},
        {"DoubleZero", Variant(0.0), "0", kNoError},
        {"DoubleNegativeZero", Variant(-0.0), "0", kNoError},
        {"DoubleFifteenDigits", Variant(0.1 + 0.2), "0.3", kNoError},
        {"DoubleExponent", Variant(1e16), "1E+16", kNoError},
        {"DoubleSmallExponent", Variant(-1e-16), "-1E-16", kNoError},
        {"Text", Variant(" as is "), " as is ", kNoError},
        {"DateOnly", Variant::date(41456), "01/07/2013", kNoError},
        {"DateSerialZero", Variant::date(0), "30/12/1899", kNoError},
        {"DateWithTime", Variant::date(41456.25), "01/07/2013 06:00:00", kNoError},
        {"DateWithSeconds", Variant::date(41456 + (13 * 3600 + 5 * 60 + 9) / 86400.0), "01/07/2013 13:05:09",
         kNoError},
        {"DateNegativeWithTime", Variant::date(-1.25), "29/12/1899 06:00:00", kNoError},
        {"DateMinusHalf", Variant::date(-0.5), "30/12/1899 12:00:00", kNoError},
        {"DateTimeRoundsToMidnight", Variant::date(41456.9999999999), "02/07/2013", kNoError},
        {"DateBeyondRange", Variant::date(1e7), "", errc::Overflow},
        {"DateNotANumber", Variant::date(std::nan("")), "", errc::Overflow},
        {"Null", Variant::null(), "", errc::InvalidUseOfNull},
        {"Object", anObject(), "", errc::TypeMismatch},
        {"Array", anArray(), "", errc::TypeMismatch},
    };
    return rows;
}

const std::vector<TextRow>& numberTextRows()
{
    static const std::vector<TextRow> rows = {
        {"Empty", Variant(), " 0", kNoError},
        {"Integer", i16(5), " 5", kNoError},
        {"IntegerNegative", i16(-32768), "-32768", kNoError},
        {"Long", i32(-70000), "-70000", kNoError},
        {"Double", Variant(12.5), " 12.5", kNoError},
        {"DoubleFifteenDigits", Variant(0.1 + 0.2), " 0.3", kNoError},
        {"True", Variant(true), "-1", kNoError},
        {"False", Variant(false), " 0", kNoError},
        {"Date", Variant::date(41456.5), " 41456.5", kNoError},
        {"TextNumber", Variant("12.5"), " 12.5", kNoError},
        {"TextSeven", Variant("7"), " 7", kNoError},
        {"TextNegativeWithBlanks", Variant(" -3 "), "-3", kNoError},
        {"TextGrouped", Variant("1,234"), " 1234", kNoError},
        {"TextNotANumber", Variant("abc"), "", errc::TypeMismatch},
        {"EmptyText", Variant(""), "", errc::TypeMismatch},
        {"Null", Variant::null(), "", errc::InvalidUseOfNull},
        {"Object", anObject(), "", errc::TypeMismatch},
        {"Array", anArray(), "", errc::TypeMismatch},
    };
    return rows;
}

class ToText : public testing::TestWithParam<TextRow> {};
class NumberTextOfValue : public testing::TestWithParam<TextRow> {};

TEST_P(ToText, ConvertsAsCStr)
{
    std::string result;
    const test::Raised raised = test::raisedBy([&] { result = toText(GetParam().value); });
    EXPECT_EQ(raised.number, GetParam().error) << raised.description;
    if (GetParam().error == kNoError) EXPECT_EQ(result, GetParam().expected);
}

TEST_P(NumberTextOfValue, WritesNumbersAndNumericTexts)
{
    std::string result;
    const test::Raised raised = test::raisedBy([&] { result = numberText(GetParam().value); });
    EXPECT_EQ(raised.number, GetParam().error) << raised.description;
    if (GetParam().error == kNoError) EXPECT_EQ(result, GetParam().expected);
}

INSTANTIATE_TEST_SUITE_P(Core, ToText, testing::ValuesIn(toTextRows()), test::rowName<TextRow>);
INSTANTIATE_TEST_SUITE_P(Core, NumberTextOfValue, testing::ValuesIn(numberTextRows()), test::rowName<TextRow>);

// ---- differsFromEmptyText -------------------------------------------------------------------

struct DiffersRow {
    const char* name;
    Variant value;
    bool expected;
    int error;
    friend void PrintTo(const DiffersRow& r, std::ostream* os) { *os << r.name; }
};

const std::vector<DiffersRow>& differsRows()
{
    static const std::vector<DiffersRow> rows = {
        {"Empty", Variant(), false, kNoError},
        {"Null", Variant::null(), false, kNoError},
        {"EmptyText", Variant(""), false, kNoError},
        {"BlankText", Variant(" "), true, kNoError},
        {"TextZero", Variant("0"), true, kNoError},
        {"TextWord", Variant("abc"), true, kNoError},
        {"IntegerZero", i16(0), true, kNoError},
        {"LongZero", i32(0), true, kNoError},
        {"DoubleZero", Variant(0.0), true, kNoError},
        {"DoubleValue", Variant(12.5), true, kNoError},
        {"False", Variant(false), true, kNoError},
        {"DateZero", Variant::date(0), true, kNoError},
        {"Object", anObject(), false, errc::TypeMismatch},
        {"Nothing", nothing(), false, errc::TypeMismatch},
        {"Array", anArray(), false, errc::TypeMismatch},
    };
    return rows;
}

class DiffersFromEmptyText : public testing::TestWithParam<DiffersRow> {};

TEST_P(DiffersFromEmptyText, ComparesAsTheDrawingDoes)
{
    bool result = false;
    const test::Raised raised = test::raisedBy([&] { result = differsFromEmptyText(GetParam().value); });
    EXPECT_EQ(raised.number, GetParam().error) << raised.description;
    if (GetParam().error == kNoError) EXPECT_EQ(result, GetParam().expected);
}

INSTANTIATE_TEST_SUITE_P(Core, DiffersFromEmptyText, testing::ValuesIn(differsRows()), test::rowName<DiffersRow>);

}  // namespace
}  // namespace kg
