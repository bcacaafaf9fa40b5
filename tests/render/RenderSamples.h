#pragma once
// Charts for the render tests, filled the way the chart object fills the control: its colours,
// borders and fonts, point labels on the X axis, the legend east of the plot.
#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QTemporaryDir>
#include <functional>
#include <string>
#include <vector>

#include "chart/control/model/ChartControl.h"
#include "core/Error.h"

namespace kg::control::samples {

inline void styleLikeTheChartObject(ChartControl& c, const std::string& header = "Qty of Bookings")
{
    c.header.text = header;
    c.header.font = {10, true};
    c.footer.font = {10, true};
    c.backgroundColor = 12763842;
    c.border = {6, 7};
    c.chartArea.backgroundColor = 11788021;
    c.chartArea.plotArea.backgroundColor = 13495295;
    c.chartArea.border = {4, 2};
    c.chartArea.plotArea.isShown = true;
    c.chartArea.x.title = "Month";
    c.chartArea.y.title = "Quantity";
    c.chartArea.y.presentationCode = 2;
    c.chartArea.x.presentationCode = 1;
    c.chartArea.x.annotationMethod = 2;
    c.legend = {true, 17, 10, 10};
}

// `series` x `points` values that differ from point to point, X of series 1 at 1..points.
inline void fillTable(ChartControl& c, int series, int points, int16_t chartType)
{
    c.group1.chartType = chartType;
    c.data().setBatched(true);
    c.data().setSeriesCount(series);
    for (int s = 1; s <= series; ++s) {
        c.data().setPointCount(s, points);
        for (int p = 1; p <= points; ++p) {
            c.data().setX(s, p, p);
            c.data().setY(s, p, 10 + (s * 7 + p * 13) % 90);
        }
    }
    c.data().setBatched(false);
}

inline void addSeriesLabels(ChartControl& c, int count, const std::string& stem = "Series ")
{
    for (int s = 1; s <= count; ++s) c.group1.seriesLabels.push_back(stem + std::to_string(s));
}

inline void addPointLabels(ChartControl& c, int count, const std::string& stem = "P")
{
    for (int p = 1; p <= count; ++p) c.group1.pointLabels.push_back(stem + std::to_string(p));
}

// A pie as the single-series pie path leaves it: one series per slice, the value at point 1.
inline void fillPie(ChartControl& c, const std::vector<double>& slices)
{
    c.group1.chartType = kPie;
    c.data().setSeriesCount(int32_t(slices.size()));
    for (size_t i = 0; i < slices.size(); ++i) {
        c.data().setPointCount(int32_t(i + 1), 1);
        c.data().setX(int32_t(i + 1), 1, 1);
        c.data().setY(int32_t(i + 1), 1, slices[i]);
    }
}

// A value label as the chart object adds it.
inline ChartLabel& addValueLabel(ChartControl& c, int32_t series, int32_t point, const std::string& text)
{
    ChartLabel& l = c.addChartLabel();
    l.name = "LB " + text;
    l.text = text;
    l.attachMethod = 2;
    l.series = series;
    l.point = point;
    l.anchor = 0;
    l.offset = 20;
    l.isConnected = true;
    l.border = 4;
    l.borderWidth = 1;
    l.backgroundColor = 65535;
    return l;
}

// A scratch folder under the test build's temporary folder when CTest names one.
inline QTemporaryDir scratchDir()
{
    const QString base = qEnvironmentVariable("KG_TEST_TMP");
    if (base.isEmpty()) return QTemporaryDir();
    QDir().mkpath(base);
    return QTemporaryDir(base + QStringLiteral("/render-XXXXXX"));
}

inline QByteArray readAll(const QString& path)
{
    QFile f(path);
    return f.open(QIODevice::ReadOnly) ? f.readAll() : QByteArray();
}

// Runs `call` and checks it fails with error `number` whose description contains `named`.
inline void expectError(const std::function<void()>& call, int32_t number, const std::string& named)
{
    try {
        call();
        ADD_FAILURE() << "no error";
    } catch (const Error& e) {
        EXPECT_EQ(e.number(), number);
        EXPECT_NE(e.description().find(named), std::string::npos) << e.description();
    }
}

// Names each row of a table after its `name` field.
inline const auto rowName = [](const auto& info) { return std::string(info.param.name); };

}  // namespace kg::control::samples
