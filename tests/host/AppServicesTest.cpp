// Application services: the folder, the settings owner, job cells as text, window placement in
// the settings file, the event log and the shell error report.
#include <gtest/gtest.h>

#include <array>
#include <functional>
#include <map>
#include <regex>

#include <QDir>
#include <QFile>
#include <QTemporaryDir>

#include "core/Convert.h"
#include "core/Date.h"
#include "core/Error.h"
#include "host/TestStand.h"
#include "HostTestSupport.h"

using namespace kg;
using namespace kg::host::teststand;

namespace {

QByteArray fileBytes(const QString& path)
{
    QFile f(path);
    return f.open(QIODevice::ReadOnly) ? f.readAll() : QByteArray();
}

// A window as the placement code sees it: five numbers by name, and the order they were put in.
class FakeWindow : public TableObject {
public:
    std::map<std::string, int32_t> values{{"Left", 0}, {"Top", 0}, {"Width", 0}, {"Height", 0}, {"WindowState", 0}};
    std::vector<std::string> puts;

    std::string objectName() const override { return "frmChart"; }
    Variant invoke(DispId id, uint16_t kind, Args& args) override
    {
        if (id == 0) return "frmChart";
        const std::string& name = names()[static_cast<size_t>(id - 1)];
        if (kind & kPropertyPut) {
            values[name] = toLong(args.at(0));
            puts.push_back(name);
            return {};
        }
        return values[name];
    }

protected:
    const std::vector<MemberInfo>& members() const override
    {
        static const std::vector<MemberInfo> m{
            {"Name", 0}, {"Left", 1}, {"Top", 2}, {"Width", 3}, {"Height", 4}, {"WindowState", 5}};
        return m;
    }

private:
    static const std::vector<std::string>& names()
    {
        static const std::vector<std::string> n{"Left", "Top", "Width", "Height", "WindowState"};
        return n;
    }
};

class AppServices : public testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_TRUE(dir_.isValid());
        config() = Config{};
        config().settingsFile = dir_.filePath("settings.ini").toStdString();
        recreate();
    }
    void TearDown() override
    {
        config() = Config{};
        setShellErrorReporter(nullptr);
    }
    void recreate() { app_ = Variant(makeFactory()->create(host::HostClass::AppServices)); }

    std::string out(const char* member, Args args)
    {
        call(app_, member, args);
        const Variant& v = args.back();
        EXPECT_EQ(v.type(), VarType::String) << member;
        return v.isString() ? v.str() : std::string();
    }

    QTemporaryDir dir_{test::tempTemplate("app")};
    Variant app_;
};

TEST_F(AppServices, ConfiguredFolderLosesItsTrailingSeparator)
{
    config().appFolder = "/opt/tavix/";
    recreate();
    EXPECT_EQ(out("GetAppFolder", {Variant()}), "/opt/tavix");
}

TEST_F(AppServices, EnvironmentNamesTheFolderWhenNotConfigured)
{
    const QByteArray saved = qgetenv("KARSTGRAPH_APPFOLDER");
    qputenv("KARSTGRAPH_APPFOLDER", "/srv/karstgraph");
    EXPECT_EQ(out("GetAppFolder", {Variant()}), "/srv/karstgraph");
    config().appFolder = "/opt/tavix";
    recreate();
    EXPECT_EQ(out("GetAppFolder", {Variant()}), "/opt/tavix");
    if (saved.isEmpty())
        qunsetenv("KARSTGRAPH_APPFOLDER");
    else
        qputenv("KARSTGRAPH_APPFOLDER", saved);
}

TEST_F(AppServices, DefaultFolderIsTheOneHoldingHelp)
{
    const QByteArray saved = qgetenv("KARSTGRAPH_APPFOLDER");
    qunsetenv("KARSTGRAPH_APPFOLDER");
    // The build copies Help/ next to bin/, where this test runs.
    const std::string folder = out("GetAppFolder", {Variant()});
    EXPECT_EQ(QDir(QString::fromStdString(folder)).canonicalPath(), QDir(KG_BUILD_DIR).canonicalPath());
    EXPECT_TRUE(QDir(QString::fromStdString(folder) + "/Help").exists());
    if (!saved.isEmpty()) qputenv("KARSTGRAPH_APPFOLDER", saved);
}

