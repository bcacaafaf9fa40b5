#include "chart/control/render/ChartText.h"

#include <algorithm>
#include <cmath>

namespace kg::control {

namespace {
constexpr double kPixelsPerPoint = 96.0 / 72.0;
constexpr double kAxisTitlePoints = 9;
constexpr double kSmallPoints = 8;
// More characters than any page can show in one line at the smallest font: the rest is cut
// before measuring, or a megabyte caption would be shaped in full on every paint.
constexpr qsizetype kMostShownCharacters = 2000;
}  // namespace

QString displayText(const std::string& text)
{
    // A byte beyond the shown characters' longest UTF-8 form cannot be shown either.
    const size_t bytes = std::min(text.size(), size_t(kMostShownCharacters) * 4);
    QString s = QString::fromUtf8(text.data(), qsizetype(bytes));
    if (s.size() > kMostShownCharacters) {
        qsizetype keep = kMostShownCharacters;
        if (s.at(keep - 1).isHighSurrogate()) --keep;  // never half a character
        s.truncate(keep);
    }
    bool clean = true;
    for (QChar c : s) {
        if (c.unicode() < 0x20) {
            clean = false;
            break;
        }
    }
    if (clean) return s;
    QString out;
    out.reserve(s.size());
    for (QChar c : s) {
        if (c.unicode() >= 0x20)
            out += c;
        else if (c == QLatin1Char('\n') || c == QLatin1Char('\r') || c == QLatin1Char('\t'))
            out += QLatin1Char(' ');
    }
    return out;
}

QFont chartFont(double points, bool bold)
{
    QFont f(QStringLiteral("DejaVu Sans"));
    f.setStyleHint(QFont::SansSerif);
    // Sizes outside what a chart can show are kept readable rather than refused.
    const double pt = std::isfinite(points) ? std::clamp(points, 1.0, 200.0) : 10.0;
    f.setPixelSize(std::max(1, int(std::lround(pt * kPixelsPerPoint))));
    f.setBold(bold);
    return f;
}

MeasuredFont::MeasuredFont(const QFont& f) : font(f), metrics(f), height(metrics.height()), ascent(metrics.ascent()) {}

ChartFonts::ChartFonts(const ChartControl& chart)
    : header(chartFont(chart.header.font.size, chart.header.font.bold)),
      footer(chartFont(chart.footer.font.size, chart.footer.font.bold)),
      axisTitle(chartFont(kAxisTitlePoints, true)),
      tick(chartFont(kSmallPoints, false)),
      legend(chartFont(kSmallPoints, false)),
      label(chartFont(kSmallPoints, false))
{
}

}  // namespace kg::control
