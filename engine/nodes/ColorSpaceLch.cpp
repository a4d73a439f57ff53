#include "ColorSpaceLch.h"

cColorSpaceLch::cColorSpaceLch(const ColorSpaceStruct& description) : lab_(description) {}

void cColorSpaceLch::ToXYZ(const double* in, double* out) {
    double lab[3];
    LchToLab(in, lab);
    double f[3];
    cColorSpaceLab::LabToF(lab, f);
    const double* white = lab_.White();
    for (int i = 0; i < 3; ++i) {
        double v = cColorSpaceLab::InverseF(f[i], f[i] * f[i] * f[i]);
        // Unlike the Lab node, LCh never hands on a negative component (NaN passes).
        if (v < 0.0) v = 0.0;
        out[i] = v * white[i];
    }
}

void cColorSpaceLch::FromXYZ(const double* in, double* out) {
    lab_.FromXYZ(in, out);
    LabToLch(out, out);
}
