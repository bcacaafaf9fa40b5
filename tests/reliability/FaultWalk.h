#pragma once
// Walking a command through every failure point of the host: first the command runs once with
// every planned operation counted (a plan on a call that never comes), which gives each
// operation's number of calls; then each call of each operation fails in a run of its own, and
// what the failure left behind is checked.
#include <gtest/gtest.h>

#include <QByteArray>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QStringList>
#include <climits>
#include <functional>
#include <string>
#include <vector>

#include "teststand/FaultPlan.h"
#include "teststand/RawIni.h"

namespace kg::test {

// Every operation the test stand asks the fault plan about (teststand/FaultPlan.h): the creation of
// the host library objects, their members, and the source form's members, grids, pickers and lists.
inline const std::vector<std::string>& plannedOperations()
{
    static const std::vector<std::string> ops = {
        "Factory.AppServices",        "Factory.JobData",          "Factory.HostAux",
        "Factory.Settings",           "AppServices.GetAppFolder", "AppServices.GetSettingsOwner",
        "AppServices.CellToText",     "AppServices.CellToNumberText", "AppServices.ReportShellError",
        "AppServices.RestoreFormState", "AppServices.SaveFormState", "AppServices.LogFormEvent",
        "Settings.ReadSetting",       "Settings.WriteSetting",    "JobData.SetFromDate",
        "JobData.SetToDate",          "JobData.GetJobQuery",      "JobData.FetchJobRows",
        "Form.grid1",                 "Form.grid2",               "Form.grid3",
        "Form.gridsettings1",         "Form.dtpFromDate",         "Form.dtpToDate",
        "Form.cboFields",             "Grid.Rows",                "Grid.FixedRows",
        "Grid.cols",                  "Grid.textmatrix",          "Grid.GetValueFromCell",
        "Picker.Value",               "List.ListCount",           "List.List",
    };
    return ops;
}

struct FailurePoint {
    std::string operation;
    int call;
    std::string name() const { return operation + " call " + std::to_string(call); }
    // The description the test stand gives the planned failure.
    std::string injectedText() const
    {
        return "Injected failure of " + operation + " (call " + std::to_string(call) + ")";
    }
};

// The calls `run` makes of every planned operation, after `prepare`; `run` must succeed.
// Operations it never calls are absent.
inline std::vector<FailurePoint> countFailurePoints(const std::function<void()>& prepare,
                                                   const std::function<std::string()>& run,
                                                   std::vector<std::string>* reached = nullptr)
{
    using teststand::FaultPlan;
    FaultPlan::clear();
    prepare();
    for (const std::string& op : plannedOperations()) FaultPlan::failOn(op, INT_MAX);
    const std::string problem = run();
    std::vector<FailurePoint> points;
    for (const std::string& op : plannedOperations()) {
        const int calls = FaultPlan::callsOf(op);
        if (calls > 0 && reached) reached->push_back(op);
        for (int n = 1; n <= calls; ++n) points.push_back({op, n});
    }
    FaultPlan::clear();
    EXPECT_EQ(problem, "") << "the command fails with no fault planned";
    return points;
}

inline QByteArray fileBytes(const QString& path)
{
    QFile f(path);
    return f.open(QIODevice::ReadOnly) ? f.readAll() : QByteArray();
}

inline teststand::rawini::Entries iniEntries(const QByteArray& text)
{
    return teststand::rawini::entriesOf(text);
}

// What a failed command may leave of the settings file: the file exactly as it was, or a whole
// file that still holds every entry it held, and nothing beside it (no temporary or lock file).
// Empty when that holds, else what is wrong.
inline std::string settingsDamage(const QString& settingsFile, const QByteArray& before,
                                  const QStringList& folderBefore)
{
    const QStringList folderAfter =
        QDir(QFileInfo(settingsFile).absolutePath()).entryList(QDir::Files | QDir::Hidden, QDir::Name);
    if (folderAfter != folderBefore)
        return "the folder held " + folderBefore.join(", ").toStdString() + " and now holds " +
               folderAfter.join(", ").toStdString();
    const QByteArray after = fileBytes(settingsFile);
    if (after == before) return {};
    const auto was = iniEntries(before), is = iniEntries(after);
    for (auto it = was.constBegin(); it != was.constEnd(); ++it)
        if (!is.contains(it.key())) return "the settings file lost " + it.key().toStdString();
    if (!after.endsWith('\n')) return "the settings file is cut short";
    return {};
}

inline QStringList filesBeside(const QString& file)
{
    return QDir(QFileInfo(file).absolutePath()).entryList(QDir::Files | QDir::Hidden, QDir::Name);
}

// Problems found in a walk, reported together: a walk has hundreds of points and one fault
// usually breaks many of them the same way.
struct WalkReport {
    std::vector<std::string> problems;
    size_t points = 0;

    void add(const FailurePoint& p, const std::string& problem) { problems.push_back(p.name() + ": " + problem); }
    std::string summary() const
    {
        std::string s = std::to_string(problems.size()) + " problems in " + std::to_string(points) + " failure points";
        for (size_t i = 0; i < problems.size() && i < 15; ++i) s += "\n  " + problems[i];
        return s;
    }
};

}  // namespace kg::test
