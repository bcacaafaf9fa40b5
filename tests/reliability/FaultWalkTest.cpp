// Every request through every failure point of the host, on a good form, a jobs database and a
// settings file: each call of each host operation the request makes fails in a run of its own.
// The request must return that failure with its description, hand the mouse pointer back, leave
// the settings file whole, and the same request straight after, with nothing planned, must chart.
#include <QFile>
#include <cstdio>

#include "teststand/SampleJobs.h"
#include "reliability/FaultWalk.h"
#include "support/RequestFixture.h"

namespace kg {
namespace {

namespace stand = teststand;
using stand::FaultPlan;

constexpr int32_t kInjected = errc::HostBase + stand::hosterr::Injected;
constexpr int16_t kNoChoice = -1;

struct RequestCase {
    const char* name;
    DispId id;
    bool gridArguments;  // lNumSeries and vTotal
    int16_t choice;      // the data choice dialog's answer, or kNoChoice
};

// A measure-choice request walks once with a one-measure and once with a two-measure choice.
const RequestCase kRequests[] = {
    {"YearlyRpt1", KG_DISPID_GENERATECHART_YEARLYRPT1, true, kNoChoice},       {"YearlyRpt2",
     KG_DISPID_GENERATECHART_YEARLYRPT2, true, kNoChoice},
    {"YearlyRpt3", KG_DISPID_GENERATECHART_YEARLYRPT3, true, kNoChoice},       {"BookingsReport",
     KG_DISPID_GENERATECHART_BOOKINGSREPORT, false, 0},
    {"BookingsReportDual", KG_DISPID_GENERATECHART_BOOKINGSREPORT, false, 5},      {"SalesDeclaration",
     KG_DISPID_GENERATECHART_SALESDECLARATION, false, 3},
    {"JobStatusReport", KG_DISPID_GENERATECHART_JOBSTATUSREPORT, false, kNoChoice}, {"GraphInitialize",
     KG_DISPID_GRAPHINITIALIZE, false, kNoChoice},
    {"ServCatSumm", KG_DISPID_GENERATECHART_SERVCATSUMM, false, 6},             {"PropGraph1",
     KG_DISPID_GENERATECHART_PROPGRAPH1, true, kNoChoice},
    {"PropGraph2", KG_DISPID_GENERATECHART_PROPGRAPH2, true, kNoChoice},       {"PropGraph3",
     KG_DISPID_GENERATECHART_PROPGRAPH3, true, kNoChoice},
    {"HourlyGraph1", KG_DISPID_GENERATECHART_HOURLYGRAPH1, true, kNoChoice},     {"HourlyGraph2",
     KG_DISPID_GENERATECHART_HOURLYGRAPH2, true, kNoChoice},
    {"HourlyGraph3", KG_DISPID_GENERATECHART_HOURLYGRAPH3, true, kNoChoice},
};

std::string goodForm()
{
    const std::string grid = test::gridJson(1, 2, 14);
    std::string captions;
    for (const std::string& c : stand::jobStatusCaptions()) captions += (captions.empty() ? "\"" : ", \"") + c + "\"";
    return "{\"grid1\": " + grid + ", \"grid2\": " + grid + ", \"grid3\": " + grid +
           ", \"gridsettings1\": {\"fixedRows\": 1, \"cells\": ["
           "[\"Quote type\", \"Qty\", \"Value\", \"Avg Value\", \"% Jobs\", \"% Value\"],"
           "[\"Retail\", 12, 1200.0, 100.0, 40, 35.5], [\"Trade\", 3, 300.0, 100.0, 60, 64.5]]},"
           " \"dtpFromDate\": \"2026-01-01\", \"dtpToDate\": \"2026-01-31\", \"cboFields\": {\"1\": [" +
           captions + "]}}";
}

class FaultWalk : public test::RequestFixture, public ::testing::WithParamInterface<RequestCase> {
protected:
    void SetUp() override
    {
        RequestFixture::SetUp();
        stand::SampleJobsSpec jobs;
        jobs.count = 4;  // every job costs fifteen cell conversions, each a failure point
        jobs.firstDate = "2026-01-02";
        jobs.lastDate = "2026-01-30";
        const std::string database = dir.filePath("jobs.db").toStdString();
        stand::writeSampleJobs(database, jobs);
        standConfig.jobsDatabase = database;
        standChanged();
        writeSetting("View3D", " 1");
        writeSetting("Rotation", " 20");
        writeSetting("Style", "Bar");
        writeSetting("LabelsOnDefault", "1");
        form_ = Variant(stand::loadFormJson(goodForm(), "walk form"));
        settingsFile_ = QString::fromStdString(standConfig.settingsFile);
    }
    void TearDown() override
    {
        FaultPlan::clear();
        RequestFixture::TearDown();
    }

