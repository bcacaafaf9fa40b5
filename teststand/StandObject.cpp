#include "teststand/StandObject.h"

#include "core/Convert.h"
#include "teststand/FaultPlan.h"

namespace kg::teststand {

StandObject::StandObject(const char* kind, std::string name, std::vector<MemberInfo> members)
    : kind_(kind), name_(std::move(name)), members_(std::move(members))
{
}

namespace {
bool sameName(const char* member, std::string_view name)
{
    for (char c : name) {
        const char m = *member++;
        if (m == c) continue;
        const char folded = c >= 'A' && c <= 'Z' ? static_cast<char>(c + ('a' - 'A')) : c;
        const char mFolded = m >= 'A' && m <= 'Z' ? static_cast<char>(m + ('a' - 'A')) : m;
        if (m == '\0' || folded != mFolded) return false;
    }
    return *member == '\0';
}
}  // namespace

DispId StandObject::idOfName(std::string_view name) const
{
    for (const MemberInfo& m : members_)
        if (sameName(m.name, name)) return m.id;
    throw Error::memberNotFound(name_ + "." + std::string(name));
}

const char* StandObject::memberName(DispId id) const
{
    for (const MemberInfo& m : members_)
        if (m.id == id) return m.name;
    return nullptr;
}

std::string StandObject::where(DispId id) const
{
    const char* member = memberName(id);
    return name_ + "." + (member ? member : "?");
}

Variant StandObject::invoke(DispId id, uint16_t kind, Args& args)
{
    const char* member = memberName(id);
    if (!member) throw Error::memberNotFound(name_ + " (dispatch id " + std::to_string(id) + ")");
    FaultPlan::check(kind_, member);
    if (kind & (kPropertyPut | kPropertyPutRef))
        throw Error::invalidCall(name_ + "." + member + " cannot be assigned");
    return run(id, args);
}

namespace {
std::string argument(size_t i, const std::string& where)
{
    return "argument " + std::to_string(i + 1) + " of " + where;
}
}  // namespace

std::string textArg(const Args& args, size_t i, const std::string& where)
{
    const Variant& v = args.at(i);
    if (v.isString()) return v.str();
    if (v.isNull()) throw Error::invalidUseOfNull(argument(i, where));
    if (v.isObject() || v.isArray())
        throw Error::typeMismatch(argument(i, where) + " is a " + typeName(v.type()) + ", not a text");
    return toText(v);
}

int32_t longArg(const Args& args, size_t i, const std::string& where)
{
    const Variant& v = args.at(i);
    if (v.type() == VarType::Long) return v.longValue();
    if (v.type() == VarType::Integer) return v.integer();
    if (v.isNull()) throw Error::invalidUseOfNull(argument(i, where));
    if (v.isObject() || v.isArray())
        throw Error::typeMismatch(argument(i, where) + " is a " + typeName(v.type()) + ", not a number");
    try {
        return toLong(v);
    } catch (const Error& e) {
        throw Error(e.number(), e.description() + " (" + argument(i, where) + ")", e.source());
    }
}

}  // namespace kg::teststand
