// Date serials: days from 30 December 1899, valid 1 January 100 to 31 December 9999.
#include <cmath>
#include <limits>
#include <string>

#include "RowSupport.h"
#include "core/Date.h"

namespace kg {
namespace {

constexpr int kNoError = 0;

// ---- dateSerial and its inverse -------------------------------------------------------------

struct SerialRow {
    const char* name;
    int year, month, day;
    double serial;
    friend void PrintTo(const SerialRow& r, std::ostream* os) { *os << r.name; }
};

const SerialRow kSerials[] = {
    {"SerialZero", 1899, 12, 30, 0},
    {"DayAfter", 1899, 12, 31, 1},
    {"DayBefore", 1899, 12, 29, -1},
    {"NewYear1900", 1900, 1, 1, 2},
    {"LastOfFebruary1900", 1900, 2, 28, 60},
    {"FirstOfMarch1900", 1900, 3, 1, 61},
    {"Century1800", 1800, 1, 1, -36522},
    {"LeapDay2000", 2000, 2, 29, 36585},
    {"LeapDay2024", 2024, 2, 29, 45351},
    {"ReportFrom", 2013, 7, 1, 41456},
    {"ReportTo", 2014, 6, 30, 41820},
    {"FirstValid", 100, 1, 1, kMinDateSerial},
    {"LastValid", 9999, 12, 31, kMaxDateSerial},
};

class DateSerial : public testing::TestWithParam<SerialRow> {};

TEST_P(DateSerial, CountsDaysFromSerialZero)
{
    const SerialRow& row = GetParam();
    EXPECT_EQ(dateSerial(row.year, row.month, row.day), row.serial);
}

TEST_P(DateSerial, CivilDateGivesTheDateBack)
{
    const SerialRow& row = GetParam();
    const CivilDate date = civilDate(row.serial);
    EXPECT_EQ(date.year, row.year);
    EXPECT_EQ(date.month, row.month);
    EXPECT_EQ(date.day, row.day);
}

INSTANTIATE_TEST_SUITE_P(Core, DateSerial, testing::ValuesIn(kSerials), test::rowName<SerialRow>);

struct BadDateRow {
    const char* name;
    int year, month, day;
    friend void PrintTo(const BadDateRow& r, std::ostream* os) { *os << r.name; }
};

const BadDateRow kBadDates[] = {
    {"NoThirtiethOfFebruary", 2026, 2, 30},
    {"NoLeapDayIn2023", 2023, 2, 29},
    {"NoLeapDayIn1900", 1900, 2, 29},
    {"NoThirtyFirstOfApril", 2024, 4, 31},
    {"DayZero", 2024, 1, 0},
    {"MonthZero", 2024, 0, 1},
    {"MonthThirteen", 2024, 13, 1},
    {"YearBeforeRange", 99, 12, 31},
    {"YearAfterRange", 10000, 1, 1},
    {"NegativeYear", -5, 1, 1},
};

class DateSerialInvalid : public testing::TestWithParam<BadDateRow> {};

TEST_P(DateSerialInvalid, IsInvalidProcedureCall)
{
    const BadDateRow& row = GetParam();
    EXPECT_EQ(test::raisedBy([&] { dateSerial(row.year, row.month, row.day); }).number, errc::InvalidProcedureCall);
}

INSTANTIATE_TEST_SUITE_P(Core, DateSerialInvalid, testing::ValuesIn(kBadDates), test::rowName<BadDateRow>);

TEST(DateSerialError, NamesTheDate)
{
    const test::Raised raised = test::raisedBy([] { dateSerial(2026, 2, 30); });
    EXPECT_NE(raised.description.find("2026-02-30"), std::string::npos) << raised.description;
}

TEST(DateSerialRoundTrip, EveryThirteenthDayOfTheRange)
{
    for (double serial = kMinDateSerial; serial <= kMaxDateSerial; serial += 13) {
        const CivilDate date = civilDate(serial);
        ASSERT_EQ(dateSerial(date.year, date.month, date.day), serial) << date.year << "-" << date.month << "-"
                                                                        << date.day;
    }
}

// ---- civilDate of serials with a time, negative serials and serials outside the range ----

struct CivilRow {
    const char* name;
    double serial;
    int year, month, day;
    int error;
    friend void PrintTo(const CivilRow& r, std::ostream* os) { *os << r.name; }
};

const CivilRow kCivil[] = {
    {"MorningOfSerialZero", 0.25, 1899, 12, 30, kNoError},
    {"JustBeforeMidnight", 0.999, 1899, 12, 30, kNoError},
    {"NegativeWithTime", -1.25, 1899, 12, 29, kNoError},
    {"MinusHalfIsSerialZero", -0.5, 1899, 12, 30, kNoError},
    {"MinusOnePointNine", -1.9, 1899, 12, 29, kNoError},
    {"EveningOfReportDay", 41456.75, 2013, 7, 1, kNoError},
    {"FirstValidWithTime", kMinDateSerial - 0.5, 100, 1, 1, kNoError},
    {"LastValidWithTime", kMaxDateSerial + 0.9, 9999, 12, 31, kNoError},
    {"DayBeforeFirst", kMinDateSerial - 1, 0, 0, 0, errc::Overflow},
    {"DayAfterLast", kMaxDateSerial + 1, 0, 0, 0, errc::Overflow},
    {"Huge", 1e300, 0, 0, 0, errc::Overflow},
    {"NotANumber", std::numeric_limits<double>::quiet_NaN(), 0, 0, 0, errc::Overflow},
    {"MinusInfinity", -std::numeric_limits<double>::infinity(), 0, 0, 0, errc::Overflow},
};

class CivilDateOfSerial : public testing::TestWithParam<CivilRow> {};

TEST_P(CivilDateOfSerial, TakesTheDayTowardZero)
{
    const CivilRow& row = GetParam();
    CivilDate date;
    const test::Raised raised = test::raisedBy([&] { date = civilDate(row.serial); });
    EXPECT_EQ(raised.number, row.error) << raised.description;
    if (row.error != kNoError) return;
    EXPECT_EQ(date.year, row.year);
    EXPECT_EQ(date.month, row.month);
    EXPECT_EQ(date.day, row.day);
}

INSTANTIATE_TEST_SUITE_P(Core, CivilDateOfSerial, testing::ValuesIn(kCivil), test::rowName<CivilRow>);

// ---- parseIsoDate ---------------------------------------------------------------------------

struct IsoRow {
    const char* name;
    const char* text;
    std::optional<double> expected;
    friend void PrintTo(const IsoRow& r, std::ostream* os) { *os << r.name; }
};

const IsoRow kIso[] = {
    {"ReportFrom", "2013-07-01", 41456.0},
    {"LeapDay", "2024-02-29", 45351.0},
    {"FirstValid", "0100-01-01", kMinDateSerial},
    {"LastValid", "9999-12-31", kMaxDateSerial},
    {"NoLeapDay", "2023-02-29", std::nullopt},
    {"NoThirtiethOfFebruary", "2026-02-30", std::nullopt},
    {"DayThirtyTwo", "2013-07-32", std::nullopt},
    {"DayZero", "2013-07-00", std::nullopt},
    {"MonthZero", "2013-00-10", std::nullopt},
    {"MonthThirteen", "2013-13-01", std::nullopt},
    {"YearBeforeRange", "0099-12-31", std::nullopt},
    {"ShortFields", "2013-7-1", std::nullopt},
    {"TrailingBlank", "2013-07-01 ", std::nullopt},
    {"LeadingBlank", " 2013-07-01", std::nullopt},
    {"Slashes", "2013/07/01", std::nullopt},
    {"NoSeparators", "20130701", std::nullopt},
    {"LetterInDay", "2013-07-0a", std::nullopt},
    {"SignedYear", "+013-07-01", std::nullopt},
    {"WithTime", "2013-07-01T00:00", std::nullopt},
    {"EmptyText", "", std::nullopt},
};

class ParseIsoDate : public testing::TestWithParam<IsoRow> {};

TEST_P(ParseIsoDate, AcceptsExactlyYearMonthDay)
{
    EXPECT_EQ(parseIsoDate(GetParam().text), GetParam().expected);
}

INSTANTIATE_TEST_SUITE_P(Core, ParseIsoDate, testing::ValuesIn(kIso), test::rowName<IsoRow>);

// ---- formatDmy ------------------------------------------------------------------------------

struct DmyRow {
    const char* name;
    double serial;
    const char* expected;
    friend void PrintTo(const DmyRow& r, std::ostream* os) { *os << r.name; }
};

const DmyRow kDmy[] = {
    {"ReportFrom", 41456, "01/07/2013"},
    {"ReportTo", 41820, "30/06/2014"},
    {"WithTime", 41456.99, "01/07/2013"},
    {"NegativeWithTime", -1.25, "29/12/1899"},
    {"FirstValid", kMinDateSerial, "01/01/0100"},
    {"LastValid", kMaxDateSerial, "31/12/9999"},
};

class FormatDmy : public testing::TestWithParam<DmyRow> {};

TEST_P(FormatDmy, WritesTwoDigitDayAndMonthAndFourDigitYear)
{
    EXPECT_EQ(formatDmy(GetParam().serial), GetParam().expected);
}

INSTANTIATE_TEST_SUITE_P(Core, FormatDmy, testing::ValuesIn(kDmy), test::rowName<DmyRow>);

TEST(FormatDmyRange, OutsideTheRangeIsOverflow)
{
    EXPECT_EQ(test::raisedBy([] { formatDmy(kMaxDateSerial + 1); }).number, errc::Overflow);
}

}  // namespace
}  // namespace kg
