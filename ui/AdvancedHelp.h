#pragma once
// "Advanced Chart Help": the chart control's own help file, <application folder>/Help/chartctl.hlp,
// opened with the desktop's opener. A failure is told to the host's ReportShellError with a
// shell-style code below 32; codes of 32 and above mean success.
//
//   kg::ui::openAdvancedHelp();                                   // the chart window's F1
//   kg::services().helpOpener = [](const std::string& path) { ...; return kg::ui::kShellOk; };  // tests
#include <functional>
#include <string>

namespace kg::ui {

// Shell-style result codes.
constexpr int kShellFileNotFound = 2;   // the help file does not exist
constexpr int kShellNoAssociation = 31; // no program to open it with, or it did not start
constexpr int kShellOk = 42;            // the opener was started (any code >= 32 is success)

// Opens the file at `path` and returns a shell-style code.
using HelpOpener = std::function<int(const std::string& path)>;

// The desktop's opener: `program` started directly (no shell) with the path as its one argument.
// 2 when the file does not exist, 31 when the program is not on the PATH or does not start, else 42.
HelpOpener desktopOpener(std::string program = "xdg-open");

// GetAppFolder, then opens <folder>/Help/chartctl.hlp with the services' help opener (none:
// desktopOpener()); a code below 32 goes to ReportShellError.
// Errors of the host's objects leave as kg::Error.
void openAdvancedHelp();

}  // namespace kg::ui
