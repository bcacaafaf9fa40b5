// Number texts, number reading, rounding and conversions of values.
//
// Contents:
//   1. Fifteen-digit decimal form   - the one rounding every text starts from
//   2. Number texts                 - numberText
//   3. Reading numbers              - the digit gatherer, readNumber (Val), strict texts (CDbl)
//   4. Whole numbers                - half-even rounding with range checks
//   5. Conversions of values        - toDouble, toInteger, toLong, toText, differsFromEmptyText
//   6. Pattern formatting           - "$0.00", "0", "DD/MM/YYYY"
//
// Everything here is locale-free (std::to_chars / std::from_chars): the host's regional settings
// never change a period into a comma in a stored setting or a label.
#include "core/Convert.h"

#include <charconv>  // locale-free conversions both ways
#include <cmath>
#include <cstring>
#include <optional>

#include "core/Date.h"
#include "core/Dispatch.h"  // equalsNoCase for the date pattern
#include "core/Error.h"

namespace kg {

namespace {

// ---- 1. Fifteen-digit decimal form ---------------------------------------------------------

// A positive finite Double rounded to 15 significant digits: value = d.dddd x 10^exponent.
// The run-time library never shows more than 15 digits, so 0.1 + 0.2 is 0.3 in every text.
struct Digits15 {
    char digit[15];  // '0'..'9'; digit[0] is not '0'
    int count;       // significant digits left after dropping trailing zeros (1..15)
    int exponent;
};

Digits15 digits15(double magnitude)
{
    char buf[40];
    const auto written = std::to_chars(buf, buf + sizeof buf, magnitude, std::chars_format::scientific, 14);
    // buf holds "d.ddddddddddddddesXX" (the exponent has two digits or more).
    Digits15 d{};
    d.digit[0] = buf[0];
    std::memcpy(d.digit + 1, buf + 2, 14);
    const char* sign = buf + 17;
    int exponent = 0;
    std::from_chars(sign + 1, written.ptr, exponent);
    d.exponent = *sign == '-' ? -exponent : exponent;
    d.count = 15;
    while (d.count > 1 && d.digit[d.count - 1] == '0') --d.count;
    return d;
}

// ---- 2. Number texts -----------------------------------------------------------------------

constexpr int kMaxPlainDigits = 15;

void appendDecimal(std::string& out, const Digits15& d)
{
    const int e = d.exponent;
    if (e >= 0 && e + 1 <= kMaxPlainDigits) {
        for (int i = 0; i <= e; ++i) out += i < d.count ? d.digit[i] : '0';
        if (d.count > e + 1) {
            out += '.';
            out.append(d.digit + e + 1, size_t(d.count - e - 1));
        }
    } else if (e < 0 && (-e - 1) + d.count <= kMaxPlainDigits) {
        out += "0.";
        out.append(size_t(-e - 1), '0');
        out.append(d.digit, size_t(d.count));
    } else {
        out += d.digit[0];
        if (d.count > 1) {
            out += '.';
            out.append(d.digit + 1, size_t(d.count - 1));
        }
        out += e < 0 ? "E-" : "E+";
        const int magnitude = e < 0 ? -e : e;
        if (magnitude < 10) out += '0';
        out += std::to_string(magnitude);
    }
}

// The number text without its sign position, for messages and CStr.
std::string unsignedPositionText(double value)
{
    std::string text = numberText(value);
    if (!text.empty() && text[0] == ' ') text.erase(0, 1);
    return text;
}

// A text quoted for a message, cut short when it is long.
std::string quoted(std::string_view text)
{
    constexpr size_t kMaxShown = 60;
    if (text.size() <= kMaxShown) return "\"" + std::string(text) + "\"";
    return "\"" + std::string(text.substr(0, kMaxShown)) + "...\"";
}

// ---- 3. Reading numbers --------------------------------------------------------------------

bool isBlank(char c) { return c == ' ' || c == '\t' || c == '\n' || c == '\r'; }
bool isDigit(char c) { return c >= '0' && c <= '9'; }
bool isExponentLetter(char c) { return c == 'e' || c == 'E' || c == 'd' || c == 'D'; }

int hexDigitValue(char c)
{
    if (c >= '0' && c <= '9') return c - '0';
    if (c >= 'a' && c <= 'f') return c - 'a' + 10;
    if (c >= 'A' && c <= 'F') return c - 'A' + 10;
    return -1;
}

int digitValue(char c, int radix)
{
    const int v = hexDigitValue(c);
    return v >= 0 && v < radix ? v : -1;
}

// A decimal number gathered digit by digit, however long its text, without allocating.
// Digits beyond kKept are folded into one sticky digit, which keeps the rounding to Double exact.
class DecimalGatherer {
public:
    void addDigit(char c, bool afterPoint)
    {
        if (count_ == 0 && c == '0') {
            if (afterPoint) --scale_;  // leading zeros only place the first significant digit
            return;
        }
        if (count_ < kKept) {
            digits_[count_++] = c;
            if (afterPoint) --scale_;
        } else {
            if (c != '0') sticky_ = true;
            if (!afterPoint) ++scale_;
        }
    }

