#pragma once
// The border styles of the control, the chart area and the value labels.
#include <QColor>
#include <QRectF>

#include "chart/control/model/ChartControl.h"

class QPainter;

namespace kg::control {

// Room a border takes on each side (a shadow only on the right and bottom; it is counted on all
// sides so that content stays centred). Unknown codes draw as no border.
double borderInset(const Border& border);

// Paints the border inside `outer` and fills what it encloses with `fill` (no fill when invalid).
// `face` is the colour a bevel is shaded from. Returns the rectangle inside the border.
QRectF paintBorder(QPainter& painter, const QRectF& outer, const Border& border, const QColor& fill,
                   const QColor& face);

}  // namespace kg::control
