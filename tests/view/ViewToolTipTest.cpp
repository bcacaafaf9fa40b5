// The tip on hover: series label, point label and the value's number text of the bar, marker or
// pie slice under the mouse; nothing away from the data.
#include <QHelpEvent>
#include <QToolTip>
#include <cmath>
#include <functional>

#include "view/ViewFixture.h"

namespace kg::control::test {
namespace {

constexpr double kPi = 3.14159265358979323846;

// Where the mouse rests, found from the layout the painter uses.
using Aim = std::function<QPointF(const ChartControl&, const ChartLayout&)>;

Aim barFront(int32_t series, int32_t point)
{
    return [=](const ChartControl& c, const ChartLayout& l) { return l.view.map(l.barRect(c, series, point).center()); };
}

// On the top face of a 3-D bar, above its front face.
Aim barTop(int32_t series, int32_t point)
{
    return [=](const ChartControl& c, const ChartLayout& l) {
        const QRectF r = l.barRect(c, series, point);
        return l.view.map(QPointF(r.center().x(), r.top()) + l.barDepth / 2);
    };
}

Aim marker(int32_t series, int32_t point, QPointF by)
{
    return [=](const ChartControl& c, const ChartLayout& l) {
        return l.toScreen(l.xOf(point), c.data().y(series, point)) + by;
    };
}

// Halfway out from the centre along the middle of a slice.
Aim sliceMiddle(int32_t series)
{
    return [=](const ChartControl&, const ChartLayout& l) {
        for (const PieSlice& s : l.pie.slices) {
            if (s.series != series) continue;
            const double a = s.midAngle() * kPi / 180;
            return l.view.map(l.pie.centre + QPointF(l.pie.rx / 2 * std::cos(a), -l.pie.ry / 2 * std::sin(a)));
        }
        return QPointF(-1, -1);
    };
}

// The 3-D pie's rim straight below the centre (270 degrees).
const Aim kRimBottom = [](const ChartControl&, const ChartLayout& l) {
    return l.view.map(l.pie.centre + QPointF(0, l.pie.ry + l.pie.rim / 2));
};

const Aim kPlotCorner = [](const ChartControl&, const ChartLayout& l) {
    return l.view.map(l.plotArea.topLeft() + QPointF(3, 3));
};
const Aim kLegend = [](const ChartControl&, const ChartLayout& l) { return l.legend.center(); };
const Aim kHeader = [](const ChartControl&, const ChartLayout& l) { return l.header.center(); };

enum class Labels { Monthly, None, PieByPoints, PieByPointsNoSeries, PieBySeries };

struct TipCase {
    const char* name;
    int16_t chartType;
    int32_t depth;
    Labels labels;
    ViewState view;
    Aim aim;
    const char* tip;
    std::function<void(ChartControl&)> tweak = nullptr;
};

void fillFor(ChartControl& c, const TipCase& t)
{
    if (t.chartType == kPie) {
        samples::styleLikeTheChartObject(c, "Jobs");
        samples::fillPie(c, {10, 30, 20});
        if (t.labels == Labels::PieBySeries) samples::addSeriesLabels(c, 3, "Status ");
        if (t.labels == Labels::PieByPoints) c.group1.seriesLabels = {"Jobs"};
        if (t.labels == Labels::PieByPoints || t.labels == Labels::PieByPointsNoSeries)
            c.group1.pointLabels = {"Open", "Closed", "Held"};
    } else {
        fillMonthlyBars(c, t.chartType);
        if (t.labels == Labels::None) {
            c.group1.seriesLabels.clear();
            c.group1.pointLabels.clear();
        }
    }
    c.chartArea.view3D = {10, 10, t.depth};
    c.view = t.view;
    if (t.tweak) t.tweak(c);
}

class ToolTipTest : public ViewFixture, public ::testing::WithParamInterface<TipCase> {};

TEST_P(ToolTipTest, NamesTheDataUnderTheMouse)
{
    const TipCase& c = GetParam();
    fillFor(*chart, c);
    makeView();
    const ChartLayout l = layout();
    const QPointF at = c.aim(*chart, l);
    ASSERT_TRUE(QRectF(view->rect()).contains(at));
    EXPECT_EQ(view->toolTipAt(at).toStdString(), c.tip);
}

const ViewState kZoomed{2.0, 0.1, -0.05};

INSTANTIATE_TEST_SUITE_P(
    Points, ToolTipTest,
    ::testing::Values(
        TipCase{"flatBar", kBar, 0, Labels::Monthly, {}, barFront(2, 3), "Series 2, Mar:  12.5"},
        TipCase{"bar3DTopFace", kBar, 10, Labels::Monthly, {}, barTop(3, 4), "Series 3, Apr:  83"},
        TipCase{"barZoomed", kBar, 10, Labels::Monthly, kZoomed, barFront(3, 4), "Series 3, Apr:  83"},
        TipCase{"barWithoutLabels", kBar, 0, Labels::None, {}, barFront(2, 3), "Series 2, Point 3:  12.5"},
        TipCase{"plotMarker", kPlot, 0, Labels::Monthly, {}, marker(2, 3, {3, -2}), "Series 2, Mar:  12.5"},
        TipCase{"areaMarker", kArea, 0, Labels::Monthly, {}, marker(3, 6, {0, 0}), "Series 3, Jun:  19"},
        TipCase{"plotNearMiss", kPlot, 0, Labels::Monthly, {}, marker(2, 3, {7, 0}), ""},
        TipCase{"pieByPointLabels", kPie, 0, Labels::PieByPoints, {}, sliceMiddle(2), "Jobs, Closed:  30"},
        TipCase{"pieWithoutSeriesLabel", kPie, 0, Labels::PieByPointsNoSeries, {}, sliceMiddle(3), "Held:  20"},
        TipCase{"pieBySeriesLabels", kPie, 0, Labels::PieBySeries, {}, sliceMiddle(1), "Status 1:  10"},
        TipCase{"pie3DRim", kPie, 10, Labels::PieByPoints, {}, kRimBottom, "Jobs, Closed:  30"},
        TipCase{"pieZoomed", kPie, 10, Labels::PieByPoints, kZoomed, sliceMiddle(3), "Jobs, Held:  20"},
        TipCase{"negativeKeepsItsSign", kBar, 10, Labels::Monthly, {}, barFront(1, 2), "Series 1, Feb: -4.25",
                [](ChartControl& c) { c.data().setY(1, 2, -4.25); }},
        // A bar moved out of the chart area by the view is hidden, and so is its tip.
        TipCase{"barMovedOutOfTheArea", kBar, 10, Labels::Monthly, {1.0, 0.9, 0}, barFront(3, 1), ""},
        TipCase{"plotBackground", kBar, 0, Labels::Monthly, {}, kPlotCorner, ""},
        TipCase{"legend", kBar, 0, Labels::Monthly, {}, kLegend, ""},
        TipCase{"header", kBar, 0, Labels::Monthly, {}, kHeader, ""}),
    rowName);

TEST_F(ViewFixture, PositionThatIsNoNumberHasNoTip)
{
    showMonthly();
    const double nan = std::nan("");
    EXPECT_TRUE(view->toolTipAt(QPointF(nan, nan)).isEmpty());
    EXPECT_TRUE(view->toolTipAt(QPointF(layout().chartContent.center().x(), nan)).isEmpty());
}

// The help event on hover shows the tip, and hides it away from the data.
TEST_F(ViewFixture, HoverShowsTheTip)
{
    fillMonthlyBars(*chart, kBar);
    chart->chartArea.view3D.depth = 0;
    makeView();
    const QPoint onBar = barFront(2, 3)(*chart, layout()).toPoint();
    QHelpEvent hover(QEvent::ToolTip, onBar, view->mapToGlobal(onBar));
    QApplication::sendEvent(view.get(), &hover);
    EXPECT_TRUE(QToolTip::isVisible());
    EXPECT_EQ(QToolTip::text().toStdString(), "Series 2, Mar:  12.5");

    const QPoint away = layout().header.center().toPoint();
    QHelpEvent elsewhere(QEvent::ToolTip, away, view->mapToGlobal(away));
    QApplication::sendEvent(view.get(), &elsewhere);
    EXPECT_FALSE(elsewhere.isAccepted());
    EXPECT_TRUE(QTest::qWaitFor([] { return !QToolTip::isVisible(); }, 3000));
}

}  // namespace
}  // namespace kg::control::test
