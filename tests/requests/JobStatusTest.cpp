// The job status request through its dispatch id, over generated job databases.
#include <sqlite3.h>

#include <QFile>

#include "support/RequestFixture.h"

namespace kg {
namespace {

struct Job {
    const char* date;
    const char* status;  // f26; nullptr for NULL
    const char* f44 = "0";
    const char* f45 = "0";
    const char* f46 = "0";
    const char* f52 = "0";
    const char* f59 = "0";
    const char* f64 = "0";
};

struct JobStatusFixture : test::RequestFixture {
    std::string database;

    void makeDatabase(const std::vector<Job>& jobs)
    {
        database = dir.filePath("jobs.db").toStdString();
        QFile::remove(QString::fromStdString(database));
        sqlite3* db = nullptr;
        ASSERT_EQ(sqlite3_open(database.c_str(), &db), SQLITE_OK);
        // The test's own values hold no quotes: plain SQL literals are enough.
        std::string sql = "CREATE TABLE jobs(id INTEGER PRIMARY KEY, job_date TEXT NOT NULL, f26 TEXT, f44, f45, f46,"
                          " f52, f59, f64); CREATE INDEX jobs_by_date ON jobs(job_date);";
        for (const Job& j : jobs) {
            sql += "INSERT INTO jobs(job_date, f26, f44, f45, f46, f52, f59, f64) VALUES (";
            const char* values[] = {j.date, j.status, j.f44, j.f45, j.f46, j.f52, j.f59, j.f64};
            for (size_t i = 0; i < 8; ++i)
                sql += (values[i] ? "'" + std::string(values[i]) + "'" : std::string("NULL")) + (i < 7 ? ", " : ");");
        }
        EXPECT_EQ(sqlite3_exec(db, sql.c_str(), nullptr, nullptr, nullptr), SQLITE_OK);
        sqlite3_close(db);
        standConfig.jobsDatabase = database;
        standChanged();
    }

    void setJobForm(const char* from, const char* to, int captions)
    {
        std::string list;
        for (int i = 0; i < captions; ++i) list += (i ? ", \"Cat " : "\"Cat ") + std::to_string(i + 1) + "\"";
        setForm(std::string("{\"dtpFromDate\": \"") + from + "\", \"dtpToDate\": \"" + to +
                "\", \"cboFields\": {\"1\": [" + list + "]}}");
    }
    double count(int point) { return chart1().data().y(1, point); }
};

TEST_F(JobStatusFixture, CountsEveryCategoryOnItsOwn)
{
    makeDatabase({
        {"2026-02-01", "Confirmed", "1"},                      // points 5 and 6
        {"2026-02-02", "confirmed"},                           // no status point
        {"2026-02-03", "Unconfirmed", "0", "1", "1", "0", "1", ""},  // 1, 9, 8, 11 (empty f64 reads 0)
        {"2026-02-04", "Imported", "abc", "0", "1", "1", "0", "1"},  // 13, 10, 7, 12; "abc" reads 0
        {"2026-02-05", "Cancelled", " 1", "0", "0", "0", "0", "1x"}, // 3, 6 (" 1"), 7 ("1x" reads 1)
        {"2026-02-06", nullptr},                               // Null status: nothing
        {"2026-03-01", "Postponed"},                           // outside the range
    });
    setJobForm("2026-02-01", "2026-02-28", 13);
    modMain::giChartKind = 2;
    ASSERT_EQ(request(KG_DISPID_GENERATECHART_JOBSTATUSREPORT), 0) << lastError;
    const double expected[14] = {0, 1, 0, 1, 0, 1, 2, 2, 1, 1, 1, 1, 1, 1};
    for (int p = 1; p <= 13; ++p) EXPECT_EQ(count(p), expected[p]) << "point " << p;
    EXPECT_EQ(modMain::giChartKind, 2);  // untouched
    EXPECT_FALSE(modMain::gfChart->isRedrawVisible());
    EXPECT_TRUE(modMain::gfChart->isShown());
    EXPECT_EQ(mousePointer(), kPointerDefault);
    EXPECT_EQ(chart1().header.text, "Tavix Job Status Chart");
    EXPECT_EQ(chart1().chartArea.x.title, "01/02/2026 - 28/02/2026");
    EXPECT_EQ(chart1().chartArea.y.title, "Quantity");
    EXPECT_EQ(chart1().group1.pointLabels.front(), "Cat 1");
    EXPECT_EQ(chart1().chartArea.x.annotationMethod, 2);
    EXPECT_FALSE(chart1().legend.isShown);
    // Hits are whole numbers; categories without hits were empty and are 0 now.
    EXPECT_EQ(modMain::gvArray.at(1, 6).type(), VarType::Integer);
    EXPECT_EQ(modMain::gvArray.at(1, 2).type(), VarType::Integer);
}

TEST_F(JobStatusFixture, ReversedDatesAskTheHostNothing)
{
    standConfig.jobsDatabase = dir.filePath("does-not-exist.db").toStdString();
    standChanged();
    setJobForm("2026-05-06", "2026-05-05", 13);
    EXPECT_EQ(request(KG_DISPID_GENERATECHART_JOBSTATUSREPORT),
              0) << lastError;  // a query would have failed on the missing file
    EXPECT_EQ(prompts.messages, std::vector<std::string>{"The FromDate must be less than or equal to the ToDate"});
    EXPECT_EQ(mousePointer(), kPointerDefault);
}

TEST_F(JobStatusFixture, NoJobsShowsTheMessageAndNoWindow)
{
    makeDatabase({{"2026-01-01", "Confirmed"}});
    setJobForm("2026-06-01", "2026-06-30", 13);
    EXPECT_EQ(request(KG_DISPID_GENERATECHART_JOBSTATUSREPORT), 0) << lastError;
    EXPECT_EQ(prompts.messages, std::vector<std::string>{"No jobs were found in that date range"});
    EXPECT_FALSE(modMain::gfChart->isShown());
    EXPECT_EQ(mousePointer(), kPointerDefault);
    EXPECT_EQ(chart1().group1.pointLabels.size(), 13u);  // already set before the query
}

struct ListCase {
    const char* name;
    int captions;
    int points;
};

class FieldLists : public JobStatusFixture, public ::testing::WithParamInterface<ListCase> {};

TEST_P(FieldLists, EveryCategoryHasAPoint)
{
    makeDatabase({{"2026-02-01", "Imported"}, {"2026-02-01", "Unconfirmed"}});
    setJobForm("2026-02-01", "2026-02-01", GetParam().captions);
    ASSERT_EQ(request(KG_DISPID_GENERATECHART_JOBSTATUSREPORT), 0) << lastError;
    EXPECT_EQ(modMain::goChart->NumPoints(), GetParam().points);
    EXPECT_EQ(chart1().data().pointCount(1), GetParam().points);
    EXPECT_EQ(chart1().group1.pointLabels.size(), size_t(GetParam().captions));
    EXPECT_EQ(count(13), 1);  // "Imported" counts even beyond the list
    EXPECT_EQ(count(1), 1);
    if (GetParam().points > 13) {
        EXPECT_EQ(count(GetParam().points), 0);
    }
}

INSTANTIATE_TEST_SUITE_P(Table, FieldLists,
                         ::testing::Values(ListCase{"shorter", 5, 13}, ListCase{"none", 0, 13},
                                           ListCase{"exact", 13, 13}, ListCase{"longer", 15, 15}),
                         [](const auto& info) { return std::string(info.param.name); });

}  // namespace
}  // namespace kg
