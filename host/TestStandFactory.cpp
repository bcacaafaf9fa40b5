// The test stand's factory and configuration, and goHostAux, which only has to exist.
#include "host/FaultPlan.h"
#include "host/StandObject.h"
#include "host/StandObjects.h"

namespace kg::host::teststand {

namespace {

class HostAuxObject final : public StandObject {
public:
    HostAuxObject() : StandObject("HostAux", "HostAux", {}) {}

protected:
    Variant run(DispId, Args&) override { return {}; }
};

class Factory final : public HostObjectFactory {
public:
    Ref<Object> create(HostClass cls) override
    {
        FaultPlan::check("Factory", hostClassName(cls));
        const Config& cfg = config();
        switch (cls) {
        case HostClass::AppServices: return makeAppServices(cfg);
        case HostClass::JobData: return makeJobData(cfg);
        case HostClass::HostAux: return makeHostAux();
        case HostClass::Settings: return makeSettings(cfg);
        }
        throw Error::invalidCall("no host class has the code " + std::to_string(static_cast<int>(cls)));
    }
};

}  // namespace

Config& config()
{
    static Config cfg;
    return cfg;
}

Ref<HostObjectFactory> makeFactory() { return makeRef<Factory>(); }

Ref<Object> makeHostAux() { return makeRef<HostAuxObject>(); }

}  // namespace kg::host::teststand
