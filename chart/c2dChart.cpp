#include "chart/c2dChart.h"

#include "core/Convert.h"
#include "core/Dispatch.h"
#include "core/Error.h"

#include <cstdint>
#include <type_traits>

namespace kg {

namespace {
// Process-wide, shared by every chart object.
bool g_view3D = false;
bool g_showLegend = false;

// Colours and border codes the chart model gives the control (Windows colour values).
constexpr control::OleColor kControlBackground = 12763842;   // grey 194,194,194
constexpr control::OleColor kChartAreaBackground = 11788021; // wheat 245,222,179
constexpr control::OleColor kPlotAreaBackground = 13495295;  // 255,235,205
constexpr control::OleColor kLabelBackground = 65535;        // yellow
}  // namespace

c2dChart::c2dChart(ObjectSource appServices, ObjectSource settings)
    : appServices_(std::move(appServices)), settings_(std::move(settings))
{
}

control::ChartControl& c2dChart::control() const
{
    if (!control_) throw Error::objectNotSet("the chart object has no chart control before Initialize");
    return *control_;
}

bool c2dChart::View3D() { return g_view3D; }
void c2dChart::setView3D(bool on) { g_view3D = on; }
bool c2dChart::ShowLegend() { return g_showLegend; }
void c2dChart::setShowLegend(bool on) { g_showLegend = on; }

void c2dChart::setRotation(int32_t degrees)
{
    control().chartArea.view3D.rotation = degrees;
    control().changed();
}

void c2dChart::setElevation(int32_t degrees)
{
    control().chartArea.view3D.elevation = degrees;
    control().changed();
}

void c2dChart::setDepth(int32_t depth)
{
    control().chartArea.view3D.depth = depth;
    control().changed();
}

void c2dChart::Initialize(control::ChartControl* control, const std::string& header, const std::string& footer,
                          const std::string& xTitle, const std::string& yTitle)
{
    control_ = control;
    header_ = header;
    footer_ = footer;
    xTitle_ = xTitle;
    yTitle_ = yTitle;
    chartType_ = control::kBar;

    control::ChartControl& c = this->control();
    c.header.text = header_;
    c.header.font = {10, true};
    c.footer.text = footer_;
    c.footer.font = {10, true};
    c.backgroundColor = kControlBackground;
    c.border.width = 7;
    c.border.style = control::kBorderBevelOut;
    c.chartArea.backgroundColor = kChartAreaBackground;
    c.chartArea.plotArea.backgroundColor = kPlotAreaBackground;
    c.chartArea.border.width = 2;
    c.chartArea.border.style = control::kBorderShadow;
    c.chartArea.plotArea.isShown = true;
    c.chartArea.x.title = xTitle_;
    c.chartArea.y.title = yTitle_;
    c.chartArea.y.presentationCode = control::kTitleRotatedUp;

    Args folder{std::string()};
    call(appServices_(), "GetAppFolder", folder);
    // The folder is used as the host returns it: no separator added or removed.
    c.helpFile = toText(folder[0]) + "/Help/" + "chartctl.hlp";

    setChartType(control::kBar);
    // A new chart starts at automatic scale and position.
    c.resetView();
}

std::string c2dChart::readSetting(chartstyle::Key key) { return chartstyle::read(appServices_(), settings_(), key); }

// A stored whole number too large for its width would make every later chart fail, and the user
// could never reach the style dialog to repair it: such a value counts as the key's default.
template <class T>
T c2dChart::readWholeSetting(chartstyle::Key key)
{
    const std::string text = readSetting(key);
    const chartstyle::KeyInfo& info = chartstyle::infoOf(key);
    const auto whole = [](double v) -> T {
        if constexpr (std::is_same_v<T, int16_t>)
            return roundToInteger(v);
        else
            return roundToLong(v);
    };
    try {
        return whole(readNumber(text));
    } catch (const Error& e) {
        if (e.number() != errc::Overflow) throw;
        Args log{std::string("SettingOutOfRange"),
                 std::string(chartstyle::kSection) + "\\" + info.name + "=" + text + " (default " + info.defaultValue +
                     " used)"};
        call(appServices_(), "LogFormEvent", log);
        return whole(readNumber(info.defaultValue));
    }
}

void c2dChart::InitChart()
{
    control::ChartControl& c = control();
    c.header.text = header_;
    c.footer.text = footer_;
    c.chartArea.x.title = xTitle_;
    c.chartArea.y.title = yTitle_;
    if (chartType_ == 0) chartType_ = control::kPlot;
    c.group1.chartType = chartType_;

    const int64_t points = int64_t(xMax_) - int64_t(xMin_) + 1;
    if (points > INT32_MAX || points < INT32_MIN)
        throw Error::overflow("point count " + std::to_string(xMax_) + " - " + std::to_string(xMin_) + " + 1");
    numPoints_ = int32_t(points);

    c.data().setSeriesCount(numSeries_);
    for (int32_t i = 1; i <= numSeries_; ++i) {
        c.group1.seriesStyles[size_t(i - 1)].lineWidth = lineWidth_;
        c.data().setPointCount(i, numPoints_);
    }

    using chartstyle::Key;
    if (readWholeSetting<int16_t>(Key::View3D) == 1) {
        setView3D(true);
        setRotation(readWholeSetting<int32_t>(Key::Rotation));
        setElevation(readWholeSetting<int32_t>(Key::Elevation));
        setDepth(readWholeSetting<int32_t>(Key::Depth));
    } else {
        setView3D(false);
        setRotation(0);
        setDepth(0);
        setElevation(0);
    }

    // Another stored text keeps the type as it stands.
    if (const auto type = chartstyle::typeOfName(readSetting(Key::Style))) chartType_ = *type;

    const std::string labels = readSetting(Key::LabelsOnDefault);
    if (labels == "1") pointLabels_ = true;
    if (labels == "0") pointLabels_ = false;
    c.changed();
}

void c2dChart::addValueLabel(const Variant& cell, int32_t series, int32_t point)
{
    const std::string text = numberText(cell);
    control::ChartLabel& label = control().addChartLabel();
    label.name = "LB " + text;
    label.text = text;
    label.attachMethod = control::kAttachToDataPoint;
    label.series = series;
    label.point = point;
    label.anchor = 0;
    label.offset = 20;
    label.isConnected = true;
    label.border = control::kBorderShadow;
    label.borderWidth = 1;
    label.backgroundColor = kLabelBackground;
}

void c2dChart::setupLegend()
{
    control::Legend& legend = control().legend;
    legend.isShown = ShowLegend();
    legend.placement = control::kLegendEast;
    legend.gapToPlot = 10;
    legend.gapBetween = 10;
}

void c2dChart::DrawChart(VariantArray& table)
{
    if (numSeries_ == 1 && chartType_ == control::kPie) {
        setShowLegend(true);
        DrawPieChart(table);
        return;
    }
    if (numSeries_ == 1) setShowLegend(false);

    control::ChartControl& c = control();
    control::ChartData& data = c.data();
    data.setBatched(true);
    data.setSeriesCount(numSeries_);
    const int32_t n = data.seriesCount();
    for (int32_t i = 1; i <= n; ++i) {
        c.group1.seriesStyles[size_t(i - 1)].lineWidth = lineWidth_;
        data.setPointCount(i, numPoints_);
    }
    c.group1.chartType = chartType_;
    c.chartArea.x.presentationCode = control::kTitleHorizontal;
    c.chartArea.x.annotationMethod = control::kAnnotatePointLabels;
    if (xAxisLabels_) {
        c.group1.pointLabels.clear();
        for (int64_t x = xMin_; x <= xMax_; ++x) c.group1.pointLabels.push_back(numberText(double(x)));
    }
    for (int32_t p = 1; p <= numPoints_; ++p) data.setX(1, p, p);
    c.clearChartLabels();
    for (int32_t s = 1; s <= numSeries_; ++s) {
        for (int32_t p = 1; p <= numPoints_; ++p) {
            Variant& cell = table.at(s, p);
            if (differsFromEmptyText(cell)) {
                data.setY(s, p, toDouble(cell));
            } else {
                data.setY(s, p, 0.0);
                cell = Variant(int16_t(0));
            }
            if (pointLabels_) addValueLabel(cell, s, p);
        }
    }
    setupLegend();
    data.setBatched(false);
}

void c2dChart::DrawPieChart(VariantArray& table)
{
    control::ChartControl& c = control();
    control::ChartData& data = c.data();
    data.setBatched(true);
    data.setSeriesCount(numPoints_);
    int32_t n = data.seriesCount();
    if (lineWidth_ > 0) {
        for (int32_t i = 1; i <= n; ++i) {
            c.group1.seriesStyles[size_t(i - 1)].lineWidth = lineWidth_;
            data.setPointCount(i, 1);
        }
    } else {
        // Every slice is one point; without this the series would have no point to hold it.
        for (int32_t i = 1; i <= n; ++i)
            if (data.pointCount(i) < 1) data.setPointCount(i, 1);
    }
    c.group1.chartType = chartType_;
    data.setX(1, 1, 1);
    c.clearChartLabels();
    n = data.seriesCount();
    for (int32_t i = 1; i <= n; ++i) {
        const Variant& cell = table.at(1, i);
        // A blank or Null slice counts as 0, as an empty cell does; other text must be a number.
        const bool blank = !cell.isNull() && !differsFromEmptyText(cell);
        const double value = cell.isNull() || blank ? 0.0 : toDouble(cell);
        data.setY(i, 1, value);
        if (pointLabels_) addValueLabel(cell.isNull() || blank ? Variant(int16_t(0)) : cell, i, 1);
    }
    setupLegend();
    data.setBatched(false);
}

void c2dChart::PrintChart() { control().print({control::kPrintFormatChart, control::kPrintScaleChart}); }

}  // namespace kg
