// The demo host's report screen under the offscreen platform, driven through its buttons as a user
// drives it: one request of each family, a measure chosen in the component's own dialog, a date
// range the component refuses, and host grids that make a request fail.
#include <QDateEdit>
#include <QPushButton>
#include <QStatusBar>
#include <QTableWidget>
#include <optional>

#include "DemoSupport.h"
#include "apps/demo/DemoWindow.h"
#include "apps/demo/ReportForm.h"
#include "teststand/SampleData.h"

namespace {

using namespace demo_test;
using kg::demo::DemoWindow;
using kg::demo::ReportRequest;

const ReportRequest& requestNamed(const char* name)
{
    for (const ReportRequest& r : kg::demo::reportRequests())
        if (std::string(r.name) == name) return r;
    throw std::invalid_argument(name);
}

class DemoWindowTest : public ::testing::Test {
protected:
    static void SetUpTestSuite() { usePrivateRegistration(); }
    static void TearDownTestSuite()
    {
        // The chart window is the component's and outlives the host's screen, shown or only loaded
        // (a request that failed after loading it); closing it unloads it.
        for (QWidget* w : QApplication::topLevelWidgets())
            if (w->objectName() == "frmChart") w->close();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    }

    void SetUp() override
    {
        // A chart window left from an earlier test would pass for one this test's request showed.
        if (QWidget* chart = visibleTopLevel("frmChart")) chart->close();
        QApplication::processEvents();
        window = std::make_unique<DemoWindow>(kg::demo::DemoOptions{
            scratch().path() + "/sample", scratch().path() + "/settings.ini", componentLibrary()});
        ASSERT_TRUE(window->loadSample()) << statusText();
        window->show();
        ASSERT_TRUE(window->connectComponent()) << statusText();
    }

    std::string statusText() const { return window->statusBar()->currentMessage().toStdString(); }

    void click(const char* request)
    {
        QPushButton* button = window->requestButton(requestNamed(request));
        ASSERT_NE(button, nullptr) << request;
        button->click();
    }

    QTableWidget* grid(const char* name) const { return window->form()->grid(name); }

    std::unique_ptr<DemoWindow> window;
};

// --- One request of each family -----------------------------------------------------------------

struct FamilyCase {
    const char* name;
    const char* request;
    const char* caption;
    const char* dialog;  // the data choice dialog the request shows, or null
};

void PrintTo(const FamilyCase& c, std::ostream* os) { *os << c.name; }

class RequestFamilyTest : public DemoWindowTest, public ::testing::WithParamInterface<FamilyCase> {};

TEST_P(RequestFamilyTest, DrawsItsChartAndSaysSo)
{
    const FamilyCase& c = GetParam();
    std::optional<WhenShown> chooser;
    if (c.dialog)
        chooser.emplace([&] { return visibleTopLevel(c.dialog); },
                        [](QWidget* dialog) { clickIn(dialog, {"optData_2", "Command1"}); });
    click(c.request);
    if (chooser) {
        EXPECT_TRUE(chooser->done()) << c.dialog << " was not shown";
    }
    EXPECT_EQ(statusText(), std::string("Drew ") + c.caption);
    QWidget* chart = visibleTopLevel("frmChart");
    EXPECT_NE(chart, nullptr) << "no chart window shown";
}

const FamilyCase kFamilies[] = {
    {"PropGraph", "GenerateChart_PropGraph2", "Prop 2", nullptr},
    {"BookingsWithMeasureTwo", "GenerateChart_BookingsReport", "Bookings", "frmChoose1"},
    {"ServiceCategoriesWithMeasureTwo", "GenerateChart_ServCatSumm", "Service Categories", "frmChoose2"},
};

INSTANTIATE_TEST_SUITE_P(Families, RequestFamilyTest, ::testing::ValuesIn(kFamilies),
                         [](const auto& info) { return std::string(info.param.name); });

// --- The component's own refusals and the host's failures ---------------------------------------

TEST_F(DemoWindowTest, ReversedDatesShowTheComponentsMessageAndNothingFails)
{
    window->form()->toDate()->setDate(window->form()->fromDate()->date().addDays(-1));
    QString shown;
    WhenShown answer([] { return visibleMessageBox(); },
                     [&](QWidget* w) {
                         auto* box = static_cast<QMessageBox*>(w);
                         shown = box->text();
                         box->button(QMessageBox::Ok)->click();
                     });
    click("GenerateChart_JobStatusReport");
    EXPECT_TRUE(answer.done()) << "no message box";
    EXPECT_EQ(shown.toStdString(), "The FromDate must be less than or equal to the ToDate");
    EXPECT_EQ(statusText(), "Drew Job Status");
}

struct FailureCase {
    const char* name;
    const char* grid;
    int columns;          // the grid cut down to this many columns
    const char* request;
    const char* status;   // how the status bar begins
};

void PrintTo(const FailureCase& c, std::ostream* os) { *os << c.name; }

class HostGridFailureTest : public DemoWindowTest, public ::testing::WithParamInterface<FailureCase> {};

TEST_P(HostGridFailureTest, StatusBarShowsTheErrorNumberAndDescription)
{
    const FailureCase& c = GetParam();
    grid(c.grid)->setColumnCount(c.columns);
    click(c.request);
    EXPECT_EQ(statusText().rfind(c.status, 0), 0u) << statusText();
}

const FailureCase kFailures[] = {
    // Twelve months read from a grid of five columns: the host's Error 9 comes back unchanged.
    {"PropGraphPastTheLastColumn", "grid2", 5, "GenerateChart_PropGraph2",
     "Error 9: Subscript out of range: grid2.textmatrix(0, 5) is outside its 7 rows and 5 columns"},
};

INSTANTIATE_TEST_SUITE_P(Grids, HostGridFailureTest, ::testing::ValuesIn(kFailures),
                         [](const auto& info) { return std::string(info.param.name); });


// --- The sample on the screen -------------------------------------------------------------------

TEST_F(DemoWindowTest, TotalsOnTheScreenAreTheSamplesTotals)
{
    const kg::teststand::SampleData sample =
        kg::teststand::writeSampleData((scratch().path() + "/sample-check").toStdString());
    const kg::demo::ReportTotals shown = window->form()->totals();
    EXPECT_NEAR(shown.quantity, sample.totals.quantity, 0.005);
    EXPECT_NEAR(shown.value, sample.totals.value, 0.005);
    EXPECT_NEAR(shown.average, sample.totals.average, 0.005);
    EXPECT_EQ(window->form()->dataRows("grid1"), 6);
}

}  // namespace
