// The settings store: texts come back exactly as stored, the file keeps IniFormat's layout both
// ways, and a write that fails raises an error and leaves the previous file as it was.
#include <gtest/gtest.h>

#include <functional>

#include <QDir>
#include <QFile>
#include <QSettings>
#include <QTemporaryDir>

#include "core/Error.h"
#include "teststand/RawIni.h"
#include "teststand/TestStand.h"
#include "HostTestSupport.h"
#include "support/FileSizeLimit.h"

using namespace kg;
using namespace kg::teststand;

namespace {

using test::fileBytes;
using test::writeBytes;

// A settings file that cannot be used fails with the settings error naming the file.
void expectFileError(const Error& e, const std::string& path)
{
    EXPECT_EQ(e.number(), errc::HostBase + hosterr::Settings);
    EXPECT_NE(e.description().find(path), std::string::npos) << e.description();
}

// A settings object on its own file in a fresh folder.
class SettingsStore : public testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_TRUE(dir_.isValid());
        path_ = dir_.filePath("settings.ini").toStdString();
        useFile(path_);
    }
    void useFile(const std::string& path)
    {
        Config cfg;
        cfg.settingsFile = path;
        settings_ = Variant(makeFactory(cfg)->create(host::HostClass::Settings));
    }

    std::string read(const std::string& section, const std::string& key, const std::string& def = "<default>",
                     const std::string& owner = "Tavix")
    {
        Args args{section, key, def, owner, Variant()};
        call(settings_, "ReadSetting", args);
        EXPECT_EQ(args[4].type(), VarType::String);
        return args[4].isString() ? args[4].str() : std::string();
    }
    void write(const std::string& section, const std::string& key, const std::string& value,
               const std::string& owner = "Tavix")
    {
        Args args{section, key, value, owner, Variant()};
        call(settings_, "WriteSetting", args);
        EXPECT_EQ(args[4].type(), VarType::Long) << "a write gives a status";
    }

    QTemporaryDir dir_{test::tempTemplate("settings")};
    std::string path_;
    Variant settings_;
};

struct TextCase : test::Named {
    std::string text;
};

const auto kTexts = testing::Values(
    TextCase{"leadingBlank", " 10"}, TextCase{"negative", "-3"}, TextCase{"comma", "1,5"},
TextCase{"equals", "a=b"}, TextCase{"semicolon", "a;b"},
    TextCase{"unicode", "Grüße € 😀"}, TextCase{"empty", ""}, TextCase{"trailingBlank", "Bar "},
TextCase{"quote", "say \"hi\""}, TextCase{"backslash", "C:\\Help\\x"},
    TextCase{"tabAndNewline", "a\tb\nc"}, TextCase{"controlThenHexDigit", std::string("\x01") + "b"},
    TextCase{"at", "@home"}, TextCase{"invalidMark", "@Invalid()"}, TextCase{"byteArrayMark", "@ByteArray(x)"},
    TextCase{"bracketsAndPercent", "[50%]"});

class SettingsRoundTrip : public SettingsStore, public testing::WithParamInterface<TextCase> {};

TEST_P(SettingsRoundTrip, ReadsBackTheTextWrittenAndAgreesWithIniFormatBothWays)
{
    write("2dCharts", "Rotation", GetParam().text);
    EXPECT_EQ(read("2dCharts", "Rotation"), GetParam().text);
    {
        QSettings ini(QString::fromStdString(path_), QSettings::IniFormat);
        const QVariant v = ini.value("Tavix/2dCharts/Rotation");
        ASSERT_EQ(v.typeId(), QMetaType::QString) << "IniFormat reads it as " << v.typeName();
        EXPECT_EQ(v.toString().toStdString(), GetParam().text);
        ini.remove("Tavix/2dCharts/Rotation");
        ini.setValue("Tavix/2dCharts/Depth", QString::fromStdString(GetParam().text));
    }
    EXPECT_EQ(read("2dCharts", "Depth"), GetParam().text);
}

INSTANTIATE_TEST_SUITE_P(Texts, SettingsRoundTrip, kTexts, test::RowName{});

struct RawValueCase : test::Named {
    const char* raw;    // as it stands after the = in the file
    const char* text;   // what ReadSetting gives
};

class HandWrittenValue : public SettingsStore, public testing::WithParamInterface<RawValueCase> {};

TEST_P(HandWrittenValue, ReadsAsItsText)
{
    writeBytes(path_, QByteArray("[Tavix]\n2dCharts\\Depth=") + GetParam().raw + "\n");
    EXPECT_EQ(read("2dCharts", "Depth"), GetParam().text);
}

