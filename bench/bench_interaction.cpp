// How immediate the chart control's view feels while the user scales, moves and zooms: one
// repaint of the monthly report (10 series x 12 points, 3-D bars with value labels) at 1600x1000
// while zoomed, through the widget and through the painter alone; one step of a scale drag
// (the mouse move and the repaint it causes); the tip's hit test. The target for a repaint is one
// frame at 120 Hz, 8 ms.
#include <benchmark/benchmark.h>

#include <QApplication>
#include <QImage>
#include <QMouseEvent>
#include <QPainter>
#include <string>

#include "BenchCharts.h"
#include "chart/control/model/ChartControl.h"
#include "chart/control/render/ChartLayout.h"
#include "chart/control/render/ChartPainter.h"
#include "chart/control/view/ChartView.h"

using namespace kg::control;

namespace {

const QSize kSize(1600, 1000);
// A graphics zoom into the chart's left half, a little moved.
const ViewState kZoomed{1.8, 0.22, -0.06};

// The view, counting its paints so that the benchmark can tell a repaint really happened.
class CountingView : public ChartView {
public:
    using ChartView::ChartView;
    int paints = 0;

protected:
    void paintEvent(QPaintEvent* event) override
    {
        ++paints;
        ChartView::paintEvent(event);
    }
};

struct Window {
    kg::Ref<ChartControl> chart = kg::makeRef<ChartControl>();
    CountingView view{chart};
    Window()
    {
        bench::fillMonthlyReport(*chart);
        chart->view = kZoomed;
        view.resize(kSize);
        view.show();
        QApplication::processEvents();
    }
};

// Made in main, so that the widget goes before the application object.
Window* g_window = nullptr;
Window& window() { return *g_window; }

void BM_ZoomedRepaint_View(benchmark::State& state)
{
    Window& w = window();
    w.chart->view = kZoomed;
    const int before = w.view.paints;
    for (auto _ : state) w.view.repaint();
    state.counters["paints_per_iteration"] = double(w.view.paints - before) / double(state.iterations());
}

void BM_ZoomedRepaint_Painter(benchmark::State& state)
{
    ChartControl& chart = *window().chart;
    chart.view = kZoomed;
    QImage image(kSize, QImage::Format_ARGB32_Premultiplied);
    for (auto _ : state) {
        QPainter painter(&image);
        paintChart(chart, painter, QRectF(image.rect()));
    }
}

void BM_UnzoomedRepaint_View(benchmark::State& state)
{
    Window& w = window();
    w.chart->view = {};
    for (auto _ : state) w.view.repaint();
    w.chart->view = kZoomed;
}

// One mouse move of a Ctrl + middle button scale drag, then the repaint it asked for.
void BM_ScaleDragStep(benchmark::State& state)
{
    Window& w = window();
    w.chart->view = kZoomed;
    const QPointF centre = computeLayout(*w.chart, QRectF(w.view.rect())).chartContent.center();
    QMouseEvent press(QEvent::MouseButtonPress, centre, w.view.mapToGlobal(centre), Qt::MiddleButton,
                      Qt::MiddleButton, Qt::ControlModifier);
    QApplication::sendEvent(&w.view, &press);
    int step = 0;
    for (auto _ : state) {
        // Down 60 pixels a pixel at a time and back up: a new scale every step, as in a real drag,
        // staying between the zoom measured above and 1.8 times that.
        const int down = step++ % 120;
        const QPointF at = centre + QPointF(0, down < 60 ? down : 120 - down);
        QMouseEvent move(QEvent::MouseMove, at, w.view.mapToGlobal(at), Qt::NoButton, Qt::MiddleButton,
                         Qt::ControlModifier);
        QApplication::sendEvent(&w.view, &move);
        w.view.repaint();
    }
    QMouseEvent release(QEvent::MouseButtonRelease, centre, w.view.mapToGlobal(centre), Qt::MiddleButton,
                        Qt::NoButton, Qt::ControlModifier);
    QApplication::sendEvent(&w.view, &release);
    w.chart->view = kZoomed;
}

void BM_ToolTipHitTest(benchmark::State& state)
{
    Window& w = window();
    w.chart->view = kZoomed;
    const QPointF centre = computeLayout(*w.chart, QRectF(w.view.rect())).chartContent.center();
    for (auto _ : state) benchmark::DoNotOptimize(w.view.toolTipAt(centre));
}

}  // namespace

BENCHMARK(BM_ZoomedRepaint_View)->Unit(benchmark::kMillisecond)->MeasureProcessCPUTime();
BENCHMARK(BM_ZoomedRepaint_Painter)->Unit(benchmark::kMillisecond)->MeasureProcessCPUTime();
BENCHMARK(BM_UnzoomedRepaint_View)->Unit(benchmark::kMillisecond)->MeasureProcessCPUTime();
BENCHMARK(BM_ScaleDragStep)->Unit(benchmark::kMillisecond)->MeasureProcessCPUTime();
BENCHMARK(BM_ToolTipHitTest)->Unit(benchmark::kMicrosecond)->MeasureProcessCPUTime();

int main(int argc, char** argv)
{
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM")) qputenv("QT_QPA_PLATFORM", "offscreen");
    QApplication app(argc, argv);
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    Window w;
    g_window = &w;
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}
