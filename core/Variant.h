#pragma once
// The values the component passes around: Empty, Null, Boolean, 16- and 32-bit whole numbers,
// Double, Date, String, object references and two-dimensional arrays of values.
// Conversions follow the run-time library's rules (see core/Convert.h); this file only holds values.
#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "core/Ref.h"

namespace kg {

class Object;
class VariantArray;

// Type codes as the automation layer numbers them (VT_*), so the C surface can reuse them.
enum class VarType : uint16_t {
    Empty = 0,
    Null = 1,
    Integer = 2,   // 16-bit signed
    Long = 3,      // 32-bit signed
    Double = 5,
    Date = 7,      // days since 30 Dec 1899, time as the fraction
    String = 8,
    Object = 9,
    Boolean = 11,
    Array = 0x200C  // array of variants
};

const char* typeName(VarType t);

class Variant {
public:
    Variant() noexcept { u_.d = 0; }             // Empty
    Variant(bool b) noexcept : type_(VarType::Boolean) { u_.b = b; }      // NOLINT
    Variant(int16_t i) noexcept : type_(VarType::Integer) { u_.i2 = i; }  // NOLINT
    Variant(int32_t l) noexcept : type_(VarType::Long) { u_.i4 = l; }     // NOLINT
    Variant(double d) noexcept : type_(VarType::Double) { u_.d = d; }     // NOLINT
    Variant(std::string s);                      // NOLINT
    Variant(const char* s);                      // NOLINT
    Variant(Ref<Object> o);                      // NOLINT
    Variant(Object* o);                          // NOLINT
    Variant(VariantArray a);                     // NOLINT

    static Variant null();
    static Variant date(double serial);

    Variant(const Variant& o);
    Variant(Variant&& o) noexcept : type_(o.type_), u_(o.u_) { o.type_ = VarType::Empty; }
    Variant& operator=(const Variant& o);
    Variant& operator=(Variant&& o) noexcept;
    ~Variant() { if (ownsHeap()) release(); }

    VarType type() const { return type_; }
    bool isEmpty() const { return type_ == VarType::Empty; }
    bool isNull() const { return type_ == VarType::Null; }
    bool isString() const { return type_ == VarType::String; }
    bool isObject() const { return type_ == VarType::Object; }
    bool isArray() const { return type_ == VarType::Array; }
    bool isNumeric() const;  // Boolean, Integer, Long, Double (not Date, not String)

    // Unchecked accessors: call only after checking type().
    bool boolean() const { return u_.b; }
    int16_t integer() const { return u_.i2; }
    int32_t longValue() const { return u_.i4; }
    double dbl() const { return u_.d; }
    double dateSerial() const { return u_.d; }
    const std::string& str() const { return *u_.s; }
    Object* object() const { return u_.o; }  // null for Nothing
    const VariantArray& array() const { return *u_.a; }
    VariantArray& array() { return *u_.a; }

private:
    // Sixteen bytes a value: the value tables hold a great many of them.
    bool ownsHeap() const { return type_ == VarType::String || type_ == VarType::Object || type_ == VarType::Array; }
    void release() noexcept;
    void copyFrom(const Variant& o);

    VarType type_ = VarType::Empty;
    union {
        bool b;
        int16_t i2;
        int32_t i4;
        double d;
        std::string* s;
        Object* o;
        VariantArray* a;
    } u_;
};

// A two-dimensional array of Variants, both dimensions from their lower bound (0 for the value table).
class VariantArray {
public:
    VariantArray() = default;
    // Dimensions lo0..hi0 by lo1..hi1; an upper bound below its lower bound is a subscript error.
    VariantArray(int32_t lo0, int32_t hi0, int32_t lo1, int32_t hi1);

    // Re-dimension to 0..hi0 by 0..hi1, discarding the contents (all cells Empty).
    void redim(int32_t hi0, int32_t hi1);

    int32_t lower(int dim) const { return dim == 0 ? lo0_ : lo1_; }
    int32_t upper(int dim) const { return dim == 0 ? lo0_ + n0_ - 1 : lo1_ + n1_ - 1; }
    int32_t count(int dim) const { return dim == 0 ? n0_ : n1_; }

    // Bounds-checked access: Error 9 (subscript out of range) outside the bounds.
    Variant& at(int32_t i, int32_t j);
    const Variant& at(int32_t i, int32_t j) const;

    bool operator==(const VariantArray&) const = delete;

private:
    void allocate(int32_t lo0, int32_t hi0, int32_t lo1, int32_t hi1);
    size_t index(int32_t i, int32_t j) const;
    int32_t lo0_ = 0, n0_ = 0, lo1_ = 0, n1_ = 0;
    std::vector<Variant> cells_;
};

}  // namespace kg

// Object references in a Variant release their object: every user of Variant needs it complete.
#include "core/Dispatch.h"  // IWYU pragma: export
