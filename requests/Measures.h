#pragma once
// The seven measures of the bookings grid a data choice dialog offers, in the order of its options
// (the index is the dialog's iChoice). The dialog's captions and the chart headers name the same
// measure in different words; both are kept as the user knows them.
#include <array>
#include <cstdint>

namespace kg::requests {

struct Measure {
    int32_t column1, column2;  // the grid columns charted; column2 0: one measure
    const char* yTitle;        // "" for two measures (a legend names them)
    const char* quoteTypeHeader;
    const char* categoryHeader;
    const char* quoteTypeCaption;  // frmChoose1's option
    const char* categoryCaption;   // frmChoose2's option
};

constexpr std::array<Measure, 7> kMeasures = {{
    {1, 0, "Quantity", "Quote Type by Quantity", "Category by Quantity", "Quote Type by Quantity",
     "Category by Quantity"},
    {2, 0, "$Value", "Quote Type by $Value", "Category by $Value", "Quote Type by Value", "Category by Value"},
    {3, 0, "Average $Value", "Quote Type by Average Value", "Category by Average Value",
     "Quote Type by Average Value", "Category by Average Value"},
    {4, 0, "% Jobs", "Quote Type by Percent of Jobs", "Category by Percent of Jobs", "Quote Type by % Jobs",
     "Category by % Jobs"},
    {5, 0, "% by $Value", "Quote Type by Percent of $Value", "Category by Percent of $Value", "Quote Type by % of $",
     "Category by % of $"},
    {2, 3, "", "Quote Type by $Value and Average $Value", "Category by $Value and Average $Value",
     "Quote Type by $Value and Average $Value", "Category by $Value and Average $Value"},
    {4, 5, "", "Quote Type by %Jobs and % $Value", "Category by %Jobs and % $Value",
     "Quote Type by % Jobs and % $Value", "Category by % Jobs and % $Value"},
}};

}  // namespace kg::requests
