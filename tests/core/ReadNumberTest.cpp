// readNumber: the leading number of a text, as the stored settings and the job fields are read.
#include <cmath>
#include <string>

#include "RowSupport.h"
#include "core/Convert.h"
#include "core/Dispatch.h"  // completes Object for Variant

namespace kg {
namespace {

struct ReadRow : test::Named {
    std::string text;
    test::Outcome<double> expected;
};

// Beyond the Double range or 32 bits: Overflow naming the text's start.
test::Raises overflowOf(const std::string& text) { return {errc::Overflow, text.substr(0, 10)}; }

const std::vector<ReadRow>& readRows()
{
    static const std::vector<ReadRow> rows = {
        // no number at all
        {"EmptyText", "", 0},
        {"OnlyBlanks", "  \t ", 0},
        {"Letters", "abc", 0},
        {"DollarFirst", "$5", 0},
        {"TwoSigns", "--5", 0},
        {"SignAlone", "-", 0},
        {"PointAlone", ".", 0},
        {"WordInfinity", "Infinity", 0},
        {"CPrefixHex", "0x1F", 0},
        // plain numbers
        {"Whole", "12", 12},
        {"Decimal", "12.5", 12.5},
        {"PointOne", "0.1", 0.1},
        {"NoIntegerDigits", ".5", 0.5},
        {"TrailingPoint", "5.", 5},
        {"PlusSign", "+7", 7},
        {"Negative", "-12.5", -12.5},
        {"StoredWithSignBlank", " 10", 10},
        // blanks, tabs, line feeds and CR skipped wherever they stand
        {"BlanksBetweenDigits", " 1 2 3", 123},
        {"BlankAfterSign", "- 5", -5},
        {"TabInside", "4\t2", 42},
        {"ControlBlanksBefore", "\t\n\r42", 42},
        {"BlankAroundPoint", "1 . 5", 1.5},
        {"BlankBeforeExponent", "2.5 e 1", 25},
        // reading stops at the first character that cannot continue the number
        {"TrailingLetters", "12abc", 12},
        {"SecondPoint", "1.5.3", 1.5},
        {"Grouping", "1,234", 1},
        {"AfterExponent", "1.5E+2x", 150},
        {"MinusZero", "  -  0", 0},
        // exponents with E or D
        {"ExponentE", "1e3", 1000},
        {"ExponentUpperNegative", "1E-2", 0.01},
        {"ExponentD", "1D2", 100},
        {"ExponentLetterAlone", "1e", 1},
        {"ExponentSignAlone", "1e+", 1},
        {"LargestExponent", "1e308", 1e308},
        {"BelowDoubleRange", "1e-400", 0},
        {"HugeNegativeExponent", "5e-99999999999999999999", 0},
        // long texts are rounded once, to the nearest Double
        {"TieRoundsToEven", "9007199254740993", 9007199254740992.0},
        {"AboveTieRoundsUp", "9007199254740993.0000000000000000000000001", 9007199254740994.0},
        {"TieBrokenBeyondDigit800", "9007199254740993." + std::string(800, '0') + "1", 9007199254740994.0},
        {"ThreeHundredDigits", "1" + std::string(300, '0'), 1e300},
        {"ManyLeadingFractionZeros", "0." + std::string(320, '0') + "1", 1e-321},
        {"ManyDigitsThenExponent", std::string(400, '1') + "e-399", 10.0 / 9.0},
        // &H and &O: 16-bit values as Integer, else 32-bit Long
        {"HexByte", "&HFF", 255},
        {"HexLowerCase", "&hff", 255},
        {"HexIntegerMax", "&H7FFF", 32767},
        {"HexIntegerMin", "&H8000", -32768},
        {"HexAllOnes16", "&HFFFF", -1},
        {"HexJustBeyond16", "&H10000", 65536},
        {"HexLongMin", "&H80000000", -2147483648.0},
        {"HexAllOnes32", "&HFFFFFFFF", -1},
        {"HexLeadingZeros", "&H0000000000FF", 255},
        {"HexBlanksInside", " & H 1 F", 31},
        {"HexStopsAtNonDigit", "&H1G", 1},
        {"HexNoDigits", "&H", 0},
        {"Octal", "&O17", 15},
        {"OctalAllOnes16", "&O177777", -1},
        {"OctalStopsAtEight", "&O18", 1},
        {"OctalNoDigits", "&O8", 0},
        {"AmpersandOtherLetter", "&X1", 0},
        // overflows
        {"BeyondDoubleRange", "1e400", overflowOf("1e400")},
        {"NegativeBeyondDoubleRange", "-1e309", overflowOf("-1e309")},
        {"FourHundredNines", std::string(400, '9'), overflowOf(std::string(400, '9'))},
        {"HugeExponent", "1e99999999999999999999", overflowOf("1e99999999999999999999")},
        {"HexBeyond32Bits", "&H100000000", overflowOf("&H100000000")},
        {"HexManyDigits", "&HFFFFFFFFFFFFFFFFFFFF", overflowOf("&HFFFFFFFFFFFFFFFFFFFF")},
        {"OctalBeyond32Bits", "&O40000000000", overflowOf("&O40000000000")},
    };
    return rows;
}

class ReadNumber : public testing::TestWithParam<ReadRow> {};

TEST_P(ReadNumber, TakesTheLeadingNumber)
{
    const double value = test::expectOutcome(GetParam().expected, [&] { return readNumber(GetParam().text); });
    EXPECT_FALSE(std::signbit(value) && value == 0.0) << "a zero reads as 0, never -0";
}

INSTANTIATE_TEST_SUITE_P(Core, ReadNumber, testing::ValuesIn(readRows()), test::RowName{});

}  // namespace
}  // namespace kg
