#pragma once
// The thirteen chart requests the report screen offers, in the order of its buttons.
#include <cstdint>
#include <string>
#include <vector>

namespace kg::demo {

struct ReportRequest {
    const char* name;     // the component's operation, GenerateChart_*
    const char* caption;  // the button's text
    int32_t dispid;
    const char* grid;     // the grid whose rows and total a grid request passes; null: no arguments
};

const std::vector<ReportRequest>& reportRequests();

// The button's object name: "cmd" and the operation without "GenerateChart_" (cmdHourlyGraph1).
std::string buttonName(const ReportRequest& request);

}  // namespace kg::demo
