#include "apps/demo/HostObject.h"

#include <strings.h>

#include <cmath>
#include <cstdio>
#include <cstdlib>

namespace kg::demo {

namespace {
HostObject* self(KGObject* object) { return static_cast<HostObject*>(object); }
}  // namespace

const KGObjectVtbl HostObject::kVtbl = {HostObject::addRef, HostObject::release, HostObject::idOfName,
                                        HostObject::invoke};

HostObject::HostObject(const ComponentApi& api, std::vector<const char*> members)
    : KGObject{&kVtbl}, api_(api), members_(std::move(members))
{
}

uint32_t HostObject::addRef(KGObject* object) { return ++self(object)->refs_; }

uint32_t HostObject::release(KGObject* object)
{
    HostObject* o = self(object);
    const uint32_t left = --o->refs_;
    if (left == 0) delete o;
    return left;
}

int32_t HostObject::idOfName(KGObject* object, const char* name, int32_t* id)
{
    if (!name || !id) return KG_E_POINTER;
    const std::vector<const char*>& members = self(object)->members_;
    for (size_t i = 0; i < members.size(); ++i)
        if (strcasecmp(name, members[i]) == 0) {
            *id = static_cast<int32_t>(i + 1);
            return KG_S_OK;
        }
    return KG_E_UNKNOWNNAME;
}

int32_t HostObject::invoke(KGObject* object, int32_t id, uint16_t flags, KGVariant* args, uint32_t argc,
                           KGVariant* result, KGErrorInfo* error)
{
    HostObject* o = self(object);
    // Everything the component reads is read-only: a write is a member it does not have.
    if (id < 1 || static_cast<size_t>(id) > o->members_.size() ||
        !(flags & (KG_DISPATCH_METHOD | KG_DISPATCH_PROPERTYGET)))
        return KG_E_MEMBERNOTFOUND;
    if (argc > 0 && !args) return KG_E_POINTER;
    return o->call(id, args, argc, result, error);
}

int32_t HostObject::raise(KGErrorInfo* error, int32_t number, const std::string& description)
{
    if (error) {
        error->number = number;
        std::snprintf(error->description, sizeof error->description, "%s", description.c_str());
        std::snprintf(error->source, sizeof error->source, "%s", "Tavix Reports");
    }
    return KG_E_EXCEPTION;
}

int32_t HostObject::returnLong(KGVariant* result, int32_t value) const
{
    if (!result) return KG_S_OK;
    api_.VariantClear(result);
    result->vt = KG_VT_I4;
    result->lVal = value;
    return KG_S_OK;
}

int32_t HostObject::returnDouble(KGVariant* result, uint16_t vt, double value) const
{
    if (!result) return KG_S_OK;
    api_.VariantClear(result);
    result->vt = vt;
    result->dblVal = value;
    return KG_S_OK;
}

int32_t HostObject::returnString(KGVariant* result, const std::string& text) const
{
    return result ? api_.VariantSetString(result, text.c_str()) : KG_S_OK;
}

int32_t HostObject::returnObject(KGVariant* result, KGObject* object) const
{
    return result ? api_.VariantSetObject(result, object) : KG_S_OK;
}

bool HostObject::wholeNumber(const KGVariant& v, int32_t& out)
{
    double d = 0;
    switch (v.vt) {
    case KG_VT_I2: out = v.iVal; return true;
    case KG_VT_I4: out = v.lVal; return true;
    case KG_VT_BOOL: out = v.boolVal; return true;
    case KG_VT_R8:
    case KG_VT_DATE: d = v.dblVal; break;
    case KG_VT_STRING: {
        const char* text = v.strVal ? v.strVal : "";
        char* end = nullptr;
        d = std::strtod(text, &end);
        if (end == text) return false;
        while (*end == ' ') ++end;
        if (*end) return false;
        break;
    }
    default: return false;
    }
    // Halves go to the even neighbour, as the run-time library rounds an index.
    d = std::nearbyint(d);
    if (!(d >= INT32_MIN && d <= INT32_MAX)) return false;
    out = static_cast<int32_t>(d);
    return true;
}

}  // namespace kg::demo
