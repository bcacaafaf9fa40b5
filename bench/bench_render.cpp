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
#include <cmath>
#include <string>

#include "chart/control/model/ChartControl.h"
#include "chart/control/render/ChartExport.h"
#include "chart/control/render/PngWriter.h"

using namespace kg::control;

namespace {

void styleLikeTheChartObject(ChartControl& c)
{
    c.header = {"Qty of Bookings: Total = 12345", {10, true}};
    c.footer.font = {10, true};
    c.backgroundColor = 12763842;
    c.border = {6, 7};
    c.chartArea.backgroundColor = 11788021;
    c.chartArea.plotArea = {13495295, true};
    c.chartArea.border = {4, 2};
    c.chartArea.x.title = "Month";
    c.chartArea.y.title = "Quantity";
    c.chartArea.y.presentationCode = 2;
    c.chartArea.x.annotationMethod = 2;
    c.chartArea.view3D = {10, 10, 10};  // the stored style's defaults
    c.legend = {true, 17, 10, 10};
}

std::string numberText(double v)
{
    std::string s = std::to_string(std::lround(v));
    return v >= 0 ? " " + s : s;
}

void addValueLabels(ChartControl& c)
{
    for (int32_t s = 1; s <= c.data().seriesCount(); ++s) {
        for (int32_t p = 1; p <= c.data().pointCount(s); ++p) {
            ChartLabel& l = c.addChartLabel();
            l.text = numberText(c.data().y(s, p));
            l.name = "LB " + l.text;
            l.attachMethod = 2;
            l.series = s;
            l.point = p;
            l.offset = 20;
            l.isConnected = true;
            l.border = 4;
            l.borderWidth = 1;
            l.backgroundColor = 65535;
        }
    }
}

void fill(ChartControl& c, int series, int points, int16_t type)
{
    static const char* months[] = {"January", "February", "March",     "April",   "May",      "June",
                                   "July",    "August",   "September", "October", "November", "December"};
    c.group1.chartType = type;
    c.data().setBatched(true);
    c.data().setSeriesCount(series);
    for (int s = 1; s <= series; ++s) {
        c.data().setPointCount(s, points);
        c.group1.seriesLabels.push_back("Series " + std::to_string(s));
        for (int p = 1; p <= points; ++p) {
            c.data().setX(s, p, p);
            c.data().setY(s, p, std::round(100 + s * 2 + 40 * std::sin(p * 0.05 + s * 0.7)));
        }
    }
    for (int p = 1; p <= points; ++p) c.group1.pointLabels.push_back(points <= 12 ? months[p - 1] : std::to_string(p));
    c.data().setBatched(false);
}

ChartControl& monthlyReport()
{
    static ChartControl c;
    if (c.data().seriesCount() == 0) {
        styleLikeTheChartObject(c);
        fill(c, 10, 12, kBar);
        addValueLabels(c);
    }
    return c;
}

ChartControl& statusPie()
{
    static ChartControl c;
    if (c.data().seriesCount() == 0) {
        styleLikeTheChartObject(c);
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
        styleLikeTheChartObject(c);
        c.chartArea.x.annotationMethod = 0;
        fill(c, 200, 1000, kPlot);
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
