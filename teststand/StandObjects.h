#pragma once
// The test stand's host library objects, each made from the configuration at its creation.
#include "core/Dispatch.h"
#include "teststand/TestStand.h"

namespace kg::teststand {

Ref<Object> makeAppServices(const Config& cfg);
Ref<Object> makeSettings(const Config& cfg);
Ref<Object> makeJobData(const Config& cfg);
Ref<Object> makeHostAux();

}  // namespace kg::teststand
