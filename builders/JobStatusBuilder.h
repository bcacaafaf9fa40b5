#pragma once
// The job status chart: one series of thirteen categories (five job states, then flags of the
// job rows), counted over the job rows of the host's job query, labelled with the source form's
// field list `cboFields`.
#include "builders/BuildContext.h"

namespace kg::builders {

// Sets the chart up, fetches the job rows through `jobData` and counts them (cell texts and
// numbers through `appServices`). Returns false, with the pointer handed back and nothing shown,
// when there are no jobs.
bool DrawJobStatus(BuildContext& context, const Variant& jobData, const Variant& appServices);

}  // namespace kg::builders
