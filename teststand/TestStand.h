#pragma once
// The test stand: the host's objects and source form for real use on this platform.
//   - the source form from a JSON form file (loadFormFile)
//   - settings on an INI file in QSettings' IniFormat layout, key path owner/section/key
//   - application services (folder, cell texts, window placement in the settings file, event log)
//   - job data over SQLite
//   - planned failures for tests (FaultPlan)
//
// A form file:
//   {"grid1": {"fixedRows": 1, "cells": [["", "Jan"], ["Agent A", 12]]},
//    "dtpFromDate": "2026-01-01", "dtpToDate": "2026-03-31",
//    "cboFields": {"1": ["Unconfirmed", "Unscheduled"]}, "jobsDatabase": "jobs.db"}
// grid1..grid3 and gridsettings1 are grids ("fixedRows" defaults to 1, or 0 for a grid without rows),
// the pickers hold YYYY-MM-DD dates, cboFields maps control array indexes to their entries.
#include <cstdint>
#include <functional>
#include <string>

#include "teststand/FaultPlan.h"
#include "host/HostObjects.h"

namespace kg::teststand {

// ReportShellError cannot show a message box from here (no widgets in this layer): it hands the
// code and its text to the reporter, which a window layer may set. Without one the text goes to
// stderr.
using ShellErrorReporter = std::function<void(int32_t code, const std::string& text)>;

struct Config {
    std::string settingsFile;   // empty: the user's file, $XDG_CONFIG_HOME/karstgraph/settings.ini
    std::string settingsOwner = "Tavix";
    std::string appFolder;      // empty: the installed data folder that holds Help/
    std::string eventLogFile;   // empty: no event log file
    bool eventLogToStderr = false;
    std::string jobsDatabase;   // the job data's database file
    ShellErrorReporter shellErrorReporter;  // empty: stderr
};

// The test stand's objects, each made with `cfg` as it is now.
Ref<host::HostObjectFactory> makeFactory(Config cfg = {});

// The source form of a JSON form file; Error naming the file, member and row for a malformed one.
Ref<Object> loadFormFile(const std::string& path);
Ref<Object> loadFormJson(const std::string& jsonText, const std::string& nameForErrors);
// The form's "jobsDatabase", made absolute against the form file's folder; empty when it has none
// or `form` is not a loaded form.
std::string jobsDatabaseOf(const Ref<Object>& form);

// The files and folders the objects use for a configuration, with the defaults applied:
// settings: cfg.settingsFile, else $KARSTGRAPH_SETTINGS, else $XDG_CONFIG_HOME (or ~/.config)
//   followed by /karstgraph/settings.ini;
// application folder: cfg.appFolder, else $KARSTGRAPH_APPFOLDER, else the first of <exe dir>,
//   <exe dir>/.., <exe dir>/../share/karstgraph (an installed tree), /usr/share/karstgraph,
//   /usr/local/share/karstgraph that holds Help/
//   (the executable's folder when none does). No trailing separator.
std::string settingsFilePath(const Config& cfg);
std::string appFolderPath(const Config& cfg);

// Error numbers of the test stand's own failures, counted from errc::HostBase.
namespace hosterr {
constexpr int32_t FormFile = 1;    // a form file that is not a valid form
constexpr int32_t Settings = 2;    // the settings file cannot be read or written
constexpr int32_t JobData = 3;     // the jobs database cannot be queried
constexpr int32_t Injected = 1000; // a failure planned by FaultPlan
}  // namespace hosterr

// "Could not open the help file (shell error <code>: <meaning>)".
std::string shellErrorText(int32_t code);
// The code of the last ReportShellError in this process; 0 before the first.
int32_t lastShellError();

}  // namespace kg::teststand
