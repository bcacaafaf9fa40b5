// The chart style dialog end to end: stored settings in, controls worked through the scripted
// prompter, settings file and goChart out.
#include <QCheckBox>
#include <QGroupBox>
#include <QLabel>
#include <QPushButton>
#include <QRadioButton>
#include <QtTest/QTest>
#include <array>
#include <functional>
#include <map>
#include <optional>
#include <ostream>

#include "core/Convert.h"
#include "ui/NumericField.h"
#include "ui/frmChartSetup.h"
#include "ui/UiFixture.h"

namespace kg::test {
namespace {

using ui::frmChartSetup;
using ui::NumericField;

constexpr std::array<const char*, 6> kKeys = {"View3D", "Rotation", "Elevation", "Depth", "Style", "LabelsOnDefault"};
using Stored = std::map<std::string, std::string>;
using StoredAfter = std::array<std::optional<std::string>, 6>;  // by kKeys; nullopt: never written

struct ChartState {
    bool view3D;
    int32_t rotation, elevation, depth;
    int16_t chartType;
    bool pointLabels;
    bool operator==(const ChartState& o) const
    {
        return view3D == o.view3D && rotation == o.rotation && elevation == o.elevation && depth == o.depth &&
               chartType == o.chartType && pointLabels == o.pointLabels;
    }
};
std::ostream& operator<<(std::ostream& os, const ChartState& s)
{
    return os << "{view3D " << s.view3D << ", " << s.rotation << "/" << s.elevation << "/" << s.depth << ", type "
              << s.chartType << ", labels " << s.pointLabels << "}";
}

// What the chart holds before each case: no value a dialog would give by default.
constexpr ChartState kBefore{false, 7, 8, 9, 1, true};

void typeInto(NumericField* field, const char* text)
{
    field->setFocus();
    field->selectAll();
    QTest::keyClicks(field, text);
}

void clearField(NumericField* field)
{
    field->selectAll();
    QTest::keyClick(field, Qt::Key_Backspace);
}

void ok(frmChartSetup& d) { d.Command1->click(); }
void cancel(frmChartSetup& d) { d.Command2->click(); }

struct SetupFixture : UiFixture {
    void SetUp() override
    {
        UiFixture::SetUp();
        c2dChart& chart = modMain::chart();
        chart.setView3D(kBefore.view3D);
        chart.setRotation(kBefore.rotation);
        chart.setElevation(kBefore.elevation);
        chart.setDepth(kBefore.depth);
        chart.setChartType(kBefore.chartType);
        chart.setPointLabels(kBefore.pointLabels);
    }
    void store(const Stored& stored)
    {
        for (const auto& [key, value] : stored) writeSetting(key, value);
    }
    void answer(std::function<void(frmChartSetup&)> work)
    {
        prompts->answers.push_back([work](QDialog& d) { work(dynamic_cast<frmChartSetup&>(d)); });
    }
    StoredAfter storedAfter() const
    {
        StoredAfter after;
        for (size_t i = 0; i < kKeys.size(); ++i) after[i] = storedStyle(kKeys[i]);
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
    std::function<void(frmChartSetup&)> work;  // ends by closing the dialog
    StoredAfter after;
    ChartState chart;
};
void PrintTo(const RoundTripCase& c, std::ostream* os) { *os << c.name; }

const RoundTripCase kRoundTrips[] = {
    {"NothingStoredOk", {}, ok, {" 1", " 10", " 10", " 10", "Bar", "0"}, {true, 10, 10, 10, 2, false}},
    {"EveryControlChangedOk",
     {},
     [](frmChartSetup& d) {
         typeInto(d.num3D[0], "-20");
         typeInto(d.num3D[1], "45");
         typeInto(d.num3D[2], "0");
         d.optChartType[3]->click();
         d.optLabel[0]->click();
         ok(d);
     },
     {" 1", "-20", " 45", " 0", "Pie", "1"},
     {true, -20, 45, 0, 3, true}},
    {"ThreeDClearedKeepsAnglesStored",
     {{"Rotation", " 30"}},
     [](frmChartSetup& d) {
         d.chk3D->click();
         ok(d);
     },
     {" 0", " 30", " 10", " 10", "Bar", "0"},
     {false, 0, 0, 0, 2, false}},
    {"StoredOffTickedAgainBringsAnglesBack",
     {{"View3D", " 0"}, {"Rotation", "-5"}},
     [](frmChartSetup& d) {
         d.chk3D->click();
         ok(d);
     },
     {" 1", "-5", " 10", " 10", "Bar", "0"},
     {true, -5, 10, 10, 2, false}},
    {"StoredOffUnchanged", {{"View3D", " 0"}, {"Elevation", " 12"}}, ok,
     {" 0", " 10", " 12", " 10", "Bar", "0"}, {false, 0, 0, 0, 2, false}},
    {"BeyondLimitsStoredClampedOnOk", {{"Rotation", "99"}, {"Elevation", "-99"}, {"Depth", "1E999"}}, ok,
     {" 1", " 45", "-45", " 45", "Bar", "0"}, {true, 45, -45, 45, 2, false}},
    {"TextWithoutNumberReadsZero", {{"View3D", "abc"}, {"Rotation", "abc"}, {"Depth", ""}}, ok,
     {" 0", " 0", " 10", " 0", "Bar", "0"}, {false, 0, 0, 0, 2, false}},
    {"LeadingNumberReadAndRounded", {{"Rotation", " 12abc"}, {"Elevation", "10.6"}, {"Depth", "-10.5"}}, ok,
     {" 1", " 12", " 11", "-11", "Bar", "0"}, {true, 12, 11, -11, 2, false}},
    {"View3DTwoLeavesBoxTicked", {{"View3D", "2"}}, ok, {" 1", " 10", " 10", " 10", "Bar", "0"},
     {true, 10, 10, 10, 2, false}},
    {"View3DTooLargeLeavesBoxTicked", {{"View3D", "40000"}, {"Rotation", " 3"}}, ok,
     {" 1", " 3", " 10", " 10", "Bar", "0"}, {true, 3, 10, 10, 2, false}},
    {"StyleInOtherCaseKeepsBar", {{"Style", "pie"}, {"LabelsOnDefault", "yes"}}, ok,
     {" 1", " 10", " 10", " 10", "Bar", "0"}, {true, 10, 10, 10, 2, false}},
    {"StoredAreaLabelsOn", {{"Style", "Area"}, {"LabelsOnDefault", "1"}}, ok,
     {" 1", " 10", " 10", " 10", "Area", "1"}, {true, 10, 10, 10, 5, true}},
    {"StoredPlot", {{"Style", "Plot"}}, ok, {" 1", " 10", " 10", " 10", "Plot", "0"}, {true, 10, 10, 10, 1, false}},
    {"StoredPieChangedToBarLabelsOff",
     {{"Style", "Pie"}, {"LabelsOnDefault", "1"}},
     [](frmChartSetup& d) {
         d.optChartType[1]->click();
         d.optLabel[1]->click();
         ok(d);
     },
     {" 1", " 10", " 10", " 10", "Bar", "0"},
     {true, 10, 10, 10, 2, false}},
    {"EmptiedFieldStoredEmptyChartGetsZero",
     {},
     [](frmChartSetup& d) {
         clearField(d.num3D[1]);
         ok(d);
     },
     {" 1", " 10", "", " 10", "Bar", "0"},
     {true, 10, 0, 10, 2, false}},
    {"TypedBeyondLimitStopsAtLastValidDigit",
     {},
     [](frmChartSetup& d) {
         typeInto(d.num3D[0], "46");
         typeInto(d.num3D[2], "-450");
         ok(d);
     },
     {" 1", " 4", " 10", "-45", "Bar", "0"},
     {true, 4, 10, -45, 2, false}},
    {"SwitchedOffFieldTakesNoTyping",
     {{"View3D", " 0"}},
     [](frmChartSetup& d) {
         typeInto(d.num3D[0], "33");
         ok(d);
     },
     {" 0", " 10", " 10", " 10", "Bar", "0"},
     {false, 0, 0, 0, 2, false}},
    {"CancelAfterChangingEverything",
     {{"View3D", " 0"}, {"Rotation", " 5"}, {"Style", "Area"}, {"LabelsOnDefault", "1"}},
     [](frmChartSetup& d) {
         d.chk3D->click();
         typeInto(d.num3D[0], "-7");
         typeInto(d.num3D[1], "30");
         d.optChartType[3]->click();
         d.optLabel[1]->click();
         cancel(d);
     },
     {" 0", " 5", std::nullopt, std::nullopt, "Area", "1"},
     kBefore},
    {"EscapeCancels",
     {},
     [](frmChartSetup& d) {
         d.optChartType[0]->click();
         QTest::keyClick(&d, Qt::Key_Escape);
     },
     {std::nullopt, std::nullopt, std::nullopt, std::nullopt, std::nullopt, std::nullopt},
     kBefore},
    {"TitleBarCloseStoresNothing",
     {{"Style", "Pie"}},
     [](frmChartSetup& d) {
         d.optChartType[0]->click();
         d.close();
     },
     {std::nullopt, std::nullopt, std::nullopt, std::nullopt, "Pie", std::nullopt},
     kBefore},
};

struct RoundTrip : SetupFixture, ::testing::WithParamInterface<RoundTripCase> {};

TEST_P(RoundTrip, StoresAndAppliesTheChoice)
{
    const RoundTripCase& c = GetParam();
    store(c.before);
    answer(c.work);
    ui::showChartSetup();
    ASSERT_EQ(prompts->dialogsShown, std::vector<std::string>{"frmChartSetup"});
    const StoredAfter after = storedAfter();
    for (size_t i = 0; i < kKeys.size(); ++i) EXPECT_EQ(after[i], c.after[i]) << kKeys[i];
    EXPECT_EQ(chartState(), c.chart);
}

INSTANTIATE_TEST_SUITE_P(ChartSetup, RoundTrip, ::testing::ValuesIn(kRoundTrips),
                         [](const auto& info) { return std::string(info.param.name); });

// ---- What the dialog shows when it opens -------------------------------------------------------

struct Shown {
    bool ticked;
    bool fieldsOn;
    std::array<const char*, 3> fields;
    int chartType;  // optChartType index
    int label;      // optLabel index
};

struct LoadCase {
    const char* name;
    Stored stored;
    Shown shown;
};
void PrintTo(const LoadCase& c, std::ostream* os) { *os << c.name; }

const LoadCase kLoads[] = {
    {"NothingStored", {}, {true, true, {"10", "10", "10"}, 1, 1}},
    {"StoredOffSwitchesFieldsOff", {{"View3D", " 0"}}, {false, false, {"10", "10", "10"}, 1, 1}},
    {"StoredOnExplicitly", {{"View3D", "1"}}, {true, true, {"10", "10", "10"}, 1, 1}},
    {"View3DRoundsToOne", {{"View3D", "0.6"}}, {true, true, {"10", "10", "10"}, 1, 1}},
    {"View3DHalfRoundsToEvenZero", {{"View3D", "0.5"}}, {false, false, {"10", "10", "10"}, 1, 1}},
    {"View3DMinusOneLeftAsDesigned", {{"View3D", "-1"}}, {true, true, {"10", "10", "10"}, 1, 1}},
    {"View3DNoNumberIsZero", {{"View3D", "abc"}}, {false, false, {"10", "10", "10"}, 1, 1}},
    {"AnglesClampedToLimits", {{"Rotation", "99"}, {"Elevation", "-46"}, {"Depth", "45"}},
     {true, true, {"45", "-45", "45"}, 1, 1}},
    {"AnglesWithoutNumberReadZero", {{"Rotation", "abc"}, {"Elevation", ""}, {"Depth", "-"}},
     {true, true, {"0", "0", "0"}, 1, 1}},
    {"AnglesShownWhole", {{"Rotation", "2.5"}, {"Elevation", "-2.5"}, {"Depth", "&H1F"}},
     {true, true, {"3", "-3", "31"}, 1, 1}},
    {"StylePlot", {{"Style", "Plot"}}, {true, true, {"10", "10", "10"}, 0, 1}},
    {"StyleArea", {{"Style", "Area"}}, {true, true, {"10", "10", "10"}, 2, 1}},
    {"StylePie", {{"Style", "Pie"}}, {true, true, {"10", "10", "10"}, 3, 1}},
    {"StyleOtherCaseLeftAsDesigned", {{"Style", "PIE"}}, {true, true, {"10", "10", "10"}, 1, 1}},
    {"StyleWithBlankLeftAsDesigned", {{"Style", " Pie"}}, {true, true, {"10", "10", "10"}, 1, 1}},
    {"LabelsOn", {{"LabelsOnDefault", "1"}}, {true, true, {"10", "10", "10"}, 1, 0}},
    {"LabelsNumberTextLeftAsDesigned", {{"LabelsOnDefault", " 1"}}, {true, true, {"10", "10", "10"}, 1, 1}},
};

struct Load : SetupFixture, ::testing::WithParamInterface<LoadCase> {};

TEST_P(Load, ShowsTheStoredStyle)
{
    const LoadCase& c = GetParam();
    store(c.stored);
    frmChartSetup d;
    EXPECT_EQ(d.chk3D->isChecked(), c.shown.ticked);
    for (int i = 0; i < 3; ++i) {
        EXPECT_EQ(d.num3D[i]->isEnabled(), c.shown.fieldsOn) << i;
        EXPECT_EQ(d.num3D[i]->text().toStdString(), c.shown.fields[size_t(i)]) << i;
    }
    // The labels stay as they are when the fields are switched off.
    EXPECT_TRUE(d.Label1->isEnabled() && d.Label2->isEnabled() && d.Label3->isEnabled());
    for (int i = 0; i < 4; ++i) EXPECT_EQ(d.optChartType[i]->isChecked(), i == c.shown.chartType) << i;
    for (int i = 0; i < 2; ++i) EXPECT_EQ(d.optLabel[i]->isChecked(), i == c.shown.label) << i;
}

INSTANTIATE_TEST_SUITE_P(ChartSetup, Load, ::testing::ValuesIn(kLoads),
                         [](const auto& info) { return std::string(info.param.name); });

// ---- The design ----------------------------------------------------------------------------------

TEST_F(SetupFixture, ControlsAreNamedCaptionedAndPlacedAsDesigned)
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
        EXPECT_EQ(widget->objectName(), name);
        EXPECT_EQ(d.findChild<QWidget*>(name), widget) << name;
    }
    EXPECT_EQ(d.Label4->text(), "Note:  Use the Advanced Help file for all chart features");
    EXPECT_EQ(d.chk3D->text(), "Show 3D Chart");
    EXPECT_EQ(d.optLabel[0]->text(), "Default - Labels ON");
    EXPECT_EQ(d.optLabel[1]->text(), "Default - Labels OFF");
    EXPECT_EQ(d.Command1->text(), "OK");
    EXPECT_EQ(d.Command2->text(), "Cancel");