TEST_F(AppServices, SettingsOwnerIsTavixUnlessConfigured)
{
    EXPECT_EQ(out("GetSettingsOwner", {Variant()}), "Tavix");
    config().settingsOwner = "Tavix Test";
    EXPECT_EQ(out("GetSettingsOwner", {Variant()}), "Tavix") << "read when the object is created";
    recreate();
    EXPECT_EQ(out("GetSettingsOwner", {Variant()}), "Tavix Test");
}

struct CellCase {
    const char* name;
    Variant cell;
    const char* text;
};

class CellText : public AppServices, public testing::WithParamInterface<CellCase> {};

TEST_P(CellText, BothConversionsGiveTheCellsText)
{
    EXPECT_EQ(out("CellToText", {int32_t{0}, int32_t{0}, GetParam().cell, ""}), GetParam().text);
    EXPECT_EQ(out("CellToNumberText", {int32_t{1}, GetParam().cell, ""}), GetParam().text);
}

INSTANTIATE_TEST_SUITE_P(Cells, CellText,
                         testing::Values(CellCase{"null", Variant::null(), ""}, CellCase{"empty", Variant(), ""},
                                         CellCase{"status", Variant("Confirmed"), "Confirmed"},
                                         CellCase{"blankText", Variant(" 1 "), " 1 "},
                                         CellCase{"long", Variant(int32_t{1}), "1"},
                                         CellCase{"integer", Variant(int16_t{-3}), "-3"},
                                         CellCase{"double", Variant(2.5), "2.5"},
                                         CellCase{"wholeDouble", Variant(1.0), "1"},
                                         CellCase{"boolean", Variant(true), "True"}),
                         [](const auto& info) { return std::string(info.param.name); });

TEST_F(AppServices, CellThatIsNoValueIsATypeMismatch)
{
    EXPECT_EQ(test::errorOf([&] { out("CellToText", {int32_t{0}, int32_t{0}, Variant(VariantArray(0, 0, 0, 0)), ""}); })
                  .number(),
              errc::TypeMismatch);
    EXPECT_EQ(test::errorOf([&] { out("CellToNumberText", {int32_t{1}, Variant(makeRef<FakeWindow>()), ""}); }).number(),
              errc::TypeMismatch);
}

TEST_F(AppServices, PlacementRoundTripsThroughTheSettingsFile)
{
    auto saved = makeRef<FakeWindow>();
    saved->values = {{"Left", 1200}, {"Top", 300}, {"Width", 9000}, {"Height", 6000}, {"WindowState", 2}};
    call(app_, "SaveFormState", {Variant(saved), "Chart"});
    auto other = makeRef<FakeWindow>();
    other->values = {{"Left", 15}, {"Top", 25}, {"Width", 4000}, {"Height", 3000}, {"WindowState", 0}};
    call(app_, "SaveFormState", {Variant(other), "ChartHelp"});

    recreate();
    auto restored = makeRef<FakeWindow>();
    call(app_, "RestoreFormState", {Variant(restored), "Chart"});
    EXPECT_EQ(restored->values, saved->values);
    EXPECT_EQ(restored->puts, (std::vector<std::string>{"Left", "Top", "Width", "Height", "WindowState"}));
    auto restoredHelp = makeRef<FakeWindow>();
    call(app_, "RestoreFormState", {Variant(restoredHelp), "ChartHelp"});
    EXPECT_EQ(restoredHelp->values, other->values);

    const QByteArray file = fileBytes(QString::fromStdString(config().settingsFile));
    EXPECT_TRUE(file.contains("[FormState]\n")) << file.toStdString();
    EXPECT_TRUE(file.contains("\nChart\\Left=1200\n")) << file.toStdString();
    EXPECT_TRUE(file.contains("\nChartHelp\\Width=4000\n")) << file.toStdString();
}

TEST_F(AppServices, NothingStoredLeavesTheWindowAlone)
{
    auto window = makeRef<FakeWindow>();
    call(app_, "RestoreFormState", {Variant(window), "Chart"});
    EXPECT_TRUE(window->puts.empty());
}

