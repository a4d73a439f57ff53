#include "ColorSpaceLinearRIMM.h"

// Both matrices are rounded to four decimals independently, so a round trip is exact to about 1e-4.
void cColorSpaceLinearRIMM::ToXYZ(const double* in, double* out) {
    const double r = in[0];
    const double g = in[1];
    const double b = in[2];
    out[0] = 0.7977 * r + 0.1352 * g + 0.0313 * b;
    out[1] = 0.288 * r + 0.7119 * g + 0.0001 * b;
    out[2] = 0.8249 * b;
}

void cColorSpaceLinearRIMM::FromXYZ(const double* in, double* out) {
    const double x = in[0];
    const double y = in[1];
    const double z = in[2];
    out[0] = 1.346 * x - 0.2556 * y - 0.0511 * z;
    out[1] = -0.5446 * x + 1.5082 * y + 0.0205 * z;
    out[2] = 1.2123 * z;
}
