// The entry points a host calls on any object, ours or its own, and the thread's last error.
#include "capi/Boundary.h"

using namespace kg::capi;

extern "C" {

KG_API uint32_t KGAddRef(KGObject* obj) { return obj ? obj->vtbl->AddRef(obj) : 0; }

KG_API uint32_t KGRelease(KGObject* obj) { return obj ? obj->vtbl->Release(obj) : 0; }

KG_API int32_t KGGetIDOfName(KGObject* obj, const char* name, int32_t* dispid)
{
    if (!obj || !name || !dispid) return KG_E_POINTER;
    return obj->vtbl->GetIDOfName(obj, name, dispid);
}

KG_API int32_t KGInvoke(KGObject* obj, int32_t dispid, uint16_t flags, KGVariant* args, uint32_t argc,
                        KGVariant* result, KGErrorInfo* error)
{
    clearError(error);
    if (!obj || (argc > 0 && !args)) return KG_E_POINTER;
    return obj->vtbl->Invoke(obj, dispid, flags, args, argc, result, error);
}

KG_API int32_t KGInvokeByName(KGObject* obj, const char* name, uint16_t flags, KGVariant* args, uint32_t argc,
                              KGVariant* result, KGErrorInfo* error)
{
    clearError(error);
    if (!obj || !name || (argc > 0 && !args)) return KG_E_POINTER;
    int32_t dispid = 0;
    const int32_t status = obj->vtbl->GetIDOfName(obj, name, &dispid);
    if (KG_FAILED(status)) {
        try {
            fillError(error, kg::errc::MemberNotFound, std::string("Object doesn't support this property or method: ") + name);
        } catch (...) {
            fillError(error, kg::errc::MemberNotFound, "Object doesn't support this property or method");
        }
        return status;
    }
    return obj->vtbl->Invoke(obj, dispid, flags, args, argc, result, error);
}

KG_API int32_t KGGetLastError(KGErrorInfo* out)
{
    if (!out) return KG_E_POINTER;
    return takeLastError(out) ? KG_S_OK : KG_S_FALSE;
}

}  // extern "C"
