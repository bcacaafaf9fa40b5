#pragma once
// End-to-end request tests: a cTavixGraph driven through its dispatch ids, the test stand's host
// objects on a temporary settings file, a form from JSON text, the headless chart window, and the
// scripted prompter that records message boxes and answers the data choice dialogs.
#include <gtest/gtest.h>

#include <QDir>
#include <QTemporaryDir>
#include <string>

#include "requests/Services.h"
#include "requests/cTavixGraph.h"
#include "requests/modMain.h"
#include "core/Error.h"
#include "teststand/TestStand.h"
#include "ui/Prompter.h"

namespace kg::test {

// The test stand on files in `dir`: its settings file and its application folder.
inline teststand::Config standIn(const QTemporaryDir& dir)
{
    teststand::Config cfg;
    cfg.settingsFile = dir.filePath("settings.ini").toStdString();
    cfg.appFolder = dir.path().toStdString();
    return cfg;
}

// Headless windows, a scripted prompter and the test stand made with `stand`.
inline Services scriptedServices(const teststand::Config& stand)
{
    Services s;
    s.prompter = std::make_shared<ui::ScriptedPrompter>();
    s.hostObjects = teststand::makeFactory(stand);
    return s;
}

struct RequestFixture : ::testing::Test {
    QTemporaryDir dir;
    teststand::Config standConfig = standIn(dir);
    ScopedServices services{scriptedServices(standConfig)};
    ui::ScriptedPrompter& prompts = static_cast<ui::ScriptedPrompter&>(*services->prompter);
    Ref<cTavixGraph> graph = makeRef<cTavixGraph>();

    void SetUp() override
    {
        modMain::releaseSharedObjects();
        modMain::gvSourceForm = Variant();
        modMain::giChartKind = 0;
    }
    void TearDown() override
    {
        modMain::releaseSharedObjects();
        modMain::gvSourceForm = Variant();
    }

    // Host objects created from now on read `standConfig` as it is now.
    void standChanged() { services->hostObjects = teststand::makeFactory(standConfig); }
    int mousePointer() const { return kg::services().windows->mousePointer(); }

    void writeSetting(const std::string& key, const std::string& value)
    {
        Args a{Variant("2dCharts"), Variant(key), Variant(value), Variant("Tavix"), Variant(std::string())};
        Ref<Object> settings = services->hostObjects->create(host::HostClass::Settings);
        call(Variant(settings), "WriteSetting", a);
    }
    void setForm(const std::string& json)
    {
        Args a{Variant(teststand::loadFormJson(json, "test form"))};
        graph->invoke(KG_DISPID_SOURCEFORM, kPropertyPut, a);
    }
    // Invokes by dispatch id; returns the error number (0 on success).
    int32_t request(DispId id, Args args = {})
    {
        try {
            graph->invoke(id, kMethod, args);
            return 0;
        } catch (const Error& e) {
            lastError = e.description();
            return e.number();
        }
    }
    control::ChartControl& chart1() { return modMain::gfChart->Chart1(); }
    std::string lastError;
};

// A grid as JSON: `fixedRows` caption rows, then data rows "Row k" with values k*10 + column.
inline std::string gridJson(int fixedRows, int dataRows, int cols)
{
    std::string s = "{\"fixedRows\": " + std::to_string(fixedRows) + ", \"cells\": [";
    for (int r = 0; r < fixedRows + dataRows; ++r) {
        s += r ? ", [" : "[";
        for (int c = 0; c < cols; ++c) {
            std::string cell;
            if (r < fixedRows)
                cell = "\"" + (c == 0 ? std::string("") : r == 0 ? "C" + std::to_string(c) : "sub") + "\"";
            else
                cell = c == 0 ? "\"Row " + std::to_string(r - fixedRows + 1) + "\"" : std::to_string((r - fixedRows + 1) * 10 + c);
            s += (c ? ", " : "") + cell;
        }
        s += "]";
    }
    return s + "]}";
}

}  // namespace kg::test
