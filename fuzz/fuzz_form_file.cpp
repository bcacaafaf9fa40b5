// The form file loader on any text: loadFormJson either refuses the text with the form file error
// (naming the form) or gives a form whose members answer as a host form does. Every member the
// form holds is then read late-bound: the grids' Rows, FixedRows and cols, their cells at the
// corners, just outside them and at coordinates taken from the text's hash; the pickers' dates;
// the field lists' entries. Inside the grid a cell reads; outside it is Error 9; nothing else.
#include <QCoreApplication>
#include <functional>

#include "core/Convert.h"
#include "FuzzSupport.h"
#include "teststand/TestStand.h"

using namespace kg;
using kg::fuzz::expectOnly;
using kg::fuzz::require;
namespace stand = kg::teststand;

namespace {

constexpr const char* kFormName = "fuzz form";

void pokeCell(const Variant& grid, const char* name, int32_t rows, int32_t cols, int64_t row, int64_t col)
{
    const bool inside = row >= 0 && row < rows && col >= 0 && col < cols;
    const Variant r = row >= INT32_MIN && row <= INT32_MAX ? Variant(int32_t(row)) : Variant(double(row));
    const Variant c = col >= INT32_MIN && col <= INT32_MAX ? Variant(int32_t(col)) : Variant(double(col));
    std::string text;
    const bool textRead = expectOnly({errc::SubscriptOutOfRange, errc::Overflow}, "textmatrix",
                                     [&] { text = toText(call(grid, "textmatrix", {r, c})); });
    require(textRead == inside, std::string(name) + ".textmatrix(" + std::to_string(row) + ", " +
                                    std::to_string(col) + ") " + (textRead ? "read" : "failed") + " in a grid of " +
                                    std::to_string(rows) + " x " + std::to_string(cols));
    Variant value;
    const bool valueRead = expectOnly({errc::SubscriptOutOfRange, errc::Overflow}, "GetValueFromCell",
                                      [&] { value = call(grid, "GetValueFromCell", {r, c}); });
    require(valueRead == inside, std::string(name) + ".GetValueFromCell disagrees with textmatrix");
    if (!inside) return;
    // A cell's text is its value as text; a null cell has the empty text.
    require(value.isNull() ? text.empty() : toText(value) == text,
            std::string(name) + " cell text \"" + text + "\" is not its value's text");
}

void pokeGrid(const Variant& form, const char* name, size_t hash)
{
    Variant grid;
    if (!expectOnly({errc::MemberNotFound}, "form member", [&] { grid = call(form, name); })) return;
    require(grid.isObject() && grid.object(), std::string(name) + " is not an object");
    const int32_t rows = toLong(call(grid, "Rows"));
    const int32_t fixedRows = toLong(call(grid, "FixedRows"));
    const int32_t cols = toLong(call(grid, "cols"));
    require(rows >= 0 && cols >= 0 && fixedRows >= 0 && fixedRows <= rows,
            std::string(name) + " has " + std::to_string(rows) + " rows, " + std::to_string(fixedRows) +
                " fixed rows and " + std::to_string(cols) + " columns");
    const int64_t rowsAt[] = {-1, 0, rows - 1, rows, int64_t(hash % 7), INT32_MAX, int64_t(INT32_MAX) + 1};
    const int64_t colsAt[] = {-1, 0, cols - 1, cols, int64_t((hash >> 8) % 7)};
    for (int64_t r : rowsAt)
        for (int64_t c : colsAt) pokeCell(grid, name, rows, cols, r, c);
    expectOnly({errc::WrongArgumentCount}, "textmatrix with one argument",
               [&] { call(grid, "textmatrix", {Variant(int32_t(0))}); });
    require(!expectOnly({errc::InvalidProcedureCall}, "Rows assignment", [&] { put(grid, "Rows", Variant(1)); }),
            std::string(name) + ".Rows could be assigned");
}

void pokeForm(const Variant& form, size_t hash)
{
    for (const char* g : {"grid1", "grid2", "grid3", "gridsettings1"}) pokeGrid(form, g, hash);
    for (const char* p : {"dtpFromDate", "dtpToDate"}) {
        Variant picker;
        if (!expectOnly({errc::MemberNotFound}, "form member", [&] { picker = call(form, p); })) continue;
        const Variant date = call(picker, "Value");
        require(date.type() == VarType::Date, std::string(p) + ".Value is not a date");
        formatPattern(date, "DD/MM/YYYY");  // a loaded date is always in the date range
    }
    for (int32_t index : {-1, 0, 1, 2, int32_t(hash % 5)}) {
        Variant list;
        if (!expectOnly({errc::MemberNotFound, errc::SubscriptOutOfRange}, "cboFields",
                        [&] { list = call(form, "cboFields", {Variant(index)}); }))
            continue;
        const int32_t count = toLong(call(list, "ListCount"));
        require(count >= 0, "a field list has a negative count");
        for (int32_t i : {-1, 0, count - 1, count}) {
            const bool read = expectOnly({errc::SubscriptOutOfRange}, "List", [&] { call(list, "List", {Variant(i)}); });
            require(read == (i >= 0 && i < count), "List(" + std::to_string(i) + ") of " + std::to_string(count));
        }
    }
    expectOnly({errc::MemberNotFound}, "unknown member", [&] { call(form, "grid4"); });
    stand::jobsDatabaseOf(Ref<Object>(form.object()));
}

}  // namespace

extern "C" int LLVMFuzzerInitialize(int* argc, char*** argv)
{
    static QCoreApplication app(*argc, *argv);  // the loader's paths and texts use QtCore
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    const std::string json(reinterpret_cast<const char*>(data), size);
    Ref<Object> form;
    try {
        form = stand::loadFormJson(json, kFormName);
    } catch (const Error& e) {
        kg::fuzz::expectError(e, {errc::HostBase + stand::hosterr::FormFile}, "loadFormJson");
        require(e.description().rfind(std::string("Form file \"") + kFormName + "\"", 0) == 0,
                "a form file error that does not name the form: " + e.description());
        return 0;
    } catch (const std::exception& e) {
        kg::fuzz::fail(std::string("loadFormJson raised a non-kg exception: ") + e.what());
    }
    require(form.get() != nullptr, "loadFormJson gave no form");
    expectOnly({}, "reading the loaded form", [&] { pokeForm(Variant(form), std::hash<std::string>{}(json)); });
    return 0;
}
