// The job status request over 100 000 jobs, 20 000 of them in the range: the whole request
// headless, and its parts (the host's query, the request without painting, one paint).
#include <benchmark/benchmark.h>

#include <QDir>
#include <QGuiApplication>
#include <QImage>

#include "chart/control/render/ChartExport.h"
#include "requests/Services.h"
#include "requests/cTavixGraph.h"
#include "requests/modMain.h"
#include "teststand/SampleJobs.h"
#include "teststand/TestStand.h"

namespace {

using namespace kg;

struct Stand {
    Ref<Object> form;
    Stand()
    {
        const std::string folder = QDir::tempPath().toStdString() + "/kg-bench-jobs";
        QDir().mkpath(QString::fromStdString(folder));
        teststand::SampleJobsSpec spec;
        spec.count = 100000;
        writeSampleJobs(folder + "/jobs.db", spec);
        teststand::Config cfg;
        cfg.jobsDatabase = folder + "/jobs.db";
        cfg.settingsFile = folder + "/settings.ini";
        cfg.appFolder = folder;
        // 100 000 jobs spread evenly over 2026: 73 days hold 20 000 of them.
        std::string list;
        for (const std::string& c : teststand::jobStatusCaptions()) list += (list.empty() ? "\"" : ", \"") + c + "\"";
        form = teststand::loadFormJson(
            "{\"dtpFromDate\": \"2026-03-01\", \"dtpToDate\": \"2026-05-12\", \"cboFields\": {\"1\": [" + list + "]}}",
            "bench form");
        services().hostObjects = teststand::makeFactory(cfg);
    }
};

Stand& stand()
{
    static Stand s;
    return s;
}

void runRequest()
{
    auto graph = makeRef<cTavixGraph>();
    graph->SourceForm(Variant(stand().form));
    Args none;
    graph->invoke(KG_DISPID_GENERATECHART_JOBSTATUSREPORT, kMethod, none);
}

void BM_JobStatusRequest(benchmark::State& state)
{
    stand();
    for (auto _ : state) runRequest();
}
BENCHMARK(BM_JobStatusRequest)->Unit(benchmark::kMillisecond);

void BM_JobQueryOnly(benchmark::State& state)
{
    stand();
    Variant jobs(services().hostObjects->create(host::HostClass::JobData));
    int32_t rows = 0;
    for (auto _ : state) {
        Args from{Variant::date(46082)}, to{Variant::date(46154)};  // 2026-03-01, 2026-05-12
        call(jobs, "SetFromDate", from);
        call(jobs, "SetToDate", to);
        Args q{Variant(int32_t(255)), std::string()};
        call(jobs, "GetJobQuery", q);
        Args fetch{q[1], Variant(), Variant(int32_t(0)), std::string(), Variant(int32_t(0))};
        call(jobs, "FetchJobRows", fetch);
        rows = fetch[4].longValue();
    }
    state.counters["rows"] = rows;
}
BENCHMARK(BM_JobQueryOnly)->Unit(benchmark::kMillisecond);

void BM_JobStatusPaint(benchmark::State& state)
{
    runRequest();
    for (auto _ : state) {
        QImage image = control::renderImage(modMain::gfChart->Chart1(), QSize(800, 600));
        benchmark::DoNotOptimize(image.bits());
    }
}
BENCHMARK(BM_JobStatusPaint)->Unit(benchmark::kMillisecond);

}  // namespace

int main(int argc, char** argv)
{
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM")) qputenv("QT_QPA_PLATFORM", "offscreen");
    QGuiApplication app(argc, argv);
    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
    return 0;
}
