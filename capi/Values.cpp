// The KGVariant and KGArray functions of the C surface, and the conversions to and from kg::Variant.
#include "capi/Values.h"

#include <cstdlib>
#include <cstring>

#include "capi/Boundary.h"
#include "capi/Objects.h"
#include "core/Error.h"

namespace {

// The largest array the component accepts (as VariantArray): a larger one cannot be meant.
constexpr int64_t kMaxCells = int64_t(1) << 26;

// Strings live in malloc'd memory, so a C host may free what it took over with free() as well.
char* duplicate(const char* text)
{
    const size_t n = std::strlen(text);
    char* copy = static_cast<char*>(std::malloc(n + 1));
    if (!copy) throw std::bad_alloc();
    std::memcpy(copy, text, n + 1);
    return copy;
}

bool knownType(uint16_t vt)
{
    switch (vt) {
    case KG_VT_EMPTY:
    case KG_VT_NULL:
    case KG_VT_I2:
    case KG_VT_I4:
    case KG_VT_R8:
    case KG_VT_DATE:
    case KG_VT_STRING:
    case KG_VT_OBJECT:
    case KG_VT_BOOL:
    case KG_VT_ARRAY: return true;
    default: return false;
    }
}

KGArray* newArray(int32_t lo0, int32_t hi0, int32_t lo1, int32_t hi1)
{
    const int64_t n0 = int64_t(hi0) - lo0 + 1, n1 = int64_t(hi1) - lo1 + 1;
    if (n0 < 1 || n1 < 1 || n0 * n1 > kMaxCells) return nullptr;
    auto* a = new KGArray;
    a->lo0 = lo0;
    a->lo1 = lo1;
    a->n0 = int32_t(n0);
    a->n1 = int32_t(n1);
    KGVariant empty;
    KGVariantInit(&empty);
    a->cells.assign(static_cast<size_t>(n0 * n1), empty);
    return a;
}

// Throws on failure; dest is Empty then.
void copyInto(KGVariant& dest, const KGVariant& src)
{
    KGVariantClear(&dest);
    switch (src.vt) {
    case KG_VT_STRING: dest.strVal = duplicate(src.strVal ? src.strVal : ""); break;
    case KG_VT_OBJECT:
        dest.objVal = src.objVal;
        KGAddRef(dest.objVal);
        break;
    case KG_VT_ARRAY: {
        if (!src.arrVal) throw kg::capi::Failure(KG_E_INVALIDARG, "a KGVariant of type array without an array");
        const KGArray& from = *src.arrVal;
        KGArray* to = newArray(from.lo0, from.lo0 + from.n0 - 1, from.lo1, from.lo1 + from.n1 - 1);
        if (!to) throw std::bad_alloc();
        try {
            for (size_t k = 0; k < from.cells.size(); ++k) copyInto(to->cells[k], from.cells[k]);
        } catch (...) {
            delete to;
            throw;
        }
        dest.arrVal = to;
        break;
    }
    default:
        if (!knownType(src.vt))
            throw kg::capi::Failure(KG_E_BADVARTYPE, "a KGVariant of unknown type " + std::to_string(src.vt));
        dest = src;
        return;
    }
    dest.vt = src.vt;
}

}  // namespace

KGArray::~KGArray()
{
    for (KGVariant& v : cells) KGVariantClear(&v);
}

KGVariant* KGArray::cell(int32_t i, int32_t j)
{
    const int64_t a = int64_t(i) - lo0, b = int64_t(j) - lo1;
    if (a < 0 || a >= n0 || b < 0 || b >= n1) return nullptr;
    return &cells[static_cast<size_t>(a) * static_cast<size_t>(n1) + static_cast<size_t>(b)];
}

