#include "ColorSpaceLab.h"

#include "ElementaryFunctions.h"

namespace {
constexpr double kSixteenOver116 = 16.0 / 116.0;
constexpr double kSlope = 7.7867;
// The long-established rounded constants, not 6/29 and (6/29)^3: stored colors depend on them.
constexpr double kFThreshold = 0.2069;
constexpr double kXYZThreshold = 0.008856;

double ForwardF(double t) {
    return t > kXYZThreshold ? Elementary::CubeRoot(t) : kSlope * t + kSixteenOver116;
}
}  // namespace

cColorSpaceLab::cColorSpaceLab(const ColorSpaceStruct& description) {
    const double* white = description.EffectiveWhite();
    for (int i = 0; i < 3; ++i) white_[i] = white[i];
}

void cColorSpaceLab::LabToF(const double* lab, double* f) {
    const double fy = (lab[0] + 16.0) / 116.0;
    f[0] = lab[1] / 500.0 + fy;
    f[1] = fy;
    f[2] = fy - lab[2] / 200.0;
}

double cColorSpaceLab::InverseF(double t, double cube) {
    return t > kFThreshold ? cube : (t - kSixteenOver116) / kSlope;
}

void cColorSpaceLab::ToXYZ(const double* in, double* out) {
    double f[3];
    LabToF(in, f);
    for (int i = 0; i < 3; ++i) out[i] = white_[i] * InverseF(f[i], f[i] * f[i] * f[i]);
}

void cColorSpaceLab::FromXYZ(const double* in, double* out) {
    FromXYZ(reinterpret_cast<const double(*)[3]>(in), reinterpret_cast<double(*)[3]>(out), 1);
}

void cColorSpaceLab::FromXYZ(const double (*xyz)[3], double (*lab)[3], size_t count) const {
    for (size_t n = 0; n < count; ++n) {
        for (int i = 0; i < 3; ++i) lab[n][i] = ForwardF(xyz[n][i] / white_[i]);
    }
    for (size_t n = 0; n < count; ++n) {
        const double fx = lab[n][0], fy = lab[n][1], fz = lab[n][2];
        lab[n][0] = 116.0 * fy - 16.0;
        lab[n][1] = 500.0 * (fx - fy);
        lab[n][2] = 200.0 * (fy - fz);
    }
}
