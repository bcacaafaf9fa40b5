#pragma once
// Writes a jobs database for the test stand: realistic statuses and flags, reproducible from a seed.
// Used by the sample data, the tests and the benchmarks.
#include <cstdint>
#include <string>
#include <vector>

namespace kg::teststand {

struct SampleJobsSpec {
    int64_t count = 1000;
    uint32_t seed = 20260101;
    std::string firstDate = "2026-01-01";  // job dates spread evenly over first..last
    std::string lastDate = "2026-12-31";
};

// The captions of the thirteen status categories, in point order, as the host keeps them in its
// field list.
const std::vector<std::string>& jobStatusCaptions();

// Creates (or replaces) the database at `path`: table jobs with an index on job_date.
// Error naming the file when it cannot be written.
void writeSampleJobs(const std::string& path, const SampleJobsSpec& spec);

}  // namespace kg::teststand
