// Late binding: members found by name without regard to case, invoked by id; the standard
// errors for a missing member, a call on no object and a wrong argument count.
#include <string>
#include <vector>

#include "RowSupport.h"
#include "core/Dispatch.h"

namespace kg {
namespace {

// A grid-like object with a fixed member table; it records what was invoked.
class FakeGrid : public TableObject {
public:
    enum : DispId { kRows = 1, kFixedRows = 2, kTextMatrix = 3, kCaption = 4, kSwap = 5, kDrop = 6 };

    Variant invoke(DispId id, uint16_t kind, Args& args) override
    {
        lastKind = kind;
        switch (id) {
        case kRows: expectArgs(args, 0, "Rows"); return int32_t(6);
        case kFixedRows: expectArgs(args, 0, "FixedRows"); return int32_t(1);
        case kTextMatrix:
            expectArgs(args, 2, "TextMatrix");
            return "cell " + std::to_string(args[0].longValue()) + "," + std::to_string(args[1].longValue());
        case kCaption:
            expectArgs(args, 1, "Caption");
            caption = args[0].str();
            return {};
        case kSwap:  // writes its by-reference argument back
            expectArgs(args, 1, "Swap");
            args[0] = "written back";
            return {};
        case kDrop:  // releases the caller's reference while running
            if (holder) *holder = Variant();
            return objectName();
        }
        throw Error::memberNotFound(objectName() + ".#" + std::to_string(id));
    }
    std::string objectName() const override { return "grid1"; }

