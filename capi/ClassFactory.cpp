// The class object of cTavixGraph and the unload query: the platform's DllGetClassObject and
// DllCanUnloadNow.
#include <atomic>

#include "requests/cTavixGraph.h"
#include "capi/Boundary.h"
#include "capi/Guids.h"
#include "capi/HostStand.h"
#include "capi/Objects.h"
#include "ui/QtUi.h"

namespace kg::capi {

namespace {

std::atomic<long> g_locks{0};

struct ClassFactory : KGClassFactory {
    std::atomic<uint32_t> refs{1};
};

ClassFactory& self(KGClassFactory* f) { return *static_cast<ClassFactory*>(f); }

uint32_t factoryAddRef(KGClassFactory* f) { return addRefHandle(self(f)); }
uint32_t factoryRelease(KGClassFactory* f) { return releaseHandle(self(f)); }

int32_t factoryCreateInstance(KGClassFactory*, KGObject** out)
{
    if (!out) return KG_E_POINTER;
    *out = nullptr;
    return guardedKeepingError([&] {
        // A host with a Qt application gets the chart windows; one without keeps the headless UI.
        ui::installQtUiForApplication();
        // A host that registered no library objects of its own gets the test stand's.
        installStandUnlessHostHasOne();
        *out = exportObject(makeRef<cTavixGraph>());
        return KG_S_OK;
    });
}

int32_t factoryLockServer(KGClassFactory*, int lock)
{
    if (lock) {
        ++g_locks;
        return KG_S_OK;
    }
    // An unlock without a lock would let the library go while a host still relies on it.
    long held = g_locks;
    while (held > 0 && !g_locks.compare_exchange_weak(held, held - 1)) {
    }
    return held > 0 ? KG_S_OK : KG_E_INVALIDARG;
}

const KGClassFactoryVtbl kFactoryVtbl = {factoryAddRef, factoryRelease, factoryCreateInstance, factoryLockServer};

}  // namespace

}  // namespace kg::capi

using namespace kg::capi;

extern "C" {

KG_API int32_t DllGetClassObject(const KGGuid* clsid, const KGGuid* iid, void** out)
{
    if (!out) return KG_E_POINTER;
    *out = nullptr;
    return guardedKeepingError([&] {
        if (!clsid) throw Failure(KG_E_POINTER, "DllGetClassObject was given no class id");
        if (!(toGuid(*clsid) == kg::kClsidTavixGraph))
            throw Failure(KG_E_CLASSNOTAVAILABLE, "Class not available: this library serves only cTavixGraph " +
                                                      kg::guidText(kg::kClsidTavixGraph) + ", not " +
                                                      kg::guidText(toGuid(*clsid)));
        if (iid && !(toGuid(*iid) == toGuid(KG_IID_ClassFactory)))
            throw Failure(KG_E_NOINTERFACE, "No such interface: the class object offers only the class factory " +
                                                kg::guidText(toGuid(KG_IID_ClassFactory)) + ", not " +
                                                kg::guidText(toGuid(*iid)));
        auto* factory = new ClassFactory;
        factory->vtbl = &kFactoryVtbl;
        handleCreated();
        *out = static_cast<KGClassFactory*>(factory);
        return KG_S_OK;
    });
}

KG_API int32_t DllCanUnloadNow(void) { return liveHandles() == 0 && g_locks == 0 ? KG_S_OK : KG_S_FALSE; }

}  // extern "C"
