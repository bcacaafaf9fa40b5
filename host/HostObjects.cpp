#include "host/HostObjects.h"

namespace kg::host {

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

}  // namespace kg::host
