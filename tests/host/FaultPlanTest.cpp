// Planned failures: exactly the n-th call of the planned operation fails, whatever the letter case
// it is called with; other operations and other calls pass.
#include <gtest/gtest.h>

#include <functional>

#include <QDir>
#include <QTemporaryDir>

#include "core/Date.h"
#include "core/Error.h"
#include "host/TestStand.h"
#include "HostTestSupport.h"

using namespace kg;
using namespace kg::host::teststand;

namespace {

const std::string kSample = std::string(KG_TEST_DATA) + "/host/form_sample.json";

struct FaultCase {
    const char* name;
    std::string operation;
    int nth;
    // One call of the operation (the objects are made once per case).
    std::function<std::function<void()>(const QTemporaryDir&)> prepare;
};

class FaultPlanCase : public testing::TestWithParam<FaultCase> {
protected:
    void TearDown() override
    {
        FaultPlan::clear();
        config() = Config{};
    }
};

TEST_P(FaultPlanCase, FailsExactlyTheNthCall)
{
    QTemporaryDir dir(test::tempTemplate("fault"));
    ASSERT_TRUE(dir.isValid());
    config().settingsFile = dir.filePath("settings.ini").toStdString();
    const std::function<void()> once = GetParam().prepare(dir);
    FaultPlan::failOn(GetParam().operation, GetParam().nth);
    for (int n = 1; n <= GetParam().nth + 2; ++n) {
        if (n != GetParam().nth) {
            EXPECT_NO_THROW(once()) << "call " << n;
            continue;
        }
        try {
            once();
            ADD_FAILURE() << "call " << n << " passed";
        } catch (const Error& e) {
            EXPECT_EQ(e.number(), errc::HostBase + hosterr::Injected);
            EXPECT_EQ(e.description(),
                      "Injected failure of " + GetParam().operation + " (call " + std::to_string(n) + ")");
        }
    }
    EXPECT_EQ(FaultPlan::callsOf(GetParam().operation), GetParam().nth + 2);
}

Variant sampleForm() { return Variant(loadFormFile(kSample)); }
Variant hostObject(host::HostClass cls) { return Variant(makeFactory()->create(cls)); }

INSTANTIATE_TEST_SUITE_P(
    Operations, FaultPlanCase,
    testing::Values(
        FaultCase{"textmatrix", "Grid.textmatrix", 3,
                  [](const QTemporaryDir&) {
                      const Variant grid = call(sampleForm(), "grid1");
                      return std::function<void()>([grid] { call(grid, "TEXTMATRIX", {1, 1}); });
                  }},
        FaultCase{"formGrid", "Form.grid1", 1,
                  [](const QTemporaryDir&) {
                      const Variant form = sampleForm();
                      return std::function<void()>([form] { call(form, "Grid1"); });
                  }},
        FaultCase{"pickerValue", "Picker.Value", 2,
                  [](const QTemporaryDir&) {
                      const Variant picker = call(sampleForm(), "dtpFromDate");
                      return std::function<void()>([picker] { call(picker, "Value"); });
                  }},
        FaultCase{"listEntry", "List.List", 2,
                  [](const QTemporaryDir&) {
                      const Variant list = call(sampleForm(), "cboFields", {1});
                      return std::function<void()>([list] { call(list, "List", {0}); });
                  }},
        FaultCase{"writeSetting", "Settings.WriteSetting", 2,
                  [](const QTemporaryDir&) {
                      const Variant s = hostObject(host::HostClass::Settings);
                      return std::function<void()>([s] {
                          Args args{"2dCharts", "Style", "Bar", "Tavix", Variant()};
                          call(s, "WriteSetting", args);
                      });
                  }},
        FaultCase{"appFolder", "AppServices.GetAppFolder", 1,
                  [](const QTemporaryDir&) {
                      const Variant app = hostObject(host::HostClass::AppServices);
                      return std::function<void()>([app] {
                          Args args{Variant()};
                          call(app, "GetAppFolder", args);
                      });
                  }},
        FaultCase{"setToDate", "JobData.SetToDate", 4,
                  [](const QTemporaryDir&) {
                      const Variant jobs = hostObject(host::HostClass::JobData);
                      return std::function<void()>([jobs] { call(jobs, "SetToDate", {Variant::date(46000)}); });
                  }},
        FaultCase{"createSettings", "Factory.Settings", 2,
                  [](const QTemporaryDir&) {
                      return std::function<void()>([] { makeFactory()->create(host::HostClass::Settings); });
                  }}),
    [](const auto& info) { return std::string(info.param.name); });

TEST(FaultPlan, OtherOperationsAndClearedPlansPass)
{
    const Variant grid = call(sampleForm(), "grid1");
    FaultPlan::failOn("Grid.GetValueFromCell", 1);
    EXPECT_NO_THROW(call(grid, "textmatrix", {0, 0}));
    EXPECT_EQ(FaultPlan::callsOf("Grid.textmatrix"), 0);
    FaultPlan::clear();
    EXPECT_NO_THROW(call(grid, "GetValueFromCell", {0, 0}));
    EXPECT_EQ(FaultPlan::callsOf("Grid.GetValueFromCell"), 0);
}

TEST(FaultPlan, NewPlanStartsCountingAgain)
{
    const Variant grid = call(sampleForm(), "grid1");
    FaultPlan::failOn("Grid.Rows", 2);
    call(grid, "Rows");
    FaultPlan::failOn("Grid.Rows", 2);
    EXPECT_NO_THROW(call(grid, "Rows"));
    EXPECT_THROW(call(grid, "Rows"), Error);
    FaultPlan::clear();
}

}  // namespace
