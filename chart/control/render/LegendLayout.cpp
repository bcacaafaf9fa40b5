// The legend's place and entries: east of the chart area, vertically centred, in as many
// columns as its height needs and its width allows. Placement code 17 (east) is the only one the
// chart object sets; other codes are placed the same way.
#include <algorithm>
#include <cmath>

#include "chart/control/render/LayoutParts.h"

namespace kg::control {

namespace layout {
namespace {
constexpr double kLegendPad = 6;
constexpr double kSwatchGap = 5;
constexpr double kLegendColumnGap = 10;
constexpr double kLegendMinText = 40;
constexpr double kLegendShare = 0.3;  // of the control's width at most
}  // namespace

void placeLegend(const ChartControl& chart, ChartLayout& L, const ChartFonts& fonts, QRectF& inner)
{
    if (!chart.legend.isShown) return;
    const std::vector<QString> texts = legendTexts(chart, L.kind);
    if (std::none_of(texts.begin(), texts.end(), [](const QString& t) { return !t.isEmpty(); })) return;

    const MeasuredFont& f = fonts.legend;
    const double swatch = std::round(std::min(f.height * 0.8, 12.0));
    const double rowH = std::max(f.height, swatch);
    const double maxWidth = std::max(60.0, inner.width() * kLegendShare);
    const double availH = inner.height() - 2 * kLegendPad;
    const int n = int(texts.size());
    if (availH < rowH || maxWidth < 2 * kLegendPad + swatch) return;

    double gap = std::clamp(double(chart.legend.gapBetween), 0.0, 100.0);
    double widest = 0;
    for (const QString& t : texts) widest = std::max(widest, f.width(t));

    // Shrink the gaps between entries before spreading them over columns.
    int perColumn = n;
    if (n * rowH + (n - 1) * gap > availH) {
        gap = n > 1 ? std::max(2.0, std::min(gap, (availH - n * rowH) / (n - 1))) : gap;
        perColumn = std::max(1, int((availH + gap) / (rowH + gap)));
    }
    int columns = (n + perColumn - 1) / perColumn;
    const double entryExtra = swatch + kSwatchGap;
    auto textWidthFor = [&](int cols) {
        return (maxWidth - 2 * kLegendPad - (cols - 1) * kLegendColumnGap) / cols - entryExtra;
    };
    double textW = std::min(widest, textWidthFor(columns));
    if (textW < kLegendMinText && columns > 1) {
        columns = std::max(
            1, int((maxWidth - 2 * kLegendPad + kLegendColumnGap) / (entryExtra + kLegendMinText + kLegendColumnGap)));
        textW = std::min(widest, textWidthFor(columns));
    }
    textW = std::max(0.0, textW);
    const int shown = std::min(n, columns * perColumn);
    L.legendTruncated = shown < n;
    const int rows = std::min(perColumn, n);
    const double columnW = entryExtra + textW;
    const double width = 2 * kLegendPad + columns * columnW + (columns - 1) * kLegendColumnGap;
    const double height = 2 * kLegendPad + rows * rowH + (rows - 1) * gap;
    const double gapToPlot = std::clamp(double(chart.legend.gapToPlot), 0.0, 200.0);

    L.legend = QRectF(inner.right() - width, inner.center().y() - height / 2, width, height);
    inner.setRight(L.legend.left() - gapToPlot);

    for (int i = 0; i < shown; ++i) {
        const int col = i / perColumn, row = i % perColumn;
        const double x = L.legend.left() + kLegendPad + col * (columnW + kLegendColumnGap);
        const double y = L.legend.top() + kLegendPad + row * (rowH + gap);
        LegendItem item;
        item.series = i + 1;
        item.swatch = QRectF(x, y + (rowH - swatch) / 2, swatch, swatch);
        item.textOrigin = QPointF(x + entryExtra, y + (rowH - f.height) / 2 + f.ascent);
        item.text = f.metrics.elidedText(texts[size_t(i)], Qt::ElideRight, textW + 0.5);
        L.legendItems.push_back(std::move(item));
    }
    if (L.legendTruncated && !L.legendItems.empty()) {
        // The last place says that more entries exist than fit.
        LegendItem& last = L.legendItems.back();
        last.series = 0;
        last.text = QStringLiteral("\u2026");
    }
}

}  // namespace layout

std::vector<QString> legendTexts(const ChartControl& chart, ChartKind kind)
{
    const int32_t count = chart.data().seriesCount();
    const std::vector<std::string>* source = &chart.group1.seriesLabels;
    if (kind == ChartKind::Pie) {
        const auto covered = [count](const std::vector<std::string>& list) {
            return std::min<size_t>(list.size(), size_t(std::max(0, count)));
        };
        if (covered(chart.group1.pointLabels) > covered(chart.group1.seriesLabels)) source = &chart.group1.pointLabels;
    }
    std::vector<QString> texts;
    texts.reserve(size_t(std::max(0, count)));
    for (int32_t s = 1; s <= count; ++s) {
        texts.push_back(size_t(s) <= source->size() ? displayText((*source)[size_t(s - 1)]) : QString());
    }
    return texts;
}

}  // namespace kg::control
