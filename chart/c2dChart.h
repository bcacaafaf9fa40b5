#pragma once
// The component's chart model: titles, X range, counts and style switches of the chart on show,
// prepared from the stored style (InitChart) and drawn into our chart control (DrawChart).
// Every request builder drives it in one order:
//   Initialize -> NumSeries, ShowLegend, XMinData, XMaxData -> InitChart -> size the value table
//   from NumSeries/NumPoints -> XAxisLabels := False -> fill table and label lists -> DrawChart.
// It reaches the host's application services and settings store late-bound, through the two
// object sources it is given (the shared goAppServices and goSettings at the moment of the call).
#include <functional>
#include <string>

#include "chart/ChartStyle.h"
#include "chart/control/model/ChartControl.h"
#include "core/Dispatch.h"  // the host objects are reached late-bound

namespace kg {

class c2dChart : public RefCounted {
public:
    using ObjectSource = std::function<Variant()>;
    c2dChart(ObjectSource appServices, ObjectSource settings);

    void Initialize(control::ChartControl* control, const std::string& header, const std::string& footer,
                    const std::string& xTitle, const std::string& yTitle);
    void InitChart();
    void DrawChart(VariantArray& table);
    void PrintChart();

    // The bound control; Error 91 before Initialize.
    control::ChartControl& control() const;
    bool hasControl() const { return static_cast<bool>(control_); }

    // 3-D view: no field, straight to and from the control.
    int32_t Rotation() const { return control().chartArea.view3D.rotation; }
    int32_t Elevation() const { return control().chartArea.view3D.elevation; }
    int32_t Depth() const { return control().chartArea.view3D.depth; }
    void setRotation(int32_t degrees);
    void setElevation(int32_t degrees);
    void setDepth(int32_t depth);

    // Stored once per process, shared by every chart object.
    static bool View3D();
    static void setView3D(bool on);
    static bool ShowLegend();
    static void setShowLegend(bool on);

    bool PointLabels() const { return pointLabels_; }
    void setPointLabels(bool on) { pointLabels_ = on; }
    bool XAxisLabels() const { return xAxisLabels_; }
    void setXAxisLabels(bool on) { xAxisLabels_ = on; }
    const std::string& ChartHeader() const { return header_; }
    void setChartHeader(std::string text) { header_ = std::move(text); }
    const std::string& ChartFooter() const { return footer_; }
    void setChartFooter(std::string text) { footer_ = std::move(text); }
    const std::string& ChartXTitle() const { return xTitle_; }
    void setChartXTitle(std::string text) { xTitle_ = std::move(text); }
    const std::string& ChartYTitle() const { return yTitle_; }
    void setChartYTitle(std::string text) { yTitle_ = std::move(text); }
    int32_t XMaxData() const { return xMax_; }
    void setXMaxData(int32_t value) { xMax_ = value; }
    int32_t YMaxData() const { return yMax_; }
    void setYMaxData(int32_t value) { yMax_ = value; }
    int32_t XMinData() const { return xMin_; }
    void setXMinData(int32_t value) { xMin_ = value; }
    int32_t YMinData() const { return yMin_; }
    void setYMinData(int32_t value) { yMin_ = value; }
    int32_t NumSeries() const { return numSeries_; }
    void setNumSeries(int32_t value) { numSeries_ = value; }
    int32_t NumPoints() const { return numPoints_; }
    void setNumPoints(int32_t value) { numPoints_ = value; }
    int16_t ChartType() const { return chartType_; }
    void setChartType(int16_t value) { chartType_ = value; }
    int16_t LineWidth() const { return lineWidth_; }
    void setLineWidth(int16_t value) { lineWidth_ = value; }

private:
    void DrawPieChart(VariantArray& table);
    void addValueLabel(const Variant& cell, int32_t series, int32_t point);
    void setupLegend();
    std::string readSetting(chartstyle::Key key);
    template <class T>
    T readWholeSetting(chartstyle::Key key);

    ObjectSource appServices_, settings_;
    Ref<control::ChartControl> control_;
    std::string header_, footer_, xTitle_, yTitle_;
    int32_t xMax_ = 0, yMax_ = 0, xMin_ = 0, yMin_ = 0;
    int32_t numSeries_ = 0, numPoints_ = 0;
    int16_t chartType_ = 0;
    int16_t lineWidth_ = 0;
    bool pointLabels_ = false;
    bool xAxisLabels_ = false;
};

}  // namespace kg
