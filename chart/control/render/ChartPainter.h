#pragma once
// The one painter of our chart control: it draws the model onto any paint device (the view
// widget, a printer page, an image, an SVG or a PDF file). The view state (scale and move of the
// chart inside its chart area) is applied to the chart area's content only.
//
//   QImage image(800, 600, QImage::Format_RGB32);
//   QPainter painter(&image);
//   kg::control::paintChart(chart, painter, image.rect());
#include <QRectF>

#include "chart/control/model/ChartControl.h"

class QPainter;

namespace kg::control {

struct ChartLayout;
struct ChartFonts;

// Paints the whole control into `target` (in the painter's current coordinates; fonts and
// sizes are logical pixels at 96 dpi).
void paintChart(const ChartControl& chart, QPainter& painter, const QRectF& target);

// The same with a layout and fonts the caller already computed for this target.
void paintChart(const ChartControl& chart, QPainter& painter, const ChartLayout& layout, const ChartFonts& fonts);

}  // namespace kg::control
