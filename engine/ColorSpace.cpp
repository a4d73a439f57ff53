#include "ColorSpace.h"

#include <cmath>
#include <numbers>

#include "ElementaryFunctions.h"

namespace {
constexpr double kTwoPi = 2.0 * std::numbers::pi;
constexpr double kDegreesPerRadian = 180.0 / std::numbers::pi;
}  // namespace

cColorSpace::~cColorSpace() = default;

void cColorSpace::ToSpectral(const double*, double*) {}
void cColorSpace::FromSpectral(const double*, double*) {}
void cColorSpace::ToComponents(const double*, double*) {}
void cColorSpace::FromComponents(const double*, double*) {}
void cColorSpace::Convert(const double*, double*) {}

void cColorSpace::LabToLch(const double* in, double* out) {
    const double l = in[0];
    const double a = in[1];
    const double b = in[2];
    double h = Elementary::Atan2(b, a);
    if (h < 0.0) h += kTwoPi;
    out[0] = l;
    out[1] = std::sqrt(a * a + b * b);
    out[2] = h * kDegreesPerRadian;
}

void cColorSpace::LchToLab(const double* in, double* out) {
    const double l = in[0];
    const double c = in[1];
    double h = in[2];
    // Hues outside one turn are brought into 0..360 so the quadrant signs stay right (-135 is 225).
    if (h < 0.0 || h >= 360.0) {
        h = std::fmod(h, 360.0);
        if (h < 0.0) h += 360.0;
        if (h >= 360.0) h = 0.0;
    }
    double a;
    double b;
    // By the tangent rather than sine and cosine, as stored colors were computed; it is unbounded at
    // the vertical axes, so they are set directly.
    if (h == 90.0) {
        a = 0.0;
        b = c;
    } else if (h == 270.0) {
        a = 0.0;
        b = -c;
    } else {
        const double t = Elementary::Tan(h / kDegreesPerRadian);
        const double aa = c / std::sqrt(t * t + 1.0);
        const double bb = t * aa;
        // tan() loses the quadrant; the hue restores the signs.
        if (h >= 0.0 && h < 90.0) {
            a = std::fabs(aa);
            b = std::fabs(bb);
        } else if (h > 90.0 && h < 180.0) {
            a = -std::fabs(aa);
            b = std::fabs(bb);
        } else if (h >= 180.0 && h < 270.0) {
            a = -std::fabs(aa);
            b = -std::fabs(bb);
        } else if (h > 270.0 && h < 360.0) {
            a = std::fabs(aa);
            b = -std::fabs(bb);
        } else {  // NaN
            a = aa;
            b = bb;
        }
    }
    out[0] = l;
    out[1] = a;
    out[2] = b;
}
