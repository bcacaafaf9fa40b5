#include "apps/demo/ComponentLibrary.h"

#include <dlfcn.h>
#include <sys/stat.h>
#include <unistd.h>

#include <climits>
#include <cstdlib>

namespace kg::demo {

namespace {

std::string executableFolder()
{
    char buf[PATH_MAX];
    const ssize_t n = ::readlink("/proc/self/exe", buf, sizeof buf - 1);
    if (n <= 0) return ".";
    std::string exe(buf, static_cast<size_t>(n));
    const size_t slash = exe.rfind('/');
    return slash == std::string::npos ? "." : exe.substr(0, slash);
}

std::string loaderError()
{
    const char* why = dlerror();
    return why ? why : "unknown reason";
}

template <class Fn>
bool lookUp(void* handle, const char* name, Fn& out, std::string& why)
{
    void* symbol = dlsym(handle, name);
    if (!symbol) {
        why = std::string("the library has no entry point ") + name;
        return false;
    }
    out = reinterpret_cast<Fn>(symbol);
    return true;
}

}  // namespace

bool sameFile(const std::string& a, const std::string& b)
{
    struct stat sa {}, sb {};
    return ::stat(a.c_str(), &sa) == 0 && ::stat(b.c_str(), &sb) == 0 && sa.st_dev == sb.st_dev &&
           sa.st_ino == sb.st_ino;
}

std::string ComponentLibrary::defaultPath()
{
    if (const char* env = std::getenv("KARSTGRAPH_LIBRARY"); env && *env) return env;
    return executableFolder() + "/../lib/libkarstgraph.so";
}

bool ComponentLibrary::resolve(void* handle, std::string& why)
{
    ComponentApi api;
    const bool all = lookUp(handle, "DllRegisterServer", api.RegisterServer, why) &&
                     lookUp(handle, "KGCreateInstanceByProgID", api.CreateInstanceByProgID, why) &&
                     lookUp(handle, "KGGetLastError", api.GetLastError, why) &&
                     lookUp(handle, "KGSetHostOption", api.SetHostOption, why) &&
                     lookUp(handle, "KGInvoke", api.Invoke, why) && lookUp(handle, "KGRelease", api.Release, why) &&
                     lookUp(handle, "KGVariantInit", api.VariantInit, why) &&
                     lookUp(handle, "KGVariantClear", api.VariantClear, why) &&
                     lookUp(handle, "KGVariantSetString", api.VariantSetString, why) &&
                     lookUp(handle, "KGVariantSetObject", api.VariantSetObject, why);
    if (all) api_ = api;
    return all;
}

bool ComponentLibrary::adopt(void* handle, const std::string& path, std::string& why)
{
    if (!resolve(handle, why)) {
        why = path + ": " + why;
        dlclose(handle);  // not ours: let the loader drop it
        return false;
    }
    handle_ = handle;
    path_ = path;
    return true;
}

bool ComponentLibrary::open(const std::string& path, std::string& why)
{
    // Local symbols: the component's insides must not meet the demo's own copy of the sample writer.
    void* handle = dlopen(path.c_str(), RTLD_NOW | RTLD_LOCAL);
    if (!handle) {
        why = "cannot load " + path + ": " + loaderError();
        return false;
    }
    return adopt(handle, path, why);
}

bool ComponentLibrary::openServing(const KGObject* object, std::string& why)
{
    Dl_info info{};
    if (!object || !object->vtbl || !dladdr(reinterpret_cast<const void*>(object->vtbl->Invoke), &info) ||
        !info.dli_fname) {
        why = "the loader does not know where the object's code comes from";
        return false;
    }
    const std::string path = info.dli_fname;
    // Already loaded by the registration lookup: only its handle is taken, nothing is loaded anew.
    void* handle = dlopen(path.c_str(), RTLD_NOW | RTLD_LOCAL | RTLD_NOLOAD);
    if (!handle) {
        why = path + " is not a loaded library: " + loaderError();
        return false;
    }
    return adopt(handle, path, why);
}

}  // namespace kg::demo
