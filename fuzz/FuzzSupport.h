#pragma once
// What every fuzz target shares: reading typed values off the fuzzer's bytes, and the verdicts.
// A target may end an input only by returning or by raising kg::Error with a number it expects;
// anything else (another exception, a broken invariant) stops the run with a message and abort(),
// which libFuzzer reports as a crash and saves the input that caused it.
#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <exception>
#include <initializer_list>
#include <string>
#include <string_view>

#include "core/Error.h"

namespace kg::fuzz {

[[noreturn]] inline void fail(const std::string& what)
{
    // Control characters (a NUL above all) shown as escapes, so the whole message reaches the log.
    std::string shown;
    for (char c : what) {
        const auto u = static_cast<unsigned char>(c);
        if (u < 0x20 && c != '\n') {
            char hex[8];
            std::snprintf(hex, sizeof hex, "\\x%02X", u);
            shown += hex;
        } else {
            shown += c;
        }
    }
    std::fprintf(stderr, "FUZZ INVARIANT BROKEN: %s\n", shown.c_str());
    std::fflush(stderr);
    std::abort();
}

inline void require(bool holds, const std::string& what)
{
    if (!holds) fail(what);
}

// A rejection must be one of the errors the operation documents, and say what was wrong.
inline void expectError(const Error& e, std::initializer_list<int32_t> allowed, const char* operation)
{
    bool known = false;
    for (int32_t n : allowed) known = known || e.number() == n;
    require(known, std::string(operation) + " raised unexpected error " + std::to_string(e.number()) + ": " +
                       e.description());
    require(!e.description().empty(), std::string(operation) + " raised error " + std::to_string(e.number()) +
                                          " without a description");
}

// Runs `f`; a kg::Error must be one of `allowed`; any other exception is a fault.
// Returns true when `f` completed.
template <class F>
bool expectOnly(std::initializer_list<int32_t> allowed, const char* operation, F&& f)
{
    try {
        f();
        return true;
    } catch (const Error& e) {
        expectError(e, allowed, operation);
    } catch (const std::exception& e) {
        fail(std::string(operation) + " raised a non-kg exception: " + e.what());
    }
    return false;
}

// The fuzzer's bytes as a stream of values; past the end every read gives zeros.
class ByteReader {
public:
    ByteReader(const uint8_t* data, size_t size) : data_(data), size_(size) {}

    bool empty() const { return pos_ >= size_; }
    size_t left() const { return empty() ? 0 : size_ - pos_; }

    uint8_t byte() { return empty() ? 0 : data_[pos_++]; }
    template <class T>
    T raw()
    {
        T value{};
        unsigned char bytes[sizeof(T)] = {};
        for (unsigned char& b : bytes) b = byte();
        std::memcpy(&value, bytes, sizeof(T));
        return value;
    }
    // Up to `most` bytes, the count taken from the stream first.
    std::string text(size_t most)
    {
        const size_t n = std::min<size_t>(byte(), most);
        std::string s;
        for (size_t i = 0; i < n && !empty(); ++i) s += static_cast<char>(byte());
        return s;
    }
    // Everything not read yet.
    std::string_view rest()
    {
        if (empty()) return {};
        const std::string_view r(reinterpret_cast<const char*>(data_ + pos_), size_ - pos_);
        pos_ = size_;
        return r;
    }

private:
    const uint8_t* data_;
    size_t size_;
    size_t pos_ = 0;
};

}  // namespace kg::fuzz
