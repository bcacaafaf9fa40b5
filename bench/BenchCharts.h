#pragma once
// The charts the benchmarks draw, filled the way the chart object fills the control: its
// colours, borders and fonts, month names on the X axis, the legend east of the plot and a
// value label on every point.
#include <cmath>
#include <string>

#include "chart/control/model/ChartControl.h"
#include "core/Convert.h"

namespace kg::control::bench {

inline void styleLikeTheChartObject(ChartControl& c)
{
    c.header = {"Qty of Bookings: Total = 12345", {10, true}};
    c.footer.font = {10, true};
    c.backgroundColor = 12763842;
    c.border = {6, 7};
    c.chartArea.backgroundColor = 11788021;
    c.chartArea.plotArea = {13495295, true};
    c.chartArea.border = {4, 2};
    c.chartArea.x.title = "Month";
    c.chartArea.y.title = "Quantity";
    c.chartArea.y.presentationCode = 2;
    c.chartArea.x.annotationMethod = 2;
    c.chartArea.view3D = {10, 10, 10};  // the stored style's defaults
    c.legend = {true, 17, 10, 10};
}

// `series` x `points` values in waves, month names for up to 12 points, else point numbers.
inline void fill(ChartControl& c, int series, int points, int16_t type)
{
    static const char* months[] = {"January", "February", "March",     "April",   "May",      "June",
                                   "July",    "August",   "September", "October", "November", "December"};
    c.group1.chartType = type;
    c.data().setBatched(true);
    c.data().setSeriesCount(series);
    for (int s = 1; s <= series; ++s) {
        c.data().setPointCount(s, points);
        c.group1.seriesLabels.push_back("Series " + std::to_string(s));
        for (int p = 1; p <= points; ++p) {
            c.data().setX(s, p, p);
            c.data().setY(s, p, std::round(100 + s * 2 + 40 * std::sin(p * 0.05 + s * 0.7)));
        }
    }
    for (int p = 1; p <= points; ++p) c.group1.pointLabels.push_back(points <= 12 ? months[p - 1] : std::to_string(p));
    c.data().setBatched(false);
}

inline void addValueLabels(ChartControl& c)
{
    for (int32_t s = 1; s <= c.data().seriesCount(); ++s) {
        for (int32_t p = 1; p <= c.data().pointCount(s); ++p) {
            ChartLabel& l = c.addChartLabel();
            l.text = numberText(c.data().y(s, p));
            l.name = "LB " + l.text;
            l.attachMethod = 2;
            l.series = s;
            l.point = p;
            l.offset = 20;
            l.isConnected = true;
            l.border = 4;
            l.borderWidth = 1;
            l.backgroundColor = 65535;
        }
    }
}

// The monthly report: 10 series x 12 points, 3-D bars with value labels.
inline void fillMonthlyReport(ChartControl& c)
{
    styleLikeTheChartObject(c);
    fill(c, 10, 12, kBar);
    addValueLabels(c);
}

}  // namespace kg::control::bench
