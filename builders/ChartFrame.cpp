#include "builders/ChartFrame.h"

namespace kg::builders {

c2dChart& prepareChart(BuildContext& context, const ChartFrame& frame, const std::function<int32_t()>& lastPoint)
{
    ChartWindowPort& window = context.window();
    c2dChart& c = context.chart();
    c.Initialize(&window.Chart1(), frame.header, "", frame.xTitle, frame.yTitle);
    c.setNumSeries(frame.numSeries);
    c2dChart::setShowLegend(frame.showLegend);
    c.setXMinData(1);
    c.setXMaxData(lastPoint());
    c.InitChart();
    if (frame.minPoints > 0 && c.NumPoints() < frame.minPoints) c.setNumPoints(frame.minPoints);
    context.table().redim(c.NumSeries(), c.NumPoints());
    c.setXAxisLabels(false);
    window.Chart1().group1.pointLabels.clear();
    return c;
}

void showChart(BuildContext& context, bool redrawVisible)
{
    c2dChart& chart = context.chart();
    ChartWindowPort& window = context.window();
    context.hourglass(false);
    window.setRedrawVisible(redrawVisible);
    window.Show();
    chart.DrawChart(context.table());
}

}  // namespace kg::builders
