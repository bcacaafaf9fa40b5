// The chart window with the real Qt windows offscreen: its menu as the host knows it, load and
// close with placement and release order, value labels, printing and the window commands.
#include <QAction>
#include <QApplication>
#include <QClipboard>
#include <QFile>
#include <QImage>
#include <QMenu>
#include <QMenuBar>
#include <QPushButton>
#include <QRadioButton>
#include <QTest>

#include "chart/control/view/ChartView.h"
#include "requests/Requests.h"
#include "ui/QtUi.h"
#include "ui/frmChartSetup.h"
#include "UiFixture.h"

namespace kg {
namespace {

struct WindowFixture : test::RequestFixture {
    std::shared_ptr<ui::QtUi> qtUi = std::make_shared<ui::QtUi>();

    void SetUp() override
    {
        test::RequestFixture::SetUp();
        services->windows = qtUi;
        standConfig.eventLogFile = dir.filePath("events.log").toStdString();
        standChanged();
    }
    void TearDown() override
    {
        if (qtUi->chartWindow()) qtUi->chartWindow()->close();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);  // the window deletes itself
        test::RequestFixture::TearDown();
    }
    ui::frmChart& window() { return *qtUi->chartWindow(); }
    void drawHourly()
    {
        setForm("{\"grid1\": " + test::gridJson(1, 2, 14) + ", \"gridsettings1\": " + test::gridJson(1, 3, 6) +
                ", \"dtpFromDate\": \"2013-07-01\", \"dtpToDate\": \"2014-06-30\"}");
        Args args{Variant(int32_t(2)), Variant(3.0)};
        ASSERT_EQ(request(KG_DISPID_GENERATECHART_HOURLYGRAPH1, args), 0) << lastError;
    }
    std::string eventLog()
    {
        QFile f(dir.filePath("events.log"));
        f.open(QIODevice::ReadOnly);
        return f.readAll().toStdString();
    }
};

struct MenuItem {
    const char* name;
    const char* caption;
    QKeySequence key;
    int menu;
};

TEST_F(WindowFixture, MenuIsAsTheHostKnowsIt)
{
    drawHourly();
    ui::frmChart& w = window();
    EXPECT_EQ(w.windowTitle(), "Tavix Charting");
    const MenuItem items[] = {
        {"mnuSetup", "Chart Settings", Qt::Key_F2, 0},
        {"mnuPrint", "Print Chart", Qt::Key_F8, 0},
        {"mnuClose", "Close", QKeySequence(Qt::CTRL | Qt::Key_X), 0},
        {"mnuLabels1", "Labels On", Qt::Key_F3, 1},
        {"mnuLabels2", "Labels Off", Qt::Key_F4, 1},
        {"mnuRedraw", "Redraw", Qt::Key_F5, 1},
        {"mnuHelp", "Mouse and Keys Help", QKeySequence(Qt::CTRL | Qt::Key_F1), 2},
        {"mnuAdvHelp", "Advanced Chart Help", Qt::Key_F1, 2},
    };
    const char* menus[] = {"File", "Chart Control", "Help"};
    for (int m = 0; m < 3; ++m) EXPECT_EQ(w.mnuTop[m]->title(), menus[m]);
    int position[3] = {0, 0, 0};
    for (const MenuItem& item : items) {
        auto* action = w.findChild<QAction*>(item.name);
        ASSERT_TRUE(action) << item.name;
        EXPECT_EQ(action->text(), item.caption);
        EXPECT_EQ(action->shortcut(), item.key) << item.name;
        EXPECT_TRUE(action == w.mnuRedraw || action->isEnabled()) << item.name;  // hidden counts as disabled
        // The host's items come first, in their order.
        EXPECT_EQ(w.mnuTop[item.menu]->actions().at(position[item.menu]++), action) << item.name;
    }
    EXPECT_FALSE(w.mnuRedraw->isVisible());  // hidden under an hourly chart
    EXPECT_TRUE(w.isVisible());
    EXPECT_EQ(w.centralWidget()->objectName(), "Chart1");
}

TEST_F(WindowFixture, LoadAndCloseLogPlacementAndReleaseInOrder)
{
    drawHourly();
    window().setGeometry(50, 60, 600, 400);
    window().close();
    QApplication::processEvents();
    EXPECT_TRUE(modMain::goAppServices.isObject() && !modMain::goAppServices.object());
    EXPECT_EQ(modMain::giChartKind, 5);  // survives the close
    EXPECT_TRUE(modMain::gvSourceForm.isObject());
    const std::string log = eventLog();
    EXPECT_NE(log.find("FormLoad frmChart"), std::string::npos) << log;
    EXPECT_NE(log.find("FormQueryUnload frmChart"), std::string::npos) << log;

    drawHourly();  // the next request loads a new window, placed where the last one was
    EXPECT_EQ(window().geometry().size(), QSize(600, 400));
}

TEST_F(WindowFixture, LabelsOnAndOffRedrawFromTheTable)
{
    drawHourly();
    window().mnuLabels1->trigger();
    EXPECT_EQ(window().Chart1().chartLabels.size(), 24u);
    EXPECT_TRUE(modMain::goChart->PointLabels());
    window().mnuLabels2->trigger();
    EXPECT_TRUE(window().Chart1().chartLabels.empty());
    EXPECT_TRUE(prompts.messages.empty());
}

TEST_F(WindowFixture, PrintWritesTheChart)
{
    drawHourly();
    const std::string pdf = dir.filePath("printed.pdf").toStdString();
    services->printToPdf = pdf;
    window().mnuPrint->trigger();
    EXPECT_TRUE(QFile::exists(QString::fromStdString(pdf)));
    EXPECT_TRUE(prompts.messages.empty());
}

struct RedrawCase {
    const char* name;
    int16_t chartKind;
    int16_t choice;
    const char* header;  // "" : nothing redrawn
    int dialogs;
};

class Redraw : public WindowFixture, public ::testing::WithParamInterface<RedrawCase> {};

TEST_P(Redraw, FollowsTheRecordedChartKind)
{
    drawHourly();
    const RedrawCase& c = GetParam();
    modMain::giChartKind = c.chartKind;
    if (c.dialogs) prompts.answers.push_back(ui::ScriptedPrompter::choose(c.choice));
    window().mnuRedraw_Click();
    EXPECT_EQ(int(prompts.dialogsShown.size()), c.dialogs);
    EXPECT_EQ(window().Chart1().header.text, *c.header ? c.header : "Qty of Bookings: Total =  3");
    EXPECT_EQ(modMain::giChartKind, c.chartKind);
    EXPECT_EQ(mousePointer(), kPointerDefault);
    EXPECT_TRUE(!*c.header || window().mnuRedraw->isVisible());
}

INSTANTIATE_TEST_SUITE_P(
    Table, Redraw,
    ::testing::Values(RedrawCase{"none", 0, 0, "", 0}, RedrawCase{"yearly", 3, 0, "", 0},
                      RedrawCase{"prop", 4, 0, "", 0}, RedrawCase{"hourly", 5, 0, "", 0},
                      RedrawCase{"bookings", 1, 2, "Quote Type by Average Value", 1},
                      RedrawCase{"categories", 2, 6, "Category by %Jobs and % $Value", 1},
                      RedrawCase{"cancelled", 1, kChoiceCancelled, "", 1}), test::byName);

TEST_F(WindowFixture, SetupRedrawsAfterOkAndAfterCancel)
{
    drawHourly();
    for (bool ok : {true, false}) {
        window().Chart1().group1.chartType = 99;  // DrawChart sets it back from the chart object
        prompts.answers.push_back([ok](QDialog& d) {
            auto& setup = dynamic_cast<ui::frmChartSetup&>(d);
            setup.optChartType[0]->click();  // Plot
            (ok ? setup.Command1 : setup.Command2)->click();
        });
        window().mnuSetup->trigger();
        EXPECT_EQ(window().Chart1().group1.chartType, control::kPlot) << ok;
    }
    EXPECT_TRUE(prompts.messages.empty());
}

TEST_F(WindowFixture, SaveAsAndCopyPutTheChartIntoAReport)
{
    drawHourly();
    const std::string svg = dir.filePath("chart.svg").toStdString();
    prompts.saveFiles.push_back(svg);
    window().mnuSaveAs->trigger();
    QFile file(QString::fromStdString(svg));
    ASSERT_TRUE(file.open(QIODevice::ReadOnly));
    EXPECT_TRUE(file.readAll().contains("Qty of Bookings: Total =  3"));

    window().mnuSaveAs->trigger();  // cancelled: nothing happens
    EXPECT_TRUE(prompts.messages.empty());

    window().mnuCopy->trigger();
    const QImage copied = QApplication::clipboard()->image();
    EXPECT_EQ(copied.size(), window().centralWidget()->size());
}

}  // namespace
}  // namespace kg
