// goJobData: the jobs between two dates from an SQLite database. The database opens at the first
// FetchJobRows, so a missing or unreadable file fails the request that needs it, naming the file.
#include <climits>
#include <cstdio>
#include <filesystem>
#include <memory>
#include <optional>
#include <string_view>

#include <sqlite3.h>

#include "core/Convert.h"
#include "core/Date.h"
#include "teststand/StandObject.h"
#include "teststand/StandObjects.h"

namespace kg::teststand {

namespace {

constexpr int32_t kFieldCount = 65;  // fields 0..64; field n holds column fN
constexpr int32_t kJobQueryOption = 255;
// Both ends inclusive; dates are stored and bound as YYYY-MM-DD, so text order is date order.
constexpr const char* kJobQuery = "SELECT * FROM jobs WHERE job_date BETWEEN ?1 AND ?2 ORDER BY job_date, id";

struct CloseDb {
    void operator()(sqlite3* db) const { sqlite3_close(db); }
};
struct FinalizeStmt {
    void operator()(sqlite3_stmt* s) const { sqlite3_finalize(s); }
};
using Db = std::unique_ptr<sqlite3, CloseDb>;
using Stmt = std::unique_ptr<sqlite3_stmt, FinalizeStmt>;

// The field a result column fills: "f26" -> 26; -1 for any other column.
int32_t fieldOfColumn(const char* name)
{
    if (!name || (name[0] != 'f' && name[0] != 'F') || !name[1]) return -1;
    int32_t n = 0;
    for (const char* p = name + 1; *p; ++p) {
        if (*p < '0' || *p > '9' || n >= kFieldCount) return -1;
        n = n * 10 + (*p - '0');
    }
    return n < kFieldCount ? n : -1;
}

Variant cellValue(sqlite3_stmt* stmt, int col)
{
    switch (sqlite3_column_type(stmt, col)) {
    case SQLITE_INTEGER: {
        const sqlite3_int64 n = sqlite3_column_int64(stmt, col);
        if (n >= INT32_MIN && n <= INT32_MAX) return static_cast<int32_t>(n);
        return static_cast<double>(n);
    }
    case SQLITE_FLOAT: return sqlite3_column_double(stmt, col);
    case SQLITE_NULL: return Variant::null();
    default: {  // text, and a blob read as its bytes
        const auto* p = static_cast<const char*>(sqlite3_column_blob(stmt, col));
        return std::string(p ? p : "", static_cast<size_t>(sqlite3_column_bytes(stmt, col)));
    }
    }
}

class JobDataObject final : public StandObject {
public:
    enum : DispId { kSetFromDate = 1, kSetToDate, kGetJobQuery, kFetchJobRows };

    explicit JobDataObject(const Config& cfg)
        : StandObject("JobData", "JobData",
                      {{"SetFromDate", kSetFromDate},
                       {"SetToDate", kSetToDate},
                       {"GetJobQuery", kGetJobQuery},
                       {"FetchJobRows", kFetchJobRows}}),
          path_(cfg.jobsDatabase)
    {
    }

protected:
    Variant run(DispId id, Args& args) override
    {
        const char* member = memberName(id);
        switch (id) {
        case kSetFromDate:
            expectArgs(args, 1, member);
            from_ = dateText(args[0], where(id));
            break;
        case kSetToDate:
            expectArgs(args, 1, member);
            to_ = dateText(args[0], where(id));
            break;
        case kGetJobQuery: {
            expectArgs(args, 2, member);
            const int32_t option = longArg(args, 0, where(id));
            if (option != kJobQueryOption)
                throw Error::invalidCall(where(id) + ": no job query has the option " + std::to_string(option));
            args[1] = kJobQuery;
            break;
        }
        case kFetchJobRows: {
            expectArgs(args, 5, member);
            int32_t count = 0;
            args[1] = fetch(textArg(args, 0, where(id)), count);
            args[4] = count;
            break;
        }
        }
        return {};
    }

private:
    // A Date (or a number, as a date serial) becomes YYYY-MM-DD; a text is taken as the stored
    // date text it names. Either way it is bound as a parameter, never put into the query text.
    static std::string dateText(const Variant& v, const std::string& where)
    {
        if (v.isString()) return v.str();
        if (v.type() == VarType::Date || v.isNumeric()) {
            const double serial = v.type() == VarType::Date ? v.dateSerial() : toDouble(v);
            const CivilDate d = civilDate(serial);
            char text[16];
            std::snprintf(text, sizeof text, "%04d-%02d-%02d", d.year, d.month, d.day);
            return text;
        }
        throw Error::typeMismatch(where + ": the date is a " + typeName(v.type()) + ", not a date");
    }

