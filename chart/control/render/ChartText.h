#pragma once
// Texts and fonts of the chart. Font sizes are in points at 96 dpi and set as pixel sizes, so the
// chart looks the same on every paint device: a printer page is painted at this logical size and
// scaled as a whole.
#include <QFont>
#include <QFontMetricsF>
#include <QString>
#include <string>

#include "chart/control/model/ChartControl.h"

namespace kg::control {

// A stored text as shown: exactly as stored (leading blanks included); control characters have
// no glyph, so line breaks and tabs show as blanks and the rest are dropped. Only the first 2000
// characters are kept: no page shows more in one line.
QString displayText(const std::string& text);

// A font of `points` at 96 dpi in the chart's sans family.
QFont chartFont(double points, bool bold);

// One font and its metrics, measured once per paint instead of once per text.
struct MeasuredFont {
    explicit MeasuredFont(const QFont& f);
    QFont font;
    QFontMetricsF metrics;
    double height = 0;  // line height
    double ascent = 0;
    double width(const QString& text) const { return metrics.horizontalAdvance(text); }
};

// The fonts of one chart: titles from the model, the rest the control's own.
struct ChartFonts {
    explicit ChartFonts(const ChartControl& chart);
    MeasuredFont header, footer;
    MeasuredFont axisTitle;  // axis titles
    MeasuredFont tick;       // tick and point label texts
    MeasuredFont legend;
    MeasuredFont label;  // value labels
};

}  // namespace kg::control
