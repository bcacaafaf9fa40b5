// Variant values: their types, arrays as values, and the bounds-checked two-dimensional table.
#include <cstdint>
#include <limits>
#include <optional>
#include <string>
#include <vector>

#include "RowSupport.h"
#include "core/Dispatch.h"
#include "core/Variant.h"

namespace kg {
namespace {

struct TypeRow : test::Named {
    Variant value;
    VarType type;
    bool numeric;
};

const std::vector<TypeRow>& typeRows()
{
    static const std::vector<TypeRow> rows = {
        {"Empty", Variant(), VarType::Empty, false},
        {"Null", Variant::null(), VarType::Null, false},
        {"Boolean", Variant(false), VarType::Boolean, true},
        {"Integer", Variant(int16_t(0)), VarType::Integer, true},
        {"Long", Variant(int32_t(0)), VarType::Long, true},
        {"Double", Variant(0.0), VarType::Double, true},
        {"Date", Variant::date(41456), VarType::Date, false},
        {"StringFromLiteral", Variant("7"), VarType::String, false},
        {"StringFromString", Variant(std::string()), VarType::String, false},
        {"Object", test::anObject(), VarType::Object, false},
        {"Nothing", test::nothing(), VarType::Object, false},
        {"Array", Variant(VariantArray(0, 0, 0, 0)), VarType::Array, false},
    };
    return rows;
}

class VariantType : public testing::TestWithParam<TypeRow> {};

TEST_P(VariantType, KeepsTheTypeItWasMadeWith)
{
    EXPECT_EQ(GetParam().value.type(), GetParam().type);
    EXPECT_EQ(GetParam().value.isNumeric(), GetParam().numeric);
    const Variant copy = GetParam().value;
    EXPECT_EQ(copy.type(), GetParam().type) << "a copy has the same type";
}

INSTANTIATE_TEST_SUITE_P(Core, VariantType, testing::ValuesIn(typeRows()), test::RowName{});

// ---- arrays are values ----------------------------------------------------------------------

TEST(VariantArrayValue, CopyingOrAssigningAVariantCopiesItsArrayAndSelfAssignmentKeepsIt)
{
    Variant original(VariantArray(0, 1, 0, 1));
    original.array().at(0, 0) = "kept";
    Variant copy = original;
    Variant assigned(1.0);
    assigned = original;
    copy.array().at(0, 0) = "copy";
    assigned.array().at(0, 0) = "assigned";
    EXPECT_EQ(original.array().at(0, 0).str(), "kept");
    EXPECT_EQ(copy.array().at(0, 0).str(), "copy");
    EXPECT_EQ(assigned.array().at(0, 0).str(), "assigned");
    const Variant& same = original;
    original = same;
    ASSERT_TRUE(original.isArray()) << "self-assignment keeps the array";
    EXPECT_EQ(original.array().at(0, 0).str(), "kept");
}

TEST(VariantArrayValue, NestedArraysAreCopiedDeeply)
{
    VariantArray inner(0, 0, 0, 0);
    inner.at(0, 0) = 1.0;
    VariantArray outer(0, 0, 0, 0);
    outer.at(0, 0) = Variant(std::move(inner));
    Variant a(std::move(outer));
    Variant b = a;
    b.array().at(0, 0).array().at(0, 0) = 2.0;
    EXPECT_EQ(a.array().at(0, 0).array().at(0, 0).dbl(), 1.0);
}

// ---- bounds ---------------------------------------------------------------------------------

struct BoundsRow : test::Named {
    int32_t lo0, hi0, lo1, hi1;
    int32_t count0, count1;
    int error;
};

const BoundsRow kBounds[] = {
    {"NegativeLowerBound", -2, 2, 0, 0, 5, 1, 0},
    {"UpperBelowLowerFirst", 0, -1, 0, 5, 0, 0, errc::SubscriptOutOfRange},
    {"TooManyCells", 0, 100000, 0, 100000, 0, 0, errc::OutOfMemory},
    {"LargestBounds", std::numeric_limits<int32_t>::min(), std::numeric_limits<int32_t>::max(),
     std::numeric_limits<int32_t>::min(), std::numeric_limits<int32_t>::max(), 0, 0, errc::OutOfMemory},
};

class VariantArrayBounds : public testing::TestWithParam<BoundsRow> {};

TEST_P(VariantArrayBounds, DimensionsFromLowerToUpper)
{
    const BoundsRow& row = GetParam();
    std::optional<VariantArray> table;
    const test::Raised raised = test::raisedBy([&] { table.emplace(row.lo0, row.hi0, row.lo1, row.hi1); });
    EXPECT_EQ(raised.number, row.error) << raised.description;
    if (row.error != 0) return;
    EXPECT_EQ(table->lower(0), row.lo0);
    EXPECT_EQ(table->upper(0), row.hi0);
    EXPECT_EQ(table->lower(1), row.lo1);
    EXPECT_EQ(table->upper(1), row.hi1);
    EXPECT_EQ(table->count(0), row.count0);
    EXPECT_EQ(table->count(1), row.count1);
    EXPECT_TRUE(table->at(row.hi0, row.hi1).isEmpty());
}

INSTANTIATE_TEST_SUITE_P(Core, VariantArrayBounds, testing::ValuesIn(kBounds), test::RowName{});

struct AtRow : test::Named {
    int32_t i, j;
    const char* shown;
};

// A table 1 To 3 by 0 To 4.
const AtRow kOutside[] = {
    {"BelowFirst", 0, 0, "(0, 0)"},
    {"AboveFirst", 4, 2, "(4, 2)"},
    {"BelowSecond", 2, -1, "(2, -1)"},
    {"AboveSecond", 1, 5, "(1, 5)"},
    {"Lowest", std::numeric_limits<int32_t>::min(), 0, "(-2147483648, 0)"},
    {"Highest", 1, std::numeric_limits<int32_t>::max(), "(1, 2147483647)"},
};

class VariantArrayAt : public testing::TestWithParam<AtRow> {};

TEST_P(VariantArrayAt, OutsideTheBoundsIsSubscriptOutOfRange)
{
    VariantArray table(1, 3, 0, 4);
    const VariantArray& readOnly = table;
    const test::Raised writing = test::raisedBy([&] { table.at(GetParam().i, GetParam().j) = 1.0; });
    EXPECT_EQ(writing.number, errc::SubscriptOutOfRange);
    EXPECT_NE(writing.description.find(GetParam().shown), std::string::npos) << writing.description;
    EXPECT_EQ(test::raisedBy([&] { readOnly.at(GetParam().i, GetParam().j); }).number, errc::SubscriptOutOfRange);
}

INSTANTIATE_TEST_SUITE_P(Core, VariantArrayAt, testing::ValuesIn(kOutside), test::RowName{});

// ---- redim ----------------------------------------------------------------------------------

TEST(VariantArrayRedim, DiscardsTheContentsAndStartsAtZero)
{
    VariantArray table(1, 3, 1, 3);
    table.at(1, 1) = 5.0;
    table.at(2, 2) = "x";
    table.redim(2, 5);
    EXPECT_EQ(table.lower(0), 0);
    EXPECT_EQ(table.upper(0), 2);
    EXPECT_EQ(table.lower(1), 0);
    EXPECT_EQ(table.upper(1), 5);
    for (int32_t i = 0; i <= 2; ++i)
        for (int32_t j = 0; j <= 5; ++j) EXPECT_TRUE(table.at(i, j).isEmpty()) << i << ", " << j;
    table.at(2, 5) = 1.0;
    table.redim(2, 5);
    EXPECT_TRUE(table.at(2, 5).isEmpty()) << "a redim to the same size empties it too";
}

TEST(VariantArrayRedim, HugeOrNegativeSizeIsRefusedAndTheTableKept)
{
    VariantArray table(0, 1, 0, 1);
    table.at(1, 1) = 9.0;
    const test::Raised raised = test::raisedBy([&] { table.redim(std::numeric_limits<int32_t>::max(), 1000); });
    EXPECT_EQ(raised.number, errc::OutOfMemory);
    EXPECT_NE(raised.description.find("2147483648"), std::string::npos) << raised.description;
    EXPECT_EQ(test::raisedBy([&] { table.redim(-1, 3); }).number, errc::SubscriptOutOfRange);
    EXPECT_EQ(table.upper(0), 1);
    EXPECT_EQ(table.at(1, 1).dbl(), 9.0);
}

}  // namespace
}  // namespace kg
