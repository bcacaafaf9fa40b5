// The test stand's factory and configuration, and goHostAux, which only has to exist.
#include "teststand/FaultPlan.h"
#include "teststand/StandObject.h"
#include "teststand/StandObjects.h"

namespace kg::teststand {

namespace {

class HostAuxObject final : public StandObject {
public:
    HostAuxObject() : StandObject("HostAux", "HostAux", {}) {}

protected:
    Variant run(DispId, Args&) override { return {}; }
};

class Factory final : public host::HostObjectFactory {
public:
    Ref<Object> create(host::HostClass cls) override
    {
        FaultPlan::check("Factory", host::hostClassName(cls));
        const Config& cfg = config();
        switch (cls) {
        case host::HostClass::AppServices: return makeAppServices(cfg);
        case host::HostClass::JobData: return makeJobData(cfg);
        case host::HostClass::HostAux: return makeHostAux();
        case host::HostClass::Settings: return makeSettings(cfg);
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

Ref<host::HostObjectFactory> makeFactory() { return makeRef<Factory>(); }

Ref<Object> makeHostAux() { return makeRef<HostAuxObject>(); }

}  // namespace kg::teststand