    // The fields and the check box sit in Frame1, the chart types in Frame2.
    EXPECT_EQ(d.chk3D->parentWidget(), d.Frame1);
    EXPECT_EQ(d.num3D[2]->parentWidget(), d.Frame1);
    EXPECT_EQ(d.optChartType[2]->parentWidget(), d.Frame2);
    // Each label to the right of its field, on its row; rows top to bottom below the box.
    QLabel* labels[3] = {d.Label1, d.Label2, d.Label3};
    const char* captions[3] = {"Rotation", "Elevation", "Depth"};
    for (int i = 0; i < 3; ++i) {
        EXPECT_EQ(labels[i]->text(), captions[i]);
        EXPECT_GE(labels[i]->x(), d.num3D[i]->geometry().right());
        EXPECT_EQ(labels[i]->y(), d.num3D[i]->y());
        EXPECT_GT(d.num3D[i]->y(), d.chk3D->geometry().bottom());
        if (i > 0) EXPECT_GT(d.num3D[i]->y(), d.num3D[i - 1]->y());
    }
    // Plot upper left, Bar lower left, Area upper right, Pie lower right.
    EXPECT_EQ(d.optChartType[0]->x(), d.optChartType[1]->x());
    EXPECT_LT(d.optChartType[0]->y(), d.optChartType[1]->y());
    EXPECT_GT(d.optChartType[2]->x(), d.optChartType[0]->x());
    EXPECT_EQ(d.optChartType[2]->y(), d.optChartType[0]->y());
    EXPECT_EQ(d.optChartType[3]->pos(), QPoint(d.optChartType[2]->x(), d.optChartType[1]->y()));
    // Frame1 left, Frame2 right; the label options below Frame2; the buttons bottom right.
    EXPECT_LT(d.Frame1->x(), d.Frame2->x());
    EXPECT_GT(d.optLabel[0]->y(), d.Frame2->geometry().bottom());
    EXPECT_GT(d.optLabel[1]->y(), d.optLabel[0]->y());
    EXPECT_GT(d.Command2->x(), d.Command1->geometry().right());
    EXPECT_GT(d.Command1->x(), d.Label4->x());
}

TEST_F(SetupFixture, ChartTypesAndLabelOptionsAreSeparateExclusiveGroups)
{
    frmChartSetup d;
    d.optChartType[2]->click();
    d.optLabel[0]->click();
    EXPECT_TRUE(d.optChartType[2]->isChecked());
    EXPECT_FALSE(d.optChartType[1]->isChecked());
    EXPECT_TRUE(d.optLabel[0]->isChecked());
    EXPECT_FALSE(d.optLabel[1]->isChecked());
    // Choosing a label option leaves the chart type alone.
    d.optLabel[1]->click();
    EXPECT_TRUE(d.optChartType[2]->isChecked());
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

// Records every call of the application services and the settings store in one list; the owner
// text changes with every GetSettingsOwner, so a read with a stale owner shows.
struct CallLog {
    std::vector<std::string> lines;
    int owners = 0;
};

class RecordingAppServices : public TableObject {
public:
    explicit RecordingAppServices(CallLog& log) : log_(log) {}
    Variant invoke(DispId id, uint16_t, Args& args) override
    {
        if (id == 1) {
            args.at(0) = Variant("owner" + std::to_string(++log_.owners));
        } else {
            log_.lines.push_back("LogFormEvent " + toText(args.at(0)) + " " + toText(args.at(1)));
        }
        return {};
    }
    std::string objectName() const override { return "goAppServices"; }

protected:
    const std::vector<MemberInfo>& members() const override
    {
        static const std::vector<MemberInfo> m = {{"GetSettingsOwner", 1}, {"LogFormEvent", 2}};
        return m;
    }

private:
    CallLog& log_;
};

class RecordingSettings : public TableObject {
public:
    explicit RecordingSettings(CallLog& log) : log_(log) {}
    Variant invoke(DispId id, uint16_t, Args& args) override
    {
        const std::string where = toText(args.at(0)) + "\\" + toText(args.at(1));
        if (id == 1) {
            log_.lines.push_back("Read " + where + " default " + toText(args.at(2)) + " by " + toText(args.at(3)));
            args.at(4) = args.at(2);
        } else {
            log_.lines.push_back("Write " + where + "=[" + toText(args.at(2)) + "] by " + toText(args.at(3)));
        }
        return {};
    }
    std::string objectName() const override { return "goSettings"; }

protected:
    const std::vector<MemberInfo>& members() const override
    {
        static const std::vector<MemberInfo> m = {{"ReadSetting", 1}, {"WriteSetting", 2}};
        return m;
    }

private:
    CallLog& log_;
};

TEST_F(SetupFixture, LoadAndOkCallTheHostInOrderWithAFreshOwnerEachTime)
{
    CallLog log;
    modMain::goAppServices = Variant(makeRef<RecordingAppServices>(log));
    modMain::goSettings = Variant(makeRef<RecordingSettings>(log));
    answer(ok);
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
    std::function<void(frmChartSetup&)> close;
    bool writes;
};
void PrintTo(const CloseCase& c, std::ostream* os) { *os << c.name; }

const CloseCase kCloses[] = {
    {"Ok", ok, true},
    {"Cancel", cancel, false},
    {"Escape", [](frmChartSetup& d) { QTest::keyClick(&d, Qt::Key_Escape); }, false},
    {"TitleBar", [](frmChartSetup& d) { d.close(); }, false},
    {"NoAnswer", nullptr, false},
};

struct Close : SetupFixture, ::testing::WithParamInterface<CloseCase> {};

TEST_P(Close, ReportsTheUnloadOnce)
{
    CallLog log;
    modMain::goAppServices = Variant(makeRef<RecordingAppServices>(log));
    modMain::goSettings = Variant(makeRef<RecordingSettings>(log));
    if (GetParam().close) answer(GetParam().close);
    ui::showChartSetup();
    int unloads = 0, writes = 0;
    for (const std::string& line : log.lines) {
        unloads += line == "LogFormEvent FormQueryUnload frmChartSetup";
        writes += line.rfind("Write ", 0) == 0;
    }
    EXPECT_EQ(unloads, 1);
    EXPECT_EQ(log.lines.back(), "LogFormEvent FormQueryUnload frmChartSetup");
    EXPECT_EQ(writes, GetParam().writes ? 6 : 0);
}

INSTANTIATE_TEST_SUITE_P(ChartSetup, Close, ::testing::ValuesIn(kCloses),
                         [](const auto& info) { return std::string(info.param.name); });

// ---- Failures of the host ------------------------------------------------------------------------

TEST_F(SetupFixture, FailingWriteEndsOkAndLeavesShowChartSetupWithTheError)
{
    host::teststand::FaultPlan::failOn("Settings.WriteSetting", 3);  // Elevation
    bool stillOpen = true;
    answer([&](frmChartSetup& d) {
        d.chk3D->click();
        ok(d);
        stillOpen = d.isVisible();
    });
    try {
        ui::showChartSetup();
        FAIL() << "no error";
    } catch (const Error& e) {
        EXPECT_EQ(e.number(), errc::HostBase + host::teststand::hosterr::Injected);
    }
    EXPECT_FALSE(stillOpen);
    // What was stored before the failure stays; nothing after it is stored or applied.
    EXPECT_EQ(storedStyle("View3D"), " 0");
    EXPECT_EQ(storedStyle("Rotation"), " 10");
    EXPECT_EQ(storedStyle("Elevation"), std::nullopt);
    EXPECT_EQ(storedStyle("Style"), std::nullopt);
    EXPECT_EQ(chartState(), kBefore);
}

TEST_F(SetupFixture, FailingReadEndsTheLoadBeforeTheDialogShows)
{
    host::teststand::FaultPlan::failOn("Settings.ReadSetting", 2);
    EXPECT_THROW(ui::showChartSetup(), Error);
    EXPECT_TRUE(prompts->dialogsShown.empty());
}

TEST_F(SetupFixture, OkWithoutChartObjectStoresThenFailsWithError91)
{
    modMain::goChart.reset();
    answer(ok);
    try {
        ui::showChartSetup();
        FAIL() << "no error";
    } catch (const Error& e) {
        EXPECT_EQ(e.number(), errc::ObjectNotSet);
    }
    EXPECT_EQ(storedStyle("LabelsOnDefault"), "0");
}

// ---- Settings outlast the dialog and the objects -------------------------------------------------

TEST_F(SetupFixture, NextDialogAndNextChartStartFromTheStoredChoice)
{
    answer([](frmChartSetup& d) {
        typeInto(d.num3D[0], "-30");
        d.optChartType[2]->click();
        d.optLabel[0]->click();
        ok(d);
    });
    ui::showChartSetup();

    // A new set of host objects (as the next request makes) reads the same file.
    modMain::releaseSharedObjects();
    modMain::GraphInitialize();
    frmChartSetup d;
    EXPECT_EQ(d.num3D[0]->text(), "-30");
    EXPECT_TRUE(d.optChartType[2]->isChecked());
    EXPECT_TRUE(d.optLabel[0]->isChecked());

    modMain::chart().Initialize(&modMain::chartWindow().Chart1(), "Header", "", "", "");
    modMain::chart().InitChart();
    EXPECT_EQ(modMain::chart().Rotation(), -30);
    EXPECT_EQ(modMain::chart().ChartType(), 5);
    EXPECT_TRUE(modMain::chart().PointLabels());
}

}  // namespace
}  // namespace kg::test
