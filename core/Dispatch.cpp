#include "core/Dispatch.h"

#include "core/Error.h"

namespace kg {

bool equalsNoCase(std::string_view a, std::string_view b)
{
    // Member names are ASCII: no locale lookup in this hot path.
    if (a.size() != b.size()) return false;
    for (size_t i = 0; i < a.size(); ++i) {
        unsigned char x = static_cast<unsigned char>(a[i]), y = static_cast<unsigned char>(b[i]);
        if (unsigned(x - 'A') < 26u) x |= 0x20;
        if (unsigned(y - 'A') < 26u) y |= 0x20;
        if (x != y) return false;
    }
    return true;
}

DispId TableObject::idOfName(std::string_view name) const
{
    for (const MemberInfo& m : members())
        if (equalsNoCase(m.name, name)) return m.id;
    throw Error::memberNotFound(objectName() + "." + std::string(name));
}

namespace {
Object& objectOf(const Variant& target, std::string_view member)
{
    if (!target.isObject() || !target.object())
        throw Error::objectNotSet("reading ." + std::string(member) + " of a " + typeName(target.type()) +
                                  " value");
    return *target.object();
}
}  // namespace

Variant call(const Variant& target, std::string_view member, Args& args, uint16_t kind)
{
    Object& o = objectOf(target, member);
    Ref<Object> keep(&o);  // the call may release the caller's reference
    return o.invoke(o.idOfName(member), kind, args);
}

Variant call(const Variant& target, std::string_view member, std::initializer_list<Variant> args, uint16_t kind)
{
    Args a(args);
    return call(target, member, a, kind);
}

void put(const Variant& target, std::string_view member, const Variant& value)
{
    Args a{value};
    call(target, member, a, kPropertyPut);
}

void expectArgs(const Args& args, size_t n, const char* member)
{
    if (args.size() != n) throw Error::wrongArgCount(member);
}

}  // namespace kg
