#include "core/Date.h"

#include <charconv>  // locale-free number text for messages
#include <cmath>

#include "core/Error.h"

namespace kg {

namespace {

constexpr int kMinYear = 100;
constexpr int kMaxYear = 9999;

constexpr bool isLeapYear(int year)
{
    return (year % 4 == 0 && year % 100 != 0) || year % 400 == 0;
}

constexpr int daysInMonth(int year, int month)
{
    constexpr int lengths[] = {31, 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
    return month == 2 && isLeapYear(year) ? 29 : lengths[month - 1];
}

constexpr bool isValidDate(int year, int month, int day)
{
    return year >= kMinYear && year <= kMaxYear && month >= 1 && month <= 12 && day >= 1 &&
           day <= daysInMonth(year, month);
}

// Days since 1 January 1970 of a proleptic Gregorian date (H. Hinnant's days_from_civil).
constexpr long long daysFromCivil(int year, int month, int day)
{
    const long long y = month <= 2 ? year - 1 : year;
    const long long era = (y >= 0 ? y : y - 399) / 400;
    const long long yearOfEra = y - era * 400;
    const long long dayOfYear = (153 * (month > 2 ? month - 3 : month + 9) + 2) / 5 + day - 1;
    const long long dayOfEra = yearOfEra * 365 + yearOfEra / 4 - yearOfEra / 100 + dayOfYear;
    return era * 146097 + dayOfEra - 719468;
}

// The inverse of daysFromCivil.
constexpr CivilDate civilFromDays(long long z)
{
    z += 719468;
    const long long era = (z >= 0 ? z : z - 146096) / 146097;
    const long long dayOfEra = z - era * 146097;
    const long long yearOfEra = (dayOfEra - dayOfEra / 1460 + dayOfEra / 36524 - dayOfEra / 146096) / 365;
    const long long dayOfYear = dayOfEra - (365 * yearOfEra + yearOfEra / 4 - yearOfEra / 100);
    const long long mp = (5 * dayOfYear + 2) / 153;
    const int day = int(dayOfYear - (153 * mp + 2) / 5 + 1);
    const int month = int(mp < 10 ? mp + 3 : mp - 9);
    const int year = int(yearOfEra + era * 400 + (month <= 2 ? 1 : 0));
    return CivilDate{year, month, day};
}

constexpr long long kSerialZero = daysFromCivil(1899, 12, 30);

static_assert(daysFromCivil(100, 1, 1) - kSerialZero == static_cast<long long>(kMinDateSerial));
static_assert(daysFromCivil(9999, 12, 31) - kSerialZero == static_cast<long long>(kMaxDateSerial));

void appendPadded(std::string& out, int value, int width)
{
    std::string digits = std::to_string(value < 0 ? -value : value);
    if (value < 0) out += '-';
    if (int(digits.size()) < width) out.append(size_t(width) - digits.size(), '0');
    out += digits;
}

std::string serialText(double serial)
{
    char buf[32];
    const auto written = std::to_chars(buf, buf + sizeof buf, serial);
    return std::string(buf, written.ptr);
}

std::string isoText(int year, int month, int day)
{
    std::string text;
    appendPadded(text, year, 4);
    text += '-';
    appendPadded(text, month, 2);
    text += '-';
    appendPadded(text, day, 2);
    return text;
}

bool isDigit(char c) { return c >= '0' && c <= '9'; }

int digitsValue(std::string_view text)
{
    int value = 0;
    for (char c : text) value = value * 10 + (c - '0');
    return value;
}

}  // namespace

double dateSerial(int year, int month, int day)
{
    if (!isValidDate(year, month, day))
        throw Error::invalidCall("date " + isoText(year, month, day) +
                                 " does not exist or lies outside 0100-01-01 to 9999-12-31");
    return double(daysFromCivil(year, month, day) - kSerialZero);
}

CivilDate civilDate(double serial)
{
    // The whole part is the day, counted toward zero: -1.25 is 29 December 1899, 06:00.
    if (!(serial > kMinDateSerial - 1.0 && serial < kMaxDateSerial + 1.0))
        throw Error::overflow("date serial " + serialText(serial) +
                              " lies outside 1 January 100 to 31 December 9999");
    return civilFromDays(static_cast<long long>(std::trunc(serial)) + kSerialZero);
}

std::optional<double> parseIsoDate(std::string_view text)
{
    if (text.size() != 10 || text[4] != '-' || text[7] != '-') return std::nullopt;
    for (size_t i : {0, 1, 2, 3, 5, 6, 8, 9})
        if (!isDigit(text[i])) return std::nullopt;
    const int year = digitsValue(text.substr(0, 4));
    const int month = digitsValue(text.substr(5, 2));
    const int day = digitsValue(text.substr(8, 2));
    if (!isValidDate(year, month, day)) return std::nullopt;
    return dateSerial(year, month, day);
}

std::string formatDmy(double serial)
{
    const CivilDate date = civilDate(serial);
    std::string text;
    appendPadded(text, date.day, 2);
    text += '/';
    appendPadded(text, date.month, 2);
    text += '/';
    appendPadded(text, date.year, 4);
    return text;
}

}  // namespace kg
