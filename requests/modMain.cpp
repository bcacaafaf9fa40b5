#include "requests/modMain.h"

#include "requests/Services.h"
#include "core/Error.h"
#include "host/HostObjects.h"

namespace kg::modMain {

void HourglassOn() { services().windows->setMousePointer(kPointerHourglass); }
void HourglassOff() { services().windows->setMousePointer(kPointerDefault); }

void GraphInitialize()
{
    Ref<host::HostObjectFactory> factory = services().hostObjects;
    if (!factory) throw Error::objectNotSet("no host object factory is installed");
    goAppServices = factory->create(host::HostClass::AppServices);
    goJobData = factory->create(host::HostClass::JobData);
    goHostAux = factory->create(host::HostClass::HostAux);
    // The chart reaches the host objects as they are when it calls, not as they were when created.
    goChart = makeRef<c2dChart>([] { return goAppServices; }, [] { return goSettings; });
    goSettings = factory->create(host::HostClass::Settings);
    gfChart = services().windows->loadChartWindow();
}

void releaseSharedObjects()
{
    goAppServices = Variant(Ref<Object>());
    goSettings = Variant(Ref<Object>());
    goJobData = Variant(Ref<Object>());
    goHostAux = Variant(Ref<Object>());
    goChart.reset();
    gfChart.reset();
}

ChartWindowPort& chartWindow()
{
    if (!gfChart) throw Error::objectNotSet("the chart window is not loaded");
    return *gfChart;
}

c2dChart& chart()
{
    if (!goChart) throw Error::objectNotSet("there is no chart object");
    return *goChart;
}

namespace {
class SharedStateContext final : public builders::BuildContext {
public:
    ChartWindowPort& window() override { return chartWindow(); }
    c2dChart& chart() override { return modMain::chart(); }
    VariantArray& table() override { return gvArray; }
    const Variant& sourceForm() override { return gvSourceForm; }
    void hourglass(bool on) override { on ? HourglassOn() : HourglassOff(); }
};
}  // namespace

builders::BuildContext& buildContext()
{
    static SharedStateContext context;
    return context;
}

}  // namespace kg::modMain
