#pragma once
// The per-user registration file: where a host looks up cTavixGraph by its programmatic name.
// An INI file with two entries of ours,
//   [CLSID\{class id}]      ProgID=..., InprocServer=<library path>, Interface=_cTavixGraph {interface id}
//   [ProgID\KarstGraph.cTavixGraph]  CLSID={class id}
// next to whatever other components keep there, which is left as it was, comments included.
// Every write replaces the whole file atomically, so a failed write leaves the old file intact.
#include <optional>
#include <string>

#include "requests/cTavixGraph.h"

namespace kg::registration {

// $KARSTGRAPH_REGISTRY, else $XDG_CONFIG_HOME (or ~/.config) followed by /karstgraph/registry.ini.
std::string registryFilePath();

// Records cTavixGraph as served by `libraryPath` (absolute), replacing an older entry of ours.
// Error 75 naming the file and the reason when it cannot be read or written.
void registerServer(const std::string& libraryPath, const std::string& file = registryFilePath());

// Removes our entries; the ProgID entry only while it still names our class. A file without our
// entries, or no file at all, is left untouched.
void unregisterServer(const std::string& file = registryFilePath());

// What the file says about a programmatic name (matched without regard to case).
struct ClassRegistration {
    Guid clsid;
    std::string library;  // empty when the class entry has no InprocServer
};
// Nothing when the file does not exist or does not name `progId`; Error 75 when it cannot be read,
// Error 13 when the class id written there is not a class id.
std::optional<ClassRegistration> findProgId(const std::string& progId, const std::string& file = registryFilePath());

// "{XXXXXXXX-XXXX-XXXX-XXXX-XXXXXXXXXXXX}" (case-insensitive, braces required) back to a Guid.
std::optional<Guid> parseGuid(const std::string& text);

}  // namespace kg::registration