TEST_F(AppServices, WindowSavedMinimisedComesBackNormal)
{
    auto window = makeRef<FakeWindow>();
    window->values = {{"Left", 100}, {"Top", 100}, {"Width", 5000}, {"Height", 4000}, {"WindowState", 1}};
    call(app_, "SaveFormState", {Variant(window), "Chart"});
    auto restored = makeRef<FakeWindow>();
    restored->values["WindowState"] = 2;
    call(app_, "RestoreFormState", {Variant(restored), "Chart"});
    EXPECT_EQ(restored->values["WindowState"], 0);
    EXPECT_EQ(restored->values["Width"], 5000);
}

struct StoredPlacementCase {
    const char* name;
    const char* left;
    const char* top;
    const char* width;
    const char* height;  // nullptr: not stored
    const char* state;
};

class InsanePlacement : public AppServices, public testing::WithParamInterface<StoredPlacementCase> {};

TEST_P(InsanePlacement, IsIgnored)
{
    const StoredPlacementCase& c = GetParam();
    QByteArray ini = "[FormState]\n";
    const std::array<std::pair<const char*, const char*>, 5> entries{
        {{"Left", c.left}, {"Top", c.top}, {"Width", c.width}, {"Height", c.height}, {"WindowState", c.state}}};
    for (const auto& [key, value] : entries)
        if (value) ini += QByteArray("Chart\\") + key + "=" + value + "\n";
    QFile f(QString::fromStdString(config().settingsFile));
    ASSERT_TRUE(f.open(QIODevice::WriteOnly));
    f.write(ini);
    f.close();

    auto window = makeRef<FakeWindow>();
    call(app_, "RestoreFormState", {Variant(window), "Chart"});
    EXPECT_TRUE(window->puts.empty());
}

INSTANTIATE_TEST_SUITE_P(
    Placements, InsanePlacement,
    testing::Values(StoredPlacementCase{"zeroWidth", "0", "0", "0", "3000", "0"},
                    StoredPlacementCase{"negativeHeight", "0", "0", "3000", "-5", "0"},
                    StoredPlacementCase{"hugeWidth", "0", "0", "200000", "3000", "0"},
                    StoredPlacementCase{"farLeft", "-150000", "0", "3000", "3000", "0"},
                    StoredPlacementCase{"unknownState", "0", "0", "3000", "3000", "5"},
                    StoredPlacementCase{"notANumber", "abc", "0", "3000", "3000", "0"},
                    StoredPlacementCase{"fraction", "10.5", "0", "3000", "3000", "0"},
                    StoredPlacementCase{"heightMissing", "0", "0", "3000", nullptr, "0"}),
    [](const auto& info) { return std::string(info.param.name); });

TEST_F(AppServices, PlacementOfSomethingThatIsNoWindowFails)
{
    EXPECT_EQ(test::errorOf([&] { call(app_, "SaveFormState", {Variant(), "Chart"}); }).number(), errc::ObjectNotSet);
    EXPECT_EQ(test::errorOf([&] { call(app_, "SaveFormState", {Variant(makeRef<FakeWindow>()), ""}); }).number(),
              errc::InvalidProcedureCall);
}

TEST_F(AppServices, EventsAreAppendedToTheLogAsLines)
{
    config().eventLogFile = dir_.filePath("events.log").toStdString();
    recreate();
    call(app_, "LogFormEvent", {"FormLoad", "frmChart"});
    call(app_, "LogFormEvent", {"FormQueryUnload", "frmChartSetup"});
    const QList<QByteArray> lines = fileBytes(dir_.filePath("events.log")).split('\n');
    ASSERT_EQ(lines.size(), 3);
    EXPECT_TRUE(lines[2].isEmpty());
    const std::regex stamp(R"(\d{4}-\d\d-\d\dT\d\d:\d\d:\d\d\S* )");
    EXPECT_TRUE(std::regex_search(lines[0].toStdString(), stamp)) << lines[0].toStdString();
    EXPECT_TRUE(lines[0].endsWith(" FormLoad frmChart")) << lines[0].toStdString();
    EXPECT_TRUE(lines[1].endsWith(" FormQueryUnload frmChartSetup")) << lines[1].toStdString();
}

