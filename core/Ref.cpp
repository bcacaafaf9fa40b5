#include "core/Ref.h"

namespace kg {

namespace {
std::atomic<long> g_live{0};
}

RefCounted::RefCounted() { ++g_live; }
RefCounted::~RefCounted() { --g_live; }

uint32_t RefCounted::release() noexcept
{
    const uint32_t left = --refs_;
    if (left == 0) delete this;
    return left;
}

long RefCounted::liveObjects() noexcept { return g_live; }

}  // namespace kg
