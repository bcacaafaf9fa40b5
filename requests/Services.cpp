#include "requests/Services.h"

namespace kg {

namespace {
Services*& current()
{
    static Services process;
    static Services* inUse = &process;
    return inUse;
}
}  // namespace

Services& services() { return *current(); }

ScopedServices::ScopedServices(Services installed) : own_(std::move(installed)), previous_(current())
{
    current() = &own_;
}

ScopedServices::~ScopedServices() { current() = previous_; }

}  // namespace kg
