// Application services: the folder, the settings owner, job cells as text, window placement in
// the settings file, the event log and the shell error report.
#include <gtest/gtest.h>

#include <map>
#include <regex>
#include <sstream>

#include <QDir>
#include <QFile>
#include <QTemporaryDir>

#include "core/Convert.h"
#include "core/Error.h"
#include "teststand/TestStand.h"
#include "HostTestSupport.h"

using namespace kg;
using namespace kg::teststand;

namespace {

using Placement = std::map<std::string, int32_t>;

// A window as the placement code sees it: five numbers by name, and the order they were put in.
class FakeWindow : public test::Thing {
public:
    explicit FakeWindow(Placement start = {}) : values(std::move(start)) {}
    Placement values;
    std::vector<std::string> puts;

    std::string objectName() const override { return "frmChart"; }
    Variant invoke(DispId id, uint16_t kind, Args& args) override
    {
        if (id == 0) return "frmChart";
        const std::string name = members()[static_cast<size_t>(id)].name;
        if (!(kind & kPropertyPut)) return values[name];
        values[name] = toLong(args.at(0));
        puts.push_back(name);
        return {};
    }

protected:
    const std::vector<MemberInfo>& members() const override
    {
        static const std::vector<MemberInfo> m{
            {"Name", 0}, {"Left", 1}, {"Top", 2}, {"Width", 3}, {"Height", 4}, {"WindowState", 5}};
        return m;
    }
};

const std::vector<std::string> kPlacementOrder{"Left", "Top", "Width", "Height", "WindowState"};

class AppServices : public testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_TRUE(dir_.isValid());
        cfg_.settingsFile = dir_.filePath("settings.ini").toStdString();
        recreate();
    }
    // A new object made with cfg_ as it is now.
    void recreate() { app_ = Variant(makeFactory(cfg_)->create(host::HostClass::AppServices)); }

    std::string out(const char* member, Args args = {Variant()})
    {
        call(app_, member, args);
        const Variant& v = args.back();
        EXPECT_EQ(v.type(), VarType::String) << member;
        return v.isString() ? v.str() : std::string();
    }
    Ref<FakeWindow> restored(const char* key)
    {
        auto window = makeRef<FakeWindow>();
        call(app_, "RestoreFormState", {Variant(window), key});
        return window;
    }

    QTemporaryDir dir_{test::tempTemplate("app")};
    Config cfg_;
    Variant app_;
};

TEST_F(AppServices, FolderIsConfiguredElseFromTheEnvironmentElseTheOneHoldingHelp)
{
    test::ScopedEnv env("KARSTGRAPH_APPFOLDER", nullptr);
    // The build copies Help/ next to bin/, where this test runs.
    EXPECT_EQ(QDir(QString::fromStdString(out("GetAppFolder"))).canonicalPath(), QDir(KG_BUILD_DIR).canonicalPath());
    env.set("/srv/karstgraph");
    EXPECT_EQ(out("GetAppFolder"), "/srv/karstgraph");
    cfg_.appFolder = "/opt/tavix/";
    recreate();
    EXPECT_EQ(out("GetAppFolder"), "/opt/tavix") << "without its trailing separator";
}

TEST_F(AppServices, SettingsOwnerIsTavixUnlessConfigured)
{
    EXPECT_EQ(out("GetSettingsOwner"), "Tavix");
    cfg_.settingsOwner = "Tavix Test";
    EXPECT_EQ(out("GetSettingsOwner"), "Tavix") << "read when the object is created";
    recreate();
    EXPECT_EQ(out("GetSettingsOwner"), "Tavix Test");
}

struct CellCase : test::Named {
    Variant cell;
    test::Outcome<std::string> text;
};

class CellText : public AppServices, public testing::WithParamInterface<CellCase> {};

TEST_P(CellText, BothConversionsGiveTheCellsText)
{
    test::expectOutcome(GetParam().text, [&] { return out("CellToText", {0, 0, GetParam().cell, ""}); });
    test::expectOutcome(GetParam().text, [&] { return out("CellToNumberText", {1, GetParam().cell, ""}); });
}

