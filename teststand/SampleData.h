#pragma once
// The bundled sample data: one SQLite database of bookings and jobs, and the host's report form
// computed from it, so that every grid, total and job count agrees with every other.
//   writeSampleData("/tmp/sample")  ->  /tmp/sample/tavix.db, /tmp/sample/form.json
#include <string>

namespace kg::teststand {

struct SampleTotals {
    double quantity = 0;   // grid1's total: bookings counted
    double value = 0;      // grid2's total: their value
    double average = 0;    // grid3's total: value per booking
};

struct SampleData {
    std::string database;  // tavix.db
    std::string form;      // form.json
    SampleTotals totals;
};

// Writes (or rewrites) the sample into `folder`; the same files every time.
// Error naming the file when one cannot be written.
SampleData writeSampleData(const std::string& folder);

}  // namespace kg::teststand