    void addExponentDigit(char c)
    {
        // Any exponent beyond this is out of the Double range whatever the digits are.
        if (exponent_ < 100000000) exponent_ = exponent_ * 10 + (c - '0');
    }
    void setExponentNegative(bool negative) { exponentNegative_ = negative; }

    // The value, rounded to the nearest Double; Error 6 beyond the Double range, 0 below it.
    double value(bool negative, std::string_view source) const
    {
        if (count_ == 0) return 0.0;
        const long long power = scale_ + (exponentNegative_ ? -exponent_ : exponent_);
        const long long leadingDigitPower = power + count_ - 1;
        if (leadingDigitPower > 400) throw overflow(source);
        if (leadingDigitPower < -400) return 0.0;

        char buf[kKept + 32];
        char* p = buf;
        std::memcpy(p, digits_, size_t(count_));
        p += count_;
        long long placed = power;
        if (sticky_) {
            *p++ = '1';
            --placed;
        }
        *p++ = 'e';
        p = std::to_chars(p, buf + sizeof buf, placed).ptr;

        double result = 0.0;
        const auto parsed = std::from_chars(buf, p, result);
        if (parsed.ec == std::errc::result_out_of_range) {
            if (leadingDigitPower >= 0) throw overflow(source);
            return 0.0;
        }
        return negative ? -result : result;
    }

private:
    static Error overflow(std::string_view source)
    {
        return Error::overflow(quoted(source) + " is beyond the range of a Double");
    }

    static constexpr int kKept = 780;  // more than the 767 digits that can decide a Double's rounding
    char digits_[kKept];
    int count_ = 0;
    long long scale_ = 0;
    long long exponent_ = 0;
    bool exponentNegative_ = false;
    bool sticky_ = false;
};

// &H / &O values: 16-bit values are Integers (so &HFFFF is -1), else 32-bit Longs; more is Error 6.
class RadixGatherer {
public:
    explicit RadixGatherer(int radix) : radix_(radix) {}

    bool add(char c, std::string_view source)
    {
        const int v = digitValue(c, radix_);
        if (v < 0) return false;
        value_ = value_ * uint64_t(radix_) + uint64_t(v);
        if (value_ > 0xFFFFFFFFull)
            throw Error::overflow(quoted(source) + " does not fit in 32 bits");
        any_ = true;
        return true;
    }
    bool anyDigit() const { return any_; }

