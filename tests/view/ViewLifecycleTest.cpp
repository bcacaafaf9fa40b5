// The view state belongs to the window's control: a redraw of the same chart (value labels on or
// off, the style dialog's redraw) keeps scale, move and zoom; a new request starts plain. The
// chart object reads a rotation made with the mouse back from the control.
#include <functional>

#include "support/RequestFixture.h"
#include "view/ViewFixture.h"

namespace kg::test {
namespace {

using control::test::dragOn;

struct AfterCase {
    const char* name;
    std::function<void(RequestFixture&)> then;
    bool keepsView;
};

class ViewLifecycleTest : public RequestFixture, public ::testing::WithParamInterface<AfterCase> {
protected:
    void runRequest()
    {
        setForm("{\"grid1\": " + gridJson(1, 3, 8) + "}");
        Args args{Variant(int32_t(3)), Variant(100.0)};
        ASSERT_EQ(request(KG_DISPID_GENERATECHART_HOURLYGRAPH1, args), 0) << lastError;
    }
    void TearDown() override
    {
        view.reset();
        RequestFixture::TearDown();
    }
    std::unique_ptr<control::ChartView> view;
};

TEST_P(ViewLifecycleTest, RedrawKeepsTheViewANewRequestResetsIt)
{
    runRequest();
    control::ChartControl& c = chart1();
    view = std::make_unique<control::ChartView>(&c);
    view->resize(900, 600);
    view->show();
    const control::ChartLayout l = control::computeLayout(c, QRectF(view->rect()));
    const QPoint centre = l.chartContent.center().toPoint();

    dragOn(view.get(), {Qt::MiddleButton}, Qt::NoModifier, centre, centre + QPoint(10, 20));  // rotate
    dragOn(view.get(), {Qt::LeftButton}, Qt::ShiftModifier, l.toScreen(2, 15).toPoint(), l.toScreen(6, 30).toPoint());
    dragOn(view.get(), {Qt::MiddleButton}, Qt::ControlModifier, centre, centre + QPoint(0, 60));
    dragOn(view.get(), {Qt::MiddleButton}, Qt::ShiftModifier, centre, centre + QPoint(-40, 25));
    ASSERT_EQ(c.chartArea.view3D.rotation, 15);
    ASSERT_EQ(c.chartArea.view3D.elevation, 20);
    EXPECT_EQ(modMain::chart().Rotation(), 15);
    EXPECT_EQ(modMain::chart().Elevation(), 20);
    const control::ViewState zoomed = c.view;
    const control::Axis x = c.chartArea.x, y = c.chartArea.y;
    ASSERT_TRUE(x.hasFixedRange && y.hasFixedRange);
    ASSERT_FALSE(zoomed.isIdentity());

    GetParam().then(*this);

    if (GetParam().keepsView) {
        EXPECT_EQ(c.view.scale, zoomed.scale);
        EXPECT_EQ(c.view.offsetX, zoomed.offsetX);
        EXPECT_EQ(c.view.offsetY, zoomed.offsetY);
        EXPECT_TRUE(c.chartArea.x.hasFixedRange);
        EXPECT_EQ(c.chartArea.x.min, x.min);
        EXPECT_EQ(c.chartArea.y.max, y.max);
    } else {
        EXPECT_TRUE(c.view.isIdentity());
        EXPECT_FALSE(c.chartArea.x.hasFixedRange);
        EXPECT_FALSE(c.chartArea.y.hasFixedRange);
    }
}

void labels(bool on)
{
    modMain::chart().setPointLabels(on);
    modMain::chart().DrawChart(modMain::gvArray);
}

INSTANTIATE_TEST_SUITE_P(
    Afterwards, ViewLifecycleTest,
    ::testing::Values(AfterCase{"labelsOn", [](RequestFixture&) { labels(true); }, true},
                      AfterCase{"styleDialogRedraw",
                                [](RequestFixture&) {
                                    c2dChart& chart = modMain::chart();
                                    chart.setRotation(-20);
                                    chart.setElevation(30);
                                    chart.setChartType(control::kPlot);
                                    chart.DrawChart(modMain::gvArray);
                                },
                                true},
                      AfterCase{"newRequest",
                                [](RequestFixture& f) {
                                    Args args{Variant(int32_t(3)), Variant(50.0)};
                                    ASSERT_EQ(f.request(KG_DISPID_GENERATECHART_HOURLYGRAPH1, args), 0) << f.lastError;
                                },
                                false}),
    control::samples::rowName);

}  // namespace
}  // namespace kg::test
