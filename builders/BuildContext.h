#pragma once
// What a builder works on, handed in by its request: the chart window, the chart object, the value
// table, the source form and the busy pointer. Builders never reach the shared state themselves,
// so they can be driven with any window and table.
#include "chart/ChartWindowPort.h"
#include "chart/c2dChart.h"
#include "core/Variant.h"

namespace kg::builders {

class BuildContext {
public:
    virtual ~BuildContext() = default;
    // Error 91 when the window is not loaded or the chart object was released.
    virtual ChartWindowPort& window() = 0;
    virtual c2dChart& chart() = 0;
    // The value table DrawChart gets.
    virtual VariantArray& table() = 0;
    virtual const Variant& sourceForm() = 0;
    // Busy pointer on or off.
    virtual void hourglass(bool on) = 0;
};

}  // namespace kg::builders
