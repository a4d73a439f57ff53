#pragma once

#include "ColorSpace.h"

// Linear sRGB: reads 0..255, writes 0..1 (the scale the renderer takes).
class PIGMO_API cColorSpaceLinearSRGB : public cColorSpace {
public:
    void ToXYZ(const double* in, double* out) override;
    void FromXYZ(const double* in, double* out) override;
};