TEST_F(AppServices, EventsGoToStderrWhenAsked)
{
    config().eventLogToStderr = true;
    recreate();
    testing::internal::CaptureStderr();
    call(app_, "LogFormEvent", {"FormLoad", "frmChartHelp"});
    const std::string err = testing::internal::GetCapturedStderr();
    EXPECT_NE(err.find(" FormLoad frmChartHelp\n"), std::string::npos) << err;
}

TEST_F(AppServices, LogThatCannotBeWrittenDoesNotFailTheEvent)
{
    const QString blocker = dir_.filePath("file.txt");
    QFile f(blocker);
    ASSERT_TRUE(f.open(QIODevice::WriteOnly));
    f.close();
    config().eventLogFile = (blocker + "/events.log").toStdString();
    recreate();
    testing::internal::CaptureStderr();
    call(app_, "LogFormEvent", {"FormLoad", "frmChart"});
    call(app_, "LogFormEvent", {"FormQueryUnload", "frmChart"});
    const std::string err = testing::internal::GetCapturedStderr();
    const size_t first = err.find(config().eventLogFile);
    EXPECT_NE(first, std::string::npos) << err;
    EXPECT_EQ(err.find(config().eventLogFile, first + 1), std::string::npos) << "warned once: " << err;
}

struct ShellErrorCase {
    const char* name;
    int32_t code;
    const char* text;
};

class ShellError : public AppServices, public testing::WithParamInterface<ShellErrorCase> {};

TEST_P(ShellError, IsReportedWithItsMeaning)
{
    std::vector<std::pair<int32_t, std::string>> reports;
    setShellErrorReporter([&](int32_t code, const std::string& text) { reports.emplace_back(code, text); });
    call(app_, "ReportShellError", {GetParam().code});
    ASSERT_EQ(reports.size(), 1u);
    EXPECT_EQ(reports[0].first, GetParam().code);
    EXPECT_EQ(reports[0].second, GetParam().text);
    EXPECT_EQ(lastShellError(), GetParam().code);
}

INSTANTIATE_TEST_SUITE_P(
    Codes, ShellError,
    testing::Values(
        ShellErrorCase{"fileNotFound", 2, "Could not open the help file (shell error 2: file not found)"},
        ShellErrorCase{"noAssociation", 31,
                       "Could not open the help file (shell error 31: no application is associated with the file)"},
        ShellErrorCase{"other", 5, "Could not open the help file (shell error 5: error)"}),
    [](const auto& info) { return std::string(info.param.name); });

TEST_F(AppServices, DefaultShellErrorReportGoesToStderr)
{
    testing::internal::CaptureStderr();
    call(app_, "ReportShellError", {int32_t{2}});
    EXPECT_EQ(testing::internal::GetCapturedStderr(),
              "Could not open the help file (shell error 2: file not found)\n");
}

TEST_F(AppServices, WrongArgumentCountsAreRefused)
{
    EXPECT_EQ(test::errorOf([&] { call(app_, "GetAppFolder"); }).number(), errc::WrongArgumentCount);
    EXPECT_EQ(test::errorOf([&] { call(app_, "CellToText", {int32_t{0}, Variant(), ""}); }).number(),
              errc::WrongArgumentCount);
    EXPECT_EQ(test::errorOf([&] { call(app_, "LogFormEvent", {"FormLoad"}); }).number(), errc::WrongArgumentCount);
}

TEST(HostAux, IsCreatedAndHasNoMembers)
{
    const Variant aux(makeFactory()->create(host::HostClass::HostAux));
    ASSERT_TRUE(aux.isObject());
    EXPECT_EQ(test::errorOf([&] { call(aux, "Anything"); }).number(), errc::MemberNotFound);
}

TEST(HostObjects, FactoryIsTheTestStandsByDefault)
{
    Ref<host::HostObjectFactory> factory = host::hostObjectFactory();
    ASSERT_TRUE(factory);
    const Variant app(factory->create(host::HostClass::AppServices));
    Args args{Variant()};
    call(app, "GetSettingsOwner", args);
    EXPECT_EQ(args[0].str(), "Tavix");
}

}  // namespace
