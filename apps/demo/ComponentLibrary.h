#pragma once
// The component as a host reaches it: the shared library loaded at run time and its C entry points
// looked up by name. Nothing of the component is linked into the demo.
//
//   ComponentLibrary lib;
//   std::string why;
//   if (!lib.open(ComponentLibrary::defaultPath(), why)) ...;
//   lib.api().CreateInstanceByProgID(KG_PROGID, &graph);
//
// The library is never unloaded: the component's windows run its code, and the component keeps the
// host's form until the process ends.
#include <string>

#include "karstgraph/karstgraph.h"

namespace kg::demo {

// The entry points the demo uses, as found in one loaded copy of the library.
struct ComponentApi {
    decltype(&::DllRegisterServer) RegisterServer = nullptr;
    decltype(&::KGCreateInstanceByProgID) CreateInstanceByProgID = nullptr;
    decltype(&::KGGetLastError) GetLastError = nullptr;
    decltype(&::KGSetHostOption) SetHostOption = nullptr;
    decltype(&::KGInvoke) Invoke = nullptr;
    decltype(&::KGRelease) Release = nullptr;
    decltype(&::KGVariantInit) VariantInit = nullptr;
    decltype(&::KGVariantClear) VariantClear = nullptr;
    decltype(&::KGVariantSetString) VariantSetString = nullptr;
    decltype(&::KGVariantSetObject) VariantSetObject = nullptr;
};

class ComponentLibrary {
public:
    // $KARSTGRAPH_LIBRARY, else lib/libkarstgraph.so next to the bin/ folder of this program.
    static std::string defaultPath();

    // Loads the library and resolves every entry point; false and `why` when it cannot.
    bool open(const std::string& path, std::string& why);
    // The library that holds the code of `object` (the registration may name another copy than the
    // one opened); false and `why` when it is not a loaded library with our entry points.
    bool openServing(const KGObject* object, std::string& why);

    bool isOpen() const { return handle_ != nullptr; }
    const std::string& path() const { return path_; }
    const ComponentApi& api() const { return api_; }

private:
    bool resolve(void* handle, std::string& why);
    // Takes `handle` as the library when it has every entry point, else closes it again.
    bool adopt(void* handle, const std::string& path, std::string& why);

    void* handle_ = nullptr;
    std::string path_;
    ComponentApi api_;
};

// Whether two paths name the same file (the loader reports paths through symbolic links).
bool sameFile(const std::string& a, const std::string& b);

}  // namespace kg::demo
