// What a host on this platform needs besides the class: the test stand's options, which stand in
// for the host's own library objects, and its source forms read from form files.
#include <cstring>

#include "capi/Boundary.h"
#include "capi/HostStand.h"
#include "capi/Objects.h"
#include "requests/Services.h"
#include "teststand/TestStand.h"

namespace kg::capi {

namespace {

bool flagValue(const std::string& key, const std::string& value)
{
    for (const char* yes : {"1", "true", "yes"})
        if (equalsNoCase(value, yes)) return true;
    for (const char* no : {"", "0", "false", "no"})
        if (equalsNoCase(value, no)) return false;
    throw Failure(KG_E_INVALIDARG, Error::invalidCall("host option \"" + key + "\" takes 1, true, yes, 0, false or no, not \"" +
                                                      value + "\""));
}

teststand::Config& standConfig()
{
    static teststand::Config cfg;
    return cfg;
}

// The factory made with the options as they were last set; the one to replace when they change.
Ref<host::HostObjectFactory>& standFactory()
{
    static Ref<host::HostObjectFactory> factory;
    return factory;
}

void setOption(const std::string& key, const std::string& value)
{
    using teststand::Config;
    Config& cfg = standConfig();
    const Config defaults;
    if (key == "settingsFile")
        cfg.settingsFile = value;
    else if (key == "settingsOwner")
        cfg.settingsOwner = value.empty() ? defaults.settingsOwner : value;
    else if (key == "appFolder")
        cfg.appFolder = value;
    else if (key == "eventLogFile")
        cfg.eventLogFile = value;
    else if (key == "eventLogToStderr")
        cfg.eventLogToStderr = flagValue(key, value);
    else if (key == "jobsDatabase")
        cfg.jobsDatabase = value;
    else
        throw Failure(KG_E_INVALIDARG,
                      Error::invalidCall("there is no host option \"" + key + "\" (settingsFile, settingsOwner, "
                                         "appFolder, eventLogFile, eventLogToStderr, jobsDatabase)"));
    // Host objects created from now on read the new options; a host's own factory stays.
    Services& in = services();
    if (in.hostObjects && in.hostObjects == standFactory())
        in.hostObjects = standFactory() = teststand::makeFactory(cfg);
}

}  // namespace

void installStandUnlessHostHasOne()
{
    Services& in = services();
    if (!in.hostObjects) in.hostObjects = standFactory() = teststand::makeFactory(standConfig());
}

}  // namespace kg::capi

using namespace kg::capi;

extern "C" {

KG_API int32_t KGSetHostOption(const char* key, const char* value)
{
    if (!key) return KG_E_POINTER;
    return guardedKeepingError([&] {
        setOption(key, value ? value : "");
        return KG_S_OK;
    });
}

KG_API int32_t KGLoadFormFile(const char* path, KGObject** form, KGErrorInfo* error)
{
    if (!form) return KG_E_POINTER;
    *form = nullptr;
    return guarded(error, [&] {
        if (!path) throw Failure(KG_E_POINTER, "KGLoadFormFile was given no file");
        *form = exportObject(kg::teststand::loadFormFile(path));
        return KG_S_OK;
    });
}

}  // extern "C"
