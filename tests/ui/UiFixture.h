#pragma once
// Window tests: the test stand's host objects on a temporary settings file (RequestFixture),
// GraphInitialize run directly, a chart object bound to the headless window's control, and the
// scripted prompter answering the modal dialogs.
#include <optional>
#include <string>

#include "chart/ChartStyle.h"
#include "teststand/FaultPlan.h"
#include "teststand/SettingsFile.h"
#include "support/RequestFixture.h"
#include "ui/UiSupport.h"
#include "ui/Prompter.h"

namespace kg::test {

struct UiFixture : RequestFixture {
    void SetUp() override
    {
        RequestFixture::SetUp();
        modMain::GraphInitialize();
        modMain::chart().Initialize(&modMain::chartWindow().Chart1(), "Header", "", "", "");
    }
    void TearDown() override
    {
        teststand::FaultPlan::clear();
        RequestFixture::TearDown();
    }

    // What the settings file holds for a key of the chart style, read from disk; nothing when
    // the key was never written.
    std::optional<std::string> storedStyle(const std::string& key) const
    {
        return settingsFile().read(std::string("Tavix/") + chartstyle::kSection + "/" + key);
    }
    // A window placement value, "FormState/<window key>/<member>".
    std::optional<std::string> storedPlacement(const std::string& windowKey, const std::string& member) const
    {
        return settingsFile().read("FormState/" + windowKey + "/" + member);
    }
    teststand::SettingsFile settingsFile() const
    {
        return teststand::SettingsFile(standConfig.settingsFile);
    }
};

}  // namespace kg::test
