// Date serials: days from 30 December 1899, valid 1 January 100 to 31 December 9999.
#include <cmath>
#include <cstdio>
#include <limits>
#include <optional>
#include <string>

#include "RowSupport.h"
#include "core/Date.h"

namespace kg {
namespace {

using test::kOverflow;
using test::Outcome;

// ---- dateSerial -----------------------------------------------------------------------------

struct SerialRow : test::Named {
    int year, month, day;
    Outcome<double> serial;
};

const test::Raises kNoSuchDay{errc::InvalidProcedureCall, ""};

const SerialRow kSerials[] = {
    {"SerialZero", 1899, 12, 30, 0.0},
    {"DayBefore", 1899, 12, 29, -1.0},
    {"NewYear1900", 1900, 1, 1, 2.0},
    {"LastOfFebruary1900", 1900, 2, 28, 60.0},
    {"FirstOfMarch1900", 1900, 3, 1, 61.0},
    {"Century1800", 1800, 1, 1, -36522.0},
    {"LeapDay2000", 2000, 2, 29, 36585.0},
    {"LeapDay2024", 2024, 2, 29, 45351.0},
    {"ReportFrom", 2013, 7, 1, 41456.0},
    {"FirstValid", 100, 1, 1, kMinDateSerial},
    {"LastValid", 9999, 12, 31, kMaxDateSerial},
    {"NoThirtiethOfFebruary", 2026, 2, 30, test::Raises{errc::InvalidProcedureCall, "2026-02-30"}},
    {"NoLeapDayIn2023", 2023, 2, 29, kNoSuchDay},
    {"NoLeapDayIn1900", 1900, 2, 29, kNoSuchDay},
    {"NoThirtyFirstOfApril", 2024, 4, 31, kNoSuchDay},
    {"DayZero", 2024, 1, 0, kNoSuchDay},
    {"MonthZero", 2024, 0, 1, kNoSuchDay},
    {"MonthThirteen", 2024, 13, 1, kNoSuchDay},
    {"YearBeforeRange", 99, 12, 31, kNoSuchDay},
    {"YearAfterRange", 10000, 1, 1, kNoSuchDay},
};

class DateSerial : public testing::TestWithParam<SerialRow> {};

TEST_P(DateSerial, CountsDaysFromSerialZero)
{
    const SerialRow& row = GetParam();
    test::expectOutcome(row.serial, [&] { return dateSerial(row.year, row.month, row.day); });
}

INSTANTIATE_TEST_SUITE_P(Core, DateSerial, testing::ValuesIn(kSerials), test::RowName{});

// With the anchors above, this pins civilDate to the same calendar everywhere in the range.
TEST(DateSerialRoundTrip, EveryThirteenthDayOfTheRange)
{
    for (double serial = kMinDateSerial; serial <= kMaxDateSerial; serial += 13) {
        const CivilDate date = civilDate(serial);
        ASSERT_EQ(dateSerial(date.year, date.month, date.day), serial) << date.year << "-" << date.month << "-"
                                                                        << date.day;
    }
}

// ---- civilDate and formatDmy of serials with a time, negative and outside the range --------

struct CivilRow : test::Named {
    double serial;
    Outcome<std::string> dmy;
};

const CivilRow kCivil[] = {
    {"MorningOfSerialZero", 0.25, "30/12/1899"},
    {"NegativeWithTime", -1.25, "29/12/1899"},
    {"MinusHalfIsSerialZero", -0.5, "30/12/1899"},
    {"MinusOnePointNine", -1.9, "29/12/1899"},
    {"EveningOfReportDay", 41456.75, "01/07/2013"},
    {"ReportTo", 41820, "30/06/2014"},
    {"FirstValidWithTime", kMinDateSerial - 0.5, "01/01/0100"},
    {"LastValidWithTime", kMaxDateSerial + 0.9, "31/12/9999"},
    {"DayBeforeFirst", kMinDateSerial - 1, kOverflow},
    {"DayAfterLast", kMaxDateSerial + 1, kOverflow},
    {"Huge", 1e300, kOverflow},
    {"NotANumber", std::numeric_limits<double>::quiet_NaN(), kOverflow},
    {"MinusInfinity", -std::numeric_limits<double>::infinity(), kOverflow},
};

class CivilDateOfSerial : public testing::TestWithParam<CivilRow> {};

TEST_P(CivilDateOfSerial, TakesTheDayTowardZero)
{
    const double serial = GetParam().serial;
    test::expectOutcome(GetParam().dmy, [&] {
        const CivilDate date = civilDate(serial);
        char text[32];
        std::snprintf(text, sizeof text, "%02d/%02d/%04d", date.day, date.month, date.year);
        return std::string(text);
    });
    test::expectOutcome(GetParam().dmy, [&] { return formatDmy(serial); });
}

INSTANTIATE_TEST_SUITE_P(Core, CivilDateOfSerial, testing::ValuesIn(kCivil), test::RowName{});

// ---- parseIsoDate ---------------------------------------------------------------------------

struct IsoRow : test::Named {
    const char* text;
    std::optional<double> expected;
};

const IsoRow kIso[] = {
    {"ReportFrom", "2013-07-01", 41456.0},
    {"LeapDay", "2024-02-29", 45351.0},
    {"FirstValid", "0100-01-01", kMinDateSerial},
    {"LastValid", "9999-12-31", kMaxDateSerial},
    {"NoLeapDay", "2023-02-29", std::nullopt},
    {"DayZero", "2013-07-00", std::nullopt},
    {"MonthThirteen", "2013-13-01", std::nullopt},
    {"YearBeforeRange", "0099-12-31", std::nullopt},
    {"ShortFields", "2013-7-1", std::nullopt},
    {"TrailingBlank", "2013-07-01 ", std::nullopt},
    {"LeadingBlank", " 2013-07-01", std::nullopt},
    {"NoSeparators", "20130701", std::nullopt},
    {"LetterInDay", "2013-07-0a", std::nullopt},
    {"SignedYear", "+013-07-01", std::nullopt},
    {"EmptyText", "", std::nullopt},
};

class ParseIsoDate : public testing::TestWithParam<IsoRow> {};

TEST_P(ParseIsoDate, AcceptsExactlyYearMonthDay)
{
    EXPECT_EQ(parseIsoDate(GetParam().text), GetParam().expected);
}

INSTANTIATE_TEST_SUITE_P(Core, ParseIsoDate, testing::ValuesIn(kIso), test::RowName{});

}  // namespace
}  // namespace kg
