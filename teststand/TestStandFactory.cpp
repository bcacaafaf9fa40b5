// The test stand's factory, and goHostAux, which only has to exist.
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
    explicit Factory(Config cfg) : cfg_(std::move(cfg)) {}
    Ref<Object> create(host::HostClass cls) override
    {
        FaultPlan::check("Factory", host::hostClassName(cls));
        switch (cls) {
        case host::HostClass::AppServices: return makeAppServices(cfg_);
        case host::HostClass::JobData: return makeJobData(cfg_);
        case host::HostClass::HostAux: return makeHostAux();
        case host::HostClass::Settings: return makeSettings(cfg_);
        }
        throw Error::invalidCall("no host class has the code " + std::to_string(static_cast<int>(cls)));
    }

private:
    Config cfg_;
};

}  // namespace

Ref<host::HostObjectFactory> makeFactory(Config cfg) { return makeRef<Factory>(std::move(cfg)); }

Ref<Object> makeHostAux() { return makeRef<HostAuxObject>(); }

}  // namespace kg::teststand
