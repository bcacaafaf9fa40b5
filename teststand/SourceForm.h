#pragma once
// The source form's objects as a loaded form file holds them: grids, date pickers, list controls
// and the form that hands them out by member name. The form owns its objects and hands out the
// same object on every call, as a real form hands out its controls.
#include <cstdint>
#include <map>
#include <string>
#include <vector>

#include "core/Dispatch.h"

namespace kg::teststand {

// A grid's cells, row by row; each cell kept both as its text (textmatrix) and its value
// (GetValueFromCell), made once at load so reading a cell copies a ready string.
struct GridData {
    int32_t rows = 0;
    int32_t cols = 0;
    int32_t fixedRows = 0;
    std::vector<std::string> texts;  // rows * cols
    std::vector<Variant> values;     // rows * cols
};

struct FormData {
    std::map<std::string, GridData> grids;           // by member name: grid1, gridsettings1, ...
    std::map<std::string, double> pickers;           // dtpFromDate, dtpToDate: date serials
    std::map<int32_t, std::vector<std::string>> fieldLists;  // cboFields(index): entries
    bool hasFieldLists = false;
    std::string jobsDatabase;                        // absolute, or empty
};

// The member names a form file may fill, in the order they are checked.
extern const char* const kGridMembers[4];
extern const char* const kPickerMembers[2];
constexpr const char* kFieldListMember = "cboFields";

Ref<Object> makeForm(FormData data, std::string name);
// The form's jobs database; empty when `form` is not a form of this file.
std::string formJobsDatabase(const Object* form);

}  // namespace kg::teststand
