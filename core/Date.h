#pragma once
// Dates as the automation layer keeps them: a Double counting days from 30 December 1899,
// the time of day as the fraction. Valid from 1 January 100 to 31 December 9999.
#include <optional>
#include <string>
#include <string_view>

namespace kg {

struct CivilDate {
    int year = 1899, month = 12, day = 30;
};

constexpr double kMinDateSerial = -657434.0;  // 1 January 100
constexpr double kMaxDateSerial = 2958465.0;  // 31 December 9999

// Error 5 (invalid procedure call) for a date outside 100..9999 or a day that does not exist.
double dateSerial(int year, int month, int day);
// The calendar date of a serial (the time of day is dropped); Error 6 outside the valid range.
CivilDate civilDate(double serial);
// "YYYY-MM-DD" exactly; nullopt for anything else (including 2026-02-30).
std::optional<double> parseIsoDate(std::string_view text);
// "DD/MM/YYYY".
std::string formatDmy(double serial);

}  // namespace kg
