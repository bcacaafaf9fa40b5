#include "core/Variant.h"

#include "core/Dispatch.h"
#include "core/Error.h"

namespace kg {

const char* typeName(VarType t)
{
    switch (t) {
    case VarType::Empty: return "Empty";
    case VarType::Null: return "Null";
    case VarType::Integer: return "Integer";
    case VarType::Long: return "Long";
    case VarType::Double: return "Double";
    case VarType::Date: return "Date";
    case VarType::String: return "String";
    case VarType::Object: return "Object";
    case VarType::Boolean: return "Boolean";
    case VarType::Array: return "Variant()";
    }
    return "Unknown";
}

Variant::Variant(std::string s) : type_(VarType::String) { u_.s = new std::string(std::move(s)); }
Variant::Variant(const char* s) : type_(VarType::String) { u_.s = new std::string(s); }
Variant::Variant(Ref<Object> o) : type_(VarType::Object)
{
    u_.o = o.get();
    if (u_.o) u_.o->addRef();
}
Variant::Variant(Object* o) : Variant(Ref<Object>(o)) {}
Variant::Variant(VariantArray a) : type_(VarType::Array) { u_.a = new VariantArray(std::move(a)); }

Variant Variant::null()
{
    Variant v;
    v.type_ = VarType::Null;
    return v;
}

Variant Variant::date(double serial)
{
    Variant v(serial);
    v.type_ = VarType::Date;
    return v;
}

void Variant::release() noexcept
{
    switch (type_) {
    case VarType::String: delete u_.s; break;
    case VarType::Object:
        if (u_.o) u_.o->release();
        break;
    case VarType::Array: delete u_.a; break;
    default: break;
    }
    type_ = VarType::Empty;
}

void Variant::copyFrom(const Variant& o)
{
    switch (o.type_) {
    case VarType::String: u_.s = new std::string(*o.u_.s); break;
    case VarType::Object:
        u_.o = o.u_.o;
        if (u_.o) u_.o->addRef();
        break;
    case VarType::Array: u_.a = new VariantArray(*o.u_.a); break;  // arrays are values: copied
    default: u_ = o.u_; break;
    }
    type_ = o.type_;
}

Variant::Variant(const Variant& o) { copyFrom(o); }

Variant& Variant::operator=(const Variant& o)
{
    if (this != &o) {
        Variant copy(o);  // before releasing: `o` may live inside what this value holds
        *this = std::move(copy);
    }
    return *this;
}

Variant& Variant::operator=(Variant&& o) noexcept
{
    if (this != &o) {
        Variant old(std::move(*this));  // released last, after the new value is in place
        type_ = o.type_;
        u_ = o.u_;
        o.type_ = VarType::Empty;
    }
    return *this;
}

bool Variant::isNumeric() const
{
    switch (type()) {
    case VarType::Boolean:
    case VarType::Integer:
    case VarType::Long:
    case VarType::Double: return true;
    default: return false;
    }
}

VariantArray::VariantArray(int32_t lo0, int32_t hi0, int32_t lo1, int32_t hi1) { allocate(lo0, hi0, lo1, hi1); }

void VariantArray::redim(int32_t hi0, int32_t hi1) { allocate(0, hi0, 0, hi1); }

void VariantArray::allocate(int32_t lo0, int32_t hi0, int32_t lo1, int32_t hi1)
{
    const int64_t n0 = int64_t(hi0) - lo0 + 1;
    const int64_t n1 = int64_t(hi1) - lo1 + 1;
    if (n0 < 1 || n1 < 1) throw Error::subscript("array bounds " + std::to_string(lo0) + " To " +
                                                 std::to_string(hi0) + ", " + std::to_string(lo1) + " To " +
                                                 std::to_string(hi1));
    // A table that large cannot be meant: refuse it before allocating.
    constexpr int64_t maxCells = int64_t(1) << 26;
    if (n0 > maxCells || n1 > maxCells || n0 * n1 > maxCells)  // each extent first: the product can overflow
        throw Error(errc::OutOfMemory,
                    "Out of memory: array of " + std::to_string(n0) + " x " + std::to_string(n1) + " cells");
    std::vector<Variant> cells(static_cast<size_t>(n0 * n1));
    cells_.swap(cells);
    lo0_ = lo0;
    lo1_ = lo1;
    n0_ = int32_t(n0);
    n1_ = int32_t(n1);
}

size_t VariantArray::index(int32_t i, int32_t j) const
{
    const int64_t a = int64_t(i) - lo0_, b = int64_t(j) - lo1_;
    if (a < 0 || a >= n0_ || b < 0 || b >= n1_)
        throw Error::subscript("(" + std::to_string(i) + ", " + std::to_string(j) + ")");
    // The first index runs fastest, as the automation layer lays arrays out: a job row's 65 fields
    // and a point's series sit together.
    return size_t(a) + size_t(b) * size_t(n0_);
}

Variant& VariantArray::at(int32_t i, int32_t j) { return cells_[index(i, j)]; }
const Variant& VariantArray::at(int32_t i, int32_t j) const { return cells_[index(i, j)]; }

}  // namespace kg
