#pragma once
// Values across the boundary: KGVariant and KGArray on the C side, kg::Variant inside. Objects are
// wrapped, never copied, and a wrapper that comes back is unwrapped to the object it wraps.
#include <string>
#include <vector>

#include "core/Variant.h"
#include "karstgraph/karstgraph.h"

// The C side's array: cells row by row, each a KGVariant owned by the array.
struct KGArray {
    int32_t lo0 = 0, n0 = 0, lo1 = 0, n1 = 0;
    std::vector<KGVariant> cells;

    KGArray() = default;
    KGArray(const KGArray&) = delete;
    KGArray& operator=(const KGArray&) = delete;
    ~KGArray();
    // Null when (i, j) is outside the bounds.
    KGVariant* cell(int32_t i, int32_t j);
    const KGVariant* cell(int32_t i, int32_t j) const { return const_cast<KGArray*>(this)->cell(i, j); }
};

namespace kg::capi {

// Error 458 with status KG_E_BADVARTYPE for a vt this surface does not define. An object that is
// not one of ours is wrapped under `name`, which messages use ("grid1").
Variant toKg(const KGVariant& v, const std::string& name = "HostObject");
// `out` is cleared and filled.
void fromKg(const Variant& v, KGVariant& out);

// Whether a callee left a value as it was (objects compared by identity): only changed by-reference
// arguments are written back, so an unchanged object keeps its pointer on the caller's side.
bool sameValue(const Variant& a, const Variant& b);
bool sameValue(const KGVariant& a, const KGVariant& b);

// A vector of KGVariants that clears them when it goes.
class VariantList {
public:
    explicit VariantList(size_t n);
    ~VariantList();
    VariantList(const VariantList&) = delete;
    VariantList& operator=(const VariantList&) = delete;
    KGVariant* data() { return items_.data(); }
    KGVariant& operator[](size_t i) { return items_[i]; }
    size_t size() const { return items_.size(); }

private:
    std::vector<KGVariant> items_;
};

}  // namespace kg::capi
