#pragma once

#include <string>
#include <vector>

#include "IColorInformation.h"

namespace Pigmo {

// One color of a color book. It fills in what the book leaves out: CIELAB from a 36-band curve
// (380 to 730 nm by 10 nm) or else from the book's sRGB, linear RGB from the book's sRGB or else
// from the curve; sRGB always follows from CIELAB. What cannot be derived is 0.
class ColorInformation final : public IColorInformation {
public:
    // lab and rgb are null when the book gives none; rgb is gamma-encoded sRGB on 0 to 255.
    // reflectance holds reflectanceCount values, or is null (then no curve is kept).
    ColorInformation(const char* name, const char* category, const float* lab, const float* rgb,
                     const float* reflectance, int reflectanceCount, const std::vector<std::string>* tags);

    const char* GetName() const override { return name_.c_str(); }
    const char* GetCategory() const override { return category_.c_str(); }
    const float* GetSRGB() const override { return sRGB_; }
    const float* GetLinearRGB() const override { return linearRGB_; }
    const float* GetLab() const override { return lab_; }
    const float* GetSpectralReflectance() const override;
    int GetSpectralReflectanceCount() const override { return static_cast<int>(reflectance_.size()); }
    const char* GetTag(unsigned int index) const override;
    int GetTagCount() const override { return static_cast<int>(tags_.size()); }

    // Band count of the curves the conversions understand.
    static constexpr int kBandCount = 36;

private:
    float sRGB_[3] = {0, 0, 0};
    float linearRGB_[3] = {0, 0, 0};
    float lab_[3] = {0, 0, 0};
    std::vector<float> reflectance_;
    std::string name_;
    std::string category_;
    std::vector<std::string> tags_;
};

// The "#RRGGBB" code of an sRGB color on the 0 to 255 scale: each channel clamped to that range and
// truncated (within a hundredth, the error of a round trip through CIELAB), red first. Every place that
// shows such a code uses this one.
std::string HtmlColorCode(double red, double green, double blue);

}  // namespace Pigmo
