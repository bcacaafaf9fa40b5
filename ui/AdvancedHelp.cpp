#include "ui/AdvancedHelp.h"

#include <QFileInfo>
#include <QProcess>
#include <QStandardPaths>

#include "requests/Services.h"
#include "requests/modMain.h"
#include "core/Convert.h"

namespace kg::ui {

namespace {

constexpr const char* kHelpFolder = "/Help/";
constexpr const char* kHelpFile = "chartctl.hlp";

}  // namespace

HelpOpener desktopOpener(std::string program)
{
    return [program = std::move(program)](const std::string& path) {
        const QString file = QString::fromStdString(path);
        if (!QFileInfo(file).isFile()) return kShellFileNotFound;
        const QString executable = QStandardPaths::findExecutable(QString::fromStdString(program));
        if (executable.isEmpty()) return kShellNoAssociation;
        // No shell in between: the path reaches the opener as one argument, blanks and all.
        if (!QProcess::startDetached(executable, {file})) return kShellNoAssociation;
        return kShellOk;
    };
}

void openAdvancedHelp()
{
    Args folder{Variant(std::string())};
    call(modMain::goAppServices, "GetAppFolder", folder);
    const std::string path = toText(folder[0]) + kHelpFolder + kHelpFile;
    const HelpOpener& opener = services().helpOpener;
    const int code = opener ? opener(path) : desktopOpener()(path);
    if (code < 32) call(modMain::goAppServices, "ReportShellError", {Variant(int32_t(code))});
}

}  // namespace kg::ui
