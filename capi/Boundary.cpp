#include "capi/Boundary.h"

#include <cstring>
#include <exception>

namespace kg::capi {

void copyText(char* buffer, size_t capacity, const std::string& text) noexcept
{
    if (!buffer || capacity == 0) return;
    size_t n = text.size() < capacity ? text.size() : capacity - 1;
    // Never end inside a multi-byte character: back off to the start of the one that was cut.
    if (n < text.size())
        while (n > 0 && (static_cast<unsigned char>(text[n]) & 0xC0) == 0x80) --n;
    std::memcpy(buffer, text.data(), n);
    buffer[n] = '\0';
}

void clearError(KGErrorInfo* error) noexcept
{
    if (!error) return;
    error->number = 0;
    error->description[0] = '\0';
    error->source[0] = '\0';
}

void fillError(KGErrorInfo* error, int32_t number, const std::string& description, const std::string& source) noexcept
{
    if (!error) return;
    error->number = number;
    copyText(error->description, sizeof error->description, description);
    copyText(error->source, sizeof error->source, source);
}

int32_t statusOfCurrentException(KGErrorInfo* error) noexcept
{
    try {
        throw;
    } catch (const Failure& f) {
        fillError(error, f);
        return f.status();
    } catch (const Error& e) {
        fillError(error, e);
        return KG_E_EXCEPTION;
    } catch (const std::bad_alloc&) {
        fillError(error, errc::OutOfMemory, "Out of memory");
        return KG_E_OUTOFMEMORY;
    } catch (const std::exception& e) {
        fillError(error, KG_E_FAIL, std::string("Unexpected failure: ") + e.what());
        return KG_E_FAIL;
    } catch (...) {
        fillError(error, KG_E_FAIL, "Unexpected failure of an unknown kind");
        return KG_E_FAIL;
    }
}

namespace {
thread_local KGErrorInfo t_lastError;
thread_local bool t_hasLastError = false;
}  // namespace

void rememberLastError(const KGErrorInfo& error) noexcept
{
    t_lastError = error;
    t_hasLastError = true;
}

void forgetLastError() noexcept { t_hasLastError = false; }

bool takeLastError(KGErrorInfo* out) noexcept
{
    const bool had = t_hasLastError;
    if (had)
        *out = t_lastError;
    else
        clearError(out);
    t_hasLastError = false;
    return had;
}

}  // namespace kg::capi
