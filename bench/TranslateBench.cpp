// cColorTranslator against Little CMS double-precision transforms doing the same conversion, one
// color per call and over whole arrays, with a summary of the time ratios at the end.
#include <benchmark/benchmark.h>
#include <lcms2.h>

#include <memory>
#include <random>
#include <string>
#include <vector>

#include "ColorSpaceTable.h"
#include "ColorTranslator.h"
#include "RatioReporter.h"

namespace {

using enum ColorSpaceCode;

constexpr size_t kBatch = 1'000'000;
constexpr size_t kCycle = 4096;  // per-color runs step through this many distinct colors

// Colors of each space, valid for both libraries' scales: Lab, LCh and XYZ as they are; RGB on the
// engine's 0..255 and on Little CMS's 0..1.
std::vector<double> Colors(ColorSpaceCode code, bool lcmsScale) {
    std::mt19937 random(20260412);
    std::uniform_real_distribution<double> unit(0.0, 1.0), opponent(-100.0, 100.0);
    std::vector<double> colors;
    colors.reserve(3 * kBatch);
    for (size_t i = 0; i < kBatch; ++i) {
        for (int c = 0; c < 3; ++c) {
            const double u = unit(random);
            switch (code) {
                case Lab:
                    colors.push_back(c == 0 ? 100.0 * u : opponent(random));
                    break;
                case Lch:
                    colors.push_back(c == 0 ? 100.0 * u : c == 1 ? 130.0 * u : 360.0 * u);
                    break;
                case XYZ:
                    colors.push_back(0.95 * u);
                    break;
                default:
                    colors.push_back(lcmsScale ? u : 255.0 * u);
                    break;
            }
        }
    }
    return colors;
}

std::unique_ptr<cColorTranslator> MakeTranslator(ColorSpaceCode from, ColorSpaceCode to) {
    auto translator = std::make_unique<cColorTranslator>();
    translator->SetSource(cColorSpaceTable::DefaultDescription(from));
    translator->SetDestination(cColorSpaceTable::DefaultDescription(to));
    return translator;
}

// The Little CMS profile and pixel type of a space.
std::pair<cmsHPROFILE, cmsUInt32Number> LcmsSpace(ColorSpaceCode code) {
    switch (code) {
        case Lab:
            return {cmsCreateLab4Profile(nullptr), TYPE_Lab_DBL};
        case XYZ:
            return {cmsCreateXYZProfile(), TYPE_XYZ_DBL};
        case LinearSRGB: {
            const cmsCIExyY d65{0.3127, 0.3290, 1.0};
            const cmsCIExyYTRIPLE primaries{{0.64, 0.33, 1.0}, {0.30, 0.60, 1.0}, {0.15, 0.06, 1.0}};
            cmsToneCurve* linear = cmsBuildGamma(nullptr, 1.0);
            cmsToneCurve* curves[3] = {linear, linear, linear};
            cmsHPROFILE profile = cmsCreateRGBProfile(&d65, &primaries, curves);
            cmsFreeToneCurve(linear);
            return {profile, TYPE_RGB_DBL};
        }
        default:
            return {cmsCreate_sRGBProfile(), TYPE_RGB_DBL};
    }
}

class LcmsTransform {
public:
    LcmsTransform(ColorSpaceCode from, ColorSpaceCode to) {
        const auto [source, sourceType] = LcmsSpace(from);
        const auto [destination, destinationType] = LcmsSpace(to);
        handle_ = cmsCreateTransform(source, sourceType, destination, destinationType,
                                     INTENT_RELATIVE_COLORIMETRIC, 0);
        cmsCloseProfile(source);
        cmsCloseProfile(destination);
    }
    ~LcmsTransform() { cmsDeleteTransform(handle_); }
    LcmsTransform(const LcmsTransform&) = delete;
    LcmsTransform& operator=(const LcmsTransform&) = delete;