INSTANTIATE_TEST_SUITE_P(Cells, CellText,
                         testing::Values(CellCase{"empty", Variant(), ""},
                                         CellCase{"long", Variant(int32_t{1}), "1"},
                                         CellCase{"integer", Variant(int16_t{-3}), "-3"},
                                         CellCase{"double", Variant(2.5), "2.5"},
                                         CellCase{"wholeDouble", Variant(1.0), "1"},
                                         CellCase{"boolean", Variant(true), "True"},
                                         CellCase{"array", test::anArray(), test::kMismatch},
                                         CellCase{"object", Variant(makeRef<FakeWindow>()), test::kMismatch}),
                         test::RowName{});

TEST_F(AppServices, PlacementRoundTripsThroughTheSettingsFileAndMinimisedComesBackNormal)
{
    const Placement chart{{"Left", 1200}, {"Top", 300}, {"Width", 9000}, {"Height", 6000}, {"WindowState", 2}};
    Placement help{{"Left", 15}, {"Top", 25}, {"Width", 4000}, {"Height", 3000}, {"WindowState", 1}};
    call(app_, "SaveFormState", {Variant(makeRef<FakeWindow>(chart)), "Chart"});
    call(app_, "SaveFormState", {Variant(makeRef<FakeWindow>(help)), "ChartHelp"});

    recreate();
    const Ref<FakeWindow> window = restored("Chart");
    EXPECT_EQ(window->values, chart);
    EXPECT_EQ(window->puts, kPlacementOrder);
    help["WindowState"] = 0;
    EXPECT_EQ(restored("ChartHelp")->values, help);
}

struct StoredPlacementCase : test::Named {
    const char* stored;  // Left Top Width Height WindowState; "-" for one not stored
};

class InsanePlacement : public AppServices, public testing::WithParamInterface<StoredPlacementCase> {};

TEST_P(InsanePlacement, LeavesTheWindowAlone)
{
    QByteArray ini = "[FormState]\n";
    std::istringstream values(GetParam().stored);
    std::string value;
    for (const std::string& key : kPlacementOrder)
        if (values >> value && value != "-") ini += QByteArray::fromStdString("Chart\\" + key + "=" + value + "\n");
    test::writeBytes(cfg_.settingsFile, ini);
    EXPECT_TRUE(restored("Chart")->puts.empty());
}

INSTANTIATE_TEST_SUITE_P(Placements, InsanePlacement,
                         testing::Values(StoredPlacementCase{"nothingStored", "- - - - -"},
                                         StoredPlacementCase{"zeroWidth", "0 0 0 3000 0"},
                                         StoredPlacementCase{"negativeHeight", "0 0 3000 -5 0"},
                                         StoredPlacementCase{"hugeWidth", "0 0 200000 3000 0"},
                                         StoredPlacementCase{"farLeft", "-150000 0 3000 3000 0"},
                                         StoredPlacementCase{"unknownState", "0 0 3000 3000 5"},
                                         StoredPlacementCase{"notANumber", "abc 0 3000 3000 0"},
                                         StoredPlacementCase{"fraction", "10.5 0 3000 3000 0"},
                                         StoredPlacementCase{"heightMissing", "0 0 3000 - 0"}),
                         test::RowName{});

TEST_F(AppServices, PlacementOfSomethingThatIsNoWindowFails)
{
    EXPECT_EQ(test::errorOf([&] { call(app_, "SaveFormState", {Variant(), "Chart"}); }).number(), errc::ObjectNotSet);
    EXPECT_EQ(test::errorOf([&] { call(app_, "SaveFormState", {Variant(makeRef<FakeWindow>()), ""}); }).number(),
              errc::InvalidProcedureCall);
}

