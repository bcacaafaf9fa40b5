#pragma once
// Small helpers every window test file uses.
#include <functional>
#include <string>

#include "core/Error.h"

namespace kg::test {

// Names each generated case after its table row.
inline constexpr auto byName = [](const auto& info) { return std::string(info.param.name); };

// The number of the error `work` ends with; 0 when it ends without one.
inline int32_t errorNumberOf(const std::function<void()>& work)
{
    try {
        work();
    } catch (const Error& e) {
        return e.number();
    }
    return 0;
}

}  // namespace kg::test
