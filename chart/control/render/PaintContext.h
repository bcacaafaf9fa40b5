#pragma once
// What every part of the painter works with: the painter, the model, its layout and its fonts.
#include <QPainter>
#include <optional>

#include "chart/control/model/ChartControl.h"
#include "chart/control/render/ChartLayout.h"
#include "chart/control/render/ChartText.h"

namespace kg::control {

struct PaintContext {
    QPainter& painter;
    const ChartControl& chart;
    const ChartLayout& layout;
    const ChartFonts& fonts;
    // Device pixels per logical pixel at the start of the paint (a printer page is painted at
    // the chart's logical size and scaled): thin lines are cosmetic, so they need this to keep
    // their width on every device while staying on the fast path.
    double lineScale = 1;

    QPen thinPen(const QColor& color, double width = 1) const;
};

// Where a value label points to: the data point on the chart and the way away from it.
struct LabelAnchor {
    QPointF point;
    QPointF direction;  // unit vector
};

// Plot area walls, grid lines, axes and their texts (bar, plot and area charts).
void paintAxes(const PaintContext& ctx);
void paintBars(const PaintContext& ctx);
void paintLines(const PaintContext& ctx, bool filled);
void paintPie(const PaintContext& ctx);
void paintValueLabels(const PaintContext& ctx);
void paintLegend(const PaintContext& ctx);

// The value label anchor of (series, point), if the chart shows that point.
std::optional<LabelAnchor> barAnchor(const PaintContext& ctx, int32_t series, int32_t point);
std::optional<LabelAnchor> lineAnchor(const PaintContext& ctx, int32_t series, int32_t point);
std::optional<LabelAnchor> pieAnchor(const PaintContext& ctx, int32_t series, int32_t point);

// Text drawn with its left end at `x` and its box's top at `top` (one text item per call, so a
// vector output keeps each text whole).
void drawTextAt(QPainter& p, const MeasuredFont& f, double x, double top, const QString& text);
void drawTextCentred(QPainter& p, const MeasuredFont& f, const QRectF& box, const QString& text);

}  // namespace kg::control
