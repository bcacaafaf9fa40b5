// The whole-number field of the style dialog: what typing lets in, and what the program's values
// become.
#include <gtest/gtest.h>

#include <QtTest/QTest>
#include <cmath>
#include <optional>

#include "core/Error.h"
#include "ui/NumericField.h"

#include "ui/UiSupport.h"

namespace kg::test {
namespace {

using ui::NumericField;

// Null as an expected Value.
constexpr std::optional<double> kNull = std::nullopt;

void expectValue(const NumericField& field, std::optional<double> expected)
{
    const Variant v = field.Value();
    if (!expected) {
        EXPECT_TRUE(v.isNull()) << typeName(v.type());
        return;
    }
    ASSERT_EQ(v.type(), VarType::Double);
    EXPECT_EQ(v.dbl(), *expected);
}

struct TypingCase {
    const char* name;
    const char* typed;
    const char* shown;
    std::optional<double> value;
};

const TypingCase kTyping[] = {
    {"WithinLimits", "45", "45", 45},
    {"NegativeLimit", "-45", "-45", -45},
    {"BeyondUpperStopsBefore", "46", "4", 4},
    {"BeyondLowerStopsBefore", "-46", "-4", -4},
    {"ThirdDigitRefused", "450", "45", 45},
    {"LeadingZerosCannotLengthen", "007", "00", 0},
    {"NoDecimalPoint", "4.5", "45", 45},
    {"NoExponent", "1e1", "11", 11},
    {"MinusInsideRefused", "4-", "4", 4},
    {"LettersRefused", "abc", "", kNull},
    {"LoneMinusReadsNull", "-", "-", kNull},
};

struct Typing : ::testing::TestWithParam<TypingCase> {};

TEST_P(Typing, OnlyWholeNumbersWithinTheLimitsGetIn)
{
    NumericField field(-45, 45);
    QTest::keyClicks(&field, GetParam().typed);
    EXPECT_EQ(field.text().toStdString(), GetParam().shown);
    expectValue(field, GetParam().value);
}

INSTANTIATE_TEST_SUITE_P(NumericField, Typing, ::testing::ValuesIn(kTyping), byName);

struct SetCase {
    const char* name;
    Variant value;
    const char* shown;
    std::optional<double> read;
};

const SetCase kSets[] = {
    {"Inside", Variant(-12.0), "-12", -12},
    {"ClampedAbove", Variant(99.0), "45", 45},
    {"ClampedBelow", Variant(-1000.0), "-45", -45},
    {"InfiniteClamped", Variant(HUGE_VAL), "45", 45},
    {"HalfAwayFromZero", Variant(10.5), "11", 11},
    {"NegativeHalfAwayFromZero", Variant(-10.5), "-11", -11},
    {"SmallNegativeIsZero", Variant(-0.4), "0", 0},
    {"Integer", Variant(int16_t(7)), "7", 7},
    {"Long", Variant(int32_t(-300)), "-45", -45},
    {"NumericText", Variant("12"), "12", 12},
    {"NullClears", Variant::null(), "", kNull},
    {"EmptyClears", Variant(), "", kNull},
};

struct Set : ::testing::TestWithParam<SetCase> {};

TEST_P(Set, ProgramValuesAreClampedAndWhole)
{
    NumericField field(-45, 45);
    field.setValue(Variant(10.0));
    field.setValue(GetParam().value);
    EXPECT_EQ(field.text().toStdString(), GetParam().shown);
    expectValue(field, GetParam().read);
}

INSTANTIATE_TEST_SUITE_P(NumericField, Set, ::testing::ValuesIn(kSets), byName);

TEST(NumericField, TextThatIsNoNumberIsATypeMismatch)
{
    NumericField field(-45, 45);
    field.setValue(Variant(10.0));
    EXPECT_EQ(errorNumberOf([&] { field.setValue(Variant("ten")); }), errc::TypeMismatch);
    EXPECT_EQ(field.text(), "10");
}

TEST(NumericField, PastedTextBeyondTheLimitsIsRefused)
{
    // A paste goes through insert(), which validates like typing.
    NumericField field(-45, 45);
    field.setValue(Variant(10.0));
    field.selectAll();
    field.insert("99");
    EXPECT_EQ(field.text(), "10");
    field.selectAll();
    field.insert("-7");
    EXPECT_EQ(field.text(), "-7");
}

TEST(NumericField, ANonNegativeFieldRefusesTheMinusSign)
{
    NumericField field(0, 100);
    QTest::keyClicks(&field, "-5");
    EXPECT_EQ(field.text(), "5");
    field.selectAll();
    QTest::keyClicks(&field, "100");
    EXPECT_EQ(field.text(), "100");
}

}  // namespace
}  // namespace kg::test
