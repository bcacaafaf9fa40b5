#pragma once
// The control's print operation: the chart as shown, on one landscape page, scaled to fit, with
// no dialog. It goes to the default printer, or to a PDF file when one is set (the test stand
// and the command line print that way).
//
//   kg::control::installPrinting(chart);
//   chart.print({3, 4, 0, 0, 0, 0});
#include <string>

#include "chart/control/model/ChartControl.h"

namespace kg::control {

// Print to this PDF file instead of a printer; an empty path prints to the default printer.
void setPrintToPdfFile(const std::string& path);
const std::string& printToPdfFile();

// Logical size a chart is printed at when no view has shown it: the chart window's first inner
// size, 6756 x 3732 twips at 15 twips a pixel.
constexpr int kDefaultPrintWidth = 450, kDefaultPrintHeight = 249;

// Prints the chart. The six print options are the outside control's codes; they do not change
// this layout. No printer and no PDF file: Error 482 "Printer error: no printer is installed".
void printChart(const ChartControl& chart, const PrintRequest& request);

// Makes printChart the control's print operation.
void installPrinting(ChartControl& chart);

}  // namespace kg::control
