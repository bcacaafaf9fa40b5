#pragma once
// Small helpers shared by the core tables: named rows and the error a call raises.
#include <gtest/gtest.h>

#include <cstdint>
#include <string>

#include "core/Error.h"

namespace kg::test {

// What a call raised: number 0 when it returned normally.
struct Raised {
    int32_t number = 0;
    std::string description;
};

template <class Call>
Raised raisedBy(Call&& call)
{
    try {
        call();
    } catch (const Error& e) {
        return {e.number(), e.description()};
    }
    return {};
}

// The row's own name becomes the test's name.
template <class Row>
std::string rowName(const testing::TestParamInfo<Row>& info)
{
    return info.param.name;
}

}  // namespace kg::test
