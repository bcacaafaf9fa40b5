#pragma once
// Colours of the chart: the model's Windows colour values as Qt colours, and the series palette.
#include <QColor>

#include "chart/control/model/ChartControl.h"

namespace kg::control {

QColor toQColor(OleColor c);

// Colour of series (or pie slice) `index`, counted from 1; the palette repeats after its last entry.
QColor seriesColor(int index);
int seriesPaletteSize();

// The shade of `c` used for the faces of a 3-D body that turn away from the light.
QColor sideShade(const QColor& c);
QColor topShade(const QColor& c);

}  // namespace kg::control
