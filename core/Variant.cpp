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

Variant::Variant(Ref<Object> o) : v_(std::move(o)) {}
Variant::Variant(Object* o) : v_(Ref<Object>(o)) {}
Variant::Variant(VariantArray a) : v_(ArrayBox{std::make_unique<VariantArray>(std::move(a))}) {}
Variant::~Variant() = default;

Variant Variant::null()
{
    Variant v;
    v.v_ = NullBox{};
    return v;
}

Variant Variant::date(double serial)
{
    Variant v;
    v.v_ = DateBox{serial};
    return v;
}

Variant::Variant(const Variant& o)
{
    if (auto* box = std::get_if<ArrayBox>(&o.v_))
        v_ = ArrayBox{std::make_unique<VariantArray>(*box->a)};  // arrays are values: copied
    else
        std::visit(
            [this](const auto& x) {
                using T = std::decay_t<decltype(x)>;
                if constexpr (!std::is_same_v<T, ArrayBox>) v_ = x;
            },
            o.v_);
}

Variant& Variant::operator=(const Variant& o)
{
    if (this != &o) {
        Variant copy(o);
        *this = std::move(copy);
    }
    return *this;
}

VarType Variant::type() const
{
    static constexpr VarType kinds[] = {VarType::Empty,  VarType::Null,   VarType::Boolean, VarType::Integer,
                                        VarType::Long,   VarType::Double, VarType::Date,    VarType::String,
                                        VarType::Object, VarType::Array};
    return kinds[v_.index()];
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

Object* Variant::object() const { return std::get<Ref<Object>>(v_).get(); }
const VariantArray& Variant::array() const { return *std::get<ArrayBox>(v_).a; }
VariantArray& Variant::array() { return *std::get<ArrayBox>(v_).a; }

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
    return size_t(a) * size_t(n1_) + size_t(b);
}

Variant& VariantArray::at(int32_t i, int32_t j) { return cells_[index(i, j)]; }
const Variant& VariantArray::at(int32_t i, int32_t j) const { return cells_[index(i, j)]; }

}  // namespace kg
