#pragma once
// The mouse and keyboard help of the chart control, as the help text window shows it: a rich text
// document in Arial 8 point with bold headings. It is part of the window's design, built here in
// code rather than loaded from a file, so it cannot go missing.
class QTextDocument;

namespace kg::ui {

// Replaces the content of `document` with the help text.
void buildChartHelp(QTextDocument& document);

}  // namespace kg::ui
