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

struct TypeRow {
    const char* name;
    Variant value;
    VarType type;
    bool numeric;
    friend void PrintTo(const TypeRow& r, std::ostream* os) { *os << r.name; }
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
        {"Object", Variant(makeRef<Thing>()), VarType::Object, false},
        {"Nothing", Variant(Ref<Object>()), VarType::Object, false},
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

INSTANTIATE_TEST_SUITE_P(Core, VariantType, testing::ValuesIn(typeRows()), test::rowName<TypeRow>);

TEST(VariantValues, AccessorsGiveTheStoredValues)
{
    EXPECT_TRUE(Variant(true).boolean());
    EXPECT_EQ(Variant(int16_t(-32768)).integer(), -32768);
    EXPECT_EQ(Variant(int32_t(-70000)).longValue(), -70000);
    EXPECT_EQ(Variant(12.5).dbl(), 12.5);
    EXPECT_EQ(Variant::date(41456.25).dateSerial(), 41456.25);
    EXPECT_EQ(Variant("abc").str(), "abc");
    EXPECT_EQ(Variant(Ref<Object>()).object(), nullptr);
}

// ---- arrays are values ----------------------------------------------------------------------

TEST(VariantArrayValue, CopyingAVariantCopiesItsArray)
{
    VariantArray table(0, 2, 0, 3);
    table.at(1, 1) = 5.0;
    Variant original(std::move(table));
    Variant copy = original;
    copy.array().at(1, 1) = 7.0;
    EXPECT_EQ(original.array().at(1, 1).dbl(), 5.0);
    EXPECT_EQ(copy.array().at(1, 1).dbl(), 7.0);
}

TEST(VariantArrayValue, AssigningAVariantCopiesItsArray)
{
    Variant original(VariantArray(0, 1, 0, 1));
    original.array().at(0, 0) = "kept";
    Variant target(1.0);
    target = original;
    target.array().at(0, 0) = "changed";
    EXPECT_EQ(original.array().at(0, 0).str(), "kept");
    EXPECT_EQ(target.array().at(0, 0).str(), "changed");
}

TEST(VariantArrayValue, SelfAssignmentKeepsTheArray)
{
    Variant v(VariantArray(0, 1, 0, 1));
    v.array().at(1, 1) = int16_t(3);
    const Variant& same = v;
    v = same;
    ASSERT_TRUE(v.isArray());
    EXPECT_EQ(v.array().at(1, 1).integer(), 3);
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

struct BoundsRow {
    const char* name;
    int32_t lo0, hi0, lo1, hi1;
    int32_t count0, count1;
    int error;
    friend void PrintTo(const BoundsRow& r, std::ostream* os) { *os << r.name; }
};

const BoundsRow kBounds[] = {
    {"ValueTable", 0, 3, 0, 12, 4, 13, 0},
    {"FromOne", 1, 3, 1, 5, 3, 5, 0},
    {"NegativeLowerBound", -2, 2, 0, 0, 5, 1, 0},
    {"SingleCell", 0, 0, 0, 0, 1, 1, 0},
    {"UpperBelowLowerFirst", 0, -1, 0, 5, 0, 0, errc::SubscriptOutOfRange},
    {"UpperBelowLowerSecond", 0, 5, 0, -1, 0, 0, errc::SubscriptOutOfRange},
    {"UpperFarBelowLower", 5, 0, 0, 5, 0, 0, errc::SubscriptOutOfRange},
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

INSTANTIATE_TEST_SUITE_P(Core, VariantArrayBounds, testing::ValuesIn(kBounds), test::rowName<BoundsRow>);

struct AtRow {
    const char* name;
    int32_t i, j;
    const char* shown;
    friend void PrintTo(const AtRow& r, std::ostream* os) { *os << r.name; }
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

INSTANTIATE_TEST_SUITE_P(Core, VariantArrayAt, testing::ValuesIn(kOutside), test::rowName<AtRow>);

TEST(VariantArrayAt, CellsAreIndependent)
{
    VariantArray table(0, 2, 0, 2);
    for (int32_t i = 0; i <= 2; ++i)
        for (int32_t j = 0; j <= 2; ++j) table.at(i, j) = int32_t(i * 10 + j);
    EXPECT_EQ(table.at(1, 2).longValue(), 12);
    EXPECT_EQ(table.at(2, 1).longValue(), 21);
    EXPECT_EQ(table.at(2, 2).longValue(), 22);
}

// ---- redim ----------------------------------------------------------------------------------

TEST(VariantArrayRedim, DiscardsTheContentsAndStartsAtZero)
{
    VariantArray table(1, 3, 1, 3);
    table.at(1, 1) = 5.0;
    table.at(3, 3) = "x";
    table.redim(2, 5);
    EXPECT_EQ(table.lower(0), 0);
    EXPECT_EQ(table.upper(0), 2);
    EXPECT_EQ(table.lower(1), 0);
    EXPECT_EQ(table.upper(1), 5);
    for (int32_t i = 0; i <= 2; ++i)
        for (int32_t j = 0; j <= 5; ++j) EXPECT_TRUE(table.at(i, j).isEmpty()) << i << ", " << j;
}

TEST(VariantArrayRedim, ToTheSameSizeStillEmptiesIt)
{
    VariantArray table(0, 1, 0, 1);
    table.at(1, 1) = 1.0;
    table.redim(1, 1);
    EXPECT_TRUE(table.at(1, 1).isEmpty());
}

TEST(VariantArrayRedim, HugeSizeIsRefusedAndTheTableKept)
{
    VariantArray table(0, 1, 0, 1);
    table.at(1, 1) = 9.0;
    const test::Raised raised = test::raisedBy([&] { table.redim(std::numeric_limits<int32_t>::max(), 1000); });
    EXPECT_EQ(raised.number, errc::OutOfMemory);
    EXPECT_NE(raised.description.find("2147483648"), std::string::npos) << raised.description;
    EXPECT_EQ(table.upper(0), 1);
    EXPECT_EQ(table.at(1, 1).dbl(), 9.0);
}

TEST(VariantArrayRedim, UpperBelowZeroIsSubscriptOutOfRangeAndTheTableKept)
{
    VariantArray table(0, 1, 0, 1);
    table.at(0, 1) = 4.0;
    EXPECT_EQ(test::raisedBy([&] { table.redim(-1, 3); }).number, errc::SubscriptOutOfRange);
    EXPECT_EQ(table.at(0, 1).dbl(), 4.0);
}

}  // namespace
}  // namespace kg
