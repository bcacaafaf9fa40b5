#include "host/HostObjects.h"

namespace kg::host {

namespace {
Ref<HostObjectFactory>& current()
{
    static Ref<HostObjectFactory> factory;
    return factory;
}
}  // namespace

const char* hostClassName(HostClass c)
{
    switch (c) {
    case HostClass::AppServices: return "AppServices";
    case HostClass::JobData: return "JobData";
    case HostClass::HostAux: return "HostAux";
    case HostClass::Settings: return "Settings";
    }
    return "?";
}

Ref<HostObjectFactory> hostObjectFactory() { return current(); }

void setHostObjectFactory(Ref<HostObjectFactory> factory) { current() = std::move(factory); }

}  // namespace kg::host
