#pragma once
// One error type for everything a request can fail with: a number and a description,
// as the host expects them back from a failed call.
#include <cstdint>
#include <stdexcept>
#include <string>

namespace kg {

// Error numbers of the run-time library that the component's steps can raise.
namespace errc {
constexpr int32_t InvalidProcedureCall = 5;
constexpr int32_t Overflow = 6;
constexpr int32_t OutOfMemory = 7;
constexpr int32_t SubscriptOutOfRange = 9;
constexpr int32_t DivisionByZero = 11;
constexpr int32_t TypeMismatch = 13;
constexpr int32_t FileNotFound = 53;
constexpr int32_t PathFileAccess = 75;
constexpr int32_t ObjectNotSet = 91;
constexpr int32_t InvalidUseOfNull = 94;
constexpr int32_t WrongArgumentCount = 450;
constexpr int32_t MemberNotFound = 438;
constexpr int32_t PrinterError = 482;
// The host's own errors are numbered from here (vbObjectError).
constexpr int32_t HostBase = static_cast<int32_t>(0x80040000u);
}  // namespace errc

class Error : public std::runtime_error {
public:
    Error(int32_t number, std::string description, std::string source = "KarstGraph");

    int32_t number() const noexcept { return number_; }
    const std::string& description() const noexcept { return description_; }
    const std::string& source() const noexcept { return source_; }

    // The standard errors with their standard descriptions; `detail` is appended after ": ".
    static Error overflow(const std::string& detail = {});
    static Error subscript(const std::string& detail = {});
    static Error typeMismatch(const std::string& detail = {});
    static Error invalidUseOfNull(const std::string& detail = {});
    static Error objectNotSet(const std::string& detail = {});
    static Error memberNotFound(const std::string& member);
    static Error invalidCall(const std::string& detail = {});
    static Error wrongArgCount(const std::string& member);
    // A failure of a host object: numbered from HostBase + code.
    static Error host(int32_t code, const std::string& description, const std::string& source);

private:
    int32_t number_;
    std::string description_;
    std::string source_;
};

}  // namespace kg
