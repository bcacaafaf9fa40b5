#include "core/Error.h"

namespace kg {

namespace {
std::string withDetail(const char* base, const std::string& detail)
{
    return detail.empty() ? std::string(base) : std::string(base) + ": " + detail;
}
}  // namespace

Error::Error(int32_t number, std::string description, std::string source)
    : std::runtime_error(description), number_(number), description_(std::move(description)),
      source_(std::move(source))
{
}

Error Error::overflow(const std::string& d) { return {errc::Overflow, withDetail("Overflow", d)}; }
Error Error::subscript(const std::string& d)
{
    return {errc::SubscriptOutOfRange, withDetail("Subscript out of range", d)};
}
Error Error::typeMismatch(const std::string& d) { return {errc::TypeMismatch, withDetail("Type mismatch", d)}; }
Error Error::invalidUseOfNull(const std::string& d)
{
    return {errc::InvalidUseOfNull, withDetail("Invalid use of Null", d)};
}
Error Error::objectNotSet(const std::string& d)
{
    return {errc::ObjectNotSet, withDetail("Object variable or With block variable not set", d)};
}
Error Error::memberNotFound(const std::string& member)
{
    return {errc::MemberNotFound, withDetail("Object doesn't support this property or method", member)};
}
Error Error::invalidCall(const std::string& d)
{
    return {errc::InvalidProcedureCall, withDetail("Invalid procedure call or argument", d)};
}
Error Error::wrongArgCount(const std::string& member)
{
    return {errc::WrongArgumentCount,
            withDetail("Wrong number of arguments or invalid property assignment", member)};
}
Error Error::host(int32_t code, const std::string& description, const std::string& source)
{
    return {errc::HostBase + code, description, source};
}

}  // namespace kg
