// Job data over SQLite: the rows between two dates (both inclusive) as the table (field, row) of
// 65 fields, dates bound as parameters, and a database that cannot be used named in the error.
#include <gtest/gtest.h>

#include <array>

#include <QTemporaryDir>
#include <sqlite3.h>

#include "core/Convert.h"
#include "core/Date.h"
#include "core/Error.h"
#include "teststand/TestStand.h"
#include "HostTestSupport.h"

using namespace kg;
using namespace kg::teststand;

namespace {

void exec(const std::string& path, const std::string& sql)
{
    sqlite3* db = nullptr;
    ASSERT_EQ(sqlite3_open(path.c_str(), &db), SQLITE_OK);
    char* message = nullptr;
    const int rc = sqlite3_exec(db, sql.c_str(), nullptr, nullptr, &message);
    EXPECT_EQ(rc, SQLITE_OK) << (message ? message : "");
    sqlite3_free(message);
    sqlite3_close(db);
}

const char* kSchema =
    "CREATE TABLE jobs(id INTEGER PRIMARY KEY, job_date TEXT NOT NULL, f26 TEXT, f44, f45, f46, f52, f59, f64);"
    "CREATE INDEX jobs_by_date ON jobs(job_date);";

// Jobs named by their status text; one on each edge of January 2026 and one outside on each side.
const char* kJobs =
    "INSERT INTO jobs(job_date, f26, f44, f45, f46, f52, f59, f64) VALUES"
    " ('2025-12-31', 'before', 1, NULL, NULL, NULL, NULL, NULL),"
    " ('2026-01-01', 'first', 1, 0, '1', NULL, 2.5, ''),"
    " ('2026-01-15', 'middle', NULL, NULL, NULL, NULL, NULL, NULL),"
    " ('2026-01-31', 'last', 0, 1, 1, 1, 1, 1),"
    " ('2026-02-01', 'after', NULL, NULL, NULL, NULL, NULL, NULL);";

constexpr int32_t kJobDataError = errc::HostBase + hosterr::JobData;

Variant day(const char* iso, double time = 0) { return Variant::date(*parseIsoDate(iso) + time); }

class JobData : public testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_TRUE(dir_.isValid());
        path_ = dir_.filePath("jobs.db").toStdString();
        exec(path_, std::string(kSchema) + kJobs);
        useDatabase(path_);
    }
    void useDatabase(const std::string& path)
    {
        Config cfg;
        cfg.jobsDatabase = path;
        jobs_ = Variant(makeFactory(cfg)->create(host::HostClass::JobData));
    }

    std::string query()
    {
        Args args{int32_t{255}, ""};
        call(jobs_, "GetJobQuery", args);
        EXPECT_EQ(args[1].type(), VarType::String);
        return args[1].isString() ? args[1].str() : std::string();
    }

    // Fetches with the dates given; returns the rows and sets count.
    Variant fetch(const Variant& from, const Variant& to, int32_t& count)
    {
        call(jobs_, "SetFromDate", {from});
        call(jobs_, "SetToDate", {to});
        Args args{query(), Variant(), int32_t{0}, "", int32_t{-1}};
        call(jobs_, "FetchJobRows", args);
        EXPECT_EQ(args[4].type(), VarType::Long);
        count = args[4].type() == VarType::Long ? args[4].longValue() : -1;
        return args[1];
    }

    // The error of a fetch between the dates, when given, with `sql` (else the component's query).
    Error fetchError(const char* from, const char* to, const char* sql = nullptr)
    {
        if (from) call(jobs_, "SetFromDate", {day(from)});
        if (to) call(jobs_, "SetToDate", {day(to)});
        Args args{sql ? Variant(sql) : Variant(query()), Variant(), int32_t{0}, "", int32_t{0}};
        return test::errorOf([&] { call(jobs_, "FetchJobRows", args); });
    }

    // The status texts (field 26) of the rows, in order.
    std::vector<std::string> statuses(const Variant& from, const Variant& to)
    {
        int32_t count = 0;
        const Variant rows = fetch(from, to, count);
        std::vector<std::string> out;
        if (count == 0) {
            EXPECT_TRUE(rows.isEmpty());
            return out;
        }
        EXPECT_TRUE(rows.isArray());
        if (!rows.isArray()) return out;
        EXPECT_EQ(rows.array().count(1), count);
        for (int32_t r = 0; r < count; ++r) out.push_back(toText(rows.array().at(26, r)));
        return out;
    }

    QTemporaryDir dir_{test::tempTemplate("jobs")};
    std::string path_;
    Variant jobs_;
};

