// The chart style dialog end to end: stored settings in, controls worked through the scripted
// prompter, settings file and goChart out.
#include <QCheckBox>
#include <QGroupBox>
#include <QLabel>
#include <QPushButton>
#include <QRadioButton>
#include <QtTest/QTest>
#include <algorithm>
#include <array>
#include <map>
#include <optional>
#include <sstream>
#include <tuple>

#include "chart/ChartStyle.h"
#include "support/FakeHost.h"
#include "ui/NumericField.h"
#include "ui/frmChartSetup.h"
#include "ui/UiFixture.h"

namespace kg::test {
namespace {

using ui::frmChartSetup;
using ui::NumericField;

using chartstyle::kKeys;
using Stored = std::map<std::string, std::string>;
using StoredAfter = std::array<std::optional<std::string>, 6>;  // by kKeys; nullopt: never written

// View3D, rotation, elevation, depth, chart type, point labels.
using ChartState = std::tuple<bool, int32_t, int32_t, int32_t, int16_t, bool>;

// What the chart holds before each case: no value a dialog would give by default.
const ChartState kBefore{false, 7, 8, 9, 1, true};

// Works the dialog as a user does, step by step: "3d" clicks the box; "rot=-20", "elev=45",
// "depth=0" type into a field ("elev=" empties it); "type=3" and "label=0" click an option; "ok",
// "cancel", "escape" and "close" end the dialog.
void work(frmChartSetup& d, const std::string& script)
{
    static const std::map<std::string, int> kFields = {{"rot", 0}, {"elev", 1}, {"depth", 2}};
    std::istringstream in(script);
    for (std::string step; in >> step;) {
        const size_t eq = step.find('=');
        const std::string what = step.substr(0, eq), value = eq == std::string::npos ? "" : step.substr(eq + 1);
        if (kFields.count(what)) {
            NumericField* field = d.num3D[kFields.at(what)];
            field->setFocus();
            field->selectAll();
            if (value.empty())
                QTest::keyClick(field, Qt::Key_Backspace);
            else
                QTest::keyClicks(field, value.c_str());
        } else if (what == "3d") {
            d.chk3D->click();
        } else if (what == "type") {
            d.optChartType[std::stoi(value)]->click();
        } else if (what == "label") {
            d.optLabel[std::stoi(value)]->click();
        } else if (what == "ok" || what == "cancel") {
            (what == "ok" ? d.Command1 : d.Command2)->click();
        } else if (what == "escape") {
            QTest::keyClick(&d, Qt::Key_Escape);
        } else if (what == "close") {
            d.close();
        } else {
            ADD_FAILURE() << "no such step: " << step;
        }
    }
}

struct SetupFixture : UiFixture {
    void SetUp() override
    {
        UiFixture::SetUp();
        c2dChart& chart = modMain::chart();
        chart.setView3D(std::get<0>(kBefore));
        chart.setRotation(std::get<1>(kBefore));
        chart.setElevation(std::get<2>(kBefore));
        chart.setDepth(std::get<3>(kBefore));
        chart.setChartType(std::get<4>(kBefore));
        chart.setPointLabels(std::get<5>(kBefore));
    }
    void store(const Stored& stored)
    {
        for (const auto& [key, value] : stored) writeSetting(key, value);
    }
    // The next dialog is worked through `script`.
    void answer(std::string script)
    {
        prompts.answers.push_back([script](QDialog& d) { work(dynamic_cast<frmChartSetup&>(d), script); });
    }
    StoredAfter storedAfter() const
    {
        StoredAfter after;
        for (size_t i = 0; i < kKeys.size(); ++i) after[i] = storedStyle(kKeys[i].name);
        return after;
    }
    static ChartState chartState()
    {
        const c2dChart& c = modMain::chart();
        return {c2dChart::View3D(), c.Rotation(), c.Elevation(), c.Depth(), c.ChartType(), c.PointLabels()};
    }
};

// ---- Round trip: stored -> dialog -> OK or Cancel -> stored and goChart -------------------------

struct RoundTripCase {
    const char* name;
    Stored before;
    const char* script;  // ends by closing the dialog
    StoredAfter after;
    ChartState chart;
};

const RoundTripCase kRoundTrips[] = {
    {"NothingStoredOk", {}, "ok", {" 1", " 10", " 10", " 10", "Bar", "0"}, {true, 10, 10, 10, 2, false}},
    {"EveryControlChangedOk", {}, "rot=-20 elev=45 depth=0 type=3 label=0 ok",
     {" 1", "-20", " 45", " 0", "Pie", "1"}, {true, -20, 45, 0, 3, true}},
    {"ThreeDClearedKeepsAnglesStored", {{"Rotation", " 30"}}, "3d ok", {" 0", " 30", " 10", " 10", "Bar", "0"},
     {false, 0, 0, 0, 2, false}},
    {"StoredOffTickedAgainBringsAnglesBack", {{"View3D", " 0"}, {"Rotation", "-5"}}, "3d ok",
     {" 1", "-5", " 10", " 10", "Bar", "0"}, {true, -5, 10, 10, 2, false}},
    {"BeyondLimitsStoredClampedOnOk", {{"Rotation", "99"}, {"Elevation", "-99"}, {"Depth", "1E999"}}, "ok",
     {" 1", " 45", "-45", " 45", "Bar", "0"}, {true, 45, -45, 45, 2, false}},
    {"TextWithoutNumberReadsZero", {{"View3D", "abc"}, {"Rotation", "abc"}, {"Depth", ""}}, "ok",
     {" 0", " 0", " 10", " 0", "Bar", "0"}, {false, 0, 0, 0, 2, false}},
    {"View3DTooLargeLeavesBoxTicked", {{"View3D", "40000"}, {"Rotation", " 3"}}, "ok",
     {" 1", " 3", " 10", " 10", "Bar", "0"}, {true, 3, 10, 10, 2, false}},
    {"StyleInOtherCaseKeepsBar", {{"Style", "pie"}, {"LabelsOnDefault", "yes"}}, "ok",
     {" 1", " 10", " 10", " 10", "Bar", "0"}, {true, 10, 10, 10, 2, false}},
    {"StoredAreaLabelsOn", {{"Style", "Area"}, {"LabelsOnDefault", "1"}}, "ok",
     {" 1", " 10", " 10", " 10", "Area", "1"}, {true, 10, 10, 10, 5, true}},
    {"StoredPlot", {{"Style", "Plot"}}, "ok", {" 1", " 10", " 10", " 10", "Plot", "0"}, {true, 10, 10, 10, 1, false}},
    {"StoredPieChangedToBarLabelsOff", {{"Style", "Pie"}, {"LabelsOnDefault", "1"}}, "type=1 label=1 ok",
     {" 1", " 10", " 10", " 10", "Bar", "0"}, {true, 10, 10, 10, 2, false}},
    {"EmptiedFieldStoredEmptyChartGetsZero", {}, "elev= ok", {" 1", " 10", "", " 10", "Bar", "0"},
     {true, 10, 0, 10, 2, false}},
    {"SwitchedOffFieldTakesNoTypingAndKeepsItsValue", {{"View3D", " 0"}, {"Elevation", " 12"}}, "rot=33 ok",
     {" 0", " 10", " 12", " 10", "Bar", "0"}, {false, 0, 0, 0, 2, false}},
    {"CancelAfterChangingEverything",
     {{"View3D", " 0"}, {"Rotation", " 5"}, {"Style", "Area"}, {"LabelsOnDefault", "1"}},
     "3d rot=-7 elev=30 type=3 label=1 cancel", {" 0", " 5", std::nullopt, std::nullopt, "Area", "1"}, kBefore},
};

struct RoundTrip : SetupFixture, ::testing::WithParamInterface<RoundTripCase> {};

TEST_P(RoundTrip, StoresAndAppliesTheChoice)
{
    const RoundTripCase& c = GetParam();
    store(c.before);
    answer(c.script);
    ui::showChartSetup();
    ASSERT_EQ(prompts.dialogsShown, std::vector<std::string>{"frmChartSetup"});
    const StoredAfter after = storedAfter();
    for (size_t i = 0; i < kKeys.size(); ++i) EXPECT_EQ(after[i], c.after[i]) << kKeys[i].name;
    EXPECT_EQ(chartState(), c.chart);
}

INSTANTIATE_TEST_SUITE_P(ChartSetup, RoundTrip, ::testing::ValuesIn(kRoundTrips), byName);

// ---- What the dialog shows when it opens -------------------------------------------------------

struct LoadCase {
    const char* name;
    Stored stored;
    bool threeD;  // the box ticked and the fields on
    std::array<const char*, 3> fields;
    int chartType;  // optChartType index
    int label;      // optLabel index
};

const LoadCase kLoads[] = {
    {"NothingStored", {}, true, {"10", "10", "10"}, 1, 1},
    {"StoredOffSwitchesFieldsOff", {{"View3D", " 0"}}, false, {"10", "10", "10"}, 1, 1},
    {"View3DHalfRoundsToEvenZero", {{"View3D", "0.5"}}, false, {"10", "10", "10"}, 1, 1},
    {"View3DMinusOneLeftAsDesigned", {{"View3D", "-1"}}, true, {"10", "10", "10"}, 1, 1},
    {"StylePie", {{"Style", "Pie"}}, true, {"10", "10", "10"}, 3, 1},
    {"StyleWithBlankLeftAsDesigned", {{"Style", " Pie"}}, true, {"10", "10", "10"}, 1, 1},
};

struct Load : SetupFixture, ::testing::WithParamInterface<LoadCase> {};

TEST_P(Load, ShowsTheStoredStyle)
{
    const LoadCase& c = GetParam();
    store(c.stored);
    frmChartSetup d;
    EXPECT_EQ(d.chk3D->isChecked(), c.threeD);
    for (int i = 0; i < 3; ++i) {
        EXPECT_EQ(d.num3D[i]->isEnabled(), c.threeD) << i;
        EXPECT_EQ(d.num3D[i]->text().toStdString(), c.fields[size_t(i)]) << i;
    }
    // The labels stay as they are when the fields are switched off.
    EXPECT_TRUE(d.Label1->isEnabled() && d.Label2->isEnabled() && d.Label3->isEnabled());
    for (int i = 0; i < 4; ++i) EXPECT_EQ(d.optChartType[i]->isChecked(), i == c.chartType) << i;
    for (int i = 0; i < 2; ++i) EXPECT_EQ(d.optLabel[i]->isChecked(), i == c.label) << i;
}

INSTANTIATE_TEST_SUITE_P(ChartSetup, Load, ::testing::ValuesIn(kLoads), byName);

// ---- The design ----------------------------------------------------------------------------------

TEST_F(SetupFixture, ControlsAreNamedAndCaptionedAsDesigned)
{
    frmChartSetup d;
    EXPECT_EQ(d.objectName(), "frmChartSetup");
    EXPECT_EQ(d.windowTitle(), "Select Chart Styles");
    EXPECT_EQ(d.size(), QSize(376, 227));  // 5640 x 3405 twips

    const std::pair<QWidget*, const char*> named[] = {
        {d.Frame1, "Frame1"},   {d.chk3D, "chk3D"},           {d.num3D[0], "num3D_0"},
        {d.num3D[1], "num3D_1"}, {d.num3D[2], "num3D_2"},       {d.Label1, "Label1"},
        {d.Label2, "Label2"},   {d.Label3, "Label3"},         {d.Frame2, "Frame2"},
        {d.optChartType[0], "optChartType_0"}, {d.optChartType[3], "optChartType_3"},
        {d.optLabel[0], "optLabel_0"},         {d.optLabel[1], "optLabel_1"},
        {d.Label4, "Label4"},   {d.Command1, "Command1"},     {d.Command2, "Command2"},
    };
    for (const auto& [widget, name] : named) {
        ASSERT_NE(widget, nullptr) << name;
        EXPECT_EQ(d.findChild<QWidget*>(name), widget) << name;
    }
    EXPECT_EQ(d.Label4->text(), "Note:  Use the Advanced Help file for all chart features");
    EXPECT_EQ(d.chk3D->text(), "Show 3D Chart");
    EXPECT_EQ(d.optLabel[0]->text(), "Default - Labels ON");
    EXPECT_EQ(d.optLabel[1]->text(), "Default - Labels OFF");
    EXPECT_EQ(d.Command1->text(), "OK");
    EXPECT_EQ(d.Command2->text(), "Cancel");
    EXPECT_EQ(d.Label1->text(), "Rotation");
    EXPECT_EQ(d.Label2->text(), "Elevation");
    EXPECT_EQ(d.Label3->text(), "Depth");
}

TEST_F(SetupFixture, ClearingTheBoxSwitchesTheFieldsOffAndTickingOn)
{
    frmChartSetup d;
    d.chk3D->click();
    for (NumericField* f : d.num3D) EXPECT_FALSE(f->isEnabled());
    d.chk3D->click();
    for (NumericField* f : d.num3D) EXPECT_TRUE(f->isEnabled());
}

// ---- Calls to the host, in order -----------------------------------------------------------------

// Host objects in memory in place of the test stand's, recording what they are asked.
struct HostCallsFixture : SetupFixture {
    Ref<FakeAppServices> services = makeRef<FakeAppServices>();
    Ref<FakeSettings> settings = makeRef<FakeSettings>();
    void SetUp() override
    {
        SetupFixture::SetUp();
        modMain::goAppServices = Variant(services);
        modMain::goSettings = Variant(settings);
    }
    int ownersAsked() const
    {
        return int(std::count(services->calls.begin(), services->calls.end(), "GetSettingsOwner"));
    }
};

// Records every call of the application services and the settings store in one list; the owner
// text changes with every GetSettingsOwner, so a read with a stale owner shows.
struct CallLog {
    std::vector<std::string> lines;
    int owners = 0;
};

// A host object whose every call goes to `handle`.
class Recorder : public TableObject {
public:
    Recorder(std::string name, std::vector<MemberInfo> members, std::function<void(DispId, Args&)> handle)
        : name_(std::move(name)), members_(std::move(members)), handle_(std::move(handle))
    {
    }
    Variant invoke(DispId id, uint16_t, Args& args) override
    {
        handle_(id, args);
        return {};
    }
    std::string objectName() const override { return name_; }

protected:
    const std::vector<MemberInfo>& members() const override { return members_; }

private:
    std::string name_;
    std::vector<MemberInfo> members_;
    std::function<void(DispId, Args&)> handle_;
};

// Puts recorders in place of the application services and the settings store.
void recordHostCalls(CallLog& log)
{
    modMain::goAppServices = Variant(makeRef<Recorder>(
        "goAppServices", std::vector<MemberInfo>{{"GetSettingsOwner", 1}, {"LogFormEvent", 2}},
        [&log](DispId id, Args& args) {
            if (id == 1)
                args.at(0) = Variant("owner" + std::to_string(++log.owners));
            else
                log.lines.push_back("LogFormEvent " + toText(args.at(0)) + " " + toText(args.at(1)));
        }));
    modMain::goSettings = Variant(makeRef<Recorder>(
        "goSettings", std::vector<MemberInfo>{{"ReadSetting", 1}, {"WriteSetting", 2}}, [&log](DispId id, Args& args) {
            const std::string where = toText(args.at(0)) + "\\" + toText(args.at(1));
            if (id == 1) {
                log.lines.push_back("Read " + where + " default " + toText(args.at(2)) + " by " + toText(args.at(3)));
                args.at(4) = args.at(2);
            } else {
                log.lines.push_back("Write " + where + "=[" + toText(args.at(2)) + "] by " + toText(args.at(3)));
            }
        }));
}

TEST_F(SetupFixture, LoadAndOkCallTheHostInOrderWithAFreshOwnerEachTime)
{
    CallLog log;
    recordHostCalls(log);
    answer("ok");
    ui::showChartSetup();
    const std::vector<std::string> expected = {
        "LogFormEvent FormLoad frmChartSetup",
        "Read 2dCharts\\View3D default 1 by owner1",
        "Read 2dCharts\\Rotation default 10 by owner2",
        "Read 2dCharts\\Elevation default 10 by owner3",
        "Read 2dCharts\\Depth default 10 by owner4",
        "Read 2dCharts\\Style default Bar by owner5",
        "Read 2dCharts\\LabelsOnDefault default 0 by owner6",
        "Write 2dCharts\\View3D=[ 1] by owner7",
        "Write 2dCharts\\Rotation=[ 10] by owner8",
        "Write 2dCharts\\Elevation=[ 10] by owner9",
        "Write 2dCharts\\Depth=[ 10] by owner10",
        "Write 2dCharts\\Style=[Bar] by owner11",
        "Write 2dCharts\\LabelsOnDefault=[0] by owner12",
        "LogFormEvent FormQueryUnload frmChartSetup",
    };
    EXPECT_EQ(log.lines, expected);
}

struct CloseCase {
    const char* name;
    const char* script;  // null: the dialog is left unanswered
    bool writes;
};

const CloseCase kCloses[] = {
    {"Ok", "type=0 ok", true},
    {"Cancel", "type=0 3d cancel", false},
    {"Escape", "type=0 escape", false},
    {"TitleBar", "type=0 close", false},
    {"NoAnswer", nullptr, false},
};

struct Close : HostCallsFixture, ::testing::WithParamInterface<CloseCase> {};

TEST_P(Close, ReportsTheUnloadOnceAndAppliesOnlyOk)
{
    if (GetParam().script) answer(GetParam().script);
    ui::showChartSetup();
    EXPECT_EQ(services->events.back(), "FormQueryUnload|frmChartSetup");
    EXPECT_EQ(std::count(services->events.begin(), services->events.end(), "FormQueryUnload|frmChartSetup"), 1);
    EXPECT_EQ(settings->values.size(), GetParam().writes ? 6u : 0u);
    EXPECT_EQ(chartState() == kBefore, !GetParam().writes) << ::testing::PrintToString(chartState());
}

INSTANTIATE_TEST_SUITE_P(ChartSetup, Close, ::testing::ValuesIn(kCloses), byName);

// ---- Failures of the host ------------------------------------------------------------------------

TEST_F(SetupFixture, FailingWriteEndsOkAndLeavesShowChartSetupWithTheError)
{
    teststand::FaultPlan::failOn("Settings.WriteSetting", 3);  // Elevation
    bool stillOpen = true;
    prompts.answers.push_back([&](QDialog& d) {
        work(dynamic_cast<frmChartSetup&>(d), "3d ok");
        stillOpen = d.isVisible();
    });
    EXPECT_EQ(errorNumberOf(ui::showChartSetup), errc::HostBase + teststand::hosterr::Injected);
    EXPECT_FALSE(stillOpen);
    // What was stored before the failure stays; nothing after it is stored or applied.
    EXPECT_EQ(storedStyle("View3D"), " 0");
    EXPECT_EQ(storedStyle("Rotation"), " 10");
    EXPECT_EQ(storedStyle("Elevation"), std::nullopt);
    EXPECT_EQ(storedStyle("Style"), std::nullopt);
    EXPECT_EQ(chartState(), kBefore);
}

TEST_F(SetupFixture, OkWithoutChartObjectStoresThenFailsWithError91)
{
    modMain::goChart.reset();
    answer("ok");
    EXPECT_EQ(errorNumberOf(ui::showChartSetup), errc::ObjectNotSet);
    EXPECT_EQ(storedStyle("LabelsOnDefault"), "0");
}

}  // namespace
}  // namespace kg::test
