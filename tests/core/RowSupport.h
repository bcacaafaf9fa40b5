#pragma once
// Small helpers shared by the tables: named rows, the outcome a call should have (a value or an
// error) and values that hold objects.
#include <gtest/gtest.h>

#include <cstdint>
#include <string>
#include <type_traits>
#include <utility>
#include <vector>

#include "core/Dispatch.h"
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

// An error a row expects; its description must contain `naming` (the bad input, where it matters).
struct Raises {
    int32_t number;
    std::string naming;
};
inline const Raises kMismatch{errc::TypeMismatch, ""};
inline const Raises kOverflow{errc::Overflow, ""};
inline const Raises kNull{errc::InvalidUseOfNull, ""};
inline const Raises kBadCall{errc::InvalidProcedureCall, ""};

// The outcome a row expects: a value, or an error.
template <class T>
struct Outcome {
    template <class U, class = std::enable_if_t<std::is_convertible_v<U, T>>>
    Outcome(U&& v) : value(std::forward<U>(v)) {}  // NOLINT: rows write the value alone
    Outcome(Raises r) : error(std::move(r)) {}     // NOLINT
    T value{};
    Raises error{0, ""};
};

// Runs `call` and checks it gives the outcome; returns what it gave.
template <class T, class Call>
T expectOutcome(const Outcome<T>& expected, Call&& call)
{
    T result{};
    const Raised raised = raisedBy([&] { result = call(); });
    EXPECT_EQ(raised.number, expected.error.number) << raised.description;
    if (expected.error.number == 0) EXPECT_EQ(result, expected.value);
    EXPECT_NE(raised.description.find(expected.error.naming), std::string::npos) << raised.description;
    return result;
}

// A row's name, printed for the row and used as the test's name.
struct Named {
    const char* name;
    friend void PrintTo(const Named& r, std::ostream* os) { *os << r.name; }
};

struct RowName {
    template <class Row>
    std::string operator()(const testing::TestParamInfo<Row>& info) const
    {
        return info.param.name;
    }
};

// A plain object, for the rows where a value holds an object.
class Thing : public TableObject {
public:
    Variant invoke(DispId, uint16_t, Args&) override { return {}; }
    std::string objectName() const override { return "Thing"; }

protected:
    const std::vector<MemberInfo>& members() const override
    {
        static const std::vector<MemberInfo> none;
        return none;
    }
};

inline Variant anObject() { return Variant(makeRef<Thing>()); }
inline Variant nothing() { return Variant(Ref<Object>()); }
inline Variant anArray() { return Variant(VariantArray(0, 1, 0, 1)); }

}  // namespace kg::test
