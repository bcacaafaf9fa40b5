#pragma once
// Our chart control's model: plain data, no painter and no widget. It holds exactly what the chart
// object sets on the control (titles, colours, borders, axes, 3-D view, chart group 1 with its data
// and label lists, the chart labels, the legend, the help file, the print operation) plus the view
// state of interactive scaling, moving and zooming. Painters, exporters, the printer and the view
// widget read it; changes are announced through one callback, held while the data batch switch is on.
//
//   ChartControl chart;
//   chart.data().setBatched(true);
//   chart.data().setSeriesCount(2);  ...  chart.data().setBatched(false);  // one repaint
#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "core/Ref.h"

namespace kg::control {

// Windows colour value: red in the lowest byte, then green, then blue.
using OleColor = uint32_t;
constexpr int redOf(OleColor c) { return int(c & 0xFF); }
constexpr int greenOf(OleColor c) { return int((c >> 8) & 0xFF); }
constexpr int blueOf(OleColor c) { return int((c >> 16) & 0xFF); }

// Chart type codes of chart group 1.
enum ChartType : int16_t {
    kPlot = 1,  // lines through the points
    kBar = 2,   // bars, side by side per point
    kPie = 3,   // one slice per series
    kArea = 5,  // lines with the area below filled
};

// Border style codes of the control, the chart area and the value labels.
enum BorderStyleCode : int {
    kBorderNone = 0,
    kBorderPlain = 1,
    kBorderEtchedIn = 2,
    kBorderEtchedOut = 3,
    kBorderShadow = 4,    // the chart area's and the value labels'
    kBorderBevelIn = 5,
    kBorderBevelOut = 6,  // the control's
};

struct Border {
    int style = 0;
    int width = 0;
};

struct Font {
    double size = 10;  // points
    bool bold = false;
};

struct Title {
    std::string text;
    Font font;
};

// How an axis title is presented.
enum AxisPresentation : int {
    kTitleHorizontal = 1,
    kTitleRotatedUp = 2,  // turned to read upwards
};
// What annotates an axis; any code other than kAnnotatePointLabels gives numbers (point numbers on X).
enum AnnotationMethod : int {
    kAnnotateValues = 0,
    kAnnotatePointLabels = 2,  // the point labels of chart group 1
};

struct Axis {
    std::string title;
    int presentationCode = 1;
    int annotationMethod = 0;
    // Axis zoom: when set, the axis runs from min to max instead of its automatic range.
    bool hasFixedRange = false;
    double min = 0, max = 0;
};

struct View3D {
    int32_t rotation = 0;
    int32_t elevation = 0;
    int32_t depth = 0;
    bool isFlat() const { return depth == 0 || (rotation == 0 && elevation == 0); }
};

struct PlotArea {
    OleColor backgroundColor = 0xFFFFFF;
    bool isShown = false;  // the plot area switch: paint its own background
};

struct ChartArea {
    OleColor backgroundColor = 0xFFFFFF;
    Border border;
    PlotArea plotArea;
    Axis x, y;
    View3D view3D;
};

class ChartControl;

// Data of chart group 1: series of points with X and Y values; the batch switch holds repainting.
class ChartData {
public:
    // Limits that keep a wild count from exhausting memory: beyond them the control refuses.
    static constexpr int32_t kMaxSeries = 1 << 20;
    static constexpr int64_t kMaxPoints = int64_t(1) << 24;  // all series together (256 MB)

    explicit ChartData(ChartControl& owner) : owner_(owner) {}

    bool isBatched() const { return batched_; }
    void setBatched(bool on);

    int32_t seriesCount() const { return int32_t(series_.size()); }
    void setSeriesCount(int32_t n);  // negative: Error 5
    int32_t pointCount(int32_t series) const;
    void setPointCount(int32_t series, int32_t n);

    // Series and points from 1. Outside the counts: Error 9.
    double x(int32_t series, int32_t point) const;
    double y(int32_t series, int32_t point) const;
    void setX(int32_t series, int32_t point, double v);
    void setY(int32_t series, int32_t point, double v);

