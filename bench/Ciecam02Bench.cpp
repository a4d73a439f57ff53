// XYZ to CIECAM02 JCh and back, per color, beside Little CMS doing the same work.
#include <benchmark/benchmark.h>
#include <lcms2.h>

#include <cstdio>
#include <map>
#include <string>
#include <vector>

#include "ColorSpaceCIECAM02.h"
#include "ColorSpaceStruct.h"
#include "ColorTranslator.h"

namespace {

constexpr double kWhite[3] = {0.9505, 1.0, 1.0888};

// A cube of linear sRGB colors, as XYZ on the Y = 1 scale.
const std::vector<double>& Colors() {
    static const std::vector<double> colors = [] {
        std::vector<double> xyz;
        for (int r = 0; r < 10; ++r)
            for (int g = 0; g < 10; ++g)
                for (int b = 0; b < 10; ++b) {
                    const double R = (r + 0.5) / 10, G = (g + 0.5) / 10, B = (b + 0.5) / 10;
                    xyz.push_back(0.4124 * R + 0.3576 * G + 0.1805 * B);
                    xyz.push_back(0.2126 * R + 0.7152 * G + 0.0722 * B);
                    xyz.push_back(0.0193 * R + 0.1192 * G + 0.9505 * B);
                }
        return xyz;
    }();
    return colors;
}

ColorSpaceStruct JCh() {
    ColorSpaceStruct d;
    d.SetType(10);
    for (int i = 0; i < 3; ++i) d.whitePoint[i] = kWhite[i];
    return d;  // viewing preset 0: Yb 50, La 300, average surround
}

void PigmoNode(benchmark::State& state) {
    const auto node = cColorSpaceCIECAM02::Create(JCh());
    const std::vector<double>& colors = Colors();
    double jch[3];
    double xyz[3];
    for (auto _ : state) {
        for (size_t i = 0; i < colors.size(); i += 3) {
            node->FromXYZ(&colors[i], jch);
            node->ToXYZ(jch, xyz);
            benchmark::DoNotOptimize(xyz);
        }
    }
    state.SetItemsProcessed(state.iterations() * static_cast<int64_t>(colors.size() / 3));
}

void PigmoTranslator(benchmark::State& state) {
    ColorSpaceStruct xyzSpace;
    xyzSpace.SetType(6);
    for (int i = 0; i < 3; ++i) xyzSpace.whitePoint[i] = kWhite[i];
    cColorTranslator forward;
    forward.SetSource(xyzSpace);
    forward.SetDestination(JCh());
    cColorTranslator inverse;
    inverse.SetSource(JCh());
    inverse.SetDestination(xyzSpace);
    const std::vector<double>& colors = Colors();
    double jch[3];
    double xyz[3];
    for (auto _ : state) {
        for (size_t i = 0; i < colors.size(); i += 3) {
            forward.Translate(&colors[i], jch);
            inverse.Translate(jch, xyz);
            benchmark::DoNotOptimize(xyz);
        }
    }
    state.SetItemsProcessed(state.iterations() * static_cast<int64_t>(colors.size() / 3));
}

void LittleCms(benchmark::State& state) {
    const ColorSpaceStruct d = JCh();
    const cmsViewingConditions vc{{kWhite[0] * 100, kWhite[1] * 100, kWhite[2] * 100},
                                  d.viewingConditions[0],
                                  d.viewingConditions[1],
                                  AVG_SURROUND,
                                  D_CALCULATE};
    cmsHANDLE model = cmsCIECAM02Init(nullptr, &vc);
    const std::vector<double>& colors = Colors();
    cmsJCh jch;
    cmsCIEXYZ xyz;
    for (auto _ : state) {
        for (size_t i = 0; i < colors.size(); i += 3) {
            // Little CMS works on the Y = 100 scale.
            const cmsCIEXYZ in{colors[i] * 100, colors[i + 1] * 100, colors[i + 2] * 100};
            cmsCIECAM02Forward(model, &in, &jch);
            cmsCIECAM02Reverse(model, &jch, &xyz);
            benchmark::DoNotOptimize(xyz);
        }
    }
    state.SetItemsProcessed(state.iterations() * static_cast<int64_t>(colors.size() / 3));
    cmsCIECAM02Done(model);
}

BENCHMARK(PigmoNode);
BENCHMARK(PigmoTranslator);
BENCHMARK(LittleCms);

// Keeps each run's time per color so the ratios can be printed after the table.
class RatioReporter : public benchmark::ConsoleReporter {
public:
    void ReportRuns(const std::vector<Run>& runs) override {
        for (const Run& run : runs) {
            const auto items = run.counters.find("items_per_second");
            if (items != run.counters.end() && items->second.value > 0)
                nanosPerColor_[run.benchmark_name()] = 1e9 / items->second.value;
        }
        ConsoleReporter::ReportRuns(runs);
    }
    void PrintRatios() const {
        const auto lcms = nanosPerColor_.find("LittleCms");
        if (lcms == nanosPerColor_.end()) return;
        for (const auto& [name, nanos] : nanosPerColor_) {
            if (name != lcms->first)
                std::printf("%s / LittleCms: %.2f (%.1f ns vs %.1f ns per color)\n", name.c_str(),
                            nanos / lcms->second, nanos, lcms->second);
        }
    }

private:
    std::map<std::string, double> nanosPerColor_;
};

}  // namespace

int main(int argc, char** argv) {
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    RatioReporter reporter;
    benchmark::RunSpecifiedBenchmarks(&reporter);
    reporter.PrintRatios();
    benchmark::Shutdown();
    return 0;
}
