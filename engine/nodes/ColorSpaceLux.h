#pragma once

#include "ColorSpace.h"

// Illuminance: the luminance Y alone.
class PIGMO_API cColorSpaceLux : public cColorSpace {
public:
    void ToXYZ(const double* in, double* out) override;
    void FromXYZ(const double* in, double* out) override;
};
