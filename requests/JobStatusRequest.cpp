#include "builders/JobStatusBuilder.h"
#include "builders/LateBoundGrid.h"
#include "requests/Requests.h"
#include "requests/UiServices.h"
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
        uiServices().messageBox(kDatesReversed);
        return;
    }
    HourglassOn();
    {
        Args a{builders::datePickerValue(gvSourceForm, "dtpFromDate")};
        call(goJobData, "SetFromDate", a);
        Args b{builders::datePickerValue(gvSourceForm, "dtpToDate")};
        call(goJobData, "SetToDate", b);
    }
    if (!builders::DrawJobStatus(buildContext(), goJobData, goAppServices)) uiServices().messageBox(kNoJobs);
}

}  // namespace kg::requests
