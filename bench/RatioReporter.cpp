#include "RatioReporter.h"

#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <string_view>

namespace Pigmo::Bench {

// Colors only on a terminal, so logs stay plain text.
RatioReporter::RatioReporter() : ConsoleReporter(isatty(STDOUT_FILENO) ? OO_ColorTabular : OO_Tabular) {}

void RatioReporter::ReportRuns(const std::vector<Run>& runs) {
    for (const Run& run : runs) {
        if (run.error_occurred || run.iterations == 0) continue;
        // With repetitions the median stands for the run; otherwise the single iteration run does.
        const bool median = run.run_type == Run::RT_Aggregate && run.aggregate_name == "median";
        if (run.run_type != Run::RT_Iteration && !median) continue;
        const auto items = run.counters.find("items_per_second");
        // The items rate is per CPU second, so it already divides by the items of each iteration.
        nanosecondsPerItem_[run.run_name.str()] =
            items != run.counters.end() && items->second.value > 0
                ? 1e9 / items->second.value
                : run.GetAdjustedCPUTime() / benchmark::GetTimeUnitMultiplier(run.time_unit) * 1e9;
    }
    ConsoleReporter::ReportRuns(runs);
}

void RatioReporter::PrintRatio(const std::string& label, const std::string& pigmoRun,
                               const std::string& lcmsRun) const {
    const auto pigmo = nanosecondsPerItem_.find(pigmoRun);
    const auto lcms = nanosecondsPerItem_.find(lcmsRun);
    if (pigmo == nanosecondsPerItem_.end() || lcms == nanosecondsPerItem_.end()) return;
    std::printf("%-20s Pigmo %10.2f ns, Little CMS %10.2f ns per item, Little CMS / Pigmo = %.2f\n",
                (label + ":").c_str(), pigmo->second, lcms->second, lcms->second / pigmo->second);
}

namespace {

// The library only honours --benchmark_format when it makes the display reporter itself.
bool ConsoleFormat(int argc, char** argv) {
    const char* environment = std::getenv("BENCHMARK_FORMAT");
    std::string_view format = environment != nullptr ? environment : "console";
    constexpr std::string_view kFlag = "--benchmark_format=";
    for (int i = 1; i < argc; ++i) {
        if (std::string_view(argv[i]).starts_with(kFlag))
            format = std::string_view(argv[i]).substr(kFlag.size());
    }
    return format == "console";
}

}  // namespace

int RunBenchmarks(int argc, char** argv, const std::vector<RatioPair>& pairs) {
    const bool console = ConsoleFormat(argc, argv);
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    if (!console) {
        // Ratio lines would break JSON or CSV output.
        benchmark::RunSpecifiedBenchmarks();
        benchmark::Shutdown();
        return 0;
    }
    RatioReporter reporter;
    benchmark::RunSpecifiedBenchmarks(&reporter);
    if (!pairs.empty()) std::printf("\nCPU time per item; Little CMS / Pigmo above 1: Pigmo is faster.\n");
    for (const RatioPair& pair : pairs) reporter.PrintRatio(pair.label, pair.pigmoRun, pair.lcmsRun);
    std::fflush(stdout);
    benchmark::Shutdown();
    return 0;
}

}  // namespace Pigmo::Bench