    void Run(const double* in, double* out, size_t count) const {
        cmsDoTransform(handle_, in, out, static_cast<cmsUInt32Number>(count));
    }

private:
    cmsHTRANSFORM handle_;
};

// Little CMS has no LCh pixel type; its conversions to and from LCh are these functions.
void LcmsPolar(ColorSpaceCode from, const double* in, double* out, size_t count) {
    for (size_t i = 0; i < count; ++i, in += 3, out += 3) {
        if (from == Lab) {
            cmsLab2LCh(reinterpret_cast<cmsCIELCh*>(out), reinterpret_cast<const cmsCIELab*>(in));
        } else {
            cmsLCh2Lab(reinterpret_cast<cmsCIELab*>(out), reinterpret_cast<const cmsCIELCh*>(in));
        }
    }
}

void Pigmo(benchmark::State& state, ColorSpaceCode from, ColorSpaceCode to, bool batch) {
    const std::vector<double> in = Colors(from, false);
    const auto translator = MakeTranslator(from, to);
    std::vector<double> out(3 * kBatch);
    size_t i = 0;
    for (auto _ : state) {
        if (batch) {
            translator->TranslateArray(in.data(), out.data(), kBatch);
        } else {
            translator->Translate(&in[3 * i], out.data());
            i = (i + 1) % kCycle;
        }
        benchmark::DoNotOptimize(out.data());
        benchmark::ClobberMemory();
    }
    state.SetItemsProcessed(state.iterations() * (batch ? kBatch : 1));
}

void LittleCms(benchmark::State& state, ColorSpaceCode from, ColorSpaceCode to, bool batch) {
    const std::vector<double> in = Colors(from, true);
    const bool polar = from == Lch || to == Lch;
    std::unique_ptr<LcmsTransform> transform = polar ? nullptr : std::make_unique<LcmsTransform>(from, to);
    std::vector<double> out(3 * kBatch);
    size_t i = 0;
    for (auto _ : state) {
        const double* source = batch ? in.data() : &in[3 * i];
        const size_t count = batch ? kBatch : 1;
        if (polar) {
            LcmsPolar(from, source, out.data(), count);
        } else {
            transform->Run(source, out.data(), count);
        }
        i = (i + 1) % kCycle;
        benchmark::DoNotOptimize(out.data());
        benchmark::ClobberMemory();
    }
    state.SetItemsProcessed(state.iterations() * (batch ? kBatch : 1));
}

std::vector<Pigmo::Bench::RatioPair> RegisterAll() {
    const std::pair<ColorSpaceCode, ColorSpaceCode> conversions[] = {
        {Lab, SRGB}, {SRGB, Lab}, {Lab, LinearSRGB}, {LinearSRGB, Lab},
        {Lab, XYZ},  {XYZ, Lab},  {Lab, Lch},        {Lch, Lab},
    };
    std::vector<Pigmo::Bench::RatioPair> pairs;
    for (const auto& [from, to] : conversions) {
        const std::string name = std::string(cColorSpaceTable::Find(CodeValue(from))->name) + "->" +
                                 cColorSpaceTable::Find(CodeValue(to))->name;
        for (const bool batch : {false, true}) {
            const std::string mode = batch ? "array" : "color";
            const std::string pigmo = name + "/pigmo/" + mode, lcms = name + "/lcms/" + mode;
            auto* p = benchmark::RegisterBenchmark(pigmo.c_str(), Pigmo, from, to, batch);
            auto* l = benchmark::RegisterBenchmark(lcms.c_str(), LittleCms, from, to, batch);
            if (batch) {
                p->Unit(benchmark::kMillisecond);
                l->Unit(benchmark::kMillisecond);
            }
            pairs.push_back({name + " " + mode, pigmo, lcms});
        }
    }
    return pairs;
}

}  // namespace

int main(int argc, char** argv) {
    const std::vector<Pigmo::Bench::RatioPair> pairs = RegisterAll();
    return Pigmo::Bench::RunBenchmarks(argc, argv, pairs);
}
