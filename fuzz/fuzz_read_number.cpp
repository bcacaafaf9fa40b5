// Number reading from any text: readNumber (the leading number, as Val reads it) and the strict
// conversions of a text value (toDouble, toInteger, toLong, numberText and the patterns).
// None may crash or raise anything but the documented errors; a number read is always finite;
// and where the strict reading accepts a text without "," grouping, both readings agree.
#include <cmath>

#include "core/Convert.h"
#include "FuzzSupport.h"

using namespace kg;
using kg::fuzz::expectOnly;
using kg::fuzz::require;

namespace {

std::string shown(std::string_view text)
{
    std::string s;
    for (char c : text.substr(0, 80)) {
        const auto u = static_cast<unsigned char>(c);
        if (u >= 0x20 && u < 0x7F) {
            s += c;
        } else {
            char hex[8];
            std::snprintf(hex, sizeof hex, "\\x%02X", u);
            s += hex;
        }
    }
    return "\"" + s + (text.size() > 80 ? "...\"" : "\"");
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    const std::string_view text(reinterpret_cast<const char*>(data), size);

    double leading = 0.0;
    const bool leadingRead = expectOnly({errc::Overflow}, "readNumber", [&] { leading = readNumber(text); });
    if (leadingRead) require(std::isfinite(leading), "readNumber gave a value that is not finite for " + shown(text));

    const Variant value{std::string(text)};
    double strict = 0.0;
    const bool strictRead =
        expectOnly({errc::TypeMismatch, errc::Overflow}, "toDouble", [&] { strict = toDouble(value); });
    if (strictRead) {
        require(std::isfinite(strict), "toDouble gave a value that is not finite for " + shown(text));
        // The strict reading takes a number in full; the leading reading must find the same one,
        // unless "," grouping (which only the strict reading knows) is in the text.
        if (text.find(',') == std::string_view::npos) {
            require(leadingRead, "readNumber overflowed where toDouble read " + numberText(strict) + " from " +
                                     shown(text));
            require(leading == strict, "readNumber gave" + numberText(leading) + " but toDouble gave" +
                                           numberText(strict) + " for " + shown(text));
        }
    }

    expectOnly({errc::TypeMismatch, errc::Overflow}, "toInteger", [&] { toInteger(value); });
    expectOnly({errc::TypeMismatch, errc::Overflow}, "toLong", [&] { toLong(value); });
    expectOnly({errc::TypeMismatch, errc::Overflow}, "numberText", [&] {
        const std::string t = numberText(value);
        require(!t.empty() && (t[0] == ' ' || t[0] == '-'), "numberText without its sign position: " + shown(t));
    });
    for (const char* pattern : {"$0.00", "0", "DD/MM/YYYY"}) {
        expectOnly({errc::Overflow}, "formatPattern", [&] {
            const std::string t = formatPattern(value, pattern);
            // A text that is no number comes back unchanged.
            if (!strictRead) require(t == text, std::string("formatPattern ") + pattern + " changed " + shown(text));
        });
    }
    return 0;
}