struct RangeCase : test::Named {
    Variant from, to;
    std::vector<std::string> expected;
};

class JobDateRange : public JobData, public testing::WithParamInterface<RangeCase> {};

TEST_P(JobDateRange, HoldsTheJobsOfBothEnds)
{
    EXPECT_EQ(statuses(GetParam().from, GetParam().to), GetParam().expected);
}

INSTANTIATE_TEST_SUITE_P(
    Ranges, JobDateRange,
    testing::Values(
        RangeCase{"month", day("2026-01-01"), day("2026-01-31"), {"first", "middle", "last"}},
        RangeCase{"wide", day("2025-01-01"), day("2026-12-31"), {"before", "first", "middle", "last", "after"}},
        RangeCase{"reversed", day("2026-01-31"), day("2026-01-01"), {}},
        RangeCase{"timeOfDayCountsTheWholeDay", day("2026-01-31", 0.75), day("2026-01-31", 0.75), {"last"}},
        RangeCase{"datesAsText", Variant("2026-01-15"), Variant("2026-01-15"), {"middle"}},
        // Spliced into the query rather than bound, these texts would select every job.
        RangeCase{"fromTextIsBound", Variant("9999-01-01' OR '1'='1"), day("2026-12-31"), {}},
        RangeCase{"toTextIsBound", day("2026-01-31"), Variant("2026-01-31'; DROP TABLE jobs; --"), {"last"}}),
    test::RowName{});

TEST_F(JobData, RowsHaveSixtyFiveFieldsWithNullWhereNoColumn)
{
    int32_t count = 0;
    const Variant rows = fetch(day("2026-01-01"), day("2026-01-01"), count);
    ASSERT_EQ(count, 1);
    ASSERT_TRUE(rows.isArray());
    const VariantArray& a = rows.array();
    EXPECT_EQ((std::array<int32_t, 4>{a.lower(0), a.upper(0), a.lower(1), a.upper(1)}),
              (std::array<int32_t, 4>{0, 64, 0, 0}));
    for (int32_t f : {0, 1, 2, 25, 27, 43, 47, 51, 53, 58, 60, 63})
        EXPECT_TRUE(a.at(f, 0).isNull()) << "field " << f;
    EXPECT_EQ(a.at(26, 0).str(), "first");
    EXPECT_EQ(a.at(44, 0).type(), VarType::Long);
    EXPECT_EQ(a.at(44, 0).longValue(), 1);
    EXPECT_EQ(a.at(45, 0).longValue(), 0);
    EXPECT_EQ(a.at(46, 0).str(), "1");
    EXPECT_TRUE(a.at(52, 0).isNull());
    EXPECT_EQ(a.at(59, 0).dbl(), 2.5);
    EXPECT_EQ(a.at(64, 0).str(), "");
}

TEST_F(JobData, TableWithoutSomeColumnsGivesNullForThem)
{
    const std::string path = dir_.filePath("few.db").toStdString();
    exec(path, "CREATE TABLE jobs(id INTEGER PRIMARY KEY, job_date TEXT NOT NULL, f26 TEXT, notes TEXT);"
               "INSERT INTO jobs(job_date, f26, notes) VALUES ('2026-01-05', 'Confirmed', 'x');");
    useDatabase(path);
    int32_t count = 0;
    const Variant rows = fetch(day("2026-01-01"), day("2026-01-31"), count);
    ASSERT_EQ(count, 1);
    EXPECT_EQ(rows.array().at(26, 0).str(), "Confirmed");
    for (int32_t f : {44, 45, 46, 52, 59, 64}) EXPECT_TRUE(rows.array().at(f, 0).isNull()) << "field " << f;
}