    // Direct read access for painters (index from 0).
    const std::vector<double>& xs(int32_t series) const { return series_.at(size_t(series - 1)).x; }
    const std::vector<double>& ys(int32_t series) const { return series_.at(size_t(series - 1)).y; }

private:
    struct Series {
        std::vector<double> x, y;
    };
    Series& at(int32_t series);
    const Series& at(int32_t series) const;
    ChartControl& owner_;
    bool batched_ = false;
    int64_t totalPoints_ = 0;
    std::vector<Series> series_;
};

struct SeriesStyle {
    int lineWidth = 0;
};

struct ChartGroup {
    int16_t chartType = kBar;
    std::vector<SeriesStyle> seriesStyles;  // item n at index n - 1; follows the series count
    std::vector<std::string> pointLabels;   // labels of the X points, in order
    std::vector<std::string> seriesLabels;  // legend texts, in order
};

// How a chart label is attached; labels attached otherwise are not drawn.
enum AttachMethod : int {
    kAttachNone = 0,
    kAttachToDataPoint = 2,  // by series and point index
};

// A chart label (value label): attached to a data point, drawn as a box offset from the point and
// connected to it.
struct ChartLabel {
    std::string name;
    std::string text;
    int attachMethod = 0;
    int32_t series = 0;
    int32_t point = 0;
    int anchor = 0;      // 0: automatic placement around the point
    int offset = 0;      // distance from the point, in pixels at 96 dpi
    bool isConnected = false;
    int border = 0;      // a BorderStyleCode
    int borderWidth = 0;
    OleColor backgroundColor = 0xFFFFFF;
};

// Where the legend is placed.
enum LegendPlacement : int {
    kLegendEast = 17,  // to the right of the plot, centred
};

// The legend; the gaps are pixels at 96 dpi.
struct Legend {
    bool isShown = false;
    int placement = kLegendEast;
    int gapToPlot = 10;     // between the legend and the plot
    int gapBetween = 10;    // between entries
};

// Interactive view state: scale, move and graphics zoom of the chart inside the chart area. A
// graphics zoom is one more scale and move, so these three numbers hold all of it. Identity when
// scale is 1 and offsets 0.
struct ViewState {
    double scale = 1.0;                 // about the chart area's centre
    double offsetX = 0, offsetY = 0;    // in chart area fractions
    bool isIdentity() const { return scale == 1.0 && offsetX == 0 && offsetY == 0; }
};

// The codes the chart object prints with: our printer ignores them and always fits the chart,
// as it is shown, to one landscape page.
enum PrintCode : int32_t {
    kPrintFormatChart = 3,  // the format the chart object asks for
    kPrintScaleChart = 4,   // the scaling the chart object asks for
};

// Print options as the print operation receives them; a zero rectangle is the whole page.
struct PrintRequest {
    int32_t format = 0;
    int32_t scale = 0;
    int32_t left = 0, top = 0, width = 0, height = 0;
};

class ChartControl : public RefCounted {
public:
    ChartControl();

    Title header, footer;
    OleColor backgroundColor = 0xFFFFFF;
    Border border;
    ChartArea chartArea;
    ChartGroup group1;
    std::vector<ChartLabel> chartLabels;
    Legend legend;
    std::string helpFile;
    ViewState view;
    // Size (pixels at 96 dpi) of the view showing the chart, 0 while none does: printing keeps
    // the picture's shape. Set by the view; not a change of the chart.
    int32_t shownWidth = 0, shownHeight = 0;

    ChartData& data() { return data_; }
    const ChartData& data() const { return data_; }

    // Chart label collection: add returns the new label (valid until the next add or clear).
    // Beyond kMaxLabels adding fails with Error 7: a label per cell of a huge table would take
    // more memory than the data and could not be read anyway.
    static constexpr size_t kMaxLabels = 65536;
    ChartLabel& addChartLabel();
    void clearChartLabels();

    // The print operation; the printer is installed by the render layer (no printer: Error 482).
    using PrintHandler = std::function<void(const ChartControl&, const PrintRequest&)>;
    void print(const PrintRequest& request) const;
    void setPrintHandler(PrintHandler h) { printHandler_ = std::move(h); }

    // Tell the views that the control changed; held while the data is batched.
    void changed();
    void setChangeListener(std::function<void()> listener) { listener_ = std::move(listener); }

    // Back to automatic scale and position (the "r" key; a new chart).
    void resetView();

private:
    ChartData data_;
    PrintHandler printHandler_;
    std::function<void()> listener_;
    bool pending_ = false;
    friend class ChartData;
};

}  // namespace kg::control
