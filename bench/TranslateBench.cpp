// cColorTranslator::Translate against Little CMS double-precision transforms, one color per call
// and in batches, with a summary of the time ratios at the end.
#include <benchmark/benchmark.h>
#include <lcms2.h>

#include <functional>
#include <memory>
#include <random>
#include <string>
#include <vector>

#include "ColorTranslator.h"
#include "RatioReporter.h"

namespace {

constexpr size_t kBatch = 1'000'000;
constexpr size_t kCycle = 4096;  // per-color runs step through this many distinct colors

constexpr int32_t kLab = 3;
constexpr int32_t kLch = 4;
constexpr int32_t kSRGB = 24;

struct Inputs {
    std::vector<double> lab;      // L 0..100, a and b -100..100
    std::vector<double> rgb255;   // sRGB on the 0..255 scale of the engine
    std::vector<double> rgbUnit;  // the same colors on the 0..1 scale of TYPE_RGB_DBL
    std::vector<cmsCIELab> labLcms;
};

const Inputs& GetInputs() {
    static const Inputs inputs = [] {
        Inputs in;
        std::mt19937 random(20260412);
        std::uniform_real_distribution<double> lightness(0.0, 100.0), opponent(-100.0, 100.0),
            channel(0.0, 255.0);
        for (size_t i = 0; i < kBatch; ++i) {
            const double L = lightness(random), a = opponent(random), b = opponent(random);
            in.lab.insert(in.lab.end(), {L, a, b});
            in.labLcms.push_back({L, a, b});
            for (int c = 0; c < 3; ++c) {
                const double v = channel(random);
                in.rgb255.push_back(v);
                in.rgbUnit.push_back(v / 255.0);
            }
        }
        return in;
    }();
    return inputs;
}

std::unique_ptr<cColorTranslator> MakeTranslator(int32_t from, int32_t to) {
    ColorSpaceStruct source, destination;
    source.SetType(from);
    destination.SetType(to);
    auto translator = std::make_unique<cColorTranslator>();
    translator->SetSource(source);
    translator->SetDestination(destination);
    return translator;
}

struct LcmsTransform {
    cmsHTRANSFORM handle;
    explicit LcmsTransform(bool labToRgb) {
        cmsHPROFILE lab = cmsCreateLab4Profile(nullptr);  // D50
        cmsHPROFILE rgb = cmsCreate_sRGBProfile();
        handle =
            labToRgb
                ? cmsCreateTransform(lab, TYPE_Lab_DBL, rgb, TYPE_RGB_DBL, INTENT_RELATIVE_COLORIMETRIC, 0)
                : cmsCreateTransform(rgb, TYPE_RGB_DBL, lab, TYPE_Lab_DBL, INTENT_RELATIVE_COLORIMETRIC, 0);
        cmsCloseProfile(lab);
        cmsCloseProfile(rgb);
    }
    ~LcmsTransform() { cmsDeleteTransform(handle); }
    LcmsTransform(const LcmsTransform&) = delete;
    LcmsTransform& operator=(const LcmsTransform&) = delete;
};

void PigmoPerColor(benchmark::State& state, int32_t from, int32_t to, const std::vector<double>& in) {
    const auto translator = MakeTranslator(from, to);
    double out[3];
    size_t i = 0;
    for (auto _ : state) {
        translator->Translate(&in[3 * i], out);
        benchmark::DoNotOptimize(out);
        i = (i + 1) % kCycle;
    }
    state.SetItemsProcessed(state.iterations());
}

void PigmoBatch(benchmark::State& state, int32_t from, int32_t to, const std::vector<double>& in) {
    const auto translator = MakeTranslator(from, to);
    std::vector<double> out(3 * kBatch);
    for (auto _ : state) {
        for (size_t i = 0; i < kBatch; ++i) translator->Translate(&in[3 * i], &out[3 * i]);
        benchmark::DoNotOptimize(out.data());
        benchmark::ClobberMemory();
    }
    state.SetItemsProcessed(state.iterations() * kBatch);
}

void LcmsPerColor(benchmark::State& state, bool labToRgb, const std::vector<double>& in) {
    const LcmsTransform transform(labToRgb);
    double out[3];
    size_t i = 0;
    for (auto _ : state) {
        cmsDoTransform(transform.handle, &in[3 * i], out, 1);
        benchmark::DoNotOptimize(out);
        i = (i + 1) % kCycle;
    }
    state.SetItemsProcessed(state.iterations());
}

void LcmsBatch(benchmark::State& state, bool labToRgb, const std::vector<double>& in) {
    const LcmsTransform transform(labToRgb);
    std::vector<double> out(3 * kBatch);
    for (auto _ : state) {
        cmsDoTransform(transform.handle, in.data(), out.data(), kBatch);
        benchmark::DoNotOptimize(out.data());
        benchmark::ClobberMemory();
    }
    state.SetItemsProcessed(state.iterations() * kBatch);
}

// Little CMS has no LCh pixel type; its Lab to LCh conversion is this function.
void LcmsLchPerColor(benchmark::State& state) {
    const std::vector<cmsCIELab>& in = GetInputs().labLcms;
    cmsCIELCh out;
    size_t i = 0;
    for (auto _ : state) {
        cmsLab2LCh(&out, &in[i]);
        benchmark::DoNotOptimize(out);
        i = (i + 1) % kCycle;
    }
    state.SetItemsProcessed(state.iterations());
}

void LcmsLchBatch(benchmark::State& state) {
    const std::vector<cmsCIELab>& in = GetInputs().labLcms;
    std::vector<cmsCIELCh> out(kBatch);
    for (auto _ : state) {
        for (size_t i = 0; i < kBatch; ++i) cmsLab2LCh(&out[i], &in[i]);
        benchmark::DoNotOptimize(out.data());
        benchmark::ClobberMemory();
    }
    state.SetItemsProcessed(state.iterations() * kBatch);
}

const char* const kConversions[] = {"LabToSRGB", "SRGBToLab", "LabToLCh"};

void RegisterAll() {
    const Inputs& in = GetInputs();
    using benchmark::RegisterBenchmark;
    RegisterBenchmark("LabToSRGB/pigmo/color", PigmoPerColor, kLab, kSRGB, std::cref(in.lab));
    RegisterBenchmark("LabToSRGB/lcms/color", LcmsPerColor, true, std::cref(in.lab));
    RegisterBenchmark("SRGBToLab/pigmo/color", PigmoPerColor, kSRGB, kLab, std::cref(in.rgb255));
    RegisterBenchmark("SRGBToLab/lcms/color", LcmsPerColor, false, std::cref(in.rgbUnit));
    RegisterBenchmark("LabToLCh/pigmo/color", PigmoPerColor, kLab, kLch, std::cref(in.lab));
    RegisterBenchmark("LabToLCh/lcms/color", LcmsLchPerColor);
    RegisterBenchmark("LabToSRGB/pigmo/batch", PigmoBatch, kLab, kSRGB, std::cref(in.lab))
        ->Unit(benchmark::kMillisecond);
    RegisterBenchmark("LabToSRGB/lcms/batch", LcmsBatch, true, std::cref(in.lab))
        ->Unit(benchmark::kMillisecond);
    RegisterBenchmark("SRGBToLab/pigmo/batch", PigmoBatch, kSRGB, kLab, std::cref(in.rgb255))
        ->Unit(benchmark::kMillisecond);
    RegisterBenchmark("SRGBToLab/lcms/batch", LcmsBatch, false, std::cref(in.rgbUnit))
        ->Unit(benchmark::kMillisecond);
    RegisterBenchmark("LabToLCh/pigmo/batch", PigmoBatch, kLab, kLch, std::cref(in.lab))
        ->Unit(benchmark::kMillisecond);
    RegisterBenchmark("LabToLCh/lcms/batch", LcmsLchBatch)->Unit(benchmark::kMillisecond);
}

std::vector<Pigmo::Bench::RatioPair> Pairs() {
    std::vector<Pigmo::Bench::RatioPair> pairs;
    for (const std::string conversion : kConversions) {
        for (const std::string mode : {"color", "batch"})
            pairs.push_back(
                {conversion + " " + mode, conversion + "/pigmo/" + mode, conversion + "/lcms/" + mode});
    }
    return pairs;
}

}  // namespace

int main(int argc, char** argv) {
    RegisterAll();
    return Pigmo::Bench::RunBenchmarks(argc, argv, Pairs());
}
