#include "ColorSpaceLabtoLch.h"

void cColorSpaceLabtoLch::Convert(const double* in, double* out) {
    LabToLch(in, out);
}
