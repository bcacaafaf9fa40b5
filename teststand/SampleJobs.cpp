#include "teststand/SampleJobs.h"

#include <sqlite3.h>

#include <cstdio>
#include <random>

#include "core/Date.h"
#include "core/Error.h"
#include "teststand/TestStand.h"

namespace kg::teststand {

namespace {

Error fileError(const std::string& path, const std::string& what)
{
    return Error::host(hosterr::JobData, "Cannot write the jobs database " + path + ": " + what, "KarstGraph test stand");
}

std::string isoDate(double serial)
{
    const CivilDate d = civilDate(serial);
    char buf[16];
    std::snprintf(buf, sizeof buf, "%04d-%02d-%02d", d.year, d.month, d.day);
    return buf;
}

struct Statement {
    sqlite3_stmt* s = nullptr;
    ~Statement() { sqlite3_finalize(s); }
};

}  // namespace

const std::vector<std::string>& jobStatusCaptions()
{
    static const std::vector<std::string> captions = {
        "Unconfirmed", "Unscheduled", "Cancelled",   "Postponed",      "Confirmed",    "Invoiced", "Paid",
        "Completed",   "Deposit Taken", "Follow-up Due", "Balance Owing", "Paid with Extras", "Imported"};
    return captions;
}

void writeSampleJobs(const std::string& path, const SampleJobsSpec& spec)
{
    const auto first = parseIsoDate(spec.firstDate), last = parseIsoDate(spec.lastDate);
    if (!first || !last || *last < *first)
        throw Error::invalidCall("sample jobs date range " + spec.firstDate + " to " + spec.lastDate);
    std::remove(path.c_str());
    sqlite3* db = nullptr;
    if (sqlite3_open(path.c_str(), &db) != SQLITE_OK) {
        const std::string why = db ? sqlite3_errmsg(db) : "cannot open";
        sqlite3_close(db);
        throw fileError(path, why);
    }
    auto exec = [&](const char* sql) {
        char* err = nullptr;
        if (sqlite3_exec(db, sql, nullptr, nullptr, &err) != SQLITE_OK) {
            const std::string why = err ? err : "error";
            sqlite3_free(err);
            sqlite3_close(db);
            throw fileError(path, why);
        }
    };
    exec("PRAGMA journal_mode=OFF; PRAGMA synchronous=OFF;"
         "CREATE TABLE jobs(id INTEGER PRIMARY KEY, job_date TEXT NOT NULL, f26 TEXT, f44, f45, f46, f52, f59, f64);"
         "BEGIN;");
    {
        Statement insert;
        sqlite3_prepare_v2(db, "INSERT INTO jobs(job_date, f26, f44, f45, f46, f52, f59, f64) VALUES (?,?,?,?,?,?,?,?)",
                           -1, &insert.s, nullptr);
        std::mt19937 rng(spec.seed);
        auto chance = [&](unsigned percent) { return rng() % 100 < percent; };
        // Status mix of a working business: mostly confirmed, some of everything else.
        static const struct { const char* status; unsigned weight; } statuses[] = {
            {"Confirmed", 46}, {"Unconfirmed", 14}, {"Unscheduled", 10}, {"Cancelled", 8},
            {"Postponed", 6},  {"Imported", 5},     {"confirmed", 1},    {"Quoted", 10}};
        const double days = *last - *first + 1;
        for (int64_t i = 0; i < spec.count; ++i) {
            const double day = *first + double(int64_t(double(i) * days / double(spec.count)));
            unsigned pick = rng() % 100;
            const char* status = statuses[0].status;
            for (const auto& s : statuses) {
                if (pick < s.weight) {
                    status = s.status;
                    break;
                }
                pick -= s.weight;
            }
            const std::string date = isoDate(day);
            sqlite3_bind_text(insert.s, 1, date.c_str(), -1, SQLITE_TRANSIENT);
            sqlite3_bind_text(insert.s, 2, status, -1, SQLITE_STATIC);
            const bool confirmed = std::string(status) == "Confirmed";
            // Flags as the host stores them: mostly "0"/"1" texts, some empty or missing.
            const unsigned flagChance[] = {confirmed ? 70u : 10u, 25u, 20u, 15u, confirmed ? 40u : 5u, 35u};
            for (int f = 0; f < 6; ++f) {
                const unsigned roll = rng() % 100;
                if (roll < 3)
                    sqlite3_bind_null(insert.s, 3 + f);
                else if (roll < 6)
                    sqlite3_bind_text(insert.s, 3 + f, "", -1, SQLITE_STATIC);
                else
                    sqlite3_bind_text(insert.s, 3 + f, chance(flagChance[f]) ? "1" : "0", -1, SQLITE_STATIC);
            }
            if (sqlite3_step(insert.s) != SQLITE_DONE) {
                const std::string why = sqlite3_errmsg(db);
                sqlite3_finalize(insert.s);
                insert.s = nullptr;
                sqlite3_close(db);
                throw fileError(path, why);
            }
            sqlite3_reset(insert.s);
        }
    }
    exec("COMMIT; CREATE INDEX jobs_by_date ON jobs(job_date);");
    sqlite3_close(db);
}

}  // namespace kg::teststand
