#include "chart/c2dChart.h"

#include "core/Convert.h"
#include "core/Error.h"

#include <cstdint>
#include <type_traits>

namespace kg {

namespace {
// Process-wide, shared by every chart object.
bool g_view3D = false;
bool g_showLegend = false;

constexpr const char* kSection = "2dCharts";

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
void c2dChart::setView3D(bool b) { g_view3D = b; }
bool c2dChart::ShowLegend() { return g_showLegend; }
void c2dChart::setShowLegend(bool b) { g_showLegend = b; }

void c2dChart::setRotation(int32_t v)
{
    control().chartArea.view3D.rotation = v;
    control().changed();
}

void c2dChart::setElevation(int32_t v)
{
    control().chartArea.view3D.elevation = v;
    control().changed();
}

void c2dChart::setDepth(int32_t v)
{
    control().chartArea.view3D.depth = v;
    control().changed();
}

void c2dChart::Initialize(control::ChartControl* gfChartForm, const std::string& fHeader, const std::string& fFooter,
                          const std::string& fXTitle, const std::string& fYTitle)
{
    control_ = gfChartForm;
    header_ = fHeader;
    footer_ = fFooter;
    xTitle_ = fXTitle;
    yTitle_ = fYTitle;
    chartType_ = control::kBar;

    control::ChartControl& c = control();
    c.header.text = header_;
    c.header.font = {10, true};
    c.footer.text = footer_;
    c.footer.font = {10, true};
    c.backgroundColor = kControlBackground;
    c.border.width = 7;
    c.border.style = 6;
    c.chartArea.backgroundColor = kChartAreaBackground;
    c.chartArea.plotArea.backgroundColor = kPlotAreaBackground;
    c.chartArea.border.width = 2;
    c.chartArea.border.style = 4;
    c.chartArea.plotArea.isShown = true;
    c.chartArea.x.title = xTitle_;
    c.chartArea.y.title = yTitle_;
    c.chartArea.y.presentationCode = 2;

    Args folder{std::string()};
    call(appServices_(), "GetAppFolder", folder);
    // The folder is used as the host returns it: no separator added or removed.
    c.helpFile = toText(folder[0]) + "/Help/" + "chartctl.hlp";

    setChartType(control::kBar);
    // A new chart starts at automatic scale and position.
    c.resetView();
}

std::string c2dChart::readSetting(const char* key, const char* defaultValue)
{
    Args owner{std::string()};
    call(appServices_(), "GetSettingsOwner", owner);
    Args read{std::string(kSection), std::string(key), std::string(defaultValue), owner[0], std::string()};
    call(settings_(), "ReadSetting", read);
    return toText(read[4]);
}

// A stored whole number too large for its width would make every later chart fail, and the user
// could never reach the style dialog to repair it: such a value counts as the key's default.
template <class T>
T c2dChart::readWholeSetting(const char* key, const char* defaultValue)
{
    const std::string text = readSetting(key, defaultValue);
    try {
        const double v = readNumber(text);
        if constexpr (std::is_same_v<T, int16_t>)
            return roundToInteger(v);
        else
            return roundToLong(v);
    } catch (const Error& e) {
        if (e.number() != errc::Overflow) throw;
        Args log{std::string("SettingOutOfRange"),
                 std::string(kSection) + "\\" + key + "=" + text + " (default " + defaultValue + " used)"};
        call(appServices_(), "LogFormEvent", log);
        const double v = readNumber(defaultValue);
        if constexpr (std::is_same_v<T, int16_t>)
            return roundToInteger(v);
        else
            return roundToLong(v);
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

    if (readWholeSetting<int16_t>("View3D", "1") == 1) {
        setView3D(true);
        setRotation(readWholeSetting<int32_t>("Rotation", "10"));
        setElevation(readWholeSetting<int32_t>("Elevation", "10"));
        setDepth(readWholeSetting<int32_t>("Depth", "10"));
    } else {
        setView3D(false);
        setRotation(0);
        setDepth(0);
        setElevation(0);
    }

    const std::string style = readSetting("Style", "Bar");
    if (style == "Bar") chartType_ = control::kBar;
    if (style == "Plot") chartType_ = control::kPlot;
    if (style == "Area") chartType_ = control::kArea;
    if (style == "Pie") chartType_ = control::kPie;

    const std::string labels = readSetting("LabelsOnDefault", "0");
    if (labels == "1") pointLabels_ = true;
    if (labels == "0") pointLabels_ = false;
    c.changed();
}

void c2dChart::addValueLabel(const Variant& cell, int32_t series, int32_t point)
{
    const std::string text = numberText(cell);
    control::ChartLabel& label = control().addChartLabel();
    label.isBatched = true;
    label.name = "LB " + text;
    label.text = text;
    label.attachMethod = 2;
    label.series = series;
    label.point = point;
    label.anchor = 0;
    label.offset = 20;
    label.isConnected = true;
    label.border = 4;
    label.borderWidth = 1;
    label.backgroundColor = kLabelBackground;
    label.isBatched = false;
}

void c2dChart::setupLegend()
{
    control::Legend& legend = control().legend;
    legend.isShown = ShowLegend();
    legend.placement = 17;
    legend.layout1 = 10;
    legend.layout2 = 10;
}

void c2dChart::DrawChart(VariantArray& m_vArray)
{
    if (numSeries_ == 1 && chartType_ == control::kPie) {
        setShowLegend(true);
        DrawPieChart(m_vArray);
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
    c.chartArea.x.presentationCode = 1;
    c.chartArea.x.annotationMethod = 2;
    if (xAxisLabels_) {
        c.group1.pointLabels.clear();
        for (int64_t x = xMin_; x <= xMax_; ++x) c.group1.pointLabels.push_back(numberText(double(x)));
    }
    for (int32_t p = 1; p <= numPoints_; ++p) data.setX(1, p, p);
    c.clearChartLabels();
    for (int32_t s = 1; s <= numSeries_; ++s) {
        for (int32_t p = 1; p <= numPoints_; ++p) {
            Variant& cell = m_vArray.at(s, p);
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

void c2dChart::PrintChart() { control().print({3, 4, 0, 0, 0, 0}); }

// ---- dispatch surface ----

namespace {
enum Member : DispId {
    mInitialize = 1, mRotation, mElevation, mDepth, mView3D, mShowLegend, mPointLabels, mXAxisLabels,
    mChartHeader, mChartFooter, mChartXTitle, mChartYTitle, mXMaxData, mYMaxData, mXMinData, mYMinData,
    mNumSeries, mNumPoints, mChartType, mLineWidth, mInitChart, mDrawChart, mPrintChart
};
}  // namespace

const std::vector<MemberInfo>& c2dChart::members() const
{
    static const std::vector<MemberInfo> table = {
        {"Initialize", mInitialize}, {"Rotation", mRotation}, {"Elevation", mElevation}, {"Depth", mDepth},
        {"View3D", mView3D}, {"ShowLegend", mShowLegend}, {"PointLabels", mPointLabels},
        {"XAxisLabels", mXAxisLabels}, {"ChartHeader", mChartHeader}, {"ChartFooter", mChartFooter},
        {"ChartXTitle", mChartXTitle}, {"ChartYTitle", mChartYTitle}, {"XMaxData", mXMaxData},
        {"YMaxData", mYMaxData}, {"XMinData", mXMinData}, {"YMinData", mYMinData}, {"NumSeries", mNumSeries},
        {"NumPoints", mNumPoints}, {"ChartType", mChartType}, {"LineWidth", mLineWidth},
        {"InitChart", mInitChart}, {"DrawChart", mDrawChart}, {"PrintChart", mPrintChart},
    };
    return table;
}

namespace {
// Property get or let with one value: `get` returns the value, `let` stores it.
template <class Get, class Let>
Variant property(uint16_t kind, Args& args, const char* name, Get get, Let let)
{
    if (kind & (kPropertyPut | kPropertyPutRef)) {
        expectArgs(args, 1, name);
        let(args[0]);
        return {};
    }
    expectArgs(args, 0, name);
    return get();
}
}  // namespace

Variant c2dChart::invoke(DispId id, uint16_t kind, Args& args)
{
    auto text = [&](const char* name, std::string& field) {
        return property(kind, args, name, [&] { return Variant(field); },
                        [&](const Variant& v) { field = toText(v); });
    };
    auto whole = [&](const char* name, int32_t& field) {
        return property(kind, args, name, [&] { return Variant(field); },
                        [&](const Variant& v) { field = toLong(v); });
    };
    auto flag = [&](const char* name, bool& field) {
        return property(kind, args, name, [&] { return Variant(field); },
                        [&](const Variant& v) { field = toDouble(v) != 0; });
    };
    switch (id) {
    case mInitialize: {
        expectArgs(args, 5, "Initialize");
        auto* chart = args[0].isObject() ? dynamic_cast<control::ChartControl*>(args[0].object()) : nullptr;
        if (!chart) throw Error::typeMismatch("Initialize expects the chart control");
        Initialize(chart, toText(args[1]), toText(args[2]), toText(args[3]), toText(args[4]));
        return {};
    }
    case mRotation:
        return property(kind, args, "Rotation", [&] { return Variant(Rotation()); },
                        [&](const Variant& v) { setRotation(toLong(v)); });
    case mElevation:
        return property(kind, args, "Elevation", [&] { return Variant(Elevation()); },
                        [&](const Variant& v) { setElevation(toLong(v)); });
    case mDepth:
        return property(kind, args, "Depth", [&] { return Variant(Depth()); },
                        [&](const Variant& v) { setDepth(toLong(v)); });
    case mView3D: return flag("View3D", g_view3D);
    case mShowLegend: return flag("ShowLegend", g_showLegend);
    case mPointLabels: return flag("PointLabels", pointLabels_);
    case mXAxisLabels: return flag("XAxisLabels", xAxisLabels_);
    case mChartHeader: return text("ChartHeader", header_);
    case mChartFooter: return text("ChartFooter", footer_);
    case mChartXTitle: return text("ChartXTitle", xTitle_);
    case mChartYTitle: return text("ChartYTitle", yTitle_);
    case mXMaxData: return whole("XMaxData", xMax_);
    case mYMaxData: return whole("YMaxData", yMax_);
    case mXMinData: return whole("XMinData", xMin_);
    case mYMinData: return whole("YMinData", yMin_);
    case mNumSeries: return whole("NumSeries", numSeries_);
    case mNumPoints: return whole("NumPoints", numPoints_);
    case mChartType:
        return property(kind, args, "ChartType", [&] { return Variant(chartType_); },
                        [&](const Variant& v) { chartType_ = toInteger(v); });
    case mLineWidth:
        return property(kind, args, "LineWidth", [&] { return Variant(lineWidth_); },
                        [&](const Variant& v) { lineWidth_ = toInteger(v); });
    case mInitChart: expectArgs(args, 0, "InitChart"); InitChart(); return {};
    case mDrawChart:
        expectArgs(args, 1, "DrawChart");
        if (!args[0].isArray()) throw Error::typeMismatch("DrawChart expects the value table");
        DrawChart(args[0].array());
        return {};
    case mPrintChart: expectArgs(args, 0, "PrintChart"); PrintChart(); return {};
    }
    throw Error::memberNotFound("c2dChart member id " + std::to_string(id));
}

}  // namespace kg
