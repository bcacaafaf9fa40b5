#pragma once
// The component's shared state, one copy per loaded library, and the operations every request uses.
#include <cstdint>

#include "builders/BuildContext.h"
#include "chart/ChartWindowPort.h"
#include "chart/c2dChart.h"
#include "core/Variant.h"

namespace kg::modMain {

// Host library objects (object references held in Variants, Nothing when released).
inline Variant goAppServices;
inline Variant goJobData;
inline Variant goHostAux;
inline Variant goSettings;
inline Ref<c2dChart> goChart;
inline Ref<ChartWindowPort> gfChart;
inline Variant gvSourceForm;
// Code of the last chart request (a RequestKind); the window's Redraw repeats a measure choice.
inline int16_t giChartKind = 0;
// The value table handed to DrawChart: series 0..NumSeries by points 0..NumPoints.
inline VariantArray gvArray;

// The request codes giChartKind holds.
enum RequestKind : int16_t {
    kNoRequest = 0,         // before the first request
    kBookingsRequest = 1,   // bookings by quote type
    kCategoryRequest = 2,   // sales declaration and service categories
    kYearlyRequest = 3,
    kPropGraphRequest = 4,
    kHourlyRequest = 5,
};

// Busy pointer on and off; not nested: one off clears any number of ons.
void HourglassOn();
void HourglassOff();

// Creates the host objects, a fresh chart object and the settings store, and loads the chart window.
void GraphInitialize();

// What closing the chart window releases, in its order.
void releaseSharedObjects();

// The chart window; Error 91 when it is not loaded.
ChartWindowPort& chartWindow();
// The chart object; Error 91 when it was released.
c2dChart& chart();

// The shared state as the builders see it.
builders::BuildContext& buildContext();

}  // namespace kg::modMain
