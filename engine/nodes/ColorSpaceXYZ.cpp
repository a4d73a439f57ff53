#include "ColorSpaceXYZ.h"

void cColorSpaceXYZ::ToXYZ(const double* in, double* out) {
    out[0] = in[0];
    out[1] = in[1];
    out[2] = in[2];
}

void cColorSpaceXYZ::FromXYZ(const double* in, double* out) {
    ToXYZ(in, out);
}
