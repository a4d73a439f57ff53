// Console output for the benchmark programs, plus Pigmo-vs-Little-CMS time ratios after the table.
#pragma once

#include <benchmark/benchmark.h>

#include <map>
#include <string>
#include <vector>

namespace Pigmo::Bench {

// Two runs doing the same work, named as the table shows them.
struct RatioPair {
    std::string label;
    std::string pigmoRun;
    std::string lcmsRun;
};

// Records each run's CPU nanoseconds per item: CPU time, because the machine is shared.
class RatioReporter : public benchmark::ConsoleReporter {
public:
    RatioReporter();

    void ReportRuns(const std::vector<Run>& runs) override;

    // Prints nothing when either run was filtered out or failed.
    void PrintRatio(const std::string& label, const std::string& pigmoRun, const std::string& lcmsRun) const;

private:
    std::map<std::string, double> nanosecondsPerItem_;
};

// The whole of a program's main after registration: runs the benchmarks the command line selects,
// then prints one ratio per pair. Returns the exit status.
int RunBenchmarks(int argc, char** argv, const std::vector<RatioPair>& pairs = {});

}  // namespace Pigmo::Bench
