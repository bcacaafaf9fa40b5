#include "teststand/SampleData.h"

#include <sqlite3.h>

#include <QDir>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QSaveFile>
#include <array>
#include <cmath>
#include <random>
#include <vector>

#include "core/Error.h"
#include "teststand/SampleJobs.h"
#include "teststand/TestStand.h"

namespace kg::teststand {

namespace {

const char* const kAgents[] = {"Alice Martin", "Ben Carter", "Chloe Nguyen", "David Okafor", "Emma Rossi",
                               "Farid Haddad"};
const char* const kQuoteTypes[] = {"Retail", "Corporate", "Wholesale", "Online", "Government", "Education",
                                   "Charity"};
const char* const kMonths[] = {"Jan", "Feb", "Mar", "Apr", "May", "Jun", "Jul", "Aug", "Sep", "Oct", "Nov", "Dec"};
constexpr int kAgentCount = 6, kTypeCount = 7;
constexpr uint32_t kSeed = 20260614;

Error writeError(const std::string& path, const std::string& why)
{
    return Error::host(hosterr::JobData, "Cannot write the sample data " + path + ": " + why, "KarstGraph test stand");
}

double round2(double v) { return std::round(v * 100.0) / 100.0; }

struct Booking {
    int month, agent, type;
    double value;
    bool job;
};

// A year of bookings with a seasonal rhythm: busier in spring and before Christmas.
std::vector<Booking> makeBookings()
{
    std::mt19937 rng(kSeed);
    static const int seasonal[12] = {18, 20, 26, 30, 28, 22, 16, 14, 24, 27, 31, 35};
    static const double price[kTypeCount] = {180, 950, 640, 120, 1500, 420, 90};
    std::vector<Booking> out;
    for (int m = 0; m < 12; ++m)
        for (int a = 0; a < kAgentCount; ++a) {
            const int n = seasonal[m] * (a + 3) / 6 + int(rng() % 6);
            for (int i = 0; i < n; ++i) {
                const int t = int(rng() % 100) < 35 ? 0 : int(rng() % kTypeCount);
                const double v = round2(price[t] * (0.6 + double(rng() % 800) / 1000.0));
                out.push_back({m, a, t, v, rng() % 100 < 62});
            }
        }
    return out;
}

void storeBookings(const std::string& path, const std::vector<Booking>& bookings)
{
    sqlite3* db = nullptr;
    if (sqlite3_open(path.c_str(), &db) != SQLITE_OK) {
        sqlite3_close(db);
        throw writeError(path, "cannot open");
    }
    std::string sql = "PRAGMA synchronous=OFF; DROP TABLE IF EXISTS bookings;"
                      "CREATE TABLE bookings(id INTEGER PRIMARY KEY, month INTEGER, agent TEXT, quote_type TEXT,"
                      " value REAL, is_job INTEGER); BEGIN;";
    char* err = nullptr;
    if (sqlite3_exec(db, sql.c_str(), nullptr, nullptr, &err) != SQLITE_OK) {
        const std::string why = err ? err : "error";
        sqlite3_free(err);
        sqlite3_close(db);
        throw writeError(path, why);
    }
    sqlite3_stmt* ins = nullptr;
    sqlite3_prepare_v2(db, "INSERT INTO bookings(month, agent, quote_type, value, is_job) VALUES (?,?,?,?,?)", -1, &ins,
                       nullptr);
    for (const Booking& b : bookings) {
        sqlite3_bind_int(ins, 1, b.month + 1);
        sqlite3_bind_text(ins, 2, kAgents[b.agent], -1, SQLITE_STATIC);
        sqlite3_bind_text(ins, 3, kQuoteTypes[b.type], -1, SQLITE_STATIC);
        sqlite3_bind_double(ins, 4, b.value);
        sqlite3_bind_int(ins, 5, b.job ? 1 : 0);
        sqlite3_step(ins);
        sqlite3_reset(ins);
    }
    sqlite3_finalize(ins);
    sqlite3_exec(db, "COMMIT;", nullptr, nullptr, nullptr);
    sqlite3_close(db);
}

QJsonObject grid(const QJsonArray& rows) { return QJsonObject{{"fixedRows", 1}, {"cells", rows}}; }

QJsonArray monthHeader(const char* first)
{
    QJsonArray h{first};
    for (const char* m : kMonths) h.append(m);
    h.append("Total");
    return h;
}

}  // namespace

SampleData writeSampleData(const std::string& folder)
{
    if (!QDir().mkpath(QString::fromStdString(folder))) throw writeError(folder, "cannot create the folder");
    SampleData data;
    data.database = folder + "/tavix.db";
    data.form = folder + "/form.json";

    SampleJobsSpec jobs;
    jobs.count = 2400;
    writeSampleJobs(data.database, jobs);
    const std::vector<Booking> bookings = makeBookings();
    storeBookings(data.database, bookings);

    // Per agent and month: count and value; per quote type: count, value and jobs.
    std::array<std::array<double, 12>, kAgentCount> count{}, value{};
    std::array<double, kTypeCount> typeCount{}, typeValue{}, typeJobs{};
    double jobsTotal = 0;
    for (const Booking& b : bookings) {
        count[b.agent][b.month] += 1;
        value[b.agent][b.month] += b.value;
        typeCount[b.type] += 1;
        typeValue[b.type] += b.value;
        typeJobs[b.type] += b.job;
        jobsTotal += b.job;
    }
    // Rows appended one by one: a brace list of one array is a copy of it for one compiler and
    // an array holding it for another.
    QJsonArray g1, g2, g3;
    for (QJsonArray* g : {&g1, &g2, &g3}) g->append(monthHeader("Agent"));
    for (int a = 0; a < kAgentCount; ++a) {
        QJsonArray r1{kAgents[a]}, r2{kAgents[a]}, r3{kAgents[a]};
        double c = 0, v = 0;
        for (int m = 0; m < 12; ++m) {
            r1.append(count[a][m]);
            r2.append(round2(value[a][m]));
            r3.append(count[a][m] > 0 ? round2(value[a][m] / count[a][m]) : 0.0);
            c += count[a][m];
            v += value[a][m];
        }
        r1.append(c);
        r2.append(round2(v));
        r3.append(c > 0 ? round2(v / c) : 0.0);
        g1.append(r1);
        g2.append(r2);
        g3.append(r3);
        data.totals.quantity += c;
        data.totals.value += v;
    }
    data.totals.value = round2(data.totals.value);
    data.totals.average = data.totals.quantity > 0 ? round2(data.totals.value / data.totals.quantity) : 0;

    QJsonArray settings;
    settings.append(QJsonArray{"Quote Type", "Qty", "Value", "Avg Value", "Pct Jobs", "Pct Value"});
    for (int t = 0; t < kTypeCount; ++t)
        settings.append(QJsonArray{kQuoteTypes[t], typeCount[t], round2(typeValue[t]),
                                   typeCount[t] > 0 ? round2(typeValue[t] / typeCount[t]) : 0.0,
                                   round2(100.0 * typeJobs[t] / jobsTotal),
                                   round2(100.0 * typeValue[t] / data.totals.value)});

    QJsonArray captions;
    for (const std::string& c : jobStatusCaptions()) captions.append(QString::fromStdString(c));
    const QJsonObject form{{"grid1", grid(g1)},
                           {"grid2", grid(g2)},
                           {"grid3", grid(g3)},
                           {"gridsettings1", grid(settings)},
                           {"dtpFromDate", "2026-01-01"},
                           {"dtpToDate", "2026-12-31"},
                           {"cboFields", QJsonObject{{"1", captions}}},
                           {"jobsDatabase", "tavix.db"},
                           {"totals", QJsonObject{{"grid1", data.totals.quantity},
                                                  {"grid2", data.totals.value},
                                                  {"grid3", data.totals.average}}}};
    QSaveFile file(QString::fromStdString(data.form));
    if (!file.open(QIODevice::WriteOnly) || file.write(QJsonDocument(form).toJson()) < 0 || !file.commit())
        throw writeError(data.form, file.errorString().toStdString());
    return data;
}

}  // namespace kg::teststand