namespace kg::capi {

Variant toKg(const KGVariant& v, const std::string& name)
{
    switch (v.vt) {
    case KG_VT_EMPTY: return {};
    case KG_VT_NULL: return Variant::null();
    case KG_VT_I2: return Variant(v.iVal);
    case KG_VT_I4: return Variant(v.lVal);
    case KG_VT_R8: return Variant(v.dblVal);
    case KG_VT_DATE: return Variant::date(v.date);
    case KG_VT_STRING: return Variant(std::string(v.strVal ? v.strVal : ""));
    case KG_VT_BOOL: return Variant(v.boolVal != 0);
    case KG_VT_OBJECT: return Variant(importObject(v.objVal, name));
    case KG_VT_ARRAY: {
        if (!v.arrVal) throw Failure(KG_E_INVALIDARG, Error::invalidCall("a KGVariant of type array without an array"));
        const KGArray& a = *v.arrVal;
        VariantArray out(a.lo0, a.lo0 + a.n0 - 1, a.lo1, a.lo1 + a.n1 - 1);
        for (int32_t i = 0; i < a.n0; ++i)
            for (int32_t j = 0; j < a.n1; ++j)
                out.at(a.lo0 + i, a.lo1 + j) = toKg(a.cells[size_t(i) * size_t(a.n1) + size_t(j)], name);
        return Variant(std::move(out));
    }
    default: break;
    }
    throw Failure(KG_E_BADVARTYPE, Error(458, "Variable uses an Automation type not supported: vt " +
                                                  std::to_string(v.vt) + " in a value of " + name));
}

void fromKg(const Variant& v, KGVariant& out)
{
    KGVariantClear(&out);
    switch (v.type()) {
    case VarType::Empty: return;
    case VarType::Null: out.vt = KG_VT_NULL; return;
    case VarType::Integer: out.iVal = v.integer(); out.vt = KG_VT_I2; return;
    case VarType::Long: out.lVal = v.longValue(); out.vt = KG_VT_I4; return;
    case VarType::Double: out.dblVal = v.dbl(); out.vt = KG_VT_R8; return;
    case VarType::Date: out.date = v.dateSerial(); out.vt = KG_VT_DATE; return;
    case VarType::Boolean: out.boolVal = v.boolean() ? -1 : 0; out.vt = KG_VT_BOOL; return;
    case VarType::String: out.strVal = duplicate(v.str().c_str()); out.vt = KG_VT_STRING; return;
    case VarType::Object: out.objVal = exportObject(v.object()); out.vt = KG_VT_OBJECT; return;
    case VarType::Array: {
        const VariantArray& a = v.array();
        KGArray* to = newArray(a.lower(0), a.upper(0), a.lower(1), a.upper(1));
        if (!to) throw std::bad_alloc();
        try {
            for (int32_t i = a.lower(0); i <= a.upper(0); ++i)
                for (int32_t j = a.lower(1); j <= a.upper(1); ++j) fromKg(a.at(i, j), *to->cell(i, j));
        } catch (...) {
            delete to;
            throw;
        }
        out.arrVal = to;
        out.vt = KG_VT_ARRAY;
        return;
    }
    }
}

bool sameValue(const Variant& a, const Variant& b)
{
    if (a.type() != b.type()) return false;
    switch (a.type()) {
    case VarType::Empty:
    case VarType::Null: return true;
    case VarType::Integer: return a.integer() == b.integer();
    case VarType::Long: return a.longValue() == b.longValue();
    case VarType::Double: return a.dbl() == b.dbl();
    case VarType::Date: return a.dateSerial() == b.dateSerial();
    case VarType::Boolean: return a.boolean() == b.boolean();
    case VarType::String: return a.str() == b.str();
    case VarType::Object: return a.object() == b.object();
    case VarType::Array: {
        const VariantArray& x = a.array();
        const VariantArray& y = b.array();
        for (int d = 0; d < 2; ++d)
            if (x.lower(d) != y.lower(d) || x.upper(d) != y.upper(d)) return false;
        for (int32_t i = x.lower(0); i <= x.upper(0); ++i)
            for (int32_t j = x.lower(1); j <= x.upper(1); ++j)
                if (!sameValue(x.at(i, j), y.at(i, j))) return false;
        return true;
    }
    }
    return false;
}

bool sameValue(const KGVariant& a, const KGVariant& b)
{
    if (a.vt != b.vt) return false;
    switch (a.vt) {
    case KG_VT_I2: return a.iVal == b.iVal;
    case KG_VT_I4: return a.lVal == b.lVal;
    case KG_VT_R8: return a.dblVal == b.dblVal;
    case KG_VT_DATE: return a.date == b.date;
    case KG_VT_BOOL: return (a.boolVal != 0) == (b.boolVal != 0);
    case KG_VT_STRING: return std::strcmp(a.strVal ? a.strVal : "", b.strVal ? b.strVal : "") == 0;
    case KG_VT_OBJECT: return a.objVal == b.objVal;
    case KG_VT_ARRAY: {
        if (!a.arrVal || !b.arrVal) return a.arrVal == b.arrVal;
        const KGArray& x = *a.arrVal;
        const KGArray& y = *b.arrVal;
        if (x.lo0 != y.lo0 || x.n0 != y.n0 || x.lo1 != y.lo1 || x.n1 != y.n1) return false;
        for (size_t k = 0; k < x.cells.size(); ++k)
            if (!sameValue(x.cells[k], y.cells[k])) return false;
        return true;
    }
    default: return true;  // Empty, Null, or a type nobody reads
    }
}

VariantList::VariantList(size_t n)
{
    KGVariant empty;
    KGVariantInit(&empty);
    items_.assign(n, empty);
}

VariantList::~VariantList()
{
    for (KGVariant& v : items_) KGVariantClear(&v);
}

}  // namespace kg::capi

