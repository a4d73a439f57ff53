#include <cstddef>
#include <cstdio>

#include "ColorSpaceTable.h"
#include "ColorTranslator.h"
#include "pigmo/bp.h"

namespace {

using enum ColorSpaceCode;

// What one conversion function translates between; built once and cloned into every engine.
struct EngineSetup {
    ColorSpaceStruct source;
    ColorSpaceStruct destination;
    AdaptationMethod adaptation = AdaptationMethod::None;
};

// Both sides at the D50 white, as the color books give their CIELAB.
template <ColorSpaceCode Source, ColorSpaceCode Destination>
EngineSetup AtD50() {
    ColorSpaceStruct source, destination;
    source.SetType(Source);
    destination.SetType(Destination);
    return {source, destination};
}

EngineSetup SpectralToLabD50() {
    ColorSpaceStruct lab;
    lab.SetType(Lab);
    lab.illuminant.SetIlluminant(kBookIlluminantKind, kBookIlluminantTemperature);
    lab.hasIlluminant = true;
    return {cColorSpaceTable::DefaultDescription(Spectral), lab};
}

// Linear sRGB on 0..1 at the white the sRGB node itself reaches, from a 6500 K Planckian light.
EngineSetup SpectralToLinearSRGB() {
    ColorSpaceStruct linear = cColorSpaceTable::DefaultDescription(LinearSRGB);
    for (int32_t channel = 0; channel < 3; ++channel) linear.SetMaximum(channel, 1.0);
    return {ColorSpaceStruct::BookSpectrum(IlluminantKind::Planckian, 6500.0), linear,
            AdaptationMethod::XYZScaling};
}

// Engines keep scratch buffers, so each thread translates on its own engine, built on its first call.
class ThreadEngine {
public:
    explicit ThreadEngine(const EngineSetup& setup) {
        translator_.SetAdaptation(setup.adaptation);
        translator_.SetSource(setup.source);
        translator_.SetDestination(setup.destination);
    }

    int Translate(const double* in, double* out, size_t count) {
        int32_t status = 1;
        if (in != nullptr && out != nullptr) {
            status = translator_.TranslateArray(in, out, count);
            if (status == 0) return 1;
        }
        std::printf("translate status: %d\n", static_cast<int>(status));
        return 0;
    }

private:
    cColorTranslator translator_;
};

// One shared, immutable setup per function (thread-safe static initialisation), one engine per thread.
template <EngineSetup (*MakeSetup)()>
int Convert(const double* in, double* out, size_t count) noexcept {
    try {
        static const EngineSetup setup = MakeSetup();
        thread_local ThreadEngine engine(setup);
        return engine.Translate(in, out, count);
    } catch (...) {
        // Only building the engine allocates; without memory the call fails and the next one retries.
        std::printf("translate status: %d\n", 1);
        return 0;
    }
}

constexpr auto kSRGBToLab = &AtD50<SRGB, Lab>;
constexpr auto kLabToSRGB = &AtD50<Lab, SRGB>;
constexpr auto kLinearSRGBToLab = &AtD50<LinearSRGB, Lab>;
constexpr auto kLabToLinearSRGB = &AtD50<Lab, LinearSRGB>;
constexpr auto kLchToLab = &AtD50<Lch, Lab>;
constexpr auto kLabToLch = &AtD50<Lab, Lch>;

}  // namespace

extern "C" {

int BPConvert36BandSpectral2LabD502(const double* in, double* out) {
    return Convert<SpectralToLabD50>(in, out, 1);
}
int BPConvert36BandSpectral2LinearsRGB(const double* in, double* out) {
    return Convert<SpectralToLinearSRGB>(in, out, 1);
}
int BPConvertsRGB2Lab(const double* in, double* out) {
    return Convert<kSRGBToLab>(in, out, 1);
}
int BPConvertLab2sRGB(const double* in, double* out) {
    return Convert<kLabToSRGB>(in, out, 1);
}
int BPConvertsLinearRGB2Lab(const double* in, double* out) {
    return Convert<kLinearSRGBToLab>(in, out, 1);
}
int BPConvertLab2LinearsRGB(const double* in, double* out) {
    return Convert<kLabToLinearSRGB>(in, out, 1);
}
int BPConvertLCh2Lab(const double* in, double* out) {
    return Convert<kLchToLab>(in, out, 1);
}
int BPConvertLab2LCh(const double* in, double* out) {
    return Convert<kLabToLch>(in, out, 1);
}

int BPConvert36BandSpectral2LabD502Array(const double* in, double* out, size_t count) {
    return Convert<SpectralToLabD50>(in, out, count);
}
int BPConvert36BandSpectral2LinearsRGBArray(const double* in, double* out, size_t count) {
    return Convert<SpectralToLinearSRGB>(in, out, count);
}
int BPConvertsRGB2LabArray(const double* in, double* out, size_t count) {
    return Convert<kSRGBToLab>(in, out, count);
}
int BPConvertLab2sRGBArray(const double* in, double* out, size_t count) {
    return Convert<kLabToSRGB>(in, out, count);
}
int BPConvertsLinearRGB2LabArray(const double* in, double* out, size_t count) {
    return Convert<kLinearSRGBToLab>(in, out, count);
}
int BPConvertLab2LinearsRGBArray(const double* in, double* out, size_t count) {
    return Convert<kLabToLinearSRGB>(in, out, count);
}
int BPConvertLCh2LabArray(const double* in, double* out, size_t count) {
    return Convert<kLchToLab>(in, out, count);
}
int BPConvertLab2LChArray(const double* in, double* out, size_t count) {
    return Convert<kLabToLch>(in, out, count);
}

}  // extern "C"
