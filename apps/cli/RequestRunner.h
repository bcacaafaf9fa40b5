#pragma once
// Runs one request through the component as a host does: cTavixGraph by dispatch id, the source
// form set first, message boxes and the data choice dialog answered by a scripted prompter, the
// chart window offscreen. Shared by `render` and `gallery`.
#include <QSize>
#include <optional>
#include <string>

#include "core/Variant.h"
#include "teststand/TestStand.h"

namespace kg::cli {

struct RequestCall {
    std::string request;                 // a GenerateChart_* name
    std::optional<int32_t> series;       // lNumSeries; default: the grid's data rows
    Variant total = Variant(0.0);        // vTotal
    std::optional<int16_t> choice;       // the data choice dialog's answer
};

enum class Outcome { Drawn, Failed, Message };

struct RequestResult {
    Outcome outcome = Outcome::Failed;
    std::string text;  // the error ("error N: description") or the message box's text
};

// Once per process, before the first request: a QApplication must exist. The host objects are
// the test stand's, made with `stand`.
void installOffscreenComponent(const teststand::Config& stand);
// Before the application object goes: unloads the chart window and releases what the component holds.
void shutdownComponent();

bool isRequestName(const std::string& name);
bool takesGridArguments(const std::string& request);
bool isMeasureRequest(const std::string& request);

RequestResult runRequest(const Variant& form, const RequestCall& call);

// Writes what the chart window shows to `path` (.png, .svg or .pdf); throws kg::Error.
void writeShownChart(const std::string& path, QSize size);

}  // namespace kg::cli
