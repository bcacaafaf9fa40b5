// Rendering speed of the chart control's painter, for the three reference charts: the monthly
// report (10 series x 12 points, bars with value labels, 800x600), the status pie (13 slices,
// 800x600) and the large hourly plot (200 series x 1000 points, 1600x1000). Each is measured
// in memory and as a PNG file; the PNG encoders are also measured alone, with the bytes they
// produce as a counter.
#include <benchmark/benchmark.h>

#include <QBuffer>
#include <QGuiApplication>
#include <QImage>
#include <QImageWriter>
#include <QTemporaryDir>
#include <string>

#include "BenchCharts.h"
#include "chart/control/model/ChartControl.h"
#include "chart/control/render/ChartExport.h"
#include "chart/control/render/PngWriter.h"

using namespace kg::control;

namespace {

ChartControl& monthlyReport()
{
    static ChartControl c;
    if (c.data().seriesCount() == 0) {
        bench::fillMonthlyReport(c);
    }
    return c;
}

ChartControl& statusPie()
{
    static ChartControl c;
    if (c.data().seriesCount() == 0) {
        bench::styleLikeTheChartObject(c);
        c.header.text = "Jobs by status";
        const double values[] = {12, 30, 5, 8, 22, 17, 3, 9, 14, 26, 7, 11, 4};
        c.group1.chartType = kPie;
        c.data().setSeriesCount(13);
        for (int s = 1; s <= 13; ++s) {
            c.data().setPointCount(s, 1);
            c.data().setX(s, 1, 1);
            c.data().setY(s, 1, values[s - 1]);
            c.group1.pointLabels.push_back("Status " + std::to_string(s));
        }
    }
    return c;
}

ChartControl& hourlyPlot()
{
    static ChartControl c;
    if (c.data().seriesCount() == 0) {
        bench::styleLikeTheChartObject(c);
        c.chartArea.x.annotationMethod = 0;
        bench::fill(c, 200, 1000, kPlot);
    }
    return c;
}

const QSize kReportSize(800, 600);
const QSize kLargeSize(1600, 1000);

void renderToImage(benchmark::State& state, ChartControl& chart, QSize size)
{
    for (auto _ : state) benchmark::DoNotOptimize(renderImage(chart, size));
}

void renderToPng(benchmark::State& state, ChartControl& chart, QSize size)
{
    QTemporaryDir dir;
    const std::string path = dir.filePath(QStringLiteral("chart.png")).toStdString();
    for (auto _ : state) exportChart(chart, path, size);
    state.counters["png_bytes"] = double(QFileInfo(QString::fromStdString(path)).size());
}

void BM_ReportBars_Image(benchmark::State& s) { renderToImage(s, monthlyReport(), kReportSize); }
void BM_ReportBars_Png(benchmark::State& s) { renderToPng(s, monthlyReport(), kReportSize); }
void BM_ReportBarsFlat_Png(benchmark::State& s)
{
    ChartControl& c = monthlyReport();
    const View3D keep = c.chartArea.view3D;
    c.chartArea.view3D = {};
    renderToPng(s, c, kReportSize);
    c.chartArea.view3D = keep;
}
void BM_StatusPie_Image(benchmark::State& s) { renderToImage(s, statusPie(), kReportSize); }
void BM_StatusPie_Png(benchmark::State& s) { renderToPng(s, statusPie(), kReportSize); }
void BM_HourlyPlot_Image(benchmark::State& s) { renderToImage(s, hourlyPlot(), kLargeSize); }
void BM_HourlyPlot_Png(benchmark::State& s) { renderToPng(s, hourlyPlot(), kLargeSize); }
void BM_HourlyPlotFlat_Image(benchmark::State& s)
{
    ChartControl& c = hourlyPlot();
    const View3D keep = c.chartArea.view3D;
    c.chartArea.view3D = {};
    renderToImage(s, c, kLargeSize);
    c.chartArea.view3D = keep;
}

// The PNG path chosen (libpng, RGB, zlib level 1, SUB filter) against Qt's default encoder.
void BM_EncodePng_LibpngFast(benchmark::State& state)
{
    const QImage image = renderImage(monthlyReport(), kReportSize);
    qsizetype bytes = 0;
    for (auto _ : state) bytes = encodePng(image).size();
    state.counters["png_bytes"] = double(bytes);
}

void BM_EncodePng_QtDefault(benchmark::State& state)
{
    const QImage image = renderImage(monthlyReport(), kReportSize);
    qsizetype bytes = 0;
    for (auto _ : state) {
        QBuffer buffer;
        buffer.open(QIODevice::WriteOnly);
        QImageWriter writer(&buffer, "png");
        writer.write(image);
        bytes = buffer.size();
    }
    state.counters["png_bytes"] = double(bytes);
}

}  // namespace

BENCHMARK(BM_ReportBars_Image)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_ReportBars_Png)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_ReportBarsFlat_Png)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_StatusPie_Image)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_StatusPie_Png)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_HourlyPlot_Image)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_HourlyPlot_Png)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_HourlyPlotFlat_Image)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_EncodePng_LibpngFast)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_EncodePng_QtDefault)->Unit(benchmark::kMillisecond);

int main(int argc, char** argv)
{
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM")) qputenv("QT_QPA_PLATFORM", "offscreen");
    QGuiApplication app(argc, argv);
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}
