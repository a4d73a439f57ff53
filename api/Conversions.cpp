#include <cstdio>

#include "ColorSpaceSRGB.h"
#include "ColorTranslator.h"
#include "pigmo/bp.h"

namespace {

// What one conversion function translates between; built once and cloned into every engine.
struct EngineSetup {
    ColorSpaceStruct source;
    ColorSpaceStruct destination;
    int32_t adaptationMethod = 0;
};

ColorSpaceStruct Described(int32_t code) {
    ColorSpaceStruct description;
    description.SetType(code);
    return description;
}

template <int32_t SourceCode, int32_t DestinationCode>
EngineSetup Plain() {
    return {Described(SourceCode), Described(DestinationCode)};
}

EngineSetup SpectralToLabD50() {
    ColorSpaceStruct lab = Described(3);
    lab.illuminant.SetIlluminant(1, 5003.0);
    lab.hasIlluminant = true;
    return {ColorSpaceStruct::BookSpectrum(1, 5003.0), lab};
}

// Linear sRGB on 0..1 at the white the sRGB node itself reaches.
ColorSpaceStruct LinearSRGBAtSRGBWhite() {
    ColorSpaceStruct linear = Described(25);
    cColorSpaceSRGB::White(linear.whitePoint);
    for (int32_t channel = 0; channel < 3; ++channel) linear.SetMaximum(channel, 1.0);
    return linear;
}

EngineSetup SpectralToLinearSRGB() {
    return {ColorSpaceStruct::BookSpectrum(2, 6500.0), LinearSRGBAtSRGBWhite(), 1};
}

// Engines keep scratch buffers, so each thread translates on its own engine, built on its first call.
class ThreadEngine {
public:
    explicit ThreadEngine(const EngineSetup& setup) {
        translator_.SetAdaptation(setup.adaptationMethod);
        translator_.SetSource(setup.source);
        translator_.SetDestination(setup.destination);
    }

    int Translate(const double* in, double* out) {
        int32_t status = 1;
        if (in != nullptr && out != nullptr) {
            status = translator_.Translate(in, out);
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
int Convert(const double* in, double* out) noexcept {
    try {
        static const EngineSetup setup = MakeSetup();
        thread_local ThreadEngine engine(setup);
        return engine.Translate(in, out);
    } catch (...) {
        // Only building the engine allocates; without memory the call fails and the next one retries.
        std::printf("translate status: %d\n", 1);
        return 0;
    }
}

}  // namespace

extern "C" {

int BPConvert36BandSpectral2LabD502(const double* in, double* out) {
    return Convert<SpectralToLabD50>(in, out);
}
int BPConvert36BandSpectral2LinearsRGB(const double* in, double* out) {
    return Convert<SpectralToLinearSRGB>(in, out);
}
int BPConvertsRGB2Lab(const double* in, double* out) {
    return Convert<Plain<24, 3>>(in, out);
}
int BPConvertLab2sRGB(const double* in, double* out) {
    return Convert<Plain<3, 24>>(in, out);
}
int BPConvertsLinearRGB2Lab(const double* in, double* out) {
    return Convert<Plain<25, 3>>(in, out);
}
int BPConvertLab2LinearsRGB(const double* in, double* out) {
    return Convert<Plain<3, 25>>(in, out);
}
int BPConvertLCh2Lab(const double* in, double* out) {
    return Convert<Plain<4, 3>>(in, out);
}
int BPConvertLab2LCh(const double* in, double* out) {
    return Convert<Plain<3, 4>>(in, out);
}

}  // extern "C"
