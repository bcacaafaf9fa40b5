// Self-registration and creation by programmatic name, through the per-user registration file.
#include <dlfcn.h>
#include <sys/stat.h>

#include <QFileInfo>

#include "capi/Registration.h"
#include "capi/Boundary.h"
#include "capi/Guids.h"

namespace kg::capi {

namespace {

// Any object of this library gives the loader's record of the file it was loaded from.
const char kAnchor = 0;

std::string thisLibraryPath()
{
    Dl_info info{};
    if (!dladdr(&kAnchor, &info) || !info.dli_fname || !*info.dli_fname)
        throw Error(errc::FileNotFound, "File not found: the loader does not say where this library was loaded from");
    return QFileInfo(QString::fromLocal8Bit(info.dli_fname)).absoluteFilePath().toStdString();
}

bool sameFile(const std::string& a, const std::string& b)
{
    struct stat sa {}, sb {};
    return ::stat(a.c_str(), &sa) == 0 && ::stat(b.c_str(), &sb) == 0 && sa.st_dev == sb.st_dev &&
           sa.st_ino == sb.st_ino;
}

using GetClassObject = int32_t (*)(const KGGuid*, const KGGuid*, void**);

// This library's entry point when the registration names this very file; otherwise the named
// library is loaded and stays loaded (nothing unloads it behind the host's back).
GetClassObject classObjectEntry(const std::string& library)
{
    if (sameFile(library, thisLibraryPath())) return &DllGetClassObject;
    void* handle = dlopen(library.c_str(), RTLD_NOW | RTLD_LOCAL);
    if (!handle) {
        const char* why = dlerror();
        throw Failure(KG_E_MODNOTFOUND, "The registered library \"" + library +
                                            "\" cannot be loaded: " + (why ? why : "unknown reason"));
    }
    void* entry = dlsym(handle, "DllGetClassObject");
    if (!entry)
        throw Failure(KG_E_CLASSNOTAVAILABLE,
                      "The registered library \"" + library + "\" has no DllGetClassObject entry point");
    return reinterpret_cast<GetClassObject>(entry);
}

}  // namespace

}  // namespace kg::capi

using namespace kg::capi;

extern "C" {

KG_API int32_t DllRegisterServer(void)
{
    return guardedKeepingError([] {
        try {
            kg::registration::registerServer(thisLibraryPath());
        } catch (const kg::Error& e) {
            throw Failure(KG_SELFREG_E_CLASS, e);
        }
        return KG_S_OK;
    });
}

KG_API int32_t DllUnregisterServer(void)
{
    return guardedKeepingError([] {
        try {
            kg::registration::unregisterServer();
        } catch (const kg::Error& e) {
            throw Failure(KG_SELFREG_E_CLASS, e);
        }
        return KG_S_OK;
    });
}

KG_API int32_t KGCreateInstanceByProgID(const char* progId, KGObject** out)
{
    if (!out) return KG_E_POINTER;
    *out = nullptr;
    return guardedKeepingError([&] {
        if (!progId) throw Failure(KG_E_POINTER, "KGCreateInstanceByProgID was given no programmatic name");
        const std::string file = kg::registration::registryFilePath();
        std::optional<kg::registration::ClassRegistration> reg;
        try {
            reg = kg::registration::findProgId(progId, file);
        } catch (const kg::Error& e) {
            throw Failure(KG_E_CLASSNOTREG, e);
        }
        if (!reg)
            throw Failure(KG_E_CLASSNOTREG, "Class not registered: the registration file \"" + file +
                                                "\" has no class with the programmatic name \"" + progId + "\"");

        const KGGuid clsid = toKGGuid(reg->clsid);
        void* classObject = nullptr;
        int32_t status = classObjectEntry(reg->library)(&clsid, &KG_IID_ClassFactory, &classObject);
        if (KG_FAILED(status))
            throw Failure(status, "The registered library \"" + reg->library + "\" does not serve class " +
                                      kg::guidText(reg->clsid));
        auto* factory = static_cast<KGClassFactory*>(classObject);
        status = factory->vtbl->CreateInstance(factory, out);
        factory->vtbl->Release(factory);
        if (KG_FAILED(status)) throw Failure(status, std::string("The class object of \"") + progId + "\" failed to create it");
        return KG_S_OK;
    });
}

}  // extern "C"