    // The host's side before a request: its form handed over, the dialog's answer ready.
    void prepare()
    {
        modMain::releaseSharedObjects();
        Args a{form_};
        graph->invoke(KG_DISPID_SOURCEFORM, kPropertyPut, a);
        scriptChoice();
    }
    void scriptChoice()
    {
        prompts.choices.clear();
        if (GetParam().choice != kNoChoice) prompts.choices.push_back(GetParam().choice);
    }
    // Runs the request: its error number (0 on success), its description in lastError.
    int32_t runRequest()
    {
        lastError.clear();
        Args args;
        if (GetParam().gridArguments) args = {Variant(int32_t(2)), Variant(1234.5)};
        return request(GetParam().id, args);
    }
    // "" when the request charted as it should, else what went wrong.
    std::string charted()
    {
        if (const int32_t n = runRequest()) return "error " + std::to_string(n) + ": " + lastError;
        if (!prompts.messages.empty()) return "message box: " + prompts.messages.back();
        if (GetParam().id != KG_DISPID_GRAPHINITIALIZE && !(modMain::gfChart && modMain::gfChart->isShown())) return "no chart shown";
        if (mousePointer() != kPointerDefault) return "the pointer stays an hourglass";
        return {};
    }

    Variant form_;
    QString settingsFile_;
};

TEST_P(FaultWalk, EveryFailurePointFailsTheRequestCleanly)
{
    const std::vector<test::FailurePoint> points =
        test::countFailurePoints([this] { prepare(); }, [this] { return charted(); });
    ASSERT_FALSE(points.empty()) << "the request reaches no host operation";

    test::WalkReport report;
    for (const test::FailurePoint& p : points) {
        ++report.points;
        prepare();
        prompts.messages.clear();
        const QByteArray settingsBefore = test::fileBytes(settingsFile_);
        const QStringList folderBefore = test::filesBeside(settingsFile_);
        FaultPlan::failOn(p.operation, p.call);
        const int32_t number = runRequest();
        const int callsMade = FaultPlan::callsOf(p.operation);
        FaultPlan::clear();

        if (callsMade < p.call) report.add(p, "the planned call never came (the request is not repeatable)");
        if (number != kInjected)
            report.add(p, "returned error " + std::to_string(number) + " (" + lastError + "), not the injected one");
        else if (lastError.find(p.injectedText()) == std::string::npos)
            report.add(p, "the description \"" + lastError + "\" does not name the injected failure");
        if (mousePointer() != kPointerDefault) report.add(p, "the mouse pointer stays an hourglass");
        if (!prompts.messages.empty()) report.add(p, "a message box was shown: " + prompts.messages.back());
        const std::string damage = test::settingsDamage(settingsFile_, settingsBefore, folderBefore);
        if (!damage.empty()) report.add(p, damage);

        // The host calls again at once, with nothing planned: the request must chart.
        scriptChoice();
        const std::string again = charted();
        if (!again.empty()) report.add(p, "the next request fails: " + again);
    }
    std::printf("[   walk   ] %s: %zu failure point%s walked\n", GetParam().name, report.points, report.points == 1 ? "" : "s");
    EXPECT_TRUE(report.problems.empty()) << report.summary();
}

INSTANTIATE_TEST_SUITE_P(Requests, FaultWalk, ::testing::ValuesIn(kRequests),
                         [](const auto& info) { return std::string(info.param.name); });

// The walk is only as good as its list of operation names: each must be one the requests reach,
// or a name misspelt in the list (or renamed in the test stand) would silently walk nothing.
class OperationList : public FaultWalk {};

TEST_P(OperationList, RequestsReachTheListedOperations)
{
    std::vector<std::string> reached;
    test::countFailurePoints([this] { prepare(); }, [this] { return charted(); }, &reached);
    for (const char* op : {"Factory.AppServices", "Factory.JobData", "Factory.HostAux", "Factory.Settings"})
        EXPECT_NE(std::find(reached.begin(), reached.end(), op), reached.end()) << op;
    if (GetParam().id == KG_DISPID_GENERATECHART_JOBSTATUSREPORT) {
        for (const char* op : {"AppServices.CellToText", "AppServices.CellToNumberText", "JobData.SetFromDate",
                               "JobData.SetToDate", "JobData.GetJobQuery", "JobData.FetchJobRows", "Form.dtpFromDate",
                               "Form.dtpToDate", "Form.cboFields", "Picker.Value", "List.ListCount", "List.List",
                               "Settings.ReadSetting", "AppServices.GetSettingsOwner", "AppServices.GetAppFolder"})
            EXPECT_NE(std::find(reached.begin(), reached.end(), op), reached.end()) << op;
    }
    if (GetParam().choice != kNoChoice) {
        for (const char* op : {"Form.gridsettings1", "Grid.Rows", "Grid.FixedRows", "Grid.GetValueFromCell"})
            EXPECT_NE(std::find(reached.begin(), reached.end(), op), reached.end()) << op;
    }
    if (GetParam().gridArguments) {
        for (const char* op : {"Grid.Rows", "Grid.FixedRows", "Grid.textmatrix"})
            EXPECT_NE(std::find(reached.begin(), reached.end(), op), reached.end()) << op;
    }
}

INSTANTIATE_TEST_SUITE_P(Requests, OperationList,
                         ::testing::Values(kRequests[6], kRequests[3], kRequests[12], kRequests[7]),
                         [](const auto& info) { return std::string(info.param.name); });

}  // namespace
}  // namespace kg
