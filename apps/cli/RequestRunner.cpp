#include "apps/cli/RequestRunner.h"

#include <QApplication>
#include <QWidget>
#include <cstring>

#include "chart/control/render/ChartExport.h"
#include "requests/cTavixGraph.h"
#include "requests/modMain.h"
#include "core/Convert.h"
#include "core/Error.h"
#include "teststand/TestStand.h"
#include "ui/Prompter.h"
#include "ui/QtUi.h"

namespace kg::cli {

namespace {

ui::ScriptedPrompter* g_prompter = nullptr;

const char* gridOf(const std::string& request) { return findOperation(request)->grid; }

}  // namespace

void installOffscreenComponent(const teststand::Config& stand)
{
    ui::installQtUi();
    services().hostObjects = teststand::makeFactory(stand);
    auto prompter = std::make_shared<ui::ScriptedPrompter>();
    g_prompter = prompter.get();
    services().prompter = std::move(prompter);
}

void shutdownComponent()
{
    // A window left open would outlive the application object; close it as a user would
    // (the chart window deletes itself on close).
    for (QWidget* w : QApplication::topLevelWidgets())
        if (w->isWindow() && !w->parentWidget()) w->close();
    modMain::releaseSharedObjects();
    modMain::gvSourceForm = Variant();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
}

bool isRequestName(const std::string& name)
{
    const Operation* op = findOperation(name);
    return op && std::strncmp(op->name, "GenerateChart_", 14) == 0;
}

bool takesGridArguments(const std::string& request)
{
    const Operation* op = findOperation(request);
    return op && op->arguments == ArgumentShape::SeriesAndTotal;
}

bool isMeasureRequest(const std::string& request)
{
    const Operation* op = findOperation(request);
    return op && op->measureChoice;
}

RequestResult runRequest(const Variant& form, const RequestCall& c)
{
    g_prompter->messages.clear();
    g_prompter->answers.clear();
    // The data choice dialog is answered by clicking the real frmChoose's options.
    if (c.choice) g_prompter->answers.push_back(ui::ScriptedPrompter::choose(*c.choice));
    try {
        auto graph = makeRef<cTavixGraph>();
        Args sourceForm{form};
        graph->invoke(operationNamed("SourceForm").id, kPropertyPutRef, sourceForm);
        Args args;
        if (takesGridArguments(c.request)) {
            int32_t series = 0;
            if (c.series) {
                series = *c.series;
            } else {
                const Variant grid = call(form, gridOf(c.request));
                series = toLong(call(grid, "Rows")) - toLong(call(grid, "FixedRows"));
            }
            args = {Variant(series), c.total};
        }
        graph->invoke(graph->idOfName(c.request), kMethod, args);
    } catch (const Error& e) {
        return {Outcome::Failed, "error " + std::to_string(e.number()) + ": " + e.description()};
    }
    if (!g_prompter->messages.empty()) return {Outcome::Message, g_prompter->messages.front()};
    if (c.choice && *c.choice == kChoiceCancelled) return {Outcome::Message, "The data choice was cancelled"};
    if (!modMain::gfChart || !modMain::gfChart->isShown()) return {Outcome::Failed, "no chart was shown"};
    return {Outcome::Drawn, {}};
}

void writeShownChart(const std::string& path, QSize size)
{
    control::exportChart(modMain::chartWindow().Chart1(), path, size);
}

}  // namespace kg::cli
