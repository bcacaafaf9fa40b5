// Number texts and pattern formatting for any Double (the first 8 bytes, NaN and infinities
// included): numberText, toText, formatPattern with "$0.00", "0" and "DD/MM/YYYY", and the
// whole-number roundings. Invariants:
//   - numberText starts with its sign position (' ' or '-'), has no grouping, and reads back
//     through readNumber to the same value within 15 significant digits; reading it and writing
//     it again gives the same text;
//   - "$0.00" and "0" give the sign, the digits and nothing else, within half a unit of the last
//     place (and never "-0" or "-$0.00");
//   - "DD/MM/YYYY" gives the serial's calendar day inside the date range and Error 6 outside.
#include <cfloat>
#include <cmath>

#include "core/Convert.h"
#include "core/Date.h"
#include "FuzzSupport.h"

using namespace kg;
using kg::fuzz::expectOnly;
using kg::fuzz::require;

namespace {

std::string hexOf(double v)
{
    char buf[64];
    std::snprintf(buf, sizeof buf, "%a", v);
    return buf;
}

// 15 significant digits of a normal Double: the text may differ by half a unit in the 15th digit,
// and reading it back by the rounding of the text to the nearest Double.
bool within15Digits(double read, double value)
{
    const double magnitude = std::fabs(value);
    const double ulp = std::nextafter(magnitude, HUGE_VAL) - magnitude;
    return std::fabs(read - value) <= 5e-15 * magnitude + 2 * ulp;
}

void checkNumberText(double v)
{
    const std::string t = numberText(v);
    require(!t.empty() && (t[0] == ' ' || t[0] == '-'), "numberText(" + hexOf(v) + ") = \"" + t + "\"");
    require(t.find(',') == std::string::npos, "numberText groups digits: " + t);
    if (!std::isfinite(v)) return;
    require((t[0] == '-') == (v < 0 && v != 0.0), "numberText sign of " + hexOf(v) + ": " + t);
    size_t digits = 0;
    bool significant = false;
    for (char c : t) {
        if (c == 'E') break;
        if (c >= '1' && c <= '9') significant = true;
        if (significant && c >= '0' && c <= '9') ++digits;
    }
    require(digits <= 15, "numberText shows more than 15 significant digits: " + t);

    double back = 0.0;
    const bool read = expectOnly({errc::Overflow}, "readNumber(numberText)", [&] { back = readNumber(t); });
    if (!read) {
        // Only the largest Doubles round up past the Double range at 15 digits.
        require(t == " 1.79769313486232E+308" || t == "-1.79769313486232E+308",
                "numberText " + t + " does not read back");
        return;
    }
    if (std::fabs(v) >= DBL_MIN)
        require(within15Digits(back, v), "numberText " + t + " reads back as " + hexOf(back) + ", not " + hexOf(v));
    else
        require(std::fabs(back) <= DBL_MIN, "numberText " + t + " of a tiny value reads back as " + hexOf(back));
    require(numberText(back) == t, "numberText is not stable: " + t + " reads back as " + hexOf(back) +
                                       ", written " + numberText(back));

    const std::string plain = toText(Variant(v));
    require(plain == (t[0] == ' ' ? t.substr(1) : t), "toText differs from numberText: " + plain + " / " + t);
}

// The sign and digits of a "$0.00" or "0" text as a number.
void checkPattern(double v, const char* pattern, int decimals)
{
    const std::string t = formatPattern(Variant(v), pattern);
    if (!std::isfinite(v)) return;
    size_t i = 0;
    const bool negative = i < t.size() && t[i] == '-';
    if (negative) ++i;
    if (decimals > 0) {
        require(i < t.size() && t[i] == '$', std::string(pattern) + " without $: " + t);
        ++i;
    }
    std::string number;
    int afterPoint = -1;
    for (; i < t.size(); ++i) {
        const char c = t[i];
        if (c == '.' && afterPoint < 0) {
            afterPoint = 0;
        } else {
            require(c >= '0' && c <= '9', std::string(pattern) + " gave a stray character: " + t);
            if (afterPoint >= 0) ++afterPoint;
        }
        number += c;
    }
    require(!number.empty() && (decimals == 0 ? afterPoint < 0 : afterPoint == decimals),
            std::string(pattern) + " gave the wrong number of decimals: " + t);
    // Read in long double: the 15-digit form of the largest Doubles lies beyond the Double range.
    const long double shownValue = (negative ? -1 : 1) * std::strtold(number.c_str(), nullptr);
    require(!(negative && shownValue == 0.0L), std::string(pattern) + " gave a negative zero: " + t);
    const long double unit = decimals == 0 ? 1.0L : 0.01L;
    require(std::fabs(shownValue - v) <= unit / 2 + 1e-14L * std::fabs(v) + 1e-12L,
            std::string(pattern) + " of " + hexOf(v) + " gave " + t);
}

void checkDate(double v)
{
    const bool inRange = v > kMinDateSerial - 1.0 && v < kMaxDateSerial + 1.0;
    std::string t;
    const bool ok = expectOnly({errc::Overflow}, "formatPattern DD/MM/YYYY",
                               [&] { t = formatPattern(Variant(v), "DD/MM/YYYY"); });
    require(ok == inRange, "DD/MM/YYYY of " + hexOf(v) + (ok ? " gave " + t : std::string(" failed")));
    if (!ok) return;
    require(t.size() == 10 && t[2] == '/' && t[5] == '/', "DD/MM/YYYY gave " + t);
    const std::string iso = t.substr(6, 4) + "-" + t.substr(3, 2) + "-" + t.substr(0, 2);
    const std::optional<double> day = parseIsoDate(iso);
    require(day.has_value() && *day == std::trunc(v), "DD/MM/YYYY of " + hexOf(v) + " gave " + t);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    kg::fuzz::ByteReader in(data, size);
    const auto v = in.raw<double>();

    expectOnly({}, "numberText", [&] { checkNumberText(v); });
    expectOnly({}, "formatPattern $0.00", [&] { checkPattern(v, "$0.00", 2); });
    expectOnly({}, "formatPattern 0", [&] { checkPattern(v, "0", 0); });
    checkDate(v);
    expectOnly({errc::Overflow}, "toText of a date", [&] { toText(Variant::date(v)); });
    expectOnly({errc::Overflow}, "roundToInteger", [&] { roundToInteger(v); });
    expectOnly({errc::Overflow}, "roundToLong", [&] {
        const int32_t l = roundToLong(v);
        require(std::fabs(double(l) - v) <= 0.5, "roundToLong(" + hexOf(v) + ") = " + std::to_string(l));
    });
    return 0;
}
