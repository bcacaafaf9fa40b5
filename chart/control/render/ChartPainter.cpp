#include "chart/control/render/ChartPainter.h"

#include <QPainter>
#include <cmath>

#include "chart/control/render/Borders.h"
#include "chart/control/render/ChartLayout.h"
#include "chart/control/render/ChartText.h"
#include "chart/control/render/Colors.h"
#include "chart/control/render/PaintContext.h"

namespace kg::control {

QPen PaintContext::thinPen(const QColor& color, double width) const
{
    QPen pen(color, width * lineScale);
    pen.setCosmetic(true);
    pen.setCapStyle(Qt::FlatCap);
    pen.setJoinStyle(Qt::RoundJoin);
    return pen;
}

void drawTextAt(QPainter& p, const MeasuredFont& f, double x, double top, const QString& text)
{
    if (text.isEmpty()) return;
    p.setFont(f.font);
    p.drawText(QPointF(x, top + f.ascent), text);
}

void drawTextCentred(QPainter& p, const MeasuredFont& f, const QRectF& box, const QString& text)
{
    if (text.isEmpty()) return;
    drawTextAt(p, f, box.center().x() - f.width(text) / 2, box.center().y() - f.height / 2, text);
}

namespace {
double lineScaleOf(const QPainter& painter)
{
    const QTransform t = painter.deviceTransform();
    const double s = std::sqrt(std::fabs(t.determinant()));
    return std::isfinite(s) && s > 0 ? s : 1.0;
}

void paintTitles(const PaintContext& ctx)
{
    QPainter& p = ctx.painter;
    p.setPen(Qt::black);
    if (!ctx.layout.header.isEmpty())
        drawTextCentred(p, ctx.fonts.header, ctx.layout.header, displayText(ctx.chart.header.text));
    if (!ctx.layout.footer.isEmpty())
        drawTextCentred(p, ctx.fonts.footer, ctx.layout.footer, displayText(ctx.chart.footer.text));
}
}  // namespace

void paintChart(const ChartControl& chart, QPainter& painter, const QRectF& target)
{
    const ChartFonts fonts(chart);
    paintChart(chart, painter, computeLayout(chart, target, fonts), fonts);
}

void paintChart(const ChartControl& chart, QPainter& painter, const ChartLayout& layout, const ChartFonts& fonts)
{
    if (layout.bounds.width() < 1 || layout.bounds.height() < 1) return;
    painter.save();
    painter.setRenderHint(QPainter::Antialiasing, true);
    painter.setRenderHint(QPainter::TextAntialiasing, true);
    PaintContext ctx{painter, chart, layout, fonts, lineScaleOf(painter)};

    const QColor face = toQColor(chart.backgroundColor);
    painter.setClipRect(layout.bounds, Qt::IntersectClip);
    paintBorder(painter, layout.bounds, chart.border, face, face);
    paintTitles(ctx);
    paintLegend(ctx);

    const QColor areaColor = toQColor(chart.chartArea.backgroundColor);
    paintBorder(painter, layout.chartArea, chart.chartArea.border, areaColor, areaColor);

    painter.save();
    painter.setClipRect(layout.chartContent, Qt::IntersectClip);
    painter.setTransform(layout.view, true);
    if (layout.kind == ChartKind::Pie) {
        paintPie(ctx);
    } else {
        paintAxes(ctx);
        if (layout.kind == ChartKind::Bar)
            paintBars(ctx);
        else
            paintLines(ctx, layout.kind == ChartKind::Area);
    }
    paintValueLabels(ctx);
    painter.restore();
    painter.restore();
}

}  // namespace kg::control
