// The exported conversions and CIEDE2000, each beside Little CMS doing the same work.
#include <benchmark/benchmark.h>
#include <lcms2.h>

#include <random>
#include <vector>

#include "RatioReporter.h"
#include "pigmo/bp.h"

namespace {

constexpr size_t kPairCount = 1000000;
constexpr size_t kColorCount = 4096;  // a power of two, cycled through by mask

struct Inputs {
    std::vector<cmsCIELab> pairs;  // reference, sample, reference, sample, ...
    std::vector<double> lab;       // kColorCount triples
    std::vector<double> rgb;       // kColorCount triples, 0..255
    std::vector<double> spectra;   // kColorCount curves of 36 bands
};

const Inputs& TheInputs() {
    static const Inputs inputs = [] {
        Inputs in;
        std::mt19937_64 random(20050101);
        std::uniform_real_distribution<double> lightness(0, 100), opponent(-110, 110), channel(0, 255),
            reflectance(0, 1), near(-3, 3);
        in.pairs.reserve(2 * kPairCount);
        for (size_t i = 0; i < kPairCount; ++i) {
            const cmsCIELab a{lightness(random), opponent(random), opponent(random)};
            // Half the samples near their reference, as in color matching; half anywhere.
            const cmsCIELab b = i % 2 ? cmsCIELab{a.L + near(random), a.a + near(random), a.b + near(random)}
                                      : cmsCIELab{lightness(random), opponent(random), opponent(random)};
            in.pairs.push_back(a);
            in.pairs.push_back(b);
        }
        for (size_t i = 0; i < kColorCount; ++i) {
            in.lab.insert(in.lab.end(), {lightness(random), opponent(random) * 0.6, opponent(random) * 0.6});
            in.rgb.insert(in.rgb.end(), {channel(random), channel(random), channel(random)});
            for (int band = 0; band < 36; ++band) in.spectra.push_back(reflectance(random));
        }
        return in;
    }();
    return inputs;
}

void PigmoDeltaE2000(benchmark::State& state) {
    const std::vector<cmsCIELab>& pairs = TheInputs().pairs;
    size_t i = 0;
    for (auto _ : state) {
        // cmsCIELab is three doubles L, a, b in order, so both libraries read the same memory.
        benchmark::DoNotOptimize(BPCalculateDeltaE2000(&pairs[2 * i].L, &pairs[2 * i + 1].L, 1, 1, 1));
        if (++i == kPairCount) i = 0;
    }
    state.SetItemsProcessed(state.iterations());
}

void LittleCmsDeltaE2000(benchmark::State& state) {
    const std::vector<cmsCIELab>& pairs = TheInputs().pairs;
    size_t i = 0;
    for (auto _ : state) {
        benchmark::DoNotOptimize(cmsCIE2000DeltaE(&pairs[2 * i], &pairs[2 * i + 1], 1, 1, 1));
        if (++i == kPairCount) i = 0;
    }
    state.SetItemsProcessed(state.iterations());
}

template <int (*Convert)(const double*, double*), const std::vector<double> Inputs::*Source, size_t Width>
void PigmoConversion(benchmark::State& state) {
    const std::vector<double>& source = TheInputs().*Source;
    double out[3];
    size_t i = 0;
    for (auto _ : state) {
        benchmark::DoNotOptimize(Convert(&source[i * Width], out));
        i = (i + 1) & (kColorCount - 1);
    }
    state.SetItemsProcessed(state.iterations());
}

// The whole input array in one call.
template <int (*Convert)(const double*, double*, size_t), const std::vector<double> Inputs::*Source>
void PigmoArray(benchmark::State& state) {
    const std::vector<double>& source = TheInputs().*Source;
    std::vector<double> out(3 * kColorCount);
    for (auto _ : state) {
        benchmark::DoNotOptimize(Convert(source.data(), out.data(), kColorCount));
        benchmark::ClobberMemory();
    }
    state.SetItemsProcessed(state.iterations() * kColorCount);
}

// Little CMS transform between the D50 Lab profile and built-in sRGB, one color per call or the
// whole array in one.
template <bool FromLab, size_t PerCall>
void LittleCmsConversion(benchmark::State& state) {
    cmsHPROFILE lab = cmsCreateLab4Profile(cmsD50_xyY());
    cmsHPROFILE srgb = cmsCreate_sRGBProfile();
    cmsHTRANSFORM transform =
        FromLab ? cmsCreateTransform(lab, TYPE_Lab_DBL, srgb, TYPE_RGB_DBL, INTENT_RELATIVE_COLORIMETRIC, 0)
                : cmsCreateTransform(srgb, TYPE_RGB_DBL, lab, TYPE_Lab_DBL, INTENT_RELATIVE_COLORIMETRIC, 0);
    std::vector<double> source = FromLab ? TheInputs().lab : TheInputs().rgb;
    if (!FromLab) {
        for (double& v : source) v /= 255.0;  // Little CMS takes RGB doubles on 0..1
    }
    std::vector<double> out(3 * PerCall);
    size_t i = 0;
    for (auto _ : state) {
        cmsDoTransform(transform, &source[i * 3], out.data(), PerCall);
        benchmark::DoNotOptimize(out.data());
        benchmark::ClobberMemory();
        i = (i + PerCall) & (kColorCount - 1);
    }
    state.SetItemsProcessed(state.iterations() * PerCall);
    cmsDeleteTransform(transform);
    cmsCloseProfile(srgb);
    cmsCloseProfile(lab);
}

BENCHMARK(PigmoDeltaE2000);
BENCHMARK(LittleCmsDeltaE2000);
BENCHMARK(PigmoConversion<BPConvertLab2sRGB, &Inputs::lab, 3>)->Name("PigmoLab2sRGB");
BENCHMARK(LittleCmsConversion<true, 1>)->Name("LittleCmsLab2sRGB");
BENCHMARK(PigmoConversion<BPConvertsRGB2Lab, &Inputs::rgb, 3>)->Name("PigmosRGB2Lab");
BENCHMARK(LittleCmsConversion<false, 1>)->Name("LittleCmssRGB2Lab");
BENCHMARK(PigmoArray<BPConvertLab2sRGBArray, &Inputs::lab>)->Name("PigmoLab2sRGBArray");
BENCHMARK(LittleCmsConversion<true, kColorCount>)->Name("LittleCmsLab2sRGBArray");
BENCHMARK(PigmoArray<BPConvertsRGB2LabArray, &Inputs::rgb>)->Name("PigmosRGB2LabArray");
BENCHMARK(LittleCmsConversion<false, kColorCount>)->Name("LittleCmssRGB2LabArray");
BENCHMARK(PigmoConversion<BPConvert36BandSpectral2LabD502, &Inputs::spectra, 36>)
    ->Name("PigmoSpectral2LabD50");

}  // namespace

int main(int argc, char** argv) {
    return Pigmo::Bench::RunBenchmarks(argc, argv,
                                       {{"DeltaE2000", "PigmoDeltaE2000", "LittleCmsDeltaE2000"},
                                        {"Lab2sRGB", "PigmoLab2sRGB", "LittleCmsLab2sRGB"},
                                        {"sRGB2Lab", "PigmosRGB2Lab", "LittleCmssRGB2Lab"},
                                        {"Lab2sRGB array", "PigmoLab2sRGBArray", "LittleCmsLab2sRGBArray"},
                                        {"sRGB2Lab array", "PigmosRGB2LabArray", "LittleCmssRGB2LabArray"}});
}
