#pragma once
// Contracts of the host's library objects, reached late-bound by name through the dispatch layer.
// The component never includes the test stand: it asks the factory in its services for new objects.
//
// goAppServices members (every argument by reference; "out" arguments are written back):
//   GetAppFolder(out folder)                  the application folder, no trailing separator
//   GetSettingsOwner(out owner)               owner text for ReadSetting / WriteSetting
//   CellToText(Long 0, Long 0, cell, out text)
//   CellToNumberText(Long 1, cell, out text)
//   ReportShellError(code Long)
//   RestoreFormState(window, key)  SaveFormState(window, key)
//       window: an object with Name, Left, Top, Width, Height (twips) and WindowState (0 normal,
//       1 minimised, 2 maximised)
//   LogFormEvent(event, windowName)
// goSettings members:
//   ReadSetting(section, key, default, owner, out value)
//   WriteSetting(section, key, value, owner, out status)      a failed write raises an error
// goJobData members:
//   SetFromDate(date)  SetToDate(date)  GetJobQuery(Long 255, out query)
//   FetchJobRows(query, out rows (field 0..64, row 0..n-1), Long 0, "", out count Long)
// goHostAux: no members are called.
#include "core/Dispatch.h"

namespace kg::host {

enum class HostClass { AppServices, JobData, HostAux, Settings };

const char* hostClassName(HostClass c);

// Creates the host's library objects for GraphInitialize.
class HostObjectFactory : public RefCounted {
public:
    virtual Ref<Object> create(HostClass cls) = 0;
};

}  // namespace kg::host
