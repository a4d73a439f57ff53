#include "ColorSpaceSRGB.h"

#include "ElementaryFunctions.h"

// Four-decimal coefficients, as stored colors were computed with them.
void cColorSpaceSRGB::LinearToXYZ(const double* rgb, double* xyz) {
    const double r = rgb[0];
    const double g = rgb[1];
    const double b = rgb[2];
    xyz[0] = 0.4124 * r + 0.3576 * g + 0.1805 * b;
    xyz[1] = 0.2126 * r + 0.7152 * g + 0.0722 * b;
    xyz[2] = 0.0193 * r + 0.1192 * g + 0.9505 * b;
}

void cColorSpaceSRGB::XYZToLinear(const double* xyz, double* rgb) {
    const double x = xyz[0];
    const double y = xyz[1];
    const double z = xyz[2];
    rgb[0] = 3.2406 * x - 1.5372 * y - 0.4986 * z;
    rgb[1] = -0.9689 * x + 1.8758 * y + 0.0415 * z;
    rgb[2] = 0.0557 * x - 0.204 * y + 1.057 * z;
}

double cColorSpaceSRGB::DecodeSRGB(double c) {
    return c > 0.04045 ? Elementary::RationalPower<12, 5>::Of((c + 0.055) / 1.055) : c / 12.92;
}

double cColorSpaceSRGB::EncodeSRGB(double v) {
    if (v < 0.0) return 0.0;
    if (v > 1.0) return 1.0;
    if (v <= 0.0031308) return 12.92 * v;
    return 1.055 * Elementary::RationalPower<5, 12>::Of(v) - 0.055;
}

void cColorSpaceSRGB::White(double* white) {
    const double full[3] = {255.0, 255.0, 255.0};
    double xyz[3];
    cColorSpaceSRGB().ToXYZ(full, xyz);
    white[0] = xyz[0] / xyz[1];
    white[1] = 1.0;
    white[2] = xyz[2] / xyz[1];
}

void cColorSpaceSRGB::ToXYZ(const double* in, double* out) {
    ToXYZ(reinterpret_cast<const double(*)[3]>(in), reinterpret_cast<double(*)[3]>(out), 1);
}

void cColorSpaceSRGB::ToXYZ(const double (*in)[3], double (*xyz)[3], size_t count) const {
    for (size_t n = 0; n < count; ++n) {
        for (int i = 0; i < 3; ++i) xyz[n][i] = DecodeSRGB(in[n][i] / 255.0);
    }
    for (size_t n = 0; n < count; ++n) LinearToXYZ(xyz[n], xyz[n]);
}

void cColorSpaceSRGB::FromXYZ(const double* in, double* out) {
    double linear[3];
    XYZToLinear(in, linear);
    for (int i = 0; i < 3; ++i) out[i] = EncodeSRGB(linear[i]) * 255.0;
}
