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
    context.table().redim(c.NumSeries(), c.NumPoints());
    c.setXAxisLabels(false);
    window.Chart1().group1.pointLabels.clear();
    return c;
}

void showChart(BuildContext& context, bool redrawVisible)
{
    context.hourglass(false);
    ChartWindowPort& window = context.window();
    window.setRedrawVisible(redrawVisible);
    window.Show();
    context.chart().DrawChart(context.table());
}

}  // namespace kg::builders
