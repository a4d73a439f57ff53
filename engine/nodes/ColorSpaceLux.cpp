#include "ColorSpaceLux.h"

void cColorSpaceLux::ToXYZ(const double* in, double* out) {
    out[0] = out[1] = out[2] = in[0];
}

void cColorSpaceLux::FromXYZ(const double* in, double* out) {
    out[0] = in[1];
}
