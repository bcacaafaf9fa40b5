#pragma once
// The control's current picture as an image or a file, for the rest of the program (the render
// command, the window's copies). The file format follows the extension: .png, .svg or .pdf.
//
//   kg::control::exportChart(chart, "/tmp/sales.svg", QSize(800, 600));
#include <QImage>
#include <QSize>
#include <string>

#include "chart/control/model/ChartControl.h"

namespace kg::control {

// Largest picture side accepted, in pixels.
constexpr int kMostExportSide = 16384;

// The chart painted on an RGB image of `size` (Error 5 for a size outside 1 to kMostExportSide).
QImage renderImage(const ChartControl& chart, QSize size);

// Whether `path` ends in an extension exportChart writes (.png, .svg or .pdf, in any case).
bool isExportFormat(const std::string& path);

// Writes the chart at `size` (pixels at 96 dpi; a PDF page of that size) to `path`. The file
// appears whole or not at all: it is written beside the target and renamed. An unknown
// extension is Error 5; a file that cannot be written is Error 75; both name the file.
void exportChart(const ChartControl& chart, const std::string& path, QSize size);

}  // namespace kg::control
