#include "builders/JobStatusBuilder.h"
#include "builders/LateBoundGrid.h"
#include "requests/Requests.h"
#include "requests/Services.h"
#include "requests/modMain.h"
#include "core/Convert.h"

namespace kg::requests {

using namespace modMain;

void GenerateChart_JobStatusReport()
{
    GraphInitialize();
    const Variant from = builders::datePickerValue(gvSourceForm, "dtpFromDate");
    const Variant to = builders::datePickerValue(gvSourceForm, "dtpToDate");
    if (toDouble(to) < toDouble(from)) {
        services().prompter->showMessage(kDatesReversed);
        return;
    }
    HourglassOn();
    {
        Args a{builders::datePickerValue(gvSourceForm, "dtpFromDate")};
        call(goJobData, "SetFromDate", a);
        Args b{builders::datePickerValue(gvSourceForm, "dtpToDate")};
        call(goJobData, "SetToDate", b);
    }
    if (!builders::DrawJobStatus(buildContext(), goJobData, goAppServices)) services().prompter->showMessage(kNoJobs);
}

}  // namespace kg::requests