TEST_F(AppServices, EventsAreAppendedToTheLogAsLinesAndToStderrWhenAsked)
{
    cfg_.eventLogFile = dir_.filePath("events.log").toStdString();
    cfg_.eventLogToStderr = true;
    recreate();
    testing::internal::CaptureStderr();
    call(app_, "LogFormEvent", {"FormLoad", "frmChart"});
    call(app_, "LogFormEvent", {"FormQueryUnload", "frmChartSetup"});
    const std::string err = testing::internal::GetCapturedStderr();
    EXPECT_NE(err.find(" FormQueryUnload frmChartSetup\n"), std::string::npos) << err;
    const QList<QByteArray> lines = test::fileBytes(cfg_.eventLogFile).split('\n');
    ASSERT_EQ(lines.size(), 3);
    EXPECT_TRUE(lines[2].isEmpty());
    const std::regex stamp(R"(\d{4}-\d\d-\d\dT\d\d:\d\d:\d\d\S* )");
    EXPECT_TRUE(std::regex_search(lines[0].toStdString(), stamp)) << lines[0].toStdString();
    EXPECT_TRUE(lines[0].endsWith(" FormLoad frmChart")) << lines[0].toStdString();
}

TEST_F(AppServices, LogThatCannotBeWrittenDoesNotFailTheEvent)
{
    const std::string blocker = dir_.filePath("file.txt").toStdString();
    test::writeBytes(blocker, "");
    cfg_.eventLogFile = blocker + "/events.log";
    recreate();
    testing::internal::CaptureStderr();
    call(app_, "LogFormEvent", {"FormLoad", "frmChart"});
    call(app_, "LogFormEvent", {"FormQueryUnload", "frmChart"});
    const std::string err = testing::internal::GetCapturedStderr();
    const size_t first = err.find(cfg_.eventLogFile);
    EXPECT_NE(first, std::string::npos) << err;
    EXPECT_EQ(err.find(cfg_.eventLogFile, first + 1), std::string::npos) << "warned once: " << err;
}

struct ShellErrorCase : test::Named {
    int32_t code;
    const char* text;
};

class ShellError : public AppServices, public testing::WithParamInterface<ShellErrorCase> {};

TEST_P(ShellError, IsReportedWithItsMeaning)
{
    std::vector<std::pair<int32_t, std::string>> reports;
    cfg_.shellErrorReporter = [&](int32_t code, const std::string& text) { reports.emplace_back(code, text); };
    recreate();
    call(app_, "ReportShellError", {GetParam().code});
    ASSERT_EQ(reports.size(), 1u);
    EXPECT_EQ(reports[0].first, GetParam().code);
    EXPECT_EQ(reports[0].second, GetParam().text);
    EXPECT_EQ(lastShellError(), GetParam().code);
    // Without a reporter of its own, the text goes to stderr.
    cfg_.shellErrorReporter = nullptr;
    recreate();
    testing::internal::CaptureStderr();
    call(app_, "ReportShellError", {GetParam().code});
    EXPECT_EQ(testing::internal::GetCapturedStderr(), GetParam().text + std::string("\n"));
}

INSTANTIATE_TEST_SUITE_P(
    Codes, ShellError,
    testing::Values(
        ShellErrorCase{"fileNotFound", 2, "Could not open the help file (shell error 2: file not found)"},
        ShellErrorCase{"noAssociation", 31,
                       "Could not open the help file (shell error 31: no application is associated with the file)"},
        ShellErrorCase{"other", 5, "Could not open the help file (shell error 5: error)"}),
    test::RowName{});

TEST_F(AppServices, WrongArgumentCountsAreRefused)
{
    EXPECT_EQ(test::errorOf([&] { call(app_, "GetAppFolder"); }).number(), errc::WrongArgumentCount);
    EXPECT_EQ(test::errorOf([&] { call(app_, "CellToText", {0, Variant(), ""}); }).number(),
              errc::WrongArgumentCount);
    EXPECT_EQ(test::errorOf([&] { call(app_, "LogFormEvent", {"FormLoad"}); }).number(), errc::WrongArgumentCount);
}

TEST(HostObjects, HostAuxHasNoMembers)
{
    const Variant aux(makeFactory()->create(host::HostClass::HostAux));
    ASSERT_TRUE(aux.isObject());
    EXPECT_EQ(test::errorOf([&] { call(aux, "Anything"); }).number(), errc::MemberNotFound);
}

}  // namespace
