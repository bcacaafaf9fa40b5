// "Advanced Chart Help": the help file's path from the application folder, the opener, and the
// shell-style codes that reach ReportShellError.
#include <QDeadlineTimer>
#include <QDir>
#include <QFile>
#include <QThread>

#include "ui/AdvancedHelp.h"
#include "ui/UiFixture.h"

namespace kg::test {
namespace {

struct AdvancedHelpFixture : UiFixture {
    std::vector<int32_t> reported;

    void SetUp() override
    {
        standConfig.shellErrorReporter = [this](int32_t code, const std::string&) { reported.push_back(code); };
        standChanged();
        UiFixture::SetUp();
    }
    // Puts a help file into an application folder, by default the fixture's temporary folder.
    std::string writeHelpFile(QString folder = {})
    {
        if (folder.isEmpty()) folder = dir.path();
        QDir(folder).mkpath("Help");
        QFile f(folder + "/Help/chartctl.hlp");
        EXPECT_TRUE(f.open(QIODevice::WriteOnly));
        f.write("help\n");
        return f.fileName().toStdString();
    }
    std::string expectedPath() const { return dir.path().toStdString() + "/Help/chartctl.hlp"; }
};

struct CodeCase {
    const char* name;
    int openerResult;
    std::vector<int32_t> reported;
};

const CodeCase kCodes[] = {
    {"Zero", 0, {0}},
    {"NoAssociation", 31, {31}},
    {"ThirtyTwoIsSuccess", 32, {}},
    {"Started", 42, {}},
};

struct Code : AdvancedHelpFixture, ::testing::WithParamInterface<CodeCase> {};

TEST_P(Code, OnlyCodesBelow32AreReported)
{
    std::vector<std::string> opened;
    services->helpOpener = [&](const std::string& path) {
        opened.push_back(path);
        return GetParam().openerResult;
    };
    ui::openAdvancedHelp();
    EXPECT_EQ(opened, std::vector<std::string>{expectedPath()});
    EXPECT_EQ(reported, GetParam().reported);
}

INSTANTIATE_TEST_SUITE_P(AdvancedHelp, Code, ::testing::ValuesIn(kCodes), byName);

struct OpenerCase {
    const char* name;
    bool fileThere;
    const char* program;  // null: the opener installed by default
    int expected;
};

const OpenerCase kOpeners[] = {
    {"FileMissing", false, "true", ui::kShellFileNotFound},
    {"DefaultOpenerFileMissing", false, nullptr, ui::kShellFileNotFound},
    {"OpenerNotOnPath", true, "kg-no-such-opener-program", ui::kShellNoAssociation},
    {"OpenerStarts", true, "true", ui::kShellOk},
};

struct DesktopOpener : AdvancedHelpFixture, ::testing::WithParamInterface<OpenerCase> {};

TEST_P(DesktopOpener, GivesShellStyleCodes)
{
    const OpenerCase& c = GetParam();
    const std::string path = c.fileThere ? writeHelpFile() : expectedPath();
    if (c.program) {
        EXPECT_EQ(ui::desktopOpener(c.program)(path), c.expected);
    }
    services->helpOpener = c.program ? ui::desktopOpener(c.program) : ui::HelpOpener{};
    ui::openAdvancedHelp();
    EXPECT_EQ(reported, c.expected < 32 ? std::vector<int32_t>{c.expected} : std::vector<int32_t>{});
    if (c.expected < 32) {
        EXPECT_EQ(teststand::lastShellError(), c.expected);
    }
}

INSTANTIATE_TEST_SUITE_P(AdvancedHelp, DesktopOpener, ::testing::ValuesIn(kOpeners), byName);

TEST_F(AdvancedHelpFixture, OpenerGetsThePathAsOneArgumentWithoutAShell)
{
    // An application folder whose name a shell would split and expand.
    const QString folder = dir.filePath("Tavix $HOME 'x' ; y");
    writeHelpFile(folder);
    standConfig.appFolder = folder.toStdString();
    standChanged();
    modMain::GraphInitialize();

    // A stand-in opener that writes down its arguments.
    const QString record = dir.filePath("args.txt");
    const QString opener = dir.filePath("record-args");
    QFile script(opener);
    ASSERT_TRUE(script.open(QIODevice::WriteOnly));
    script.write(("#!/bin/sh\nprintf '%s\\n' \"$#\" \"$1\" > '" + record + ".part'\nmv '" + record + ".part' '" +
                  record + "'\n")
                     .toUtf8());
    script.close();
    script.setPermissions(QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);

    services->helpOpener = ui::desktopOpener(opener.toStdString());
    ui::openAdvancedHelp();
    EXPECT_TRUE(reported.empty());

    // The opener runs detached; wait for what it wrote.
    QDeadlineTimer deadline(10000);
    while (!QFile::exists(record) && !deadline.hasExpired()) QThread::msleep(20);
    QFile out(record);
    ASSERT_TRUE(out.open(QIODevice::ReadOnly)) << "the opener did not run";
    const QStringList lines = QString::fromUtf8(out.readAll()).split('\n');
    ASSERT_GE(lines.size(), 2);
    EXPECT_EQ(lines[0], "1");
    EXPECT_EQ(lines[1], folder + "/Help/chartctl.hlp");
}

}  // namespace
}  // namespace kg::test
