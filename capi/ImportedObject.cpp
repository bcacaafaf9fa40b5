#include "capi/ImportedObject.h"

#include <cstdio>

#include "capi/Values.h"
#include "core/Error.h"

namespace kg::capi {

ImportedObject::ImportedObject(KGObject* object, std::string name) : object_(object), name_(std::move(name))
{
    object_->vtbl->AddRef(object_);
}

ImportedObject::~ImportedObject() { object_->vtbl->Release(object_); }

DispId ImportedObject::idOfName(std::string_view name) const
{
    const std::string text(name);
    DispId id = 0;
    if (KG_FAILED(object_->vtbl->GetIDOfName(object_, text.c_str(), &id)))
        throw Error::memberNotFound(name_ + "." + text);
    names_[id] = text;
    return id;
}

std::string ImportedObject::memberName(DispId id) const
{
    auto it = names_.find(id);
    if (it != names_.end()) return name_ + "." + it->second;
    char buf[16];
    std::snprintf(buf, sizeof buf, "0x%08X", static_cast<unsigned>(id));
    return name_ + " member " + buf;
}

namespace {

// The error a failed Invoke stands for, as the run-time library reports a failed late-bound call.
Error errorOf(int32_t status, KGErrorInfo& info, const std::string& member)
{
    info.description[sizeof info.description - 1] = '\0';  // the host's buffers may be unterminated
    info.source[sizeof info.source - 1] = '\0';
    const std::string description = info.description;
    const std::string source = info.source[0] ? info.source : member;
    switch (status) {
    case KG_E_MEMBERNOTFOUND:
    case KG_E_UNKNOWNNAME: return Error::memberNotFound(member);
    case KG_E_BADPARAMCOUNT: return Error::wrongArgCount(member);
    case KG_E_TYPEMISMATCH: return Error::typeMismatch(member);
    default: break;
    }
    if (status == KG_E_EXCEPTION && info.number != 0)
        return Error(info.number, description.empty() ? "Automation error in " + member : description, source);
    char code[16];
    std::snprintf(code, sizeof code, "0x%08X", static_cast<unsigned>(status));
    return Error(status, description.empty() ? "Automation error " + std::string(code) + " in " + member : description,
                 source);
}

}  // namespace

Variant ImportedObject::invoke(DispId id, uint16_t kind, Args& args)
{
    const std::string member = memberName(id);
    VariantList passed(args.size());
    VariantList snapshot(args.size());
    for (size_t i = 0; i < args.size(); ++i) {
        fromKg(args[i], passed[i]);
        if (KG_FAILED(KGVariantCopy(&snapshot[i], &passed[i]))) throw std::bad_alloc();
    }
    VariantList result(1);
    KGErrorInfo info{};
    const int32_t status = object_->vtbl->Invoke(object_, id, kind, passed.data(), static_cast<uint32_t>(args.size()),
                                                 &result[0], &info);
    if (KG_FAILED(status)) throw errorOf(status, info, member);

    // What the host hands back is read as any value of the host's: a bad one fails the calling step.
    const std::string resultName = names_.count(id) ? names_[id] : name_;
    try {
        for (size_t i = 0; i < args.size(); ++i)
            if (!sameValue(passed[i], snapshot[i])) args[i] = toKg(passed[i], name_);
        return toKg(result[0], resultName);
    } catch (const Error& e) {
        throw Error(e.number(), e.description() + " (from " + member + ")", e.source());
    }
}

}  // namespace kg::capi
