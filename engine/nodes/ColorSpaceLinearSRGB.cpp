#include "ColorSpaceLinearSRGB.h"

#include "ColorSpaceSRGB.h"

void cColorSpaceLinearSRGB::ToXYZ(const double* in, double* out) {
    const double linear[3] = {in[0] / 255.0, in[1] / 255.0, in[2] / 255.0};
    cColorSpaceSRGB::LinearToXYZ(linear, out);
}

void cColorSpaceLinearSRGB::FromXYZ(const double* in, double* out) {
    cColorSpaceSRGB::XYZToLinear(in, out);
}