using kg::capi::guarded;

extern "C" {

KG_API void KGVariantInit(KGVariant* v)
{
    if (!v) return;
    std::memset(static_cast<void*>(v), 0, sizeof *v);
    v->vt = KG_VT_EMPTY;
}

KG_API void KGVariantClear(KGVariant* v)
{
    if (!v) return;
    switch (v->vt) {
    case KG_VT_STRING: std::free(v->strVal); break;
    case KG_VT_OBJECT: KGRelease(v->objVal); break;
    case KG_VT_ARRAY: delete v->arrVal; break;
    default: break;
    }
    KGVariantInit(v);
}

KG_API int32_t KGVariantSetString(KGVariant* v, const char* utf8)
{
    if (!v) return KG_E_POINTER;
    return guarded(nullptr, [&] {
        char* copy = duplicate(utf8 ? utf8 : "");
        KGVariantClear(v);
        v->strVal = copy;
        v->vt = KG_VT_STRING;
        return KG_S_OK;
    });
}

KG_API int32_t KGVariantSetObject(KGVariant* v, KGObject* obj)
{
    if (!v) return KG_E_POINTER;
    KGAddRef(obj);  // first: obj may be what v holds now
    KGVariantClear(v);
    v->objVal = obj;
    v->vt = KG_VT_OBJECT;
    return KG_S_OK;
}

KG_API int32_t KGVariantCopy(KGVariant* dest, const KGVariant* src)
{
    if (!dest || !src) return KG_E_POINTER;
    if (dest == src) return KG_S_OK;
    return guarded(nullptr, [&] {
        try {
            copyInto(*dest, *src);
        } catch (...) {
            KGVariantInit(dest);  // nothing was stored that needs freeing
            throw;
        }
        return KG_S_OK;
    });
}

KG_API KGArray* KGArrayCreate(int32_t lo0, int32_t hi0, int32_t lo1, int32_t hi1)
{
    try {
        return newArray(lo0, hi0, lo1, hi1);
    } catch (...) {
        return nullptr;
    }
}

KG_API void KGArrayDestroy(KGArray* a) { delete a; }

KG_API int32_t KGArrayBounds(const KGArray* a, int dim, int32_t* lower, int32_t* upper)
{
    if (!a || !lower || !upper) return KG_E_POINTER;
    if (dim != 0 && dim != 1) return KG_E_INVALIDARG;
    *lower = dim == 0 ? a->lo0 : a->lo1;
    *upper = dim == 0 ? a->lo0 + a->n0 - 1 : a->lo1 + a->n1 - 1;
    return KG_S_OK;
}

KG_API int32_t KGArrayGet(const KGArray* a, int32_t i, int32_t j, KGVariant* out)
{
    if (!a || !out) return KG_E_POINTER;
    const KGVariant* cell = a->cell(i, j);
    if (!cell) return KG_E_BADINDEX;
    return KGVariantCopy(out, cell);
}

KG_API int32_t KGArrayPut(KGArray* a, int32_t i, int32_t j, const KGVariant* value)
{
    if (!a || !value) return KG_E_POINTER;
    KGVariant* cell = a->cell(i, j);
    if (!cell) return KG_E_BADINDEX;
    KGVariant copy;
    KGVariantInit(&copy);
    const int32_t status = KGVariantCopy(&copy, value);  // first: value may be this very cell
    if (KG_FAILED(status)) return status;
    KGVariantClear(cell);
    *cell = copy;
    return KG_S_OK;
}

}  // extern "C"
