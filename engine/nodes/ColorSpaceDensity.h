#pragma once

#include <cstdint>
#include <vector>

#include "ColorSpace.h"
#include "ColorSpaceStruct.h"

// Reflectance spectrum to red, green, blue and visual density: each a weighted sum of band
// densities, the weighting functions carried to the source's band grid.
class PIGMO_API cColorSpaceDensity : public cColorSpace {
public:
    static constexpr int32_t kChannels = 4;

    cColorSpaceDensity(const ColorSpaceStruct& destination, const ColorSpaceStruct& source);

    void ToXYZ(const double* in, double* out) override;    // no colorimetry: leaves out untouched
    void FromXYZ(const double* in, double* out) override;  // no colorimetry: leaves out untouched
    void Convert(const double* in, double* out) override;

private:
    std::vector<double> weights_[kChannels];
    std::vector<double> reference_;
    int32_t bandCount_ = 0;
};
