#pragma once
// The control's print operation: the chart as shown, on one landscape page, scaled to fit, with
// no dialog. It goes to the default printer, or to a PDF file when the print target names one
// (the test stand and the command line print that way).
//
//   kg::control::installPrinting(chart, [] { return std::string("/tmp/chart.pdf"); });
//   chart.print({3, 4, 0, 0, 0, 0});
#include <functional>
#include <string>

#include "chart/control/model/ChartControl.h"

namespace kg::control {

// The PDF file to print to, asked at each print; an empty path prints to the default printer.
using PrintTarget = std::function<std::string()>;

// Logical size a chart is printed at when no view has shown it: the chart window's first inner
// size, 6756 x 3732 twips at 15 twips a pixel.
constexpr int kDefaultPrintWidth = 450, kDefaultPrintHeight = 249;

// Prints the chart. The six print options are the outside control's codes; they do not change
// this layout. No printer and no PDF file: Error 482 "Printer error: no printer is installed".
void printChart(const ChartControl& chart, const PrintRequest& request, const std::string& pdfFile);

// Makes printChart the control's print operation; no target: always the default printer.
void installPrinting(ChartControl& chart, PrintTarget target = {});

}  // namespace kg::control
