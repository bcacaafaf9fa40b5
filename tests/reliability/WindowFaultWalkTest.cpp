// The chart window's road through every failure point, with the real windows offscreen: a request
// that loads the window, the style dialog's OK (the settings write), Print (the printer), Redraw
// and Close (the window placement write). Besides every call of every host operation, the printer
// fails (a PDF file that cannot be made) and the settings write fails part way (a file size limit,
// as a full disk). A failure must be reported with its description (returned, or in the message
// box of a menu command), hand the mouse pointer back, leave the settings file whole; the command
// must work when tried again, and the next request must chart.
#include <QAction>
#include <QCoreApplication>
#include <QEvent>
#include <QPushButton>
#include <QRadioButton>
#include <csignal>
#include <cstdio>
#include <sys/resource.h>

#include "teststand/SettingsFile.h"
#include "reliability/FaultWalk.h"
#include "support/RequestFixture.h"
#include "ui/NumericField.h"
#include "ui/Prompter.h"
#include "ui/QtUi.h"
#include "ui/frmChartSetup.h"

namespace kg {
namespace {

namespace stand = teststand;
using stand::FaultPlan;


// Failure points that are not the fault plan's.
const test::FailurePoint kPrinterFails{"the printer", 1};
const test::FailurePoint kDiskFull{"a full disk", 1};

// Every write of the settings file fails part way while this lives: files may not grow beyond
// a byte less than the settings file has now.
class DiskFull {
public:
    explicit DiskFull(const QString& settingsFile)
    {
        getrlimit(RLIMIT_FSIZE, &saved_);
        oldHandler_ = std::signal(SIGXFSZ, SIG_IGN);
        rlimit tiny = saved_;
        tiny.rlim_cur = static_cast<rlim_t>(std::max<qint64>(QFileInfo(settingsFile).size() - 1, 1));
        setrlimit(RLIMIT_FSIZE, &tiny);
    }
    ~DiskFull()
    {
        setrlimit(RLIMIT_FSIZE, &saved_);
        std::signal(SIGXFSZ, oldHandler_);
    }
    DiskFull(const DiskFull&) = delete;
    DiskFull& operator=(const DiskFull&) = delete;

private:
    rlimit saved_{};
    void (*oldHandler_)(int) = nullptr;
};

class WindowWalk;

struct WindowCommand {
    const char* name;
    void (WindowWalk::*prepare)();
    std::string (WindowWalk::*run)();  // "" when the command worked, else its error or message
    bool retryInPlace;                 // the command can be given again in the state a failure left
    bool writesSettings;
    bool prints;
};

class WindowWalk : public test::RequestFixture, public ::testing::WithParamInterface<WindowCommand> {
public:
    void SetUp() override
    {
        RequestFixture::SetUp();
        services->windows = qt_;
        writeSetting("View3D", " 1");
        writeSetting("Style", "Bar");
        const std::string grid = test::gridJson(1, 2, 14);
        form_ = Variant(stand::loadFormJson(
            "{\"grid1\": " + grid +
                ", \"gridsettings1\": {\"fixedRows\": 1, \"cells\": ["
                "[\"Quote type\", \"Qty\", \"Value\", \"Avg Value\", \"% Jobs\", \"% Value\"],"
                "[\"Retail\", 12, 1200.0, 100.0, 40, 35.5], [\"Trade\", 3, 300.0, 100.0, 60, 64.5]]},"
                " \"dtpFromDate\": \"2026-01-01\", \"dtpToDate\": \"2026-01-31\"}",
            "walk form"));
        settingsFile_ = QString::fromStdString(standConfig.settingsFile);
        // Printed beside, not in, the settings file's folder: that folder is checked for leftovers.
        QDir(dir.path()).mkpath("prints");
        pdf_ = dir.filePath("prints/print.pdf");
        services->printToPdf = pdf_.toStdString();
    }
    void TearDown() override
    {
        FaultPlan::clear();
        closeWindow();
        RequestFixture::TearDown();
    }

    // ---- the commands -------------------------------------------------------------------------

    void noChart()
    {
        closeWindow();
        modMain::releaseSharedObjects();
        Args a{form_};
        graph->invoke(KG_DISPID_SOURCEFORM, kPropertyPut, a);
    }
    void hourlyShown()
    {
        noChart();
        ASSERT_EQ(hourlyRequest(), "");
    }
    void bookingsShown()
    {
        noChart();
        prompts.answers.push_back(ui::ScriptedPrompter::choose(0));
        ASSERT_EQ(request(KG_DISPID_GENERATECHART_BOOKINGSREPORT), 0) << lastError;
    }

