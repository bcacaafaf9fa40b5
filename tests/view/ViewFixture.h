#pragma once
// The chart control's view on a chart filled as the chart object fills it, driven by QTest mouse
// and key events, with the layout the painter uses to find the chart area, the legend and the
// data positions on screen.
#include <gtest/gtest.h>

#include <QApplication>
#include <QWheelEvent>
#include <QtTest/QTest>
#include <memory>
#include <vector>

#include "chart/control/render/ChartLayout.h"
#include "chart/control/view/ChartView.h"
#include "render/RenderSamples.h"

namespace kg::control::test {

inline const QSize kViewSize(1000, 700);
using samples::rowName;

// A drag with the given buttons pressed in order (and let go in reverse order).
inline void dragOn(QWidget* w, const std::vector<Qt::MouseButton>& buttons, Qt::KeyboardModifiers m, QPoint from,
                   QPoint to)
{
    for (Qt::MouseButton b : buttons) QTest::mousePress(w, b, m, from);
    QTest::mouseMove(w, (from + to) / 2);
    QTest::mouseMove(w, to);
    for (auto it = std::rbegin(buttons); it != std::rend(buttons); ++it) QTest::mouseRelease(w, *it, {}, to);
}

// The three series of the view tests: values that differ from bar to bar, one with a decimal.
inline void fillMonthlyBars(ChartControl& c, int16_t chartType)
{
    samples::styleLikeTheChartObject(c, "Bookings");
    samples::fillTable(c, 3, 6, chartType);
    c.data().setY(2, 3, 12.5);
    samples::addSeriesLabels(c, 3);
    for (const char* m : {"Jan", "Feb", "Mar", "Apr", "May", "Jun"}) c.group1.pointLabels.push_back(m);
    c.chartArea.view3D = {10, 10, 10};  // the stored style's defaults
}

struct ViewFixture : ::testing::Test {
    Ref<ChartControl> chart = makeRef<ChartControl>();
    std::unique_ptr<ChartView> view;

    void makeView(QSize size = kViewSize)
    {
        view = std::make_unique<ChartView>(chart);
        view->resize(size);
        view->show();
    }
    void TearDown() override
    {
        // QTest remembers held buttons between tests: let go of every one.
        for (Qt::MouseButton b : {Qt::LeftButton, Qt::RightButton, Qt::MiddleButton})
            if (QTestPrivate::qtestMouseButtons.testFlag(b)) QTest::mouseRelease(view.get(), b, {}, QPoint(1, 1));
        view.reset();
    }

    // The monthly bars (or another type over the same figures) on a view of the usual size.
    void showMonthly(int16_t chartType = kBar)
    {
        fillMonthlyBars(*chart, chartType);
        makeView();
    }

    ChartLayout layout() const { return computeLayout(*chart, QRectF(view->rect())); }
    QPoint areaCentre() const { return layout().chartContent.center().toPoint(); }

    void press(Qt::MouseButton b, Qt::KeyboardModifiers m, QPoint at) { QTest::mousePress(view.get(), b, m, at); }
    void release(Qt::MouseButton b, QPoint at) { QTest::mouseRelease(view.get(), b, {}, at); }
    void moveTo(QPoint at) { QTest::mouseMove(view.get(), at); }
    void key(int k, Qt::KeyboardModifiers m = {}) { QTest::keyClick(view.get(), Qt::Key(k), m); }
    void wheel(QPoint at, int delta, Qt::KeyboardModifiers m)
    {
        QWheelEvent e(QPointF(at), QPointF(view->mapToGlobal(at)), QPoint(), QPoint(0, delta), Qt::NoButton, m,
                      Qt::NoScrollPhase, false);
        QApplication::sendEvent(view.get(), &e);
    }

    void drag(const std::vector<Qt::MouseButton>& buttons, Qt::KeyboardModifiers m, QPoint from, QPoint to)
    {
        dragOn(view.get(), buttons, m, from, to);
    }
};

}  // namespace kg::control::test