    [[noreturn]] void fail(const std::string& problem) const
    {
        throw Error::host(hosterr::JobData, "The jobs database \"" + path_ + "\" " + problem, "JobData");
    }

    sqlite3* database()
    {
        if (db_) return db_.get();
        if (path_.empty())
            throw Error::host(hosterr::JobData, "No jobs database is configured for the job data", "JobData");
        std::error_code ec;
        if (!std::filesystem::exists(path_, ec))
            throw Error(errc::FileNotFound, "File not found: the jobs database \"" + path_ + "\" does not exist",
                        "JobData");
        sqlite3* raw = nullptr;
        const int rc = sqlite3_open_v2(path_.c_str(), &raw, SQLITE_OPEN_READONLY, nullptr);
        Db db(raw);
        if (rc != SQLITE_OK) fail(std::string("cannot be opened: ") + (raw ? sqlite3_errmsg(raw) : sqlite3_errstr(rc)));
        sqlite3_busy_timeout(db.get(), 2000);
        db_ = std::move(db);
        return db_.get();
    }

    Variant fetch(const std::string& query, int32_t& count)
    {
        sqlite3* db = database();
        sqlite3_stmt* raw = nullptr;
        const char* tail = nullptr;
        if (sqlite3_prepare_v2(db, query.c_str(), static_cast<int>(query.size() + 1), &raw, &tail) != SQLITE_OK)
            fail(std::string("cannot be queried: ") + sqlite3_errmsg(db));
        Stmt stmt(raw);
        if (!stmt) fail("cannot be queried: the job query is empty");
        if (tail && *tail && std::string_view(tail).find_first_not_of(" \t\r\n;") != std::string_view::npos)
            fail("cannot be queried: the job query must be one statement");
        if (!sqlite3_stmt_readonly(stmt.get())) fail("cannot be queried: the job query must only read");

        const int params = sqlite3_bind_parameter_count(stmt.get());
        if (params > 2) fail("cannot be queried: the job query takes the from and to dates only");
        if (params >= 1 && !from_) fail("cannot be queried: SetFromDate was not called");
        if (params >= 2 && !to_) fail("cannot be queried: SetToDate was not called");
        if (params >= 1) sqlite3_bind_text(stmt.get(), 1, from_->c_str(), -1, SQLITE_TRANSIENT);
        if (params >= 2) sqlite3_bind_text(stmt.get(), 2, to_->c_str(), -1, SQLITE_TRANSIENT);

        const int columns = sqlite3_column_count(stmt.get());
        std::vector<int32_t> fieldOf(static_cast<size_t>(columns));
        for (int c = 0; c < columns; ++c) fieldOf[static_cast<size_t>(c)] = fieldOfColumn(sqlite3_column_name(stmt.get(), c));

        // Only the columns that fill a field are kept while stepping; the table is made once.
        std::vector<std::pair<int32_t, int>> used;  // (field, column)
        for (int c = 0; c < columns; ++c)
            if (fieldOf[static_cast<size_t>(c)] >= 0) used.emplace_back(fieldOf[static_cast<size_t>(c)], c);
        std::vector<Variant> cells;
        int rc;
        while ((rc = sqlite3_step(stmt.get())) == SQLITE_ROW)
            for (const auto& [field, column] : used) cells.push_back(cellValue(stmt.get(), column));
        if (rc != SQLITE_DONE) fail(std::string("cannot be read: ") + sqlite3_errmsg(db));

        const size_t perRow = used.size();
        count = perRow ? static_cast<int32_t>(cells.size() / perRow) : 0;
        if (!perRow) {
            // No column fills a field: count the rows alone.
            sqlite3_reset(stmt.get());
            while (sqlite3_step(stmt.get()) == SQLITE_ROW) ++count;
        }
        if (count == 0) return {};
        VariantArray table(0, kFieldCount - 1, 0, count - 1);
        const Variant null = Variant::null();
        for (int32_t r = 0; r < count; ++r) {
            for (int32_t f = 0; f < kFieldCount; ++f) table.at(f, r) = null;
            for (size_t u = 0; u < perRow; ++u)
                table.at(used[u].first, r) = std::move(cells[size_t(r) * perRow + u]);
        }
        return Variant(std::move(table));
    }

    std::string path_;
    std::optional<std::string> from_, to_;
    Db db_;
};

}  // namespace

Ref<Object> makeJobData(const Config& cfg) { return makeRef<JobDataObject>(cfg); }

}  // namespace kg::teststand
