#pragma once
// A host grid reached late-bound: each member is looked up by name on first use (so a missing
// member fails at the step that uses it) and its dispatch id is kept for the cell loops.
#include <string>

#include "core/Dispatch.h"

namespace kg::builders {

class LateBoundGrid {
public:
    explicit LateBoundGrid(Variant grid) : grid_(std::move(grid)) {}

    int32_t Rows() { return wholeNumber("Rows", rows_); }
    int32_t FixedRows() { return wholeNumber("FixedRows", fixedRows_); }
    int32_t cols() { return wholeNumber("cols", cols_); }
    std::string textmatrix(int32_t row, int32_t col);
    Variant GetValueFromCell(int32_t row, int32_t col);

private:
    Object& object(const char* member);
    DispId id(const char* member, DispId& cache);
    int32_t wholeNumber(const char* member, DispId& cache);

    Variant grid_;
    static constexpr DispId kUnresolved = INT32_MIN;
    DispId rows_ = kUnresolved, fixedRows_ = kUnresolved, cols_ = kUnresolved;
    DispId textmatrix_ = kUnresolved, valueFromCell_ = kUnresolved;
};

// The `Value` of one of the source form's date pickers.
Variant datePickerValue(const Variant& form, const char* picker);

}  // namespace kg::builders
