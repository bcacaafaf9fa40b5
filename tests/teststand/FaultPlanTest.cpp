// Planned failures: exactly the n-th call of the planned operation fails, whatever the letter case
// it is called with; other operations and other calls pass.
#include <gtest/gtest.h>

#include <functional>

#include <QTemporaryDir>

#include "core/Error.h"
#include "teststand/TestStand.h"
#include "HostTestSupport.h"

using namespace kg;
using namespace kg::teststand;

namespace {

const std::string kSample = std::string(KG_TEST_DATA) + "/host/form_sample.json";

Variant sampleForm() { return Variant(loadFormFile(kSample)); }
Variant sampleMember(const char* member, Args args = {}) { return call(sampleForm(), member, args); }
// The settings file of the case being run; each case has a folder of its own.
std::string g_settingsFile;

Variant hostObject(host::HostClass cls)
{
    Config cfg;
    cfg.settingsFile = g_settingsFile;
    return Variant(makeFactory(cfg)->create(cls));
}

struct FaultCase : test::Named {
    std::string operation;
    int nth;
    std::function<Variant()> target;  // made once per case; with no member, making it is the call
    const char* member;
    Args args;
};

class FaultPlanCase : public testing::TestWithParam<FaultCase> {
protected:
    void TearDown() override
    {
        FaultPlan::clear();
        g_settingsFile.clear();
    }
};

TEST_P(FaultPlanCase, FailsExactlyTheNthCall)
{
    const FaultCase& c = GetParam();
    QTemporaryDir dir(test::tempTemplate("fault"));
    ASSERT_TRUE(dir.isValid());
    g_settingsFile = dir.filePath("settings.ini").toStdString();
    const Variant target = c.member ? c.target() : Variant();
    const auto once = [&] {
        Args args = c.args;
        c.member ? call(target, c.member, args) : c.target();
    };
    FaultPlan::failOn(c.operation, c.nth);
    for (int n = 1; n <= c.nth + 2; ++n) {
        const test::Raised raised = test::raisedBy(once);
        if (n != c.nth) {
            EXPECT_EQ(raised.number, 0) << "call " << n << ": " << raised.description;
            continue;
        }
        EXPECT_EQ(raised.number, errc::HostBase + hosterr::Injected) << "call " << n;
        EXPECT_EQ(raised.description, "Injected failure of " + c.operation + " (call " + std::to_string(n) + ")");
    }
    EXPECT_EQ(FaultPlan::callsOf(c.operation), c.nth + 2);
}

INSTANTIATE_TEST_SUITE_P(
    Operations, FaultPlanCase,
    testing::Values(
        FaultCase{"textmatrix", "Grid.textmatrix", 3, [] { return sampleMember("grid1"); }, "TEXTMATRIX", {1, 1}},
        FaultCase{"formGrid", "Form.grid1", 1, sampleForm, "Grid1", {}},
        // A member that is no call of its own: making the object is the planned operation.
        FaultCase{"createSettings", "Factory.Settings", 2, [] { return hostObject(host::HostClass::Settings); },
                  nullptr, {}}),
    test::RowName{});

TEST(FaultPlan, OtherOperationsAndClearedPlansPass)
{
    const Variant grid = sampleMember("grid1");
    FaultPlan::failOn("Grid.GetValueFromCell", 1);
    EXPECT_NO_THROW(call(grid, "textmatrix", {0, 0}));
    EXPECT_EQ(FaultPlan::callsOf("Grid.textmatrix"), 0);
    FaultPlan::clear();
    EXPECT_NO_THROW(call(grid, "GetValueFromCell", {0, 0}));
    EXPECT_EQ(FaultPlan::callsOf("Grid.GetValueFromCell"), 0);
}

TEST(FaultPlan, NewPlanStartsCountingAgain)
{
    const Variant grid = sampleMember("grid1");
    FaultPlan::failOn("Grid.Rows", 2);
    call(grid, "Rows");
    FaultPlan::failOn("Grid.Rows", 2);
    EXPECT_NO_THROW(call(grid, "Rows"));
    EXPECT_THROW(call(grid, "Rows"), Error);
    FaultPlan::clear();
}

}  // namespace
