#include "apps/demo/GraphClient.h"

#include <cstdio>

namespace kg::demo {

namespace {

std::string statusText(int32_t status)
{
    char buf[16];
    std::snprintf(buf, sizeof buf, "0x%08X", static_cast<unsigned>(status));
    return buf;
}

Outcome success() { return Outcome{true, 0, {}}; }

}  // namespace

std::string Outcome::errorText() const { return "Error " + std::to_string(number) + ": " + description; }

GraphClient::~GraphClient()
{
    if (graph_) serving_.api().Release(graph_);
}

Outcome GraphClient::lastError(const ComponentApi& api, int32_t status, const std::string& what) const
{
    KGErrorInfo info{};
    const bool known = api.GetLastError && api.GetLastError(&info) == KG_S_OK;
    Outcome out;
    out.number = known && info.number != 0 ? info.number : status;
    out.description = what + (known && info.description[0] ? std::string(": ") + info.description
                                                           : " (status " + statusText(status) + ")");
    return out;
}

Outcome GraphClient::connect(const std::string& libraryPath)
{
    std::string why;
    if (!loaded_.isOpen() && !loaded_.open(libraryPath, why)) return Outcome{false, KG_E_MODNOTFOUND, why};
    const ComponentApi& api = loaded_.api();
    int32_t status = api.CreateInstanceByProgID(KG_PROGID, &graph_);
    if (status == KG_E_CLASSNOTREG) {
        const int32_t registeredStatus = api.RegisterServer();
        if (KG_FAILED(registeredStatus))
            return lastError(api, registeredStatus, "Cannot register " + std::string(KG_PROGID));
        registered_ = true;
        status = api.CreateInstanceByProgID(KG_PROGID, &graph_);
    }
    if (KG_FAILED(status)) {
        graph_ = nullptr;
        return lastError(api, status, "Cannot create " + std::string(KG_PROGID));
    }
    if (!serving_.openServing(graph_, why)) {
        // Options could not reach the object's own library; the one opened is the best guess.
        serving_ = loaded_;
    }
    return success();
}

Outcome GraphClient::setHostOption(const char* key, const std::string& value)
{
    if (!serving_.isOpen()) return Outcome{false, KG_E_POINTER, "The component is not loaded"};
    const ComponentApi& api = serving_.api();
    const int32_t status = api.SetHostOption(key, value.c_str());
    if (KG_FAILED(status)) return lastError(api, status, std::string("Cannot set the host option ") + key);
    return success();
}

Outcome GraphClient::invoke(int32_t dispid, uint16_t flags, KGVariant* args, uint32_t argc)
{
    if (!graph_) return Outcome{false, KG_E_POINTER, "The component is not loaded"};
    KGErrorInfo info{};
    const int32_t status = loaded_.api().Invoke(graph_, dispid, flags, args, argc, nullptr, &info);
    if (KG_SUCCEEDED(status)) return success();
    Outcome out;
    out.number = info.number != 0 ? info.number : status;
    out.description = info.description[0] ? info.description : "Automation error " + statusText(status);
    return out;
}

Outcome GraphClient::setSourceForm(KGObject* form)
{
    KGVariant arg;
    loaded_.api().VariantInit(&arg);
    loaded_.api().VariantSetObject(&arg, form);
    const Outcome out = invoke(KG_DISPID_SOURCEFORM, KG_DISPATCH_PROPERTYPUT, &arg, 1);
    loaded_.api().VariantClear(&arg);
    return out;
}

Outcome GraphClient::request(int32_t dispid) { return invoke(dispid, KG_DISPATCH_METHOD, nullptr, 0); }

Outcome GraphClient::request(int32_t dispid, int32_t numSeries, double total)
{
    KGVariant args[2];
    loaded_.api().VariantInit(&args[0]);
    loaded_.api().VariantInit(&args[1]);
    args[0].vt = KG_VT_I4;
    args[0].lVal = numSeries;
    args[1].vt = KG_VT_R8;
    args[1].dblVal = total;
    const Outcome out = invoke(dispid, KG_DISPATCH_METHOD, args, 2);
    // By reference: whatever the component wrote back is ours to free.
    loaded_.api().VariantClear(&args[0]);
    loaded_.api().VariantClear(&args[1]);
    return out;
}

}  // namespace kg::demo
