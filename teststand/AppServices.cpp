// goAppServices: the application folder, the settings owner, job cells as text, the shell error
// report, window placement and the window event log.
#include <atomic>
#include <cstdio>
#include <mutex>
#include <set>

#include <QDateTime>
#include <QFile>

#include "core/Convert.h"
#include "teststand/SettingsFile.h"
#include "teststand/StandObject.h"
#include "teststand/StandObjects.h"
#include "teststand/WindowPlacement.h"

namespace kg::teststand {

namespace {

std::atomic<int32_t> g_lastShellError{0};

void reportShellError(const ShellErrorReporter& reporter, int32_t code)
{
    const std::string text = shellErrorText(code);
    g_lastShellError = code;
    if (reporter)
        reporter(code, text);
    else
        std::fprintf(stderr, "%s\n", text.c_str());
}

// The event log is a diagnostic: a log file that cannot be opened is said once on stderr and
// never fails the window that reports the event.
void appendToLog(const std::string& path, const std::string& line)
{
    QFile f(QString::fromStdString(path));
    if (f.open(QIODevice::WriteOnly | QIODevice::Append) && f.write(line.data(), static_cast<qint64>(line.size())) ==
                                                                static_cast<qint64>(line.size()))
        return;
    static std::mutex mutex;
    static std::set<std::string> warned;
    std::lock_guard lock(mutex);
    if (warned.insert(path).second)
        std::fprintf(stderr, "KarstGraph: cannot write the event log \"%s\": %s\n", path.c_str(),
                     f.errorString().toLocal8Bit().constData());
}

// A job cell as text: nothing for Null and Empty, texts as they are, numbers without the sign blank.
std::string cellText(const Variant& cell, const std::string& where)
{
    if (cell.isNull() || cell.isEmpty()) return {};
    if (cell.isString()) return cell.str();
    if (cell.isObject() || cell.isArray())
        throw Error::typeMismatch(where + ": the cell is a " + typeName(cell.type()) + ", not a value");
    return toText(cell);
}

class AppServicesObject final : public StandObject {
public:
    enum : DispId {
        kGetAppFolder = 1,
        kGetSettingsOwner,
        kCellToText,
        kCellToNumberText,
        kReportShellError,
        kRestoreFormState,
        kSaveFormState,
        kLogFormEvent
    };

    explicit AppServicesObject(const Config& cfg)
        : StandObject("AppServices", "AppServices",
                      {{"GetAppFolder", kGetAppFolder},
                       {"GetSettingsOwner", kGetSettingsOwner},
                       {"CellToText", kCellToText},
                       {"CellToNumberText", kCellToNumberText},
                       {"ReportShellError", kReportShellError},
                       {"RestoreFormState", kRestoreFormState},
                       {"SaveFormState", kSaveFormState},
                       {"LogFormEvent", kLogFormEvent}}),
          cfg_(cfg),
          settings_(settingsFilePath(cfg))
    {
    }

protected:
    Variant run(DispId id, Args& args) override
    {
        const char* member = memberName(id);
        switch (id) {
        case kGetAppFolder:
            expectArgs(args, 1, member);
            args[0] = appFolderPath(cfg_);
            break;
        case kGetSettingsOwner:
            expectArgs(args, 1, member);
            args[0] = cfg_.settingsOwner;
            break;
        case kCellToText:
            expectArgs(args, 4, member);
            args[3] = cellText(args[2], where(id));
            break;
        case kCellToNumberText:
            expectArgs(args, 3, member);
            args[2] = cellText(args[1], where(id));
            break;
        case kReportShellError:
            expectArgs(args, 1, member);
            reportShellError(cfg_.shellErrorReporter, longArg(args, 0, where(id)));
            break;
        case kRestoreFormState:
            expectArgs(args, 2, member);
            restoreWindowPlacement(settings_, args[0], textArg(args, 1, where(id)));
            break;
        case kSaveFormState:
            expectArgs(args, 2, member);
            saveWindowPlacement(settings_, args[0], textArg(args, 1, where(id)));
            break;
        case kLogFormEvent: {
            expectArgs(args, 2, member);
            const std::string line = QDateTime::currentDateTime().toString(Qt::ISODateWithMs).toStdString() + " " +
                                     textArg(args, 0, where(id)) + " " + textArg(args, 1, where(id)) + "\n";
            if (!cfg_.eventLogFile.empty()) appendToLog(cfg_.eventLogFile, line);
            if (cfg_.eventLogToStderr) std::fputs(line.c_str(), stderr);
            break;
        }
        }
        return {};
    }

private:
    Config cfg_;
    SettingsFile settings_;
};

}  // namespace

std::string shellErrorText(int32_t code)
{
    const char* meaning = code == 2    ? "file not found"
                          : code == 31 ? "no application is associated with the file"
                                       : "error";
    return "Could not open the help file (shell error " + std::to_string(code) + ": " + meaning + ")";
}

int32_t lastShellError() { return g_lastShellError; }

Ref<Object> makeAppServices(const Config& cfg) { return makeRef<AppServicesObject>(cfg); }

}  // namespace kg::teststand
