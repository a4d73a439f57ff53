// XYZ to CIECAM02 JCh and back, per color, beside Little CMS doing the same work.
#include <benchmark/benchmark.h>
#include <lcms2.h>

#include <vector>

#include "ColorSpaceCIECAM02.h"
#include "ColorSpaceStruct.h"
#include "ColorSpaceTable.h"
#include "ColorTranslator.h"
#include "RatioReporter.h"

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
    d.SetType(ColorSpaceCode::CIECAM02_JCh);
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
    xyzSpace.SetType(ColorSpaceCode::XYZ);
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

}  // namespace

int main(int argc, char** argv) {
    return Pigmo::Bench::RunBenchmarks(
        argc, argv, {{"node", "PigmoNode", "LittleCms"}, {"translator", "PigmoTranslator", "LittleCms"}});
}
