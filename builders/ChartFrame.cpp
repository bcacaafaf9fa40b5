#include "builders/ChartFrame.h"

#include "component/modMain.h"

namespace kg::builders {

using namespace modMain;

c2dChart& prepareChart(ChartWindowPort& window, const ChartFrame& frame, const std::function<int32_t()>& lastPoint)
{
    c2dChart& c = chart();
    c.Initialize(&window.Chart1(), frame.header, "", frame.xTitle, frame.yTitle);
    c.setNumSeries(frame.numSeries);
    c2dChart::setShowLegend(frame.showLegend);
    c.setXMinData(1);
    c.setXMaxData(lastPoint());
    c.InitChart();
    gvArray.redim(c.NumSeries(), c.NumPoints());
    c.setXAxisLabels(false);
    window.Chart1().group1.pointLabels.clear();
    return c;
}

void showChart(ChartWindowPort& window, c2dChart& chart, bool redrawVisible)
{
    HourglassOff();
    window.setRedrawVisible(redrawVisible);
    window.Show();
    chart.DrawChart(gvArray);
}

}  // namespace kg::builders
