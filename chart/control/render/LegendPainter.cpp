// The legend: a framed box of colour swatches and texts beside the chart area.
#include <QPainter>

#include "chart/control/render/Colors.h"
#include "chart/control/render/PaintContext.h"

namespace kg::control {

void paintLegend(const PaintContext& ctx)
{
    const ChartLayout& L = ctx.layout;
    if (L.legend.isEmpty()) return;
    QPainter& p = ctx.painter;
    p.fillRect(L.legend.translated(2, 2), QColor(0, 0, 0, 70));
    p.fillRect(L.legend, toQColor(ctx.chart.chartArea.backgroundColor));
    p.setPen(ctx.thinPen(QColor(0x40, 0x40, 0x40)));
    p.setBrush(Qt::NoBrush);
    p.drawRect(L.legend);
    p.setFont(ctx.fonts.legend.font);
    for (const LegendItem& item : L.legendItems) {
        if (item.series > 0) {
            p.setPen(ctx.thinPen(seriesColor(item.series).darker(170), 0.75));
            p.setBrush(seriesColor(item.series));
            p.drawRect(item.swatch);
        }
        p.setPen(Qt::black);
        if (!item.text.isEmpty()) p.drawText(item.textOrigin, item.text);
    }
}

}  // namespace kg::control
