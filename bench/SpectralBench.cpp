// Spectrum to CIELAB per color through the engine, for each weighting method, and the cost of
// building the spectral node per integration mode. Little CMS has no spectral path; it stands in
// for the Lab step after the node's own XYZ, and the ratio of the two Lab steps is printed.
#include <benchmark/benchmark.h>
#include <lcms2.h>

#include <algorithm>
#include <cmath>
#include <random>
#include <vector>

#include "ColorSpaceSpectral.h"
#include "ColorSpaceTable.h"
#include "ColorTranslator.h"
#include "RatioReporter.h"

namespace {

constexpr int kBands = 36;
constexpr size_t kColors = 4096;

ColorSpaceStruct Books(WeightingMethod weighting) {
    ColorSpaceStruct d = cColorSpaceTable::DefaultDescription(ColorSpaceCode::Spectral);
    d.weighting = static_cast<int32_t>(weighting);
    return d;
}

ColorSpaceStruct LabOf(const ColorSpaceStruct& spectral) {
    ColorSpaceStruct lab = cColorSpaceTable::DefaultDescription(ColorSpaceCode::Lab);
    lab.hasIlluminant = true;
    lab.illuminant = spectral.illuminant;
    return lab;
}

const std::vector<double>& Spectra() {
    static const std::vector<double> spectra = [] {
        std::mt19937 random(20261206);
        std::uniform_real_distribution<double> level(0.02, 0.95), phase(0.0, 6.28);
        std::vector<double> v;
        for (size_t i = 0; i < kColors; ++i) {
            const double base = level(random), p = phase(random);
            for (int b = 0; b < kBands; ++b)
                v.push_back(std::clamp(base + 0.3 * std::sin(0.2 * b + p), 0.0, 1.0));
        }
        return v;
    }();
    return spectra;
}

// Weighting 4 (Sprague, the books' method), 0 direct, 5 Lagrange, 2 fixed table, 1 one-nanometre.
void BM_SpectrumToLab(benchmark::State& state) {
    const ColorSpaceStruct source = Books(static_cast<WeightingMethod>(state.range(0)));
    cColorTranslator engine;
    engine.SetSource(source);
    engine.SetDestination(LabOf(source));
    const std::vector<double>& spectra = Spectra();
    double lab[3];
    size_t i = 0;
    for (auto _ : state) {
        engine.Translate(&spectra[i * kBands], lab);
        benchmark::DoNotOptimize(lab);
        i = (i + 1) % kColors;
    }
    state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_SpectrumToLab)->ArgName("weighting")->Arg(4)->Arg(0)->Arg(5)->Arg(2)->Arg(1);

// The same conversion with the Lab step done by Little CMS on the node's XYZ.
void BM_SpectrumToLabWithLcmsLab(benchmark::State& state) {
    const ColorSpaceStruct source = Books(WeightingMethod::Sprague);
    cColorSpaceSpectral node(source, source);
    const cmsCIEXYZ white = {source.illuminant.relativeWhite[0], 1.0, source.illuminant.relativeWhite[2]};
    const std::vector<double>& spectra = Spectra();
    double xyz[3];
    cmsCIELab lab;
    size_t i = 0;
    for (auto _ : state) {
        node.ToXYZ(&spectra[i * kBands], xyz);
        const cmsCIEXYZ in = {xyz[0], xyz[1], xyz[2]};
        cmsXYZ2Lab(&white, &lab, &in);
        benchmark::DoNotOptimize(lab);
        i = (i + 1) % kColors;
    }
    state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_SpectrumToLabWithLcmsLab);

// Node construction: weighting 0 direct, 1 one-nanometre, 4 Sprague, 5 Lagrange, 2 fixed table;
// observer 2 adds the physiological model.
void BM_NodeConstruction(benchmark::State& state) {
    ColorSpaceStruct source = Books(static_cast<WeightingMethod>(state.range(0)));
    source.observer = static_cast<int>(state.range(1));
    for (auto _ : state) {
        cColorSpaceSpectral node(source, source);
        benchmark::DoNotOptimize(&node);
    }
}
BENCHMARK(BM_NodeConstruction)
    ->ArgNames({"weighting", "observer"})
    ->Args({0, 0})
    ->Args({1, 0})
    ->Args({4, 0})
    ->Args({5, 0})
    ->Args({2, 0})
    ->Args({4, 2})
    ->Unit(benchmark::kMicrosecond);

// The CIE 2006 observer at a field size without a published matrix derives its own.
void BM_NodeConstructionDerivedObserver(benchmark::State& state) {
    ColorSpaceStruct source = Books(WeightingMethod::Sprague);
    source.observer = 2;
    source.fieldSize = 5.0;
    for (auto _ : state) {
        cColorSpaceSpectral node(source, source);
        benchmark::DoNotOptimize(&node);
    }
}
BENCHMARK(BM_NodeConstructionDerivedObserver)->Unit(benchmark::kMicrosecond);

}  // namespace

int main(int argc, char** argv) {
    return Pigmo::Bench::RunBenchmarks(
        argc, argv, {{"spectrum to Lab", "BM_SpectrumToLab/weighting:4", "BM_SpectrumToLabWithLcmsLab"}});
}
