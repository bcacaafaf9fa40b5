#pragma once
// A host's own form and grid, written as a host in C writes them: a struct that starts with the
// function table, counted references, members looked up by name without regard to case. Every
// member call is logged, and one member can be told to fail with a status and an error.
#include <strings.h>

#include <cstdio>
#include <cstring>
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

struct HostGrid {
    KGObject base;  // first, so a HostGrid* is a KGObject*
    uint32_t refs;
    int32_t rows, fixedRows, cols;
    const char* const* cells;  // rows * cols texts
    HostFailure failure;
    HostLog* log;
};

struct HostForm {
    KGObject base;
    uint32_t refs;
    HostGrid* grid1;  // the form's reference
    HostFailure failure;
    HostLog* log;
};

namespace hostform {

enum { kGrid1 = 1, kRows = 1, kFixedRows, kCols, kTextMatrix };

inline int32_t fail(const HostFailure& f, KGErrorInfo* error)
{
    if (error) {
        error->number = f.number;
        std::snprintf(error->description, sizeof error->description, "%s", f.description);
        std::snprintf(error->source, sizeof error->source, "%s", "TavixHost");
    }
    return f.status;
}

inline bool fails(const HostFailure& f, const char* member) { return f.member && strcasecmp(f.member, member) == 0; }

inline int32_t wholeArg(const KGVariant& v)
{
    switch (v.vt) {
    case KG_VT_I2: return v.iVal;
    case KG_VT_I4: return v.lVal;
    case KG_VT_R8: return static_cast<int32_t>(v.dblVal);
    default: return -1;
    }
}

inline uint32_t gridAddRef(KGObject* self) { return ++reinterpret_cast<HostGrid*>(self)->refs; }
inline uint32_t gridRelease(KGObject* self)
{
    HostGrid* g = reinterpret_cast<HostGrid*>(self);
    const uint32_t left = --g->refs;
    if (left == 0) {
        --g->log->alive;
        delete g;
    }
    return left;
}

inline int32_t gridGetIDOfName(KGObject*, const char* name, int32_t* id)
{
    static const char* const names[] = {"Rows", "FixedRows", "cols", "textmatrix"};
    for (int i = 0; i < 4; ++i) {
        if (strcasecmp(name, names[i]) == 0) {
            *id = i + 1;
            return KG_S_OK;
        }
    }
    return KG_E_UNKNOWNNAME;
}

inline int32_t gridInvoke(KGObject* self, int32_t id, uint16_t, KGVariant* args, uint32_t argc, KGVariant* result,
                          KGErrorInfo* error)
{
    HostGrid* g = reinterpret_cast<HostGrid*>(self);
    static const char* const names[] = {"", "Rows", "FixedRows", "cols", "textmatrix"};
    if (id < kRows || id > kTextMatrix) return KG_E_MEMBERNOTFOUND;
    std::string call = names[id];
    if (id == kTextMatrix && argc == 2)
        call += "(" + std::to_string(wholeArg(args[0])) + "," + std::to_string(wholeArg(args[1])) + ")";
    g->log->calls.push_back(call);
    if (fails(g->failure, names[id])) return fail(g->failure, error);
    if (id != kTextMatrix) {
        KGVariantClear(result);
        result->vt = KG_VT_I4;
        result->lVal = id == kRows ? g->rows : id == kFixedRows ? g->fixedRows : g->cols;
        return KG_S_OK;
    }
    if (argc != 2) return KG_E_BADPARAMCOUNT;
    const int32_t r = wholeArg(args[0]), c = wholeArg(args[1]);
    if (r < 0 || r >= g->rows || c < 0 || c >= g->cols) return KG_E_BADINDEX;
    return KGVariantSetString(result, g->cells[r * g->cols + c]);
}

inline const KGObjectVtbl kGridVtbl = {gridAddRef, gridRelease, gridGetIDOfName, gridInvoke};

inline uint32_t formAddRef(KGObject* self) { return ++reinterpret_cast<HostForm*>(self)->refs; }
inline uint32_t formRelease(KGObject* self)
{
    HostForm* f = reinterpret_cast<HostForm*>(self);
    const uint32_t left = --f->refs;
    if (left == 0) {
        KGRelease(&f->grid1->base);
        --f->log->alive;
        delete f;
    }
    return left;
}

inline int32_t formGetIDOfName(KGObject*, const char* name, int32_t* id)
{
    if (strcasecmp(name, "grid1") != 0) return KG_E_UNKNOWNNAME;
    *id = kGrid1;
    return KG_S_OK;
}

inline int32_t formInvoke(KGObject* self, int32_t id, uint16_t, KGVariant*, uint32_t argc, KGVariant* result,
                          KGErrorInfo* error)
{
    HostForm* f = reinterpret_cast<HostForm*>(self);
    if (id != kGrid1) return KG_E_MEMBERNOTFOUND;
    f->log->calls.push_back("grid1");
    if (fails(f->failure, "grid1")) return fail(f->failure, error);
    if (argc != 0) return KG_E_BADPARAMCOUNT;
    return KGVariantSetObject(result, &f->grid1->base);
}

inline const KGObjectVtbl kFormVtbl = {formAddRef, formRelease, formGetIDOfName, formInvoke};

}  // namespace hostform

// A new form (one reference for the caller) whose grid1 shows `cells`.
inline KGObject* makeHostForm(HostLog& log, int32_t rows, int32_t fixedRows, int32_t cols, const char* const* cells,
                              HostFailure formFailure = {}, HostFailure gridFailure = {})
{
    auto* grid = new HostGrid{{&hostform::kGridVtbl}, 1, rows, fixedRows, cols, cells, gridFailure, &log};
    auto* form = new HostForm{{&hostform::kFormVtbl}, 1, grid, formFailure, &log};
    log.alive += 2;
    return &form->base;
}

}  // namespace capi_test