INSTANTIATE_TEST_SUITE_P(
    Values, HandWrittenValue,
    testing::Values(RawValueCase{"plain", "10", "10"}, RawValueCase{"list", "1,5", "1,5"},
                    RawValueCase{"listWithBlanks", "1 , 5", "1 , 5"}, RawValueCase{"quotedList", "\"a\", \"b\"", "a, b"},
                    RawValueCase{"quotedBlank", "\" 10\"", " 10"}, RawValueCase{"blanksAround", "   10   ", "10"},
                    RawValueCase{"comment", "10 ; the depth", "10"}, RawValueCase{"quotedSemicolon", "\"1;2\"", "1;2"},
                    RawValueCase{"escapes", "a\\tb\\\\c\\x41", "a\tb\\cA"}, RawValueCase{"empty", "", ""},
                    RawValueCase{"doubledAt", "@@x", "@x"}, RawValueCase{"utf8", "Grüße", "Grüße"},
                    RawValueCase{"crlf", "10\r", "10"}, RawValueCase{"invalidMark", "@Invalid()", "<default>"}),
    test::RowName{});

TEST_F(SettingsStore, HandWrittenFileIsOwnerSectionKeyAndAWriteKeepsItsLayout)
{
    ASSERT_TRUE(QFile::copy(QString(KG_TEST_DATA) + "/host/settings_handwritten.ini", QString::fromStdString(path_)));
    EXPECT_EQ(read("2dCharts", "View3D"), "0");
    EXPECT_EQ(read("2dCharts", "Style"), "Pie");
    EXPECT_EQ(read("2dCharts", "Rotation"), "1,5");
    EXPECT_EQ(read("2dCharts", "Depth", "10"), "10");
    EXPECT_EQ(read("2dCharts", "Style", "Bar", "Other"), "Bar");
    EXPECT_EQ(read("2dcharts", "Style", "Bar"), "Bar");  // keys are case-sensitive, as in IniFormat
    // A write keeps the layout and the other texts.
    QFile::setPermissions(QString::fromStdString(path_), QFile::ReadOwner | QFile::WriteOwner);
    write("2dCharts", "Depth", " 10");
    const QByteArray bytes = fileBytes(path_);
    EXPECT_TRUE(bytes.startsWith("[Tavix]\n")) << bytes.toStdString();
    EXPECT_TRUE(bytes.contains("\n2dCharts\\Depth=\" 10\"\n")) << bytes.toStdString();
    EXPECT_TRUE(bytes.contains("\n2dCharts\\View3D=0\n")) << bytes.toStdString();
    EXPECT_EQ(read("2dCharts", "Rotation"), "1,5");
    EXPECT_EQ(read("2dCharts", "Depth"), " 10");
}

TEST_F(SettingsStore, FailedWriteLeavesThePreviousFile)
{
    write("2dCharts", "Style", "Pie");
    const QByteArray before = fileBytes(path_);
    {
        const test::FileSizeLimit fullDisk(200);
        expectFileError(test::errorOf([&] { write("2dCharts", "Rotation", std::string(1000, 'x')); }), path_);
    }
    EXPECT_EQ(fileBytes(path_), before);
    EXPECT_EQ(read("2dCharts", "Rotation"), "<default>");
}

TEST_F(SettingsStore, FolderAtTheFilesPlaceOrAFileAtTheFoldersPlaceFails)
{
    ASSERT_TRUE(QDir().mkpath(QString::fromStdString(path_)));
    expectFileError(test::errorOf([&] { read("2dCharts", "Style"); }), path_);
    expectFileError(test::errorOf([&] { write("2dCharts", "Style", "Pie"); }), path_);
    const std::string file = dir_.filePath("file.ini").toStdString();
    writeBytes(file, "[Tavix]\n");
    useFile(file + "/settings.ini");
    expectFileError(test::errorOf([&] { write("2dCharts", "Style", "Pie"); }), file + "/settings.ini");
    EXPECT_EQ(fileBytes(file), "[Tavix]\n");
}

TEST_F(SettingsStore, MissingFileReadsDefaultsAndIsCreatedByAWrite)
{
    const std::string missing = dir_.filePath("new/folder/settings.ini").toStdString();
    useFile(missing);
    EXPECT_EQ(read("2dCharts", "Style", "Bar"), "Bar");
    write("2dCharts", "Style", "Area");
    EXPECT_EQ(read("2dCharts", "Style", "Bar"), "Area");
    EXPECT_TRUE(QFile::exists(QString::fromStdString(missing)));
}

struct BadArgsCase : test::Named {
    Args args;
    int32_t number;
};

class SettingsBadArguments : public SettingsStore, public testing::WithParamInterface<BadArgsCase> {};

TEST_P(SettingsBadArguments, AreRefused)
{
    for (const char* member : {"ReadSetting", "WriteSetting"}) {
        Args args = GetParam().args;
        EXPECT_EQ(test::errorOf([&] { call(settings_, member, args); }).number(), GetParam().number) << member;
    }
    EXPECT_FALSE(QFile::exists(QString::fromStdString(path_)));
}

