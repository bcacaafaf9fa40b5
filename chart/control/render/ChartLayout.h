#pragma once
// Where every part of the chart goes for a given target rectangle: the geometry that the painter
// draws and that a view uses to hit-test (which element is under the mouse, which data value a
// pixel shows).
//
//   ChartLayout layout = computeLayout(chart, QRectF(0, 0, 800, 600));
//   QPointF p = layout.toScreen(3, 120.5);        // device position of point 3, value 120.5
//   QPointF v; layout.toValue(mousePos, v);       // the data value under the mouse
#include <QPointF>
#include <QPolygonF>
#include <QRectF>
#include <QString>
#include <QTransform>
#include <vector>

#include "chart/control/model/ChartControl.h"
#include "chart/control/render/NiceScale.h"

class QPaintDevice;

namespace kg::control {

struct ChartFonts;

// How the chart type code is drawn: 1 plot, 3 pie, 5 area; every other code as bars.
enum class ChartKind { Bar, Plot, Area, Pie };
ChartKind chartKindOf(int16_t chartType);

// Data values to pixels of the plot's front plane, before the view transform.
struct ValueMapping {
    double xMin = 0, xMax = 1, yMin = 0, yMax = 1;
    QRectF plot;
    double xPixel(double x) const;
    double yPixel(double y) const;
    QPointF toPixel(double x, double y) const { return {xPixel(x), yPixel(y)}; }
    QPointF toValue(QPointF pixel) const;
};

struct AxisLabel {
    double value = 0;  // position on the axis
    QString text;
};

// One pie slice: a series with a positive value at point 1. Angles in degrees, Qt's convention
// (counter-clockwise from three o'clock); slices run clockwise, so span is negative.
struct PieSlice {
    int32_t series = 0;
    double value = 0;
    double startAngle = 0, spanAngle = 0;
    double midAngle() const { return startAngle + spanAngle / 2; }
};

struct PieGeometry {
    QPointF centre;
    double rx = 0, ry = 0;  // radii of the top face
    double rim = 0;         // visible thickness (3-D)
    std::vector<PieSlice> slices;
};

struct LegendItem {
    int32_t series = 0;  // colour index: series or slice number
    QRectF swatch;
    QPointF textOrigin;  // baseline start
    QString text;        // elided to the column width
};

struct ChartLayout {
    ChartKind kind = ChartKind::Bar;
    QRectF bounds;        // the whole control
    QRectF header;        // empty when the header has no text
    QRectF footer;        // empty when the footer has no text
    QRectF chartArea;     // the chart area with its border
    QRectF chartContent;  // inside that border: the frame of the view transform, and the clip
    QRectF plotArea;      // front plane of the plot (bar, plot, area) or the pie's box
    QRectF legend;        // empty when no legend is shown
    QTransform view;      // scale and move of the chart area's content (identity by default)

    // Cartesian charts.
    ValueMapping mapping;
    QPointF depth;  // offset of the back plane for the 3-D look; (0, 0) when flat
    AxisScale yScale;
    std::vector<AxisLabel> yLabels;
    std::vector<AxisLabel> xLabels;  // already thinned so that none overlap
    bool xLabelsRotated = false;
    QRectF xTitle, yTitle;           // empty when the axis has no title
    std::vector<double> xPositions;  // X value of point p at index p - 1
    double barWidth = 0;             // one bar of a cluster
    double clusterWidth = 0;         // all bars of one point
    // 3-D bars are square columns standing in the middle of the depth: `barDepth` is a column's
    // own depth offset, `barShift` moves its front face back from the front plane.
    QPointF barDepth, barShift;

    // Pie charts.
    PieGeometry pie;

    // Legend entries that fit; `legendTruncated` when some did not.
    std::vector<LegendItem> legendItems;
    bool legendTruncated = false;

    // Device position of a data value (view transform included), and back.
    QPointF toScreen(double x, double y) const;
    bool toValue(QPointF screen, QPointF& value) const;
    // X value of point p (from 1).
    double xOf(int32_t point) const;
    // Front face of the bar of (series, point) (barShift included), or a null box when there is none.
    QRectF barRect(const ChartControl& chart, int32_t series, int32_t point) const;
    // The faces of a 3-D bar beside its front face: the top (or bottom, seen from below) and the
    // side towards the back plane.
    struct BarFaces {
        QPolygonF top, side;
    };
    BarFaces barFaces(const QRectF& front) const;
    // Where bars and lines are drawn: the plot's front plane and, in 3-D, its back plane.
    QRectF seriesArea() const { return plotArea.united(plotArea.translated(depth)); }
};

// The layout for painting the chart into `target`. Sizes are logical pixels and fonts are set in
// pixels, so the device does not change the result; it is accepted for callers that have one.
ChartLayout computeLayout(const ChartControl& chart, const QRectF& target, QPaintDevice* device = nullptr);
// The same with fonts already measured for this chart (the painter measures them once per paint).
ChartLayout computeLayout(const ChartControl& chart, const QRectF& target, const ChartFonts& fonts);

// The view state as a transform of the chart area's content: scale about its centre, then move
// by fractions of its size.
QTransform viewTransform(const ViewState& view, const QRectF& chartContent);

// Legend texts: series labels; for a pie the slices' captions, from whichever of the series and
// point label lists covers more slices (the series labels when equal).
std::vector<QString> legendTexts(const ChartControl& chart, ChartKind kind);

// Inner padding of a value label box around its text.
constexpr double kLabelPadX = 4, kLabelPadY = 1;

}  // namespace kg::control
