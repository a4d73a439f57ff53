#pragma once

#include "ColorSpace.h"
#include "ColorSpaceStruct.h"

// CIE Yxy: Y (white = 1) and the chromaticity x, y.
class PIGMO_API cColorSpaceYxy : public cColorSpace {
public:
    explicit cColorSpaceYxy(const ColorSpaceStruct& description);
    void ToXYZ(const double* in, double* out) override;
    void FromXYZ(const double* in, double* out) override;

private:
    double xw_;  // chromaticity of the white, given to black
    double yw_;
};