TEST_F(JobData, QueryThatWritesIsRefused)
{
    EXPECT_EQ(fetchError("2025-01-01", "2027-01-01", "DELETE FROM jobs").number(), kJobDataError);
    EXPECT_EQ(statuses(day("2025-01-01"), day("2027-01-01")).size(), 5u);
}

TEST_F(JobData, FetchWithoutDatesIsAnError)
{
    const Error e = fetchError(nullptr, nullptr);
    EXPECT_EQ(e.number(), kJobDataError);
    EXPECT_NE(e.description().find("SetFromDate"), std::string::npos) << e.description();
}

TEST_F(JobData, OtherQueryOptionOrDateOfAnotherKindIsRefused)
{
    EXPECT_EQ(test::errorOf([&] { call(jobs_, "GetJobQuery", {1, ""}); }).number(), errc::InvalidProcedureCall);
    for (const Variant& v : {Variant::null(), Variant(), test::anArray()})
        EXPECT_EQ(test::errorOf([&] { call(jobs_, "SetFromDate", {v}); }).number(), errc::TypeMismatch);
}

struct BadDatabaseCase : test::Named {
    std::string (*make)(const QTemporaryDir&);  // gives the database path
    int32_t number;
    const char* naming = nullptr;  // what the error names; the path when nullptr
};

class UnusableDatabase : public JobData, public testing::WithParamInterface<BadDatabaseCase> {};

TEST_P(UnusableDatabase, FailsTheFetchNamingTheFile)
{
    const std::string path = GetParam().make(dir_);
    useDatabase(path);  // creating the object does not touch the file
    const Error e = fetchError("2026-01-01", "2026-01-31");
    EXPECT_EQ(e.number(), GetParam().number);
    EXPECT_NE(e.description().find(GetParam().naming ? GetParam().naming : path), std::string::npos)
        << e.description();
}

INSTANTIATE_TEST_SUITE_P(
    Databases, UnusableDatabase,
    testing::Values(
        BadDatabaseCase{"missing", [](const QTemporaryDir& d) { return d.filePath("none.db").toStdString(); },
                        errc::FileNotFound},
        BadDatabaseCase{"notADatabase",
                        [](const QTemporaryDir& d) {
                            test::writeBytes(d.filePath("text.db").toStdString(), QByteArray(4096, 'k'));
                            return d.filePath("text.db").toStdString();
                        },
                        kJobDataError},
        BadDatabaseCase{"noJobsTable",
                        [](const QTemporaryDir& d) {
                            exec(d.filePath("other.db").toStdString(), "CREATE TABLE other(x);");
                            return d.filePath("other.db").toStdString();
                        },
                        kJobDataError},
        BadDatabaseCase{"folder", [](const QTemporaryDir& d) { return d.path().toStdString(); }, kJobDataError},
        BadDatabaseCase{"notConfigured", [](const QTemporaryDir&) { return std::string(); }, kJobDataError,
                        "No jobs database"}),
    test::RowName{});

TEST_F(JobData, WrongArgumentCountsAreRefused)
{
    EXPECT_EQ(test::errorOf([&] { call(jobs_, "SetFromDate"); }).number(), errc::WrongArgumentCount);
    EXPECT_EQ(test::errorOf([&] { call(jobs_, "GetJobQuery", {int32_t{255}}); }).number(), errc::WrongArgumentCount);
    EXPECT_EQ(test::errorOf([&] { call(jobs_, "FetchJobRows", {query(), Variant(), int32_t{0}, ""}); }).number(),
              errc::WrongArgumentCount);
}

}  // namespace
