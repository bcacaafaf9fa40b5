#pragma once
// What every C entry point does at the boundary: no C++ exception crosses it. A failure becomes a
// status and, where the caller gave one, a filled KGErrorInfo; entry points without one keep the
// description for KGGetLastError.
#include <new>
#include <string>

#include "core/Error.h"
#include "karstgraph/karstgraph.h"

namespace kg::capi {

// A failure with a status of its own (KG_E_BADPARAMCOUNT, KG_E_CLASSNOTREG, ...) and the error
// number and description that explain it.
class Failure : public Error {
public:
    Failure(int32_t status, const Error& why) : Error(why), status_(status) {}
    Failure(int32_t status, const std::string& description) : Error(status, description), status_(status) {}
    int32_t status() const noexcept { return status_; }

private:
    int32_t status_;
};

void clearError(KGErrorInfo* error) noexcept;
void fillError(KGErrorInfo* error, int32_t number, const std::string& description,
               const std::string& source = "KarstGraph") noexcept;
inline void fillError(KGErrorInfo* error, const Error& e) noexcept
{
    fillError(error, e.number(), e.description(), e.source());
}
// Copies UTF-8 text into a fixed buffer, cut short at a character boundary and always terminated.
void copyText(char* buffer, size_t capacity, const std::string& text) noexcept;

// The status of the exception being handled, with `error` filled: a Failure gives its own status,
// any other kg::Error KG_E_EXCEPTION, everything else KG_E_OUTOFMEMORY or KG_E_FAIL.
int32_t statusOfCurrentException(KGErrorInfo* error) noexcept;

// Runs the body of an entry point that has an error parameter.
template <class Body>
int32_t guarded(KGErrorInfo* error, Body&& body) noexcept
{
    clearError(error);
    try {
        return body();
    } catch (...) {
        return statusOfCurrentException(error);
    }
}

// The thread's last error, for entry points without an error parameter.
void rememberLastError(const KGErrorInfo& error) noexcept;
void forgetLastError() noexcept;
bool takeLastError(KGErrorInfo* out) noexcept;

// Runs the body of an entry point without an error parameter; a failure is kept for KGGetLastError.
template <class Body>
int32_t guardedKeepingError(Body&& body) noexcept
{
    KGErrorInfo error;
    const int32_t status = guarded(&error, std::forward<Body>(body));
    if (KG_FAILED(status))
        rememberLastError(error);
    else
        forgetLastError();
    return status;
}

}  // namespace kg::capi
