#include "ColorInformation.h"

#include <pigmo/bp.h>

#include <algorithm>
#include <cmath>
#include <cstdio>

#include "ColorSpaceSRGB.h"

namespace Pigmo {

namespace {

// Stores a conversion's result; what overflows a float cannot be shown or rendered, so it is 0.
void Store(const double* in, float* out) {
    for (int i = 0; i < 3; ++i) {
        out[i] = static_cast<float>(in[i]);
        if (!std::isfinite(out[i])) out[i] = 0.0f;
    }
}

}  // namespace

ColorInformation::ColorInformation(const char* name, const char* category, const float* lab, const float* rgb,
                                   const float* reflectance, int reflectanceCount,
                                   const std::vector<std::string>* tags)
    : name_(name != nullptr ? name : ""), category_(category != nullptr ? category : "") {
    // A count without values is no curve: nothing can be derived from it.
    const bool bands = reflectance != nullptr && reflectanceCount == kBandCount;
    double curve[kBandCount];
    if (bands)
        for (int i = 0; i < kBandCount; ++i) curve[i] = reflectance[i];

    double in[3];
    double out[3] = {0, 0, 0};
    if (lab != nullptr) {
        for (int i = 0; i < 3; ++i) lab_[i] = lab[i];
    } else if (bands) {
        BPConvert36BandSpectral2LabD502(curve, out);
        Store(out, lab_);
    } else if (rgb != nullptr) {
        // Without it a book's sRGB-only color would show black in every field but the swatch.
        for (int i = 0; i < 3; ++i) in[i] = rgb[i];
        BPConvertsRGB2Lab(in, out);
        Store(out, lab_);
    }

    for (int i = 0; i < 3; ++i) in[i] = lab_[i];
    out[0] = out[1] = out[2] = 0;
    BPConvertLab2sRGB(in, out);
    Store(out, sRGB_);

    if (rgb != nullptr) {
        // Book sRGB is encoded on 0..255; the map renders linear values on 0..1.
        for (int i = 0; i < 3; ++i) in[i] = cColorSpaceSRGB::DecodeSRGB(rgb[i] / 255.0);
        Store(in, linearRGB_);
    } else if (bands) {
        // The conversion answers on a 1/255 scale.
        out[0] = out[1] = out[2] = 0;
        BPConvert36BandSpectral2LinearsRGB(curve, out);
        for (double& v : out) v *= 255.0;
        Store(out, linearRGB_);
    }

    if (reflectance != nullptr && reflectanceCount > 0)
        reflectance_.assign(reflectance, reflectance + reflectanceCount);
    if (tags != nullptr) tags_ = *tags;
}

const float* ColorInformation::GetSpectralReflectance() const {
    return reflectance_.empty() ? nullptr : reflectance_.data();
}

std::string HtmlColorCode(double red, double green, double blue) {
    // Truncated; the hundredth allowed keeps 39.9958 from a round trip through CIELAB at 40.
    const auto channel = [](double v) {
        return static_cast<unsigned>(std::isnan(v) ? 0.0 : std::clamp(v + 0.01, 0.0, 255.0));
    };
    char code[8];
    std::snprintf(code, sizeof code, "#%02X%02X%02X", channel(red), channel(green), channel(blue));
    return code;
}

const char* ColorInformation::GetTag(unsigned int index) const {
    return index < tags_.size() ? tags_[index].c_str() : nullptr;
}

}  // namespace Pigmo
