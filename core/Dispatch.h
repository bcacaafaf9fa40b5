#pragma once
// Our automation layer: objects expose members by dispatch id and by name (names matched without
// regard to case). Everything the component reaches late-bound (the host's form, grids, pickers,
// library objects) and everything it offers (cTavixGraph) goes through this one interface.
#include <cstdint>
#include <initializer_list>
#include <string>
#include <string_view>
#include <vector>

#include "core/Ref.h"
#include "core/Variant.h"

namespace kg {

using DispId = int32_t;

// How a member is invoked (DISPATCH_* values).
enum InvokeKind : uint16_t {
    kMethod = 1,
    kPropertyGet = 2,
    kPropertyPut = 4,
    kPropertyPutRef = 8,
};

// Arguments in declaration order. A by-reference parameter is written back into its slot.
using Args = std::vector<Variant>;

class Object : public RefCounted {
public:
    // The member's dispatch id; Error 438 when there is no such member.
    virtual DispId idOfName(std::string_view name) const = 0;
    // Invoke by id. Errors raised by the member propagate as kg::Error.
    virtual Variant invoke(DispId id, uint16_t kind, Args& args) = 0;
    // A short name for messages ("grid1", "cTavixGraph").
    virtual std::string objectName() const = 0;
};

// A member of a table-driven object.
struct MemberInfo {
    const char* name;
    DispId id;
};

// Base for objects whose members are a fixed table; names are looked up case-insensitively.
class TableObject : public Object {
public:
    DispId idOfName(std::string_view name) const override;

protected:
    virtual const std::vector<MemberInfo>& members() const = 0;
};

bool equalsNoCase(std::string_view a, std::string_view b);

// Late-bound calls, as a caller that only knows the member's name makes them.
// `target` must hold an object; Empty, Null or Nothing raise Error 91.
Variant call(const Variant& target, std::string_view member, Args& args,
             uint16_t kind = kMethod | kPropertyGet);
Variant call(const Variant& target, std::string_view member, std::initializer_list<Variant> args = {},
             uint16_t kind = kMethod | kPropertyGet);
void put(const Variant& target, std::string_view member, const Variant& value);

// Argument checking for implementers of invoke().
void expectArgs(const Args& args, size_t n, const char* member);

}  // namespace kg