    std::string hourlyRequest()
    {
        Args args{Variant(int32_t(2)), Variant(10.0)};
        if (const int32_t n = request(KG_DISPID_GENERATECHART_HOURLYGRAPH1,
            args)) return "Error " + std::to_string(n) + ": " + lastError;
        if (!window() || !window()->isVisible()) return "no chart window shown";
        return {};
    }
    std::string styleDialogOk()
    {
        prompts.answers.clear();
        prompts.answers.push_back([](QDialog& d) {
            auto& setup = dynamic_cast<ui::frmChartSetup&>(d);
            setup.num3D[0]->setValue(Variant(30.0));
            setup.optChartType[3]->click();  // Pie
            setup.optLabel[0]->click();      // labels on
            setup.Command1->click();
        });
        try {
            ui::showChartSetup();
        } catch (const Error& e) {
            return "Error " + std::to_string(e.number()) + ": " + e.description();
        }
        const stand::SettingsFile file(settingsFile_.toStdString());
        if (file.read("Tavix/2dCharts/Rotation") != " 30" || file.read("Tavix/2dCharts/Style") != "Pie" ||
            file.read("Tavix/2dCharts/LabelsOnDefault") != "1")
            return "OK did not store the choice";
        return {};
    }
    std::string print()
    {
        QFile::remove(pdf_);
        const std::string shown = menuCommand([this] { return window()->mnuPrint; });
        if (!shown.empty()) return shown;
        if (services->printToPdf == pdf_.toStdString() && QFileInfo(pdf_).size() == 0) return "nothing printed";
        return {};
    }
    std::string redraw()
    {
        prompts.answers.clear();
        prompts.answers.push_back(ui::ScriptedPrompter::choose(5));
        const std::string shown = menuCommand([this] { return window()->mnuRedraw; });
        if (!shown.empty()) return shown;
        if (modMain::chart().ChartHeader() != "Quote Type by $Value and Average $Value") return "no redraw";
        return {};
    }
    std::string close()
    {
        prompts.messages.clear();
        if (!window()) return "no window to close";
        window()->close();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
        if (window()) return "the window is still there";
        if (modMain::goChart) return "closing did not release the shared objects";
        return prompts.messages.empty() ? std::string() : prompts.messages.back();
    }

    // ---- support ------------------------------------------------------------------------------

    ui::frmChart* window() const { return qt_->chartWindow(); }
    void closeWindow()
    {
        FaultPlan::clear();
        if (ui::frmChart* w = window()) w->close();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
        prompts.messages.clear();
    }
    // A menu command as the user gives it; a failure comes back as the message box it shows.
    std::string menuCommand(const std::function<QAction*()>& action)
    {
        prompts.messages.clear();
        if (!window()) return "no window";
        action()->trigger();
        return prompts.messages.empty() ? std::string() : prompts.messages.back();
    }
    std::string runCommand() { return (this->*GetParam().run)(); }
    void prepareCommand() { (this->*GetParam().prepare)(); }

    std::shared_ptr<ui::QtUi> qt_ = std::make_shared<ui::QtUi>();
    Variant form_;
    QString settingsFile_;
    QString pdf_;
};

const WindowCommand kCommands[] = {
    {"RequestLoadsTheWindow", &WindowWalk::noChart, &WindowWalk::hourlyRequest, true, false, false},
    {"StyleDialogOk", &WindowWalk::hourlyShown, &WindowWalk::styleDialogOk, true, true, false},
    {"Print", &WindowWalk::hourlyShown, &WindowWalk::print, true, false, true},
    {"Redraw", &WindowWalk::bookingsShown, &WindowWalk::redraw, true, false, false},
    {"Close", &WindowWalk::hourlyShown, &WindowWalk::close, false, true, false},
};

TEST_P(WindowWalk, EveryFailurePointIsReportedAndLeavesAWorkingComponent)
{
    const WindowCommand& command = GetParam();
    std::vector<test::FailurePoint> points =
        test::countFailurePoints([this] { prepareCommand(); }, [this] { return runCommand(); });
    if (command.prints) points.push_back(kPrinterFails);
    if (command.writesSettings) points.push_back(kDiskFull);
    ASSERT_FALSE(points.empty());

    test::WalkReport report;
    for (const test::FailurePoint& p : points) {
        ++report.points;
        prepareCommand();
        if (HasFatalFailure()) return;
        const QByteArray settingsBefore = test::fileBytes(settingsFile_);
        const QStringList folderBefore = test::filesBeside(settingsFile_);
        std::string failure;
        std::string expected = p.injectedText();
        if (p.operation == kPrinterFails.operation) {
            const std::string missing = dir.filePath("missing/folder/print.pdf").toStdString();
            services->printToPdf = missing;
            failure = runCommand();
            services->printToPdf = pdf_.toStdString();
            expected = "Printer error: cannot print to the PDF file " + missing;
        } else if (p.operation == kDiskFull.operation) {
            {
                DiskFull full(settingsFile_);
                failure = runCommand();
            }
            expected = "The settings file \"" + settingsFile_.toStdString() + "\" cannot be written";
        } else {
            FaultPlan::failOn(p.operation, p.call);
            failure = runCommand();
            FaultPlan::clear();
        }

        if (failure.find(expected) == std::string::npos)
            report.add(p, "reported \"" + failure + "\", not \"" + expected + "\"");
        if (qt_->mousePointer() != kPointerDefault) report.add(p, "the mouse pointer stays an hourglass");
        const std::string damage = test::settingsDamage(settingsFile_, settingsBefore, folderBefore);
        if (!damage.empty()) report.add(p, damage);

        if (command.retryInPlace) {
            const std::string retry = runCommand();
            if (!retry.empty()) report.add(p, "the command fails when given again: " + retry);
        }
        Args none{form_};
        graph->invoke(KG_DISPID_SOURCEFORM, kPropertyPut, none);
        const std::string next = hourlyRequest();
        if (!next.empty()) report.add(p, "the next request fails: " + next);
        if (qt_->mousePointer() != kPointerDefault) report.add(p, "the next request leaves the hourglass");
    }
    std::printf("[   walk   ] %s: %zu failure point%s walked\n", command.name, report.points, report.points == 1 ? "" : "s");
    EXPECT_TRUE(report.problems.empty()) << report.summary();
}

INSTANTIATE_TEST_SUITE_P(Commands, WindowWalk, ::testing::ValuesIn(kCommands),
                         [](const auto& info) { return std::string(info.param.name); });

}  // namespace
}  // namespace kg