INSTANTIATE_TEST_SUITE_P(
    Arguments, SettingsBadArguments,
    testing::Values(BadArgsCase{"emptySection", {"", "Style", "Bar", "Tavix", Variant()}, errc::InvalidProcedureCall},
                    BadArgsCase{"emptyKey", {"2dCharts", "", "Bar", "Tavix", Variant()}, errc::InvalidProcedureCall},
                    BadArgsCase{"emptyOwner", {"2dCharts", "Style", "Bar", "", Variant()}, errc::InvalidProcedureCall},
                    BadArgsCase{"slashInKey", {"2dCharts", "a/b", "Bar", "Tavix", Variant()}, errc::InvalidProcedureCall},
                    BadArgsCase{"backslashInSection", {"2d\\Charts", "Style", "Bar", "Tavix", Variant()},
                                errc::InvalidProcedureCall},
                    BadArgsCase{"nullValue", {"2dCharts", "Style", Variant::null(), "Tavix", Variant()},
                                errc::InvalidUseOfNull},
                    BadArgsCase{"fourArguments", {"2dCharts", "Style", "Bar", "Tavix"}, errc::WrongArgumentCount}),
    test::RowName{});

TEST(RawIni, KeysEscapeAsIniFormatDoes)
{
    for (const QString key : {QStringLiteral("2dCharts/View3D"), QStringLiteral("a b%c"), QStringLiteral("Grüße/€")}) {
        EXPECT_EQ(rawini::unescapeKey(rawini::escapeKey(key)), key);
    }
    EXPECT_EQ(rawini::escapeKey("2dCharts/View3D"), "2dCharts\\View3D");
    EXPECT_EQ(rawini::escapeKey("a b"), "a%20b");
    EXPECT_EQ(rawini::unescapeKey("Gr%FC%DFe%20key\\x%20y"), QString::fromUtf8("Grüße key/x y"));
}

// Any owner the host may name is a section like any other (also the names IniFormat gives a
// meaning of its own, "General" holding the keys without a section), and any text comes back, while
// the other owners' entries survive the rewrite.
TEST(RawIni, EveryOwnerAndTextRoundTripsBesideTheOthers)
{
    const QString feff = QChar(0xFEFF);
    for (const auto& [owner, value] : std::vector<std::pair<QString, QString>>{
             {"Tavix", "Pie"}, {"General", "Pie"}, {"general", "Pie"}, {"GENERAL", "Pie"}, {"%General", "Pie"},
             {"Tavix Pty. Ltd. (AU) #2", "Pie"}, {QString::fromUtf8("タビックス"), "Pie"},
             {"Tavix", QString::fromUtf8("a\0b\x01\t\r\n", 7)}, {"Tavix", "a" + feff + "b"},
             {"Tavix", feff + "b"}, {"Tavix", "\t" + feff + "b"}}) {
        const rawini::Entries entries{{"Neighbour/2dCharts/Style", "Area"}, {owner + "/2dCharts/Style", value},
                                      {"Other/2dCharts/Style", "Bar"}};
        EXPECT_EQ(rawini::entriesOf(rawini::fileTextOf(entries)), entries) << owner.toStdString();
    }
}

struct PathCase : test::Named {
    std::string configured;
    const char* karstgraphSettings;  // nullptr: unset
    const char* xdgConfigHome;
    const char* home;
    std::string expected;
};

class DefaultSettingsFile : public testing::TestWithParam<PathCase> {};

TEST_P(DefaultSettingsFile, FollowsConfigThenEnvironment)
{
    const PathCase& c = GetParam();
    const test::ScopedEnv settings("KARSTGRAPH_SETTINGS", c.karstgraphSettings);
    const test::ScopedEnv xdg("XDG_CONFIG_HOME", c.xdgConfigHome);
    const test::ScopedEnv home("HOME", c.home);
    Config cfg;
    cfg.settingsFile = c.configured;
    EXPECT_EQ(settingsFilePath(cfg), c.expected);
}

INSTANTIATE_TEST_SUITE_P(
    Paths, DefaultSettingsFile,
    testing::Values(PathCase{"configured", "/srv/s.ini", "/env/s.ini", "/xdg", "/home/u", "/srv/s.ini"},
                    PathCase{"environment", "", "/env/s.ini", "/xdg", "/home/u", "/env/s.ini"},
                    PathCase{"xdg", "", nullptr, "/xdg/", "/home/u", "/xdg/karstgraph/settings.ini"},
                    PathCase{"xdgRelativeIgnored", "", nullptr, "rel", "/home/u", "/home/u/.config/karstgraph/settings.ini"},
                    PathCase{"home", "", nullptr, nullptr, "/home/u", "/home/u/.config/karstgraph/settings.ini"}),
    test::RowName{});

}  // namespace
