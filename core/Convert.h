#pragma once
// Conversions between values and texts, with the run-time library's rules that the charts and the
// stored settings rely on. Every number text comes from numberText(); every number read from a text
// comes from readNumber(). Both are tested as tables of cases.
#include <cstdint>
#include <string>
#include <string_view>

#include "core/Variant.h"

namespace kg {

// Number text with a sign position: " 12.5", " 0", "-3", " 0.3" (for 0.1 + 0.2), " 1E+16".
// Period as decimal point, no grouping, at most 15 significant digits with trailing zeros dropped,
// a 0 before the point; exponent form only where 15 digits cannot show the value plainly.
std::string numberText(double value);
// The same for a value: numbers as they are, a text first converted by toDouble();
// Null raises Error 94, an object or array Error 13.
std::string numberText(const Variant& value);

// The leading number of a text (reading as Val does): blanks, tabs and line feeds are skipped
// wherever they stand; optional sign, digits, one period, exponent (E or D); &H and &O prefixes
// (hexadecimal and octal, 16-bit values as Integer, else 32-bit); 0 when there is no number.
// A value beyond the Double range raises Error 6 (overflow).
double readNumber(std::string_view text);

// Whole numbers from Doubles: halves round to the even neighbour; out of range raises Error 6.
int16_t roundToInteger(double value);
int32_t roundToLong(double value);

// Variant to number, as CDbl / CInt / CLng: Empty gives 0, Boolean True -1, a Date its serial,
// a text must be a number in full (surrounding blanks allowed) or Error 13; Null raises Error 94.
double toDouble(const Variant& value);
int16_t toInteger(const Variant& value);
int32_t toLong(const Variant& value);

// Variant to text, as CStr: numbers without the sign blank ("12.5", "-3"), Empty "", Boolean
// "True"/"False", a Date as "DD/MM/YYYY" (with the time when it has one); Null raises Error 94.
std::string toText(const Variant& value);

// `value <> ""` as the drawing compares a cell: true for every number, false for Empty and "",
// and false for Null (the comparison gives Null, which is not True).
bool differsFromEmptyText(const Variant& value);

// Formatting by pattern, for the patterns the component uses: "$0.00", "0" and "DD/MM/YYYY".
// Numbers round halves away from zero on their 15-digit decimal form (2.675 -> "$2.68",
// -3.25 -> "-$3.25", -7.6 -> "-8"). A numeric text is formatted as its number; another text is
// returned unchanged; Null raises Error 94. A date pattern formats a Date (or a number as a date serial).
std::string formatPattern(const Variant& value, std::string_view pattern);

}  // namespace kg
