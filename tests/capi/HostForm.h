#pragma once
// A host's own form and grid, written as a host in C writes them: a struct that starts with the
// function table, counted references, members looked up by name without regard to case. Every
// member call is logged, and one member can be told to fail with a status and an error.
#include <strings.h>

#include <cstdio>
#include <string>
#include <vector>

#include "karstgraph/karstgraph.h"

namespace capi_test {

// How a member fails: its name, the status Invoke returns and the error it fills.
struct HostFailure {
    const char* member = nullptr;  // null: no member fails
    int32_t status = KG_E_EXCEPTION;
    int32_t number = 0;
    const char* description = "";
};

struct HostLog {
    std::vector<std::string> calls;  // "grid1", "Rows", "textmatrix(1,3)", ...
    int alive = 0;                   // host objects not yet freed
};

// The form (members: grid1) or its grid (members: Rows, FixedRows, cols, textmatrix).
struct HostObject {
    KGObject base;  // first, so a HostObject* is a KGObject*
    uint32_t refs;
    const char* members[4];  // a member's dispatch id is its place plus one
    HostFailure failure;
    HostLog* log;
    HostObject* grid1;  // the form's reference; null on the grid
    int32_t rows, fixedRows, cols;
    const char* const* cells;  // rows * cols texts
};

namespace hostform {

inline int32_t wholeArg(const KGVariant& v)
{
    switch (v.vt) {
    case KG_VT_I2: return v.iVal;
    case KG_VT_I4: return v.lVal;
    case KG_VT_R8: return static_cast<int32_t>(v.dblVal);
    default: return -1;
    }
}

inline uint32_t addRef(KGObject* self) { return ++reinterpret_cast<HostObject*>(self)->refs; }

inline uint32_t release(KGObject* self)
{
    auto* o = reinterpret_cast<HostObject*>(self);
    const uint32_t left = --o->refs;
    if (left == 0) {
        if (o->grid1) KGRelease(&o->grid1->base);
        --o->log->alive;
        delete o;
    }
    return left;
}

inline int32_t getIDOfName(KGObject* self, const char* name, int32_t* id)
{
    const auto* o = reinterpret_cast<HostObject*>(self);
    for (int i = 0; i < 4 && o->members[i]; ++i) {
        if (strcasecmp(name, o->members[i]) == 0) {
            *id = i + 1;
            return KG_S_OK;
        }
    }
    return KG_E_UNKNOWNNAME;
}

inline int32_t invoke(KGObject* self, int32_t id, uint16_t, KGVariant* args, uint32_t argc, KGVariant* result,
                      KGErrorInfo* error)
{
    auto* o = reinterpret_cast<HostObject*>(self);
    if (id < 1 || id > 4 || !o->members[id - 1]) return KG_E_MEMBERNOTFOUND;
    const char* member = o->members[id - 1];
    const bool cell = strcasecmp(member, "textmatrix") == 0;
    std::string call = member;
    if (cell && argc == 2)
        call += "(" + std::to_string(wholeArg(args[0])) + "," + std::to_string(wholeArg(args[1])) + ")";
    o->log->calls.push_back(call);
    const HostFailure& f = o->failure;
    if (f.member && strcasecmp(f.member, member) == 0) {
        if (error) {
            error->number = f.number;
            std::snprintf(error->description, sizeof error->description, "%s", f.description);
            std::snprintf(error->source, sizeof error->source, "%s", "TavixHost");
        }
        return f.status;
    }
    if (o->grid1) return argc != 0 ? KG_E_BADPARAMCOUNT : KGVariantSetObject(result, &o->grid1->base);
    if (!cell) {
        KGVariantClear(result);
        result->vt = KG_VT_I4;
        result->lVal = id == 1 ? o->rows : id == 2 ? o->fixedRows : o->cols;
        return KG_S_OK;
    }
    if (argc != 2) return KG_E_BADPARAMCOUNT;
    const int32_t r = wholeArg(args[0]), c = wholeArg(args[1]);
    if (r < 0 || r >= o->rows || c < 0 || c >= o->cols) return KG_E_BADINDEX;
    return KGVariantSetString(result, o->cells[r * o->cols + c]);
}

inline const KGObjectVtbl kVtbl = {addRef, release, getIDOfName, invoke};

}  // namespace hostform

// A new form (one reference for the caller) whose grid1 shows `cells`; `failure` names a member of
// either.
inline KGObject* makeHostForm(HostLog& log, int32_t rows, int32_t fixedRows, int32_t cols, const char* const* cells,
                              const HostFailure& failure = {})
{
    auto* grid = new HostObject{{&hostform::kVtbl}, 1, {"Rows", "FixedRows", "cols", "textmatrix"}, failure, &log,
                                nullptr, rows, fixedRows, cols, cells};
    auto* form = new HostObject{{&hostform::kVtbl}, 1, {"grid1", nullptr, nullptr, nullptr}, failure, &log, grid,
                                0, 0, 0, nullptr};
    log.alive += 2;
    return &form->base;
}

}  // namespace capi_test
