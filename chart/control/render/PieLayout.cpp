// The pie's place: centred in the chart area with room for its value labels; in 3-D a disc
// tilted by the elevation with a rim as thick as the depth asks.
#include <algorithm>
#include <cmath>

#include "chart/control/render/LayoutParts.h"

namespace kg::control::layout {

namespace {
constexpr double kPi = 3.14159265358979323846;
}  // namespace

void placePie(const ChartControl& chart, ChartLayout& L, const ChartFonts& fonts)
{
    const QRectF box = L.chartContent.adjusted(kContentPad, kContentPad, -kContentPad, -kContentPad);
    const View3D& v = chart.chartArea.view3D;
    double ratio = 1, rimShare = 0, start = 90;
    if (!v.isFlat()) {
        // Tilt strongest at an elevation of 45 degrees; the rim grows with the depth.
        const double elevation = std::clamp(std::fabs(double(v.elevation)), 0.0, 90.0);
        const double tilt = std::sin(2 * elevation * kPi / 180);
        ratio = 1 - 0.5 * tilt;
        rimShare = std::clamp(double(v.depth), 0.0, 100.0) / 100 * 0.8 * tilt;
        start = 90 - std::fmod(double(v.rotation), 360.0);
    }
    const LabelRoom room = valueLabelRoom(chart, fonts, true);
    const double roomX = room.any ? room.above + room.width : 0;
    const double roomY = room.any ? room.above + room.height : 0;
    double rx = std::min((box.width() - 2 * roomX) / 2, (box.height() - 2 * roomY) / (2 * ratio + rimShare));
    rx = std::max(rx, std::min(box.width(), box.height()) / 6);
    rx = std::max(rx, 4.0);
    PieGeometry& pie = L.pie;
    pie.rx = rx;
    pie.ry = rx * ratio;
    pie.rim = rx * rimShare;
    pie.centre = QPointF(box.center().x(), box.center().y() - pie.rim / 2);
    L.plotArea = QRectF(pie.centre.x() - pie.rx, pie.centre.y() - pie.ry, 2 * pie.rx, 2 * pie.ry + pie.rim);

    double total = 0;
    const ChartData& d = chart.data();
    for (int32_t s = 1; s <= d.seriesCount(); ++s) {
        if (d.pointCount(s) < 1) continue;
        const double value = d.ys(s)[0];
        if (std::isfinite(value) && value > 0) total += std::min(value, 1e300);
    }
    if (!(total > 0) || !std::isfinite(total)) return;
    double angle = start;
    for (int32_t s = 1; s <= d.seriesCount(); ++s) {
        if (d.pointCount(s) < 1) continue;
        const double value = d.ys(s)[0];
        if (!std::isfinite(value) || value <= 0) continue;
        PieSlice slice;
        slice.series = s;
        slice.value = value;
        slice.startAngle = angle;
        slice.spanAngle = -360.0 * std::min(value, 1e300) / total;
        angle += slice.spanAngle;
        pie.slices.push_back(slice);
    }
}

}  // namespace kg::control::layout
