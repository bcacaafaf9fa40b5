// The help text window: its document, its size following, one instance, and its placement kept
// under "ChartHelp".
#include <QCoreApplication>
#include <QFile>
#include <QScrollBar>
#include <QTextBlock>
#include <QTextBrowser>
#include <QTextDocument>
#include <QTextList>

#include "ui/HelpText.h"
#include "ui/frmChartHelp.h"
#include "ui/UiFixture.h"

namespace kg::test {
namespace {

using ui::chartHelpWindow;
using ui::frmChartHelp;
using ui::showChartHelp;

struct HelpFixture : UiFixture {
    QString eventLog;

    void SetUp() override
    {
        UiFixture::SetUp();
        eventLog = dir.filePath("events.log");
        standConfig.eventLogFile = eventLog.toStdString();
        standChanged();
        modMain::GraphInitialize();  // application services that write the event log
    }
    void TearDown() override
    {
        closeHelp();
        UiFixture::TearDown();
    }
    // Closes the window as the title bar does and lets Qt delete it.
    static void closeHelp()
    {
        if (frmChartHelp* w = chartHelpWindow()) w->close();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    }
    // "FormLoad frmChartHelp" and the like, in order, without the time stamps.
    std::vector<std::string> events() const
    {
        std::vector<std::string> lines;
        QFile f(eventLog);
        if (!f.open(QIODevice::ReadOnly)) return lines;
        for (const QByteArray& line : f.readAll().split('\n'))
            if (!line.isEmpty()) lines.push_back(line.mid(line.indexOf(' ') + 1).toStdString());
        return lines;
    }
};

// ---- The document ------------------------------------------------------------------------------

struct BlockInfo {
    QString text;
    bool bold = true;         // every fragment bold
    bool arial8 = true;       // every fragment Arial 8 point
    bool numbered = false;    // an item of a decimal list
};

std::vector<BlockInfo> blocksOf(const QTextDocument& doc)
{
    std::vector<BlockInfo> blocks;
    for (QTextBlock b = doc.begin(); b != doc.end(); b = b.next()) {
        BlockInfo info;
        info.text = b.text();
        for (auto it = b.begin(); !it.atEnd(); ++it) {
            const QTextCharFormat f = it.fragment().charFormat();
            info.bold = info.bold && f.fontWeight() == QFont::Bold;
            info.arial8 = info.arial8 && f.fontFamilies().toStringList() == QStringList{"Arial"} &&
                          f.fontPointSize() == 8;
        }
        info.numbered = b.textList() && b.textList()->format().style() == QTextListFormat::ListDecimal;
        blocks.push_back(info);
    }
    return blocks;
}

// The fixture's document, read block by block.
struct HelpText : ::testing::Test {
    QTextDocument doc;
    std::vector<BlockInfo> blocks;
    void SetUp() override
    {
        ui::buildChartHelp(doc);
        blocks = blocksOf(doc);
    }
};

struct Section {
    const char* heading;
    std::vector<const char*> words;  // each must appear in the steps under the heading
};

// The headings in order, and a key phrase or two that each one's steps must name.
const Section kSections[] = {
    {"To Scale the Chart:", {"Ctrl", "wheel"}},
    {"To Move the Chart:", {"Shift", "Move the mouse"}},
    {"To Graphics Zoom an Area of the Chart:", {"left mouse button", "Escape"}},
    {"To Axis Zoom the Chart:", {"Shift", "minimum and maximum"}},
    {"To Rotate the Chart (Bar/Pie charts displaying 3D effect only):", {"elevation", "-45 to 45"}},
    {"To Reset to Automatic Scale and Position:", {"\"r\""}},
};

TEST_F(HelpText, EveryFragmentIsArial8Point)
{
    ASSERT_GT(blocks.size(), 20u);
    for (const BlockInfo& b : blocks) EXPECT_TRUE(b.arial8) << b.text.toStdString();
    EXPECT_EQ(doc.defaultFont().family(), "Arial");
    EXPECT_EQ(doc.defaultFont().pointSize(), 8);
}

TEST_F(HelpText, OpensWithTheBoldTitleThenTwoParagraphsThenSpecialNotes)
{
    ASSERT_GE(blocks.size(), 7u);
    EXPECT_EQ(blocks[0].text, "Interacting with the Chart");
    EXPECT_EQ(blocks[3].text, "Special Notes");
    EXPECT_EQ(blocks[6].text, kSections[0].heading);  // after the two notes
    for (size_t i = 0; i < 6; ++i) EXPECT_EQ(blocks[i].bold, i == 0 || i == 3) << i;
}

TEST_F(HelpText, EachHeadingIsBoldInOrderAndItsNumberedStepsDescribeTheGestures)
{
    size_t from = 0;
    for (const Section& section : kSections) {
        auto it = std::find_if(blocks.begin() + long(from), blocks.end(),
                               [&](const BlockInfo& b) { return b.text == section.heading; });
        ASSERT_NE(it, blocks.end()) << section.heading << " missing or out of order";
        EXPECT_TRUE(it->bold) << section.heading;
        EXPECT_FALSE(it->numbered) << section.heading;
        QString steps;
        size_t count = 0;
        for (auto s = it + 1; s != blocks.end() && s->numbered; ++s, ++count) {
            EXPECT_FALSE(s->bold) << s->text.toStdString();
            steps += s->text + "\n";
        }
        EXPECT_GE(count, 2u) << section.heading;
        for (const char* word : section.words) EXPECT_TRUE(steps.contains(word)) << section.heading << ": " << word;
        from = size_t(it - blocks.begin()) + 1 + count;
    }
    EXPECT_EQ(from, blocks.size());  // the last heading's steps end the document
}

// ---- The window --------------------------------------------------------------------------------

TEST_F(HelpFixture, OpensAsDesignedAndReportsItsLoad)
{
    showChartHelp();
    frmChartHelp* w = chartHelpWindow();
    ASSERT_NE(w, nullptr);
    EXPECT_EQ(w->objectName(), "frmChartHelp");
    EXPECT_EQ(w->windowTitle(), "Chart Mouse and Keyboard Functions");
    EXPECT_TRUE(w->isVisible());
    EXPECT_FALSE(w->isModal());
    EXPECT_EQ(w->parentWidget(), nullptr);
    EXPECT_EQ(w->size(), QSize(656, 353));  // 9852 x 5304 twips
    EXPECT_EQ(w->Text1->objectName(), "Text1");
    EXPECT_TRUE(w->Text1->isReadOnly());
    EXPECT_EQ(w->Text1->geometry(), QRect(0, 0, 656, 353));
    EXPECT_TRUE(w->Text1->toPlainText().startsWith("Interacting with the Chart"));
    EXPECT_EQ(w->Text1->verticalScrollBar()->value(), 0);  // opens at the title
    EXPECT_EQ(events(), std::vector<std::string>{"FormLoad frmChartHelp"});
}

TEST_F(HelpFixture, SecondShowReusesTheWindow)
{
    showChartHelp();
    frmChartHelp* first = chartHelpWindow();
    first->hide();
    showChartHelp();
    EXPECT_EQ(chartHelpWindow(), first);
    EXPECT_TRUE(first->isVisible());
    EXPECT_EQ(events(), std::vector<std::string>{"FormLoad frmChartHelp"});  // loaded once
}

TEST_F(HelpFixture, TextFollowsAResizeAndClosingSavesThePlacementUnderChartHelp)
{
    showChartHelp();
    chartHelpWindow()->resize(500, 300);
    QCoreApplication::processEvents();
    EXPECT_EQ(chartHelpWindow()->Text1->geometry(), QRect(0, 0, 500, 300)) << "the text follows the window";
    closeHelp();
    EXPECT_EQ(chartHelpWindow(), nullptr);
    EXPECT_EQ(storedPlacement("ChartHelp", "Width"), "7500");
    EXPECT_EQ(storedPlacement("ChartHelp", "Height"), "4500");
    EXPECT_EQ(storedPlacement("ChartHelp", "WindowState"), "0");
    EXPECT_EQ(storedPlacement("Chart", "Width"), std::nullopt);

    showChartHelp();
    ASSERT_NE(chartHelpWindow(), nullptr);
    EXPECT_EQ(chartHelpWindow()->size(), QSize(500, 300));
    EXPECT_EQ(chartHelpWindow()->Text1->size(), QSize(500, 300));
    EXPECT_EQ(events(), (std::vector<std::string>{"FormLoad frmChartHelp", "FormQueryUnload frmChartHelp",
                                                  "FormLoad frmChartHelp"}));
}

TEST_F(HelpFixture, ClosingAfterTheChartWindowReleasedTheHostObjectsIsQuiet)
{
    showChartHelp();
    modMain::releaseSharedObjects();
    closeHelp();
    EXPECT_EQ(chartHelpWindow(), nullptr);
    EXPECT_TRUE(prompts.messages.empty());
    EXPECT_EQ(storedPlacement("ChartHelp", "Width"), std::nullopt);
}

TEST_F(HelpFixture, FailingSaveIsReportedAndTheWindowStillCloses)
{
    showChartHelp();
    teststand::FaultPlan::failOn("AppServices.SaveFormState", 1);
    closeHelp();
    EXPECT_EQ(chartHelpWindow(), nullptr);
    ASSERT_EQ(prompts.messages.size(), 1u);
    EXPECT_NE(prompts.messages[0].find("SaveFormState"), std::string::npos) << prompts.messages[0];
}

TEST_F(HelpFixture, FailingLoadLeavesNoWindow)
{
    teststand::FaultPlan::failOn("AppServices.RestoreFormState", 1);
    EXPECT_THROW(showChartHelp(), Error);
    EXPECT_EQ(chartHelpWindow(), nullptr);
}

}  // namespace
}  // namespace kg::test