    uint16_t lastKind = 0;
    std::string caption;
    Variant* holder = nullptr;

protected:
    const std::vector<MemberInfo>& members() const override
    {
        static const std::vector<MemberInfo> table = {{"Rows", kRows},       {"FixedRows", kFixedRows},
                                                      {"TextMatrix", kTextMatrix}, {"Caption", kCaption},
                                                      {"Swap", kSwap},       {"Drop", kDrop}};
        return table;
    }
};

// ---- names ----------------------------------------------------------------------------------

struct NameRow {
    const char* name;
    const char* member;
    DispId id;
    friend void PrintTo(const NameRow& r, std::ostream* os) { *os << r.name; }
};

const NameRow kNames[] = {
    {"AsDeclared", "Rows", FakeGrid::kRows},
    {"LowerCase", "rows", FakeGrid::kRows},
    {"UpperCase", "FIXEDROWS", FakeGrid::kFixedRows},
    {"MixedCase", "tExTmAtRiX", FakeGrid::kTextMatrix},
    {"OtherMember", "caption", FakeGrid::kCaption},
};

class DispatchName : public testing::TestWithParam<NameRow> {};

TEST_P(DispatchName, IsFoundWithoutRegardToCase)
{
    const FakeGrid grid;
    EXPECT_EQ(grid.idOfName(GetParam().member), GetParam().id);
}

INSTANTIATE_TEST_SUITE_P(Core, DispatchName, testing::ValuesIn(kNames), test::rowName<NameRow>);

struct MissingRow {
    const char* name;
    const char* member;
    friend void PrintTo(const MissingRow& r, std::ostream* os) { *os << r.name; }
};

const MissingRow kMissing[] = {
    {"Prefix", "Row"},
    {"Longer", "Rowss"},
    {"TrailingBlank", "Rows "},
    {"EmptyName", ""},
    {"OtherObjectsMember", "GetValueFromCell"},
};

class DispatchMissingMember : public testing::TestWithParam<MissingRow> {};

TEST_P(DispatchMissingMember, IsError438NamingObjectAndMember)
{
    Variant grid(makeRef<FakeGrid>());
    const test::Raised raised = test::raisedBy([&] { call(grid, GetParam().member); });
    EXPECT_EQ(raised.number, errc::MemberNotFound);
    EXPECT_NE(raised.description.find("grid1." + std::string(GetParam().member)), std::string::npos)
        << raised.description;
}

INSTANTIATE_TEST_SUITE_P(Core, DispatchMissingMember, testing::ValuesIn(kMissing), test::rowName<MissingRow>);

// ---- targets that hold no object ------------------------------------------------------------

struct TargetRow {
    const char* name;
    Variant target;
    friend void PrintTo(const TargetRow& r, std::ostream* os) { *os << r.name; }
};

const std::vector<TargetRow>& noObjectTargets()
{
    static const std::vector<TargetRow> rows = {
        {"Empty", Variant()},
        {"Nothing", Variant(Ref<Object>())},
        {"Null", Variant::null()},
        {"Number", Variant(int16_t(1))},
        {"Text", Variant("grid1")},
        {"Array", Variant(VariantArray(0, 0, 0, 0))},
    };
    return rows;
}

class DispatchWithoutObject : public testing::TestWithParam<TargetRow> {};

TEST_P(DispatchWithoutObject, CallIsError91)
{
    const test::Raised raised = test::raisedBy([] { call(GetParam().target, "Rows"); });
    EXPECT_EQ(raised.number, errc::ObjectNotSet);
    EXPECT_NE(raised.description.find("Rows"), std::string::npos) << raised.description;
}

TEST_P(DispatchWithoutObject, PutIsError91)
{
    EXPECT_EQ(test::raisedBy([] { put(GetParam().target, "Caption", Variant("x")); }).number, errc::ObjectNotSet);
}

INSTANTIATE_TEST_SUITE_P(Core, DispatchWithoutObject, testing::ValuesIn(noObjectTargets()),
                         test::rowName<TargetRow>);

// ---- calls ----------------------------------------------------------------------------------

TEST(DispatchCall, ReachesTheMemberByNameWithItsArguments)
{
    Ref<FakeGrid> grid = makeRef<FakeGrid>();
    const Variant target(grid);
    EXPECT_EQ(call(target, "rows").longValue(), 6);
    EXPECT_EQ(grid->lastKind, kMethod | kPropertyGet);
    EXPECT_EQ(call(target, "TEXTMATRIX", {int32_t(2), int32_t(0)}).str(), "cell 2,0");
}

TEST(DispatchCall, PutAssignsWithPropertyPut)
{
    Ref<FakeGrid> grid = makeRef<FakeGrid>();
    put(Variant(grid), "caption", Variant("Quote Type"));
    EXPECT_EQ(grid->caption, "Quote Type");
    EXPECT_EQ(grid->lastKind, kPropertyPut);
}

TEST(DispatchCall, ByReferenceArgumentIsWrittenBack)
{
    Args args{Variant("before")};
    call(Variant(makeRef<FakeGrid>()), "Swap", args);
    EXPECT_EQ(args[0].str(), "written back");
}

TEST(DispatchCall, WrongArgumentCountIsError450NamingTheMember)
{
    const Variant grid(makeRef<FakeGrid>());
    const test::Raised raised = test::raisedBy([&] { call(grid, "TextMatrix", {int32_t(1)}); });
    EXPECT_EQ(raised.number, errc::WrongArgumentCount);
    EXPECT_NE(raised.description.find("TextMatrix"), std::string::npos) << raised.description;
}

TEST(DispatchCall, ObjectStaysAliveWhileItsMemberReleasesTheCaller)
{
    Ref<FakeGrid> grid = makeRef<FakeGrid>();
    Variant holder(grid);
    grid->holder = &holder;
    grid.reset();  // the Variant is now the only owner
    const long live = RefCounted::liveObjects();
    const Variant result = call(holder, "Drop");
    EXPECT_EQ(result.str(), "grid1");
    EXPECT_TRUE(holder.isEmpty());
    EXPECT_EQ(RefCounted::liveObjects(), live - 1) << "released after the call returned";
}

// ---- equalsNoCase ---------------------------------------------------------------------------

struct EqualsRow {
    const char* name;
    const char* a;
    const char* b;
    bool equal;
    friend void PrintTo(const EqualsRow& r, std::ostream* os) { *os << r.name; }
};

const EqualsRow kEquals[] = {
    {"Same", "Rows", "Rows", true},
    {"DifferentCase", "gridsettings1", "GridSettings1", true},
    {"BothEmpty", "", "", true},
    {"DifferentLength", "Rows", "Row", false},
    {"DifferentLetter", "Rows", "Rowz", false},
    {"DigitsMatter", "grid1", "grid2", false},
    {"BlankMatters", "Rows", "Rows ", false},
};

class EqualsNoCase : public testing::TestWithParam<EqualsRow> {};

TEST_P(EqualsNoCase, ComparesLettersWithoutCase)
{
    EXPECT_EQ(equalsNoCase(GetParam().a, GetParam().b), GetParam().equal);
}

INSTANTIATE_TEST_SUITE_P(Core, EqualsNoCase, testing::ValuesIn(kEquals), test::rowName<EqualsRow>);

}  // namespace
}  // namespace kg
