#include "capi/TypeInfo.h"

#include <cstdio>
#include <string>

#include "requests/cTavixGraph.h"
#include "capi/Boundary.h"

namespace kg::capi {

namespace {

uint32_t parameterCount(const Operation& op)
{
    if (op.kind == OperationKind::PropertyPut) return 1;
    const std::string parameters = op.parameters;
    if (parameters.empty()) return 0;
    uint32_t n = 1;
    for (char c : parameters)
        if (c == ',') ++n;
    return n;
}

std::string hexId(DispId id)
{
    char buf[16];
    std::snprintf(buf, sizeof buf, "0x%08X", static_cast<unsigned>(id));
    return buf;
}

}  // namespace

void checkCall(const Object& object, DispId id, uint16_t flags, uint32_t argc)
{
    if (!dynamic_cast<const cTavixGraph*>(&object)) return;
    const Operation* op = nullptr;
    for (const Operation& candidate : kOperations)
        if (candidate.id == id) op = &candidate;
    if (!op)
        throw Failure(KG_E_MEMBERNOTFOUND, Error::memberNotFound("cTavixGraph has no member with dispatch id " + hexId(id)));

    const bool put = op->kind == OperationKind::PropertyPut;
    if (put && !(flags & (kPropertyPut | kPropertyPutRef)))
        throw Failure(KG_E_MEMBERNOTFOUND,
                      Error::memberNotFound(std::string(op->name) + " is a write-only property: invoke it as a property put"));
    if (!put && !(flags & kMethod))
        throw Failure(KG_E_MEMBERNOTFOUND,
                      Error::memberNotFound(std::string(op->name) + " is a method: invoke it as a method"));

    const uint32_t expected = parameterCount(*op);
    if (argc != expected)
        throw Failure(KG_E_BADPARAMCOUNT,
                      Error::wrongArgCount(std::string(op->name) + " takes " + std::to_string(expected) +
                                           (expected == 1 ? " argument" : " arguments") + ", not " +
                                           std::to_string(argc)));
}

}  // namespace kg::capi
