#pragma once
// What the chart tests share: an operation that must be refused with a given error, whose
// description names the bad input.
#include <gtest/gtest.h>

#include <functional>
#include <string>

#include "core/Error.h"

namespace kg::test {

inline void expectError(const std::function<void()>& operation, int32_t number, const std::string& detail = {})
{
    try {
        operation();
        ADD_FAILURE() << "no error; expected Error " << number;
    } catch (const Error& e) {
        EXPECT_EQ(e.number(), number) << e.description();
        EXPECT_NE(e.description().find(detail), std::string::npos) << e.description();
    }
}

}  // namespace kg::test
