#include "builders/LateBoundGrid.h"

#include "core/Convert.h"
#include "core/Error.h"

namespace kg::builders {

Object& LateBoundGrid::object(const char* member)
{
    if (!grid_.isObject() || !grid_.object())
        throw Error::objectNotSet(std::string("reading .") + member + " of a grid that is not an object");
    return *grid_.object();
}

DispId LateBoundGrid::id(const char* member, DispId& cache)
{
    if (cache == kUnresolved) cache = object(member).idOfName(member);
    return cache;
}

int32_t LateBoundGrid::wholeNumber(const char* member, DispId& cache)
{
    Args none;
    const DispId d = id(member, cache);
    return toLong(object(member).invoke(d, kMethod | kPropertyGet, none));
}

std::string LateBoundGrid::textmatrix(int32_t row, int32_t col)
{
    Args cell{Variant(row), Variant(col)};
    const DispId d = id("textmatrix", textmatrix_);
    return toText(object("textmatrix").invoke(d, kMethod | kPropertyGet, cell));
}

Variant LateBoundGrid::GetValueFromCell(int32_t row, int32_t col)
{
    Args cell{Variant(row), Variant(col)};
    const DispId d = id("GetValueFromCell", valueFromCell_);
    return object("GetValueFromCell").invoke(d, kMethod | kPropertyGet, cell);
}

Variant datePickerValue(const Variant& form, const char* picker) { return call(call(form, picker), "Value"); }

}  // namespace kg::builders
