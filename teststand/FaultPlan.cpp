#include "teststand/FaultPlan.h"

#include <atomic>
#include <map>
#include <mutex>

#include "core/Error.h"
#include "teststand/TestStand.h"

namespace kg::teststand {

namespace {
struct Plan {
    int failOn = 0;
    int calls = 0;
};

struct Plans {
    std::atomic<bool> active{false};  // read on every member call: kept lock-free
    std::mutex mutex;
    std::map<std::string, Plan, std::less<>> byOperation;
};

Plans& plans()
{
    static Plans p;
    return p;
}
}  // namespace

void FaultPlan::failOn(const std::string& operation, int nthCall)
{
    Plans& p = plans();
    std::lock_guard lock(p.mutex);
    p.byOperation[operation] = Plan{nthCall, 0};
    p.active = true;
}

void FaultPlan::clear()
{
    Plans& p = plans();
    std::lock_guard lock(p.mutex);
    p.byOperation.clear();
    p.active = false;
}

int FaultPlan::callsOf(const std::string& operation)
{
    Plans& p = plans();
    std::lock_guard lock(p.mutex);
    auto it = p.byOperation.find(operation);
    return it == p.byOperation.end() ? 0 : it->second.calls;
}

void FaultPlan::check(std::string_view kind, std::string_view member)
{
    Plans& p = plans();
    if (!p.active.load(std::memory_order_relaxed)) return;
    std::string operation = std::string(kind) + "." + std::string(member);
    int call = 0;
    {
        std::lock_guard lock(p.mutex);
        auto it = p.byOperation.find(operation);
        if (it == p.byOperation.end()) return;
        call = ++it->second.calls;
        if (call != it->second.failOn) return;
    }
    throw Error::host(hosterr::Injected,
                      "Injected failure of " + operation + " (call " + std::to_string(call) + ")",
                      std::string(kind));
}

}  // namespace kg::teststand
