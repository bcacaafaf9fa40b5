#pragma once
// A window's placement in the settings file: group "FormState", keys "<key>\Left", "<key>\Top",
// "<key>\Width", "<key>\Height", "<key>\WindowState", whole twips as decimal text.
// The window is reached late-bound by those member names.
#include <string>

#include "core/Variant.h"
#include "teststand/SettingsFile.h"

namespace kg::teststand {

void saveWindowPlacement(const SettingsFile& file, const Variant& window, const std::string& key);
// Puts the stored placement back when all five values are stored and sane (size 1 to 100000,
// position within +-100000, state 0 to 2); otherwise the window is left as it is. A window saved
// minimised comes back normal, so that it does not reopen out of sight.
void restoreWindowPlacement(const SettingsFile& file, const Variant& window, const std::string& key);

}  // namespace kg::teststand
