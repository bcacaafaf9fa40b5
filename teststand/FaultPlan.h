#pragma once
// Planned failures, so a test can make the host fail at an exact step: "fail the 3rd call of
// Grid.textmatrix". Every test stand member asks the plan first. Operations are named
// "<Kind>.<Member>" with the member as the object lists it: AppServices.GetAppFolder,
// Settings.WriteSetting, JobData.FetchJobRows, Form.grid1, Grid.textmatrix, Picker.Value,
// List.List; Factory.<class> (Factory.Settings) for the creation of a host object.
#include <string>
#include <string_view>

namespace kg::teststand {

class FaultPlan {
public:
    // Fail the n-th call of `operation` (n counted from 1, starting now); other calls pass.
    static void failOn(const std::string& operation, int nthCall);
    // Forget every plan and its count.
    static void clear();
    // Calls of `operation` counted since its plan was set; 0 when it has no plan.
    static int callsOf(const std::string& operation);
    // Counts one call of kind.member; raises Error(HostBase + 1000,
    // "Injected failure of <op> (call n)") when it is the planned one.
    // Without any plan this is one atomic load.
    static void check(std::string_view kind, std::string_view member);
};

}  // namespace kg::teststand
