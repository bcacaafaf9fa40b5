#pragma once
// Base of the test stand's objects: a member table, the fault plan asked before every member, and
// the argument checks every member shares. All members are methods or read-only properties.
#include <string>
#include <vector>

#include "core/Dispatch.h"
#include "core/Error.h"

namespace kg::teststand {

class StandObject : public TableObject {
public:
    Variant invoke(DispId id, uint16_t kind, Args& args) final;
    // As TableObject's, with an ASCII-only fold: grids are read cell by cell by name.
    DispId idOfName(std::string_view name) const override;
    std::string objectName() const override { return name_; }

protected:
    // `kind` names the object in planned failures ("Grid"), `name` in messages ("grid1").
    StandObject(const char* kind, std::string name, std::vector<MemberInfo> members);
    const std::vector<MemberInfo>& members() const override { return members_; }

    // The member's work, after the plan and the read-only check have passed.
    virtual Variant run(DispId id, Args& args) = 0;

    // "grid1.textmatrix": the member as messages name it.
    std::string where(DispId id) const;
    const char* memberName(DispId id) const;

private:
    const char* kind_;
    std::string name_;
    std::vector<MemberInfo> members_;
};

// The common case of a whole-number argument, without building a message: false for other types.
inline bool wholeArg(const Variant& v, int32_t& out)
{
    if (v.type() == VarType::Long) out = v.longValue();
    else if (v.type() == VarType::Integer) out = v.integer();
    else return false;
    return true;
}

// Argument readers that name the member and the argument when the value does not fit.
std::string textArg(const Args& args, size_t i, const std::string& where);
int32_t longArg(const Args& args, size_t i, const std::string& where);

}  // namespace kg::teststand
