#include "ColorSpaceLchtoLab.h"

void cColorSpaceLchtoLab::Convert(const double* in, double* out) {
    LchToLab(in, out);
}
