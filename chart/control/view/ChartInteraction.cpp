#include "chart/control/view/ChartInteraction.h"

#include <algorithm>
#include <cmath>

namespace kg::control {

namespace {
bool bothButtons(Qt::MouseButtons buttons)
{
    return (buttons.testFlag(Qt::LeftButton) && buttons.testFlag(Qt::RightButton)) ||
           buttons.testFlag(Qt::MiddleButton);
}

bool isSelection(Gesture g) { return g == Gesture::GraphicsZoom || g == Gesture::AxisZoom; }
bool isDrag(Gesture g) { return g == Gesture::Scale || g == Gesture::Move || g == Gesture::Rotate; }

// QRectF::contains takes a position that is no number for inside.
bool inside(const QRectF& r, QPointF p) { return std::isfinite(p.x()) && std::isfinite(p.y()) && r.contains(p); }

double clampScale(double s)
{
    return std::isfinite(s) ? std::clamp(s, ChartInteraction::kMinScale, ChartInteraction::kMaxScale) : 1.0;
}

double clampOffset(double d)
{
    return std::isfinite(d) ? std::clamp(d, -ChartInteraction::kMostOffset, ChartInteraction::kMostOffset) : 0.0;
}

int32_t clampAngle(double degrees)
{
    const double most = ChartInteraction::kMostAngle;
    return int32_t(std::clamp(degrees, -most, most));
}

// Whole degrees for a drag of `pixels`, towards zero.
double degreesFor(double pixels) { return std::trunc(pixels / ChartInteraction::kPixelsPerDegree); }
}  // namespace

Gesture ChartInteraction::gestureFor(const ChartControl& chart, Qt::MouseButtons buttons,
                                     Qt::KeyboardModifiers modifiers)
{
    const bool ctrl = modifiers.testFlag(Qt::ControlModifier);
    const bool shift = modifiers.testFlag(Qt::ShiftModifier);
    if (ctrl && shift) return Gesture::None;
    if (bothButtons(buttons)) {
        if (ctrl) return Gesture::Scale;
        if (shift) return Gesture::Move;
        // The 3-D look is the depth the style gives; rotation and elevation may pass through 0
        // on the way, which must not lock the chart flat.
        const ChartKind kind = chartKindOf(chart.group1.chartType);
        const bool threeD = chart.chartArea.view3D.depth != 0;
        return threeD && (kind == ChartKind::Bar || kind == ChartKind::Pie) ? Gesture::Rotate : Gesture::None;
    }
    if (buttons == Qt::LeftButton) {
        if (ctrl) return Gesture::GraphicsZoom;
        if (shift) return Gesture::AxisZoom;
    }
    return Gesture::None;
}

bool ChartInteraction::press(QPointF pos, Qt::MouseButtons buttons, Qt::KeyboardModifiers modifiers)
{
    const Gesture wanted = gestureFor(chart_, buttons, modifiers);
    if (wanted == gesture_ && wanted != Gesture::None) return true;
    // A second button joining the first changes the gesture (Ctrl + left, then right: scale).
    const bool wasActive = gesture_ != Gesture::None;
    cancel();
    if (wanted == Gesture::None) return wasActive;
    layout_ = computeLayout(chart_, target_);
    if (!inside(layout_.chartArea, pos)) return wasActive;
    if (wanted == Gesture::AxisZoom && layout_.kind == ChartKind::Pie) return wasActive;
    begin(wanted, pos);
    return true;
}

void ChartInteraction::begin(Gesture g, QPointF pos)
{
    gesture_ = g;
    start_ = last_ = pos;
    startView_ = chart_.view;
    startView3D_ = chart_.chartArea.view3D;
}

bool ChartInteraction::move(QPointF pos)
{
    if (gesture_ == Gesture::None) return false;
    if (pos == last_ || !std::isfinite(pos.x()) || !std::isfinite(pos.y())) return true;
    last_ = pos;
    if (isDrag(gesture_)) drag(pos);
    return true;
}

void ChartInteraction::drag(QPointF pos)
{
    const QPointF d = pos - start_;
    const QRectF frame = layout_.chartContent;
    switch (gesture_) {
    case Gesture::Scale: setScaleAboutCentre(startView_.scale * std::exp(d.y() * kScalePerPixel), startView_); break;
    case Gesture::Move:
        if (frame.width() > 0 && frame.height() > 0) {
            chart_.view.offsetX = clampOffset(startView_.offsetX + d.x() / frame.width());
            chart_.view.offsetY = clampOffset(startView_.offsetY + d.y() / frame.height());
            chart_.changed();
        }
        break;
    case Gesture::Rotate: {
        View3D& v = chart_.chartArea.view3D;
        const int32_t elevation = clampAngle(startView3D_.elevation + degreesFor(d.y()));
        const int32_t rotation = layout_.kind == ChartKind::Bar
                                     ? clampAngle(startView3D_.rotation + degreesFor(d.x()))
                                     : v.rotation;
        if (elevation == v.elevation && rotation == v.rotation) break;
        v.elevation = elevation;
        v.rotation = rotation;
        chart_.changed();
        break;
    }
    default: break;
    }
}

bool ChartInteraction::release(QPointF pos, Qt::MouseButtons buttons)
{
    if (gesture_ == Gesture::None) return false;
    if (isSelection(gesture_)) {
        if (!buttons.testFlag(Qt::LeftButton)) finishSelection(pos);
        return true;
    }
    if (!bothButtons(buttons)) {
        move(pos);
        gesture_ = Gesture::None;
    }
    return true;
}

QRectF ChartInteraction::selection() const
{
    if (!isSelection(gesture_)) return {};
    return QRectF(start_, last_).normalized().intersected(layout_.chartContent);
}

void ChartInteraction::finishSelection(QPointF pos)
{
    move(pos);
    const QRectF selected = selection();
    const Gesture g = gesture_;
    gesture_ = Gesture::None;
    if (selected.width() < kLeastSelection || selected.height() < kLeastSelection) return;
    if (g == Gesture::GraphicsZoom)
        zoomGraphics(selected);
    else
        zoomAxes(selected);
}

// The selection is enlarged by the same factor both ways until it fills the chart area in one
// direction, and its centre comes to the area's centre. As a view state: the zoom applied after
// the current scale and move is one more scale and move.
void ChartInteraction::zoomGraphics(const QRectF& selected)
{
    const QRectF frame = layout_.chartContent;
    const ViewState from = chart_.view;
    const double fit = std::min(frame.width() / selected.width(), frame.height() / selected.height());
    const double scale = clampScale(from.scale * fit);
    const double k = scale / (std::isfinite(from.scale) && from.scale > 0 ? from.scale : 1.0);
    const QPointF c = frame.center(), s = selected.center();
    chart_.view.scale = scale;
    chart_.view.offsetX = clampOffset(k * (c.x() + from.offsetX * frame.width() - s.x()) / frame.width());
    chart_.view.offsetY = clampOffset(k * (c.y() + from.offsetY * frame.height() - s.y()) / frame.height());
    chart_.changed();
}

// The axes take the data values at the selection's corners (through the current scale and move),
// and the chart is shown unscaled so that its new axes are in view.
void ChartInteraction::zoomAxes(const QRectF& selected)
{
    QPointF a, b;
    if (!layout_.toValue(selected.topLeft(), a) || !layout_.toValue(selected.bottomRight(), b)) return;
    if (!std::isfinite(a.x()) || !std::isfinite(a.y()) || !std::isfinite(b.x()) || !std::isfinite(b.y())) return;
    if (a.x() == b.x() || a.y() == b.y()) return;
    Axis& x = chart_.chartArea.x;
    Axis& y = chart_.chartArea.y;
    x.hasFixedRange = y.hasFixedRange = true;
    x.min = std::min(a.x(), b.x());
    x.max = std::max(a.x(), b.x());
    y.min = std::min(a.y(), b.y());
    y.max = std::max(a.y(), b.y());
    chart_.view.scale = 1;
    chart_.view.offsetX = chart_.view.offsetY = 0;
    chart_.changed();
}

// Scales about the chart area's centre: the point shown there stays there.
void ChartInteraction::setScaleAboutCentre(double scale, const ViewState& from)
{
    const double s = clampScale(scale);
    const double k = s / (std::isfinite(from.scale) && from.scale > 0 ? from.scale : 1.0);
    chart_.view.scale = s;
    chart_.view.offsetX = clampOffset(from.offsetX * k);
    chart_.view.offsetY = clampOffset(from.offsetY * k);
    chart_.changed();
}

bool ChartInteraction::wheel(QPointF pos, int angleDelta, Qt::KeyboardModifiers modifiers)
{
    if (angleDelta == 0 || gesture_ != Gesture::None) return false;
    if (!modifiers.testFlag(Qt::ControlModifier) || modifiers.testFlag(Qt::ShiftModifier)) return false;
    if (!inside(computeLayout(chart_, target_).chartArea, pos)) return false;
    const ViewState from = chart_.view;
    setScaleAboutCentre(from.scale * std::pow(kWheelNotchScale, angleDelta / 120.0), from);
    return true;
}

bool ChartInteraction::keyPress(int key, Qt::KeyboardModifiers modifiers)
{
    if (key == Qt::Key_Escape) {
        if (!isSelection(gesture_)) return false;
        cancel();
        return true;
    }
    if (key == Qt::Key_R && !(modifiers & (Qt::ControlModifier | Qt::AltModifier | Qt::MetaModifier))) {
        cancel();
        chart_.resetView();
        return true;
    }
    return false;
}

void ChartInteraction::cancel() { gesture_ = Gesture::None; }

}  // namespace kg::control
