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

struct NameRow : test::Named {
    const char* member;
    DispId id;  // 0: no such member
};

const NameRow kNames[] = {
    {"AsDeclared", "Rows", FakeGrid::kRows},
    {"UpperCase", "FIXEDROWS", FakeGrid::kFixedRows},
    {"MixedCase", "tExTmAtRiX", FakeGrid::kTextMatrix},
    {"Prefix", "Row", 0},
    {"Longer", "Rowss", 0},
    {"DifferentLetter", "Rowz", 0},
    {"TrailingBlank", "Rows ", 0},
    {"EmptyName", "", 0},
};

class DispatchName : public testing::TestWithParam<NameRow> {};

TEST_P(DispatchName, IsFoundWithoutRegardToCaseElseError438NamingObjectAndMember)
{
    Variant grid(makeRef<FakeGrid>());
    if (GetParam().id != 0) {
        EXPECT_EQ(FakeGrid().idOfName(GetParam().member), GetParam().id);
        return;
    }
    const test::Raised raised = test::raisedBy([&] { call(grid, GetParam().member); });
    EXPECT_EQ(raised.number, errc::MemberNotFound);
    EXPECT_NE(raised.description.find("grid1." + std::string(GetParam().member)), std::string::npos)
        << raised.description;
}

INSTANTIATE_TEST_SUITE_P(Core, DispatchName, testing::ValuesIn(kNames), test::RowName{});

// ---- targets that hold no object ------------------------------------------------------------

struct TargetRow : test::Named {
    Variant target;
};

const std::vector<TargetRow>& noObjectTargets()
{
    static const std::vector<TargetRow> rows = {
        {"Empty", Variant()},
        {"Nothing", test::nothing()},
        {"Null", Variant::null()},
        {"Number", Variant(int16_t(1))},
        {"Text", Variant("grid1")},
        {"Array", test::anArray()},
    };
    return rows;
}

class DispatchWithoutObject : public testing::TestWithParam<TargetRow> {};

TEST_P(DispatchWithoutObject, CallAndPutAreError91)
{
    const test::Raised raised = test::raisedBy([] { call(GetParam().target, "Rows"); });
    EXPECT_EQ(raised.number, errc::ObjectNotSet);
    EXPECT_NE(raised.description.find("Rows"), std::string::npos) << raised.description;
    EXPECT_EQ(test::raisedBy([] { put(GetParam().target, "Caption", Variant("x")); }).number, errc::ObjectNotSet);
}

INSTANTIATE_TEST_SUITE_P(Core, DispatchWithoutObject, testing::ValuesIn(noObjectTargets()), test::RowName{});

// ---- calls ----------------------------------------------------------------------------------

TEST(DispatchCall, ReachesTheMemberByNameWithItsArgumentsPutAssignsAndByReferenceWritesBack)
{
    Ref<FakeGrid> grid = makeRef<FakeGrid>();
    const Variant target(grid);
    EXPECT_EQ(call(target, "rows").longValue(), 6);
    EXPECT_EQ(grid->lastKind, kMethod | kPropertyGet);
    EXPECT_EQ(call(target, "TEXTMATRIX", {int32_t(2), int32_t(0)}).str(), "cell 2,0");
    put(target, "caption", Variant("Quote Type"));
    EXPECT_EQ(grid->caption, "Quote Type");
    EXPECT_EQ(grid->lastKind, kPropertyPut);
    Args args{Variant("before")};
    call(target, "Swap", args);
    EXPECT_EQ(args[0].str(), "written back") << "a by-reference argument is written back";
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

}  // namespace
}  // namespace kg
