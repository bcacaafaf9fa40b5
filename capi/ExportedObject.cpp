// Our objects as the host sees them: a KGObject whose functions call the kg::Object it wraps.
#include <atomic>

#include "capi/Boundary.h"
#include "capi/ImportedObject.h"
#include "capi/Objects.h"
#include "capi/TypeInfo.h"
#include "capi/Values.h"

namespace kg::capi {

namespace {

std::atomic<long> g_liveHandles{0};

struct ExportedObject : KGObject {
    std::atomic<uint32_t> refs{1};
    Ref<Object> inner;
};

ExportedObject& self(KGObject* obj) { return *static_cast<ExportedObject*>(obj); }

uint32_t exportedAddRef(KGObject* obj) { return addRefHandle(self(obj)); }
uint32_t exportedRelease(KGObject* obj) { return releaseHandle(self(obj)); }

int32_t exportedGetIDOfName(KGObject* obj, const char* name, int32_t* dispid)
{
    if (!name || !dispid) return KG_E_POINTER;
    return guardedKeepingError([&] {
        try {
            *dispid = self(obj).inner->idOfName(name);
        } catch (const Error& e) {
            throw Failure(KG_E_UNKNOWNNAME, e);
        }
        return KG_S_OK;
    });
}

int32_t exportedInvoke(KGObject* obj, int32_t dispid, uint16_t flags, KGVariant* args, uint32_t argc,
                       KGVariant* result, KGErrorInfo* error)
{
    return guarded(error, [&] {
        if (argc > 0 && !args) throw Failure(KG_E_POINTER, "Invoke was given arguments without an argument array");
        Object& target = *self(obj).inner;
        checkCall(target, dispid, flags, argc);

        Args kgArgs;
        kgArgs.reserve(argc);
        for (uint32_t i = 0; i < argc; ++i) kgArgs.push_back(toKg(args[i]));
        const Args passed = kgArgs;

        Variant returned;
        try {
            returned = target.invoke(dispid, flags, kgArgs);
        } catch (const Error& e) {
            // Whatever the member raised, however deep: the failure of the call, as the host expects it.
            throw Failure(KG_E_EXCEPTION, e);
        }
        for (uint32_t i = 0; i < argc; ++i)
            if (!sameValue(passed[i], kgArgs[i])) fromKg(kgArgs[i], args[i]);
        if (result) fromKg(returned, *result);
        return KG_S_OK;
    });
}

const KGObjectVtbl kExportedVtbl = {exportedAddRef, exportedRelease, exportedGetIDOfName, exportedInvoke};

}  // namespace

KGObject* exportObject(const Ref<Object>& object)
{
    if (!object) return nullptr;
    if (auto* imported = dynamic_cast<ImportedObject*>(object.get())) {
        KGObject* own = imported->hostObject();
        own->vtbl->AddRef(own);
        return own;
    }
    auto* wrapper = new ExportedObject;
    wrapper->vtbl = &kExportedVtbl;
    wrapper->inner = object;
    handleCreated();
    return wrapper;
}

Ref<Object> importObject(KGObject* object, const std::string& name)
{
    if (!object) return {};
    if (object->vtbl == &kExportedVtbl) return self(object).inner;
    return makeRef<ImportedObject>(object, name);
}

long liveHandles() noexcept { return g_liveHandles; }
void handleCreated() noexcept { ++g_liveHandles; }
void handleDestroyed() noexcept { --g_liveHandles; }

}  // namespace kg::capi
