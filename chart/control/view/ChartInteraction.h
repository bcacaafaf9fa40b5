#pragma once
// What the mouse and the keyboard do to a drawn chart, kept apart from the widget so that it can be
// driven with plain positions, buttons and keys. Every gesture starts inside the chart area; the
// titles, the legend and the footer never react.
//
//   Gesture (held keys + buttons at the press)       Effect while dragging / on release
//   Ctrl  + both buttons (left and right) or middle  scale about the chart area's centre: down
//                                                    enlarges, up shrinks (x e per 100 pixels)
//   Shift + both buttons or middle                   move: the chart follows the mouse
//   no key + both buttons or middle                  rotate a bar or pie chart with the 3-D look
//                                                    (depth not 0): down raises the elevation,
//                                                    right turns the rotation up (bars only);
//                                                    2 pixels a degree, both kept in -45..45
//   Ctrl  + left                                     graphics zoom: the selected rectangle is
//                                                    enlarged (same factor both ways, so the
//                                                    picture keeps its shape) and centred
//   Shift + left                                     axis zoom: the axes run over the selection's
//                                                    data values; scale and move are removed so
//                                                    that the axes are in view (not for pies)
//   Ctrl  + wheel                                    scale: each notch away from the user x 1.2
//   "r" (without Ctrl or Alt)                        back to automatic scale, position and axes
//   Escape                                           cancels a zoom selection in progress
//
// Ctrl and Shift held together choose nothing. A selection less than 4 pixels wide or high is no
// zoom. Scale stays within 0.1 to 20 and moves within 10 chart area sizes. Scale, move and
// graphics zoom are the control's view state (ViewState); axis zoom its axes' fixed ranges;
// rotation and elevation its 3-D view, which the chart object reads back.
//
//   ChartInteraction interaction(chart);
//   interaction.setTarget(widget.rect());
//   interaction.press(pos, Qt::LeftButton, Qt::ControlModifier);
//   interaction.move(pos2);  interaction.release(pos2, Qt::NoButton);   // zoomed
#include <QPointF>
#include <QRectF>
#include <Qt>

#include "chart/control/model/ChartControl.h"
#include "chart/control/render/ChartLayout.h"

namespace kg::control {

enum class Gesture { None, Scale, Move, Rotate, GraphicsZoom, AxisZoom };

class ChartInteraction {
public:
    static constexpr double kMinScale = 0.1, kMaxScale = 20;
    static constexpr double kMostOffset = 10;          // chart area sizes, either way
    static constexpr double kScalePerPixel = 0.01;     // scale x exp(pixels down x this)
    static constexpr double kWheelNotchScale = 1.2;    // one wheel notch (120 eighths of a degree)
    static constexpr double kPixelsPerDegree = 2;      // rotate
    static constexpr int32_t kMostAngle = 45;          // rotation and elevation, either way
    static constexpr double kLeastSelection = 4;       // pixels, both ways

    explicit ChartInteraction(ChartControl& chart) : chart_(chart) {}

    // The rectangle the chart is painted into (the widget's).
    void setTarget(const QRectF& target) { target_ = target; }
    const QRectF& target() const { return target_; }

    // Each returns true when the event was used. `buttons` are all the buttons held after the
    // event; `modifiers` the keys held at the press.
    bool press(QPointF pos, Qt::MouseButtons buttons, Qt::KeyboardModifiers modifiers);
    bool move(QPointF pos);
    bool release(QPointF pos, Qt::MouseButtons buttons);
    bool wheel(QPointF pos, int angleDelta, Qt::KeyboardModifiers modifiers);
    bool keyPress(int key, Qt::KeyboardModifiers modifiers);
    // Ends any gesture; a zoom selection is dropped, a drag keeps what it did so far.
    void cancel();

    Gesture gesture() const { return gesture_; }
    // The zoom selection in progress (inside the chart area), or an empty rectangle.
    QRectF selection() const;

    // The gesture that buttons and keys choose on this chart (None where the chart does not
    // allow it: rotate without the 3-D look or on a plot or area chart).
    static Gesture gestureFor(const ChartControl& chart, Qt::MouseButtons buttons, Qt::KeyboardModifiers modifiers);

private:
    void begin(Gesture g, QPointF pos);
    void drag(QPointF pos);
    void finishSelection(QPointF pos);
    void zoomGraphics(const QRectF& selected);
    void zoomAxes(const QRectF& selected);
    void setScaleAboutCentre(double scale, const ViewState& from);

    ChartControl& chart_;
    QRectF target_;
    Gesture gesture_ = Gesture::None;
    QPointF start_, last_;
    ChartLayout layout_;     // as at the press: the frame and the data mapping of the gesture
    ViewState startView_;
    View3D startView3D_;
};

}  // namespace kg::control