    double value() const
    {
        if (value_ <= 0xFFFFull) return double(value_ >= 0x8000ull ? int64_t(value_) - 0x10000 : int64_t(value_));
        return double(value_ >= 0x80000000ull ? int64_t(value_) - 0x100000000ll : int64_t(value_));
    }

private:
    int radix_;
    uint64_t value_ = 0;
    bool any_ = false;
};

int radixOfPrefixLetter(char c)
{
    if (c == 'h' || c == 'H') return 16;
    if (c == 'o' || c == 'O') return 8;
    return 0;
}

// A short decimal with "," grouping or a D exponent, rewritten for from_chars in a stack buffer:
// regional texts such as "1,234.56" stay almost as fast as plain ones. nullopt sends the text on
// to the general reading, which also gives the verdict on texts that are no number.
std::optional<double> withoutGrouping(std::string_view t, size_t start)
{
    char buf[64];
    if (t.size() - start > sizeof buf || start == t.size() || !(isDigit(t[start]) || t[start] == '.'))
        return std::nullopt;
    size_t n = 0;
    bool inIntegerPart = true;
    for (size_t i = start; i < t.size(); ++i) {
        const char c = t[i];
        if (c == ',') {
            if (!inIntegerPart || i == start || !isDigit(t[i - 1]) || i + 1 == t.size() || !isDigit(t[i + 1]))
                return std::nullopt;
            continue;
        }
        if (!isDigit(c)) inIntegerPart = false;
        buf[n++] = (c == 'd' || c == 'D') ? 'e' : c;
    }
    double value = 0.0;
    const auto parsed = std::from_chars(buf, buf + n, value);
    if (parsed.ec != std::errc() || parsed.ptr != buf + n) return std::nullopt;
    return value;
}

// A whole text that is a number, as CDbl accepts it: blanks around, an optional sign, digits with
// "," grouping between digits, an optional fraction and exponent, or an &H / &O value.
// nullopt when the text is not a number; Error 6 when it is one beyond the Double range.
std::optional<double> strictNumber(std::string_view text)
{
    size_t begin = 0, end = text.size();
    while (begin < end && isBlank(text[begin])) ++begin;
    while (end > begin && isBlank(text[end - 1])) --end;
    const std::string_view t = text.substr(begin, end - begin);
    if (t.empty()) return std::nullopt;

    const bool negative = t[0] == '-';
    const size_t start = (t[0] == '-' || t[0] == '+') ? 1 : 0;

    // The common case, a plain decimal, goes straight to from_chars. It must start with a digit
    // or a point so that from_chars never sees "inf", "nan" or a second sign.
    if (start < t.size() && (isDigit(t[start]) || t[start] == '.')) {
        double value = 0.0;
        const auto parsed = std::from_chars(t.data() + start, t.data() + t.size(), value);
        if (parsed.ec == std::errc() && parsed.ptr == t.data() + t.size())
            return value == 0.0 ? 0.0 : (negative ? -value : value);
    }

    if (const std::optional<double> value = withoutGrouping(t, start))
        return *value == 0.0 ? 0.0 : (negative ? -*value : *value);

    if (t[0] == '&') {
        const int radix = t.size() > 1 ? radixOfPrefixLetter(t[1]) : 0;
        if (radix == 0) return std::nullopt;
        RadixGatherer gatherer(radix);
        for (size_t i = 2; i < t.size(); ++i)
            if (!gatherer.add(t[i], t)) return std::nullopt;
        if (!gatherer.anyDigit()) return std::nullopt;
        return gatherer.value();
    }

    DecimalGatherer number;
    size_t i = start;
    bool mantissaDigits = false;
    for (; i < t.size(); ++i) {
        if (isDigit(t[i])) {
            number.addDigit(t[i], false);
            mantissaDigits = true;
        } else if (t[i] == ',' && i > start && isDigit(t[i - 1]) && i + 1 < t.size() && isDigit(t[i + 1])) {
            continue;  // grouping between digits
        } else {
            break;
        }
    }
    if (i < t.size() && t[i] == '.') {
        for (++i; i < t.size() && isDigit(t[i]); ++i) {
            number.addDigit(t[i], true);
            mantissaDigits = true;
        }
    }
    if (!mantissaDigits) return std::nullopt;
    if (i < t.size() && isExponentLetter(t[i])) {
        ++i;
        if (i < t.size() && (t[i] == '+' || t[i] == '-')) number.setExponentNegative(t[i++] == '-');
        if (i == t.size() || !isDigit(t[i])) return std::nullopt;
        for (; i < t.size() && isDigit(t[i]); ++i) number.addExponentDigit(t[i]);
    }
    if (i != t.size()) return std::nullopt;
    const double value = number.value(negative, text);
    return value == 0.0 ? 0.0 : value;
}

double textToDouble(std::string_view text)
{
    if (const std::optional<double> value = strictNumber(text)) return *value;
    throw Error::typeMismatch(quoted(text) + " is not a number");
}

// ---- 4. Whole numbers ----------------------------------------------------------------------

// Halves to the even neighbour, independent of the floating-point rounding mode.
double roundHalfEven(double value)
{
    const double below = std::floor(value);
    const double fraction = value - below;  // exact for every finite Double
    if (fraction > 0.5) return below + 1.0;
    if (fraction < 0.5) return below;
    return std::fmod(below, 2.0) == 0.0 ? below : below + 1.0;
}

double roundChecked(double value, double lowest, double highest, const char* typeName)
{
    const double rounded = std::isfinite(value) ? roundHalfEven(value) : value;
    if (!(rounded >= lowest && rounded <= highest))
        throw Error::overflow(unsignedPositionText(value) + " does not fit in " + typeName);
    return rounded;
}

// ---- 5. Conversions of values --------------------------------------------------------------

Error notConvertible(const Variant& value, const char* what)
{
    return Error::typeMismatch(std::string("cannot convert ") + typeName(value.type()) + " to " + what);
}

Error nullConverted(const char* what) { return Error::invalidUseOfNull(std::string("converting Null to ") + what); }

// Seconds of the day in a serial's fraction, rounded to the second; the fraction is the time
// whatever the sign of the serial.
long long secondsOfDay(double serial)
{
    if (!std::isfinite(serial)) return 0;  // the date itself raises the error
    const double fraction = std::fabs(serial - std::trunc(serial));
    return std::llround(fraction * 86400.0);
}

std::string dateTimeText(double serial)
{
    double day = std::trunc(serial);
    long long seconds = secondsOfDay(serial);
    if (seconds >= 86400) {  // 23:59:59.6 and later round into the next calendar day
        seconds = 0;
        day += 1.0;
    }
    std::string text = formatDmy(day);
    if (seconds == 0) return text;
    char time[16];
    const long long parts[] = {seconds / 3600, seconds / 60 % 60, seconds % 60};
    char* p = time;
    for (long long part : parts) {
        *p++ = char('0' + part / 10);
        *p++ = char('0' + part % 10);
        *p++ = ':';
    }
    text += ' ';
    text.append(time, size_t(p - time - 1));
    return text;
}

// ---- 6. Pattern formatting -----------------------------------------------------------------

enum class Pattern { Currency, Whole, Date };

Pattern patternOf(std::string_view pattern)
{
    if (pattern == "$0.00") return Pattern::Currency;
    if (pattern == "0") return Pattern::Whole;
    if (equalsNoCase(pattern, "DD/MM/YYYY")) return Pattern::Date;
    throw Error::invalidCall("format pattern " + quoted(pattern) + " is not supported");
}

// |value| x 10^decimals as whole-number digits, rounded half away from zero on the 15-digit form
// (so 2.675, stored as 2.67499..., still gives 268 for two decimals).
std::string scaledDigits(double magnitude, int decimals)
{
    if (magnitude == 0.0) return "0";
    const Digits15 d = digits15(magnitude);
    // The 15 digits read as a whole number D: magnitude = D x 10^(exponent - 14).
    const int shift = d.exponent - 14 + decimals;
    std::string out;
    if (shift >= 0) {
        out.assign(d.digit, 15);
        out.append(size_t(shift), '0');
        return out;
    }
    const int kept = 15 + shift;
    if (kept < 0) return "0";
    out.assign(d.digit, size_t(kept));
    if (d.digit[kept] >= '5') {
        int i = kept - 1;
        while (i >= 0 && out[size_t(i)] == '9') out[size_t(i--)] = '0';
        if (i < 0)
            out.insert(out.begin(), '1');
        else
            ++out[size_t(i)];
    }
    return out.empty() ? "0" : out;
}

std::string formatNumber(double value, Pattern pattern)
{
    if (!std::isfinite(value)) return unsignedPositionText(value);
    const int decimals = pattern == Pattern::Currency ? 2 : 0;
    std::string digits = scaledDigits(std::fabs(value), decimals);
    const bool zero = digits.find_first_not_of('0') == std::string::npos;
    std::string text = value < 0.0 && !zero ? "-" : "";  // never "-0" or "-$0.00"
    if (pattern == Pattern::Whole) return text + digits;
    if (digits.size() < 3) digits.insert(0, 3 - digits.size(), '0');
    digits.insert(digits.size() - 2, 1, '.');
    return text + "$" + digits;
}

}  // namespace

// ---- Public operations ---------------------------------------------------------------------

std::string numberText(double value)
{
    if (std::isnan(value)) return " NaN";
    if (std::isinf(value)) return value > 0 ? " Inf" : "-Inf";
    if (value == 0.0) return " 0";  // also -0.0
    std::string text(1, value < 0 ? '-' : ' ');
    appendDecimal(text, digits15(std::fabs(value)));
    return text;
}

std::string numberText(const Variant& value)
{
    return numberText(toDouble(value));  // Empty gives " 0"; Null, objects and arrays raise there
}

double readNumber(std::string_view text)
{
    size_t pos = 0;
    // The next character that is not a blank, or '\0' at the end; blanks count nowhere.
    const auto peek = [&]() -> char {
        while (pos < text.size() && isBlank(text[pos])) ++pos;
        return pos < text.size() ? text[pos] : '\0';
    };

    if (peek() == '&') {
        ++pos;
        const int radix = radixOfPrefixLetter(peek());
        if (radix == 0) return 0.0;
        ++pos;
        RadixGatherer gatherer(radix);
        while (pos < text.size() && gatherer.add(peek(), text)) ++pos;
        return gatherer.value();
    }

    bool negative = false;
    if (peek() == '-' || peek() == '+') negative = text[pos++] == '-';

    DecimalGatherer number;
    while (isDigit(peek())) number.addDigit(text[pos++], false);
    if (peek() == '.') {
        ++pos;
        while (isDigit(peek())) number.addDigit(text[pos++], true);
    }
    if (isExponentLetter(peek())) {
        ++pos;
        if (peek() == '-' || peek() == '+') number.setExponentNegative(text[pos++] == '-');
        while (isDigit(peek())) number.addExponentDigit(text[pos++]);
    }
    const double value = number.value(negative, text);
    return value == 0.0 ? 0.0 : value;
}

int16_t roundToInteger(double value)
{
    return static_cast<int16_t>(roundChecked(value, -32768.0, 32767.0, "an Integer (-32768 to 32767)"));
}

int32_t roundToLong(double value)
{
    return static_cast<int32_t>(
        roundChecked(value, -2147483648.0, 2147483647.0, "a Long (-2147483648 to 2147483647)"));
}

double toDouble(const Variant& value)
{
    switch (value.type()) {
    case VarType::Empty: return 0.0;
    case VarType::Null: throw nullConverted("a number");
    case VarType::Boolean: return value.boolean() ? -1.0 : 0.0;
    case VarType::Integer: return value.integer();
    case VarType::Long: return value.longValue();
    case VarType::Double: return value.dbl();
    case VarType::Date: return value.dateSerial();
    case VarType::String: return textToDouble(value.str());
    case VarType::Object:
    case VarType::Array: break;
    }
    throw notConvertible(value, "a number");
}

int16_t toInteger(const Variant& value)
{
    switch (value.type()) {
    case VarType::Integer: return value.integer();
    case VarType::Long: return roundToInteger(value.longValue());
    default: return roundToInteger(toDouble(value));
    }
}

int32_t toLong(const Variant& value)
{
    switch (value.type()) {
    case VarType::Integer: return value.integer();
    case VarType::Long: return value.longValue();
    default: return roundToLong(toDouble(value));
    }
}

std::string toText(const Variant& value)
{
    switch (value.type()) {
    case VarType::Empty: return {};
    case VarType::Null: throw nullConverted("a text");
    case VarType::Boolean: return value.boolean() ? "True" : "False";
    case VarType::Integer: return std::to_string(value.integer());
    case VarType::Long: return std::to_string(value.longValue());
    case VarType::Double: return unsignedPositionText(value.dbl());
    case VarType::Date: return dateTimeText(value.dateSerial());
    case VarType::String: return value.str();
    case VarType::Object:
    case VarType::Array: break;
    }
    throw notConvertible(value, "a text");
}

bool differsFromEmptyText(const Variant& value)
{
    switch (value.type()) {
    case VarType::Empty:
    case VarType::Null: return false;
    case VarType::String: return !value.str().empty();
    case VarType::Boolean:
    case VarType::Integer:
    case VarType::Long:
    case VarType::Double:
    case VarType::Date: return true;
    case VarType::Object:
    case VarType::Array: break;
    }
    throw notConvertible(value, "a text for comparison");
}

std::string formatPattern(const Variant& value, std::string_view pattern)
{
    const Pattern kind = patternOf(pattern);
    double number = 0.0;
    switch (value.type()) {
    case VarType::Null: throw nullConverted("a formatted text");
    case VarType::String: {
        const std::optional<double> parsed = strictNumber(value.str());
        if (!parsed) return value.str();  // a text that is no number stays as it is
        number = *parsed;
        break;
    }
    default: number = toDouble(value); break;
    }
    if (kind == Pattern::Date) return formatDmy(number);
    return formatNumber(number, kind);
}

}  // namespace kg
