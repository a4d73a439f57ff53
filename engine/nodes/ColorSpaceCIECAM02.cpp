#include "ColorSpaceCIECAM02.h"

#include <cmath>

#include "ChromaticAdaptation.h"
#include "ColorSpaceTable.h"
#include "Matrix3.h"

namespace {

constexpr double kDegreesPerRadian = 57.29577951308232;

// The matrices to the digits the model has always used, so results stay reproducible.
constexpr double kCat02Inverse[9] = {1.096124, -0.278869, 0.182745,  0.454369, 0.473533,
                                     0.072098, -0.009628, -0.005698, 1.015326};
// Hunt-Pointer-Estevez times the inverse of CAT02, and its inverse.
constexpr double kCat02ToHpe[9] = {0.740979,  0.218025,  0.0410058, 0.285353, 0.624201,
                                   0.0904454, -0.009628, -0.005698, 1.01533};
constexpr double kHpeToCat02[9] = {1.55915,   -0.544722, -0.0144452, -0.714327, 1.85031,
                                   -0.135977, 0.0107761, 0.0052185,  0.984005};

double Compress(double fl, double v) {
    if (!(v < 0.0)) {
        const double p = std::pow(fl * v / 100.0, 0.42);
        return 400.0 * p / (p + 27.13) + 0.1;
    }
    const double p = std::pow(-fl * v / 100.0, 0.42);
    return 0.1 - 400.0 * p / (p + 27.13);
}

double Expand(double fl, double va) {
    const double d = std::fabs(va - 0.1);
    const double v = (100.0 / fl) * std::pow(27.13 * d / (400.0 - d), 1.0 / 0.42);
    return va > 0.1 ? v : -v;
}

}  // namespace

cColorSpaceCIECAM02::cColorSpaceCIECAM02(const ColorSpaceStruct& description)
    : absolute_(description.emissive) {
    const double* effective = description.EffectiveWhite();
    const double scale = absolute_ ? 1.0 : 100.0;
    const double white[3] = {effective[0] * scale, effective[1] * scale, effective[2] * scale};
    const double* viewing = description.viewingConditions;
    const double yb = viewing[0];
    const double la = viewing[1];
    c_ = viewing[2];
    const double nc = viewing[3];
    const double f = viewing[5];

    const double k = 1.0 / (5.0 * la + 1.0);
    const double k4 = k * k * k * k;
    // The cube root to 14 digits, as stored appearance values were computed with it.
    fl_ = 0.2 * k4 * (5.0 * la) + 0.1 * (1.0 - k4) * (1.0 - k4) * std::pow(5.0 * la, 0.33333333333333);
    const double n = yb / white[1];
    nbb_ = 0.725 * std::pow(1.0 / n, 0.2);
    z_ = 1.48 + std::sqrt(n);
    // Not limited to 0..1: the published model leaves that to the caller.
    d_ = f * (1.0 - (1.0 / 3.6) * std::exp((-42.0 - la) / 92.0));

    double rgbW[3];
    Multiply3(kCat02Matrix, white, rgbW);
    for (int i = 0; i < 3; ++i) adapt_[i] = (white[1] / rgbW[i]) * d_ + 1.0 - d_;
    fl4_ = std::pow(fl_, 0.25);
    chromaScale_ = std::pow(1.64 - std::pow(0.29, n), 0.73);
    hueScale_ = nc * (12500.0 / 13.0) * nbb_;

    double compressed[3];
    CompressedResponses(rgbW, compressed);
    aw_ = AchromaticResponse(compressed);
}

std::unique_ptr<cColorSpaceCIECAM02> cColorSpaceCIECAM02::Create(const ColorSpaceStruct& description) {
    switch (description.Code()) {
        case ColorSpaceCode::CIECAM02_JCh:
            return std::make_unique<cColorSpaceCIECAM02_JCh>(description);
        case ColorSpaceCode::CIECAM02_JMh:
            return std::make_unique<cColorSpaceCIECAM02_JMh>(description);
        case ColorSpaceCode::CIECAM02_Jsh:
            return std::make_unique<cColorSpaceCIECAM02_Jsh>(description);
        case ColorSpaceCode::CIECAM02_JChab:
            return std::make_unique<cColorSpaceCIECAM02_JChab>(description);
        case ColorSpaceCode::CIECAM02_JMhab:
            return std::make_unique<cColorSpaceCIECAM02_JMhab>(description);
        case ColorSpaceCode::CIECAM02_Jshab:
            return std::make_unique<cColorSpaceCIECAM02_Jshab>(description);
        case ColorSpaceCode::CIECAM02_QCh:
            return std::make_unique<cColorSpaceCIECAM02_QCh>(description);
        case ColorSpaceCode::CIECAM02_QMh:
            return std::make_unique<cColorSpaceCIECAM02_QMh>(description);
        case ColorSpaceCode::CIECAM02_Qsh:
            return std::make_unique<cColorSpaceCIECAM02_Qsh>(description);
        case ColorSpaceCode::CIECAM02_QChab:
            return std::make_unique<cColorSpaceCIECAM02_QChab>(description);
        case ColorSpaceCode::CIECAM02_QMhab:
            return std::make_unique<cColorSpaceCIECAM02_QMhab>(description);
        case ColorSpaceCode::CIECAM02_Qshab:
            return std::make_unique<cColorSpaceCIECAM02_Qshab>(description);
        default:
            return nullptr;
    }
}

void cColorSpaceCIECAM02::CompressedResponses(const double* rgb, double* compressed) const {
    const double adapted[3] = {rgb[0] * adapt_[0], rgb[1] * adapt_[1], rgb[2] * adapt_[2]};
    double hpe[3];
    Multiply3(kCat02ToHpe, adapted, hpe);
    for (int i = 0; i < 3; ++i) compressed[i] = Compress(fl_, hpe[i]);
}

double cColorSpaceCIECAM02::AchromaticResponse(const double* compressed) const {
    const double a = (2.0 * compressed[0] + compressed[1] + 0.05 * compressed[2] - 0.305) * nbb_;
    return a > 0.0 ? a : 0.0;  // also catches NaN
}

cColorSpaceCIECAM02::Correlates cColorSpaceCIECAM02::Forward(const double* xyz) const {
    const double scale = absolute_ ? 1.0 : 100.0;
    double sample[3];
    for (int i = 0; i < 3; ++i) {
        sample[i] = xyz[i] * scale;
        if (sample[i] <= 0.0) sample[i] = 0.0;
    }
    double rgb[3];
    Multiply3(kCat02Matrix, sample, rgb);
    double p[3];
    CompressedResponses(rgb, p);

    const double a = p[0] - (12.0 / 11.0) * p[1] + (1.0 / 11.0) * p[2];
    const double b = (p[0] + p[1] - 2.0 * p[2]) / 9.0;
    Correlates out;
    out.h = std::atan2(b, a) * kDegreesPerRadian;
    if (out.h < 0.0) out.h += 360.0;
    const double e = (std::cos(out.h / kDegreesPerRadian + 2.0) + 3.8) * hueScale_;
    const double t = e * std::sqrt(a * a + b * b) / (p[0] + p[1] + 1.05 * p[2]);
    const double achromatic = AchromaticResponse(p);

    out.J = 100.0 * std::pow(achromatic / aw_, c_ * z_);
    const double rootJ = std::sqrt(out.J / 100.0);
    out.C = std::pow(t, 0.9) * rootJ * chromaScale_;
    out.M = out.C * fl4_;
    out.Q = rootJ * BrightnessScale();
    out.s = 100.0 * std::sqrt(out.M / out.Q);
    return out;
}

void cColorSpaceCIECAM02::Inverse(double J, double C, double h, double* xyz) const {
    const double t = J > 0.0 ? std::pow(C / (std::sqrt(J / 100.0) * chromaScale_), 1.0 / 0.9) : 0.0;
    const double achromatic = aw_ * std::pow(J / 100.0, 1.0 / (c_ * z_));
    const double hr = h / kDegreesPerRadian;
    const double p1 = hueScale_ * (std::cos(hr + 2.0) + 3.8);
    const double p2 = achromatic / nbb_ + 0.305;

    double a = 0.0;
    double b = 0.0;
    if (t != 0.0) {
        const double sn = std::sin(hr);
        const double cs = std::cos(hr);
        const double numerator = p2 * 3.05 * (460.0 / 1403.0);
        // Divide by the larger of cos h and sin h to stay away from a zero denominator.
        if (std::fabs(cs) > std::fabs(sn)) {
            a = numerator / ((p1 / t) / cs + 11.0 / 23.0 - (sn / cs) * (-108.0 / 23.0));
            b = a * sn / cs;
        } else {
            b = numerator / ((cs / sn) * (11.0 / 23.0) + (p1 / t) / sn - 27.0 / 1403.0 + 6615.0 / 1403.0);
            a = b * cs / sn;
        }
    }

    const double base = 0.327869 * achromatic / nbb_ + 0.1;
    const double compressed[3] = {base + 0.321454 * a + 0.205274 * b, base - 0.635068 * a - 0.18603 * b,
                                  base - 0.156807 * a - 4.49038 * b};
    const double hpe[3] = {Expand(fl_, compressed[0]), Expand(fl_, compressed[1]),
                           Expand(fl_, compressed[2])};
    double rgb[3];
    Multiply3(kHpeToCat02, hpe, rgb);
    for (int i = 0; i < 3; ++i) rgb[i] /= adapt_[i];
    Multiply3(kCat02Inverse, rgb, xyz);
    if (!absolute_) {
        for (int i = 0; i < 3; ++i) xyz[i] *= 0.01;
    }
}

void cColorSpaceCIECAM02::Appearance(Layout layout, const double* xyz, double* out) const {
    const Correlates v = Forward(xyz);
    out[0] = layout.lightness == 'J' ? v.J : v.Q;
    out[1] = layout.colorfulness == 'C' ? v.C : layout.colorfulness == 'M' ? v.M : v.s;
    out[2] = v.h;
    if (layout.cartesian) LchToLab(out, out);
}

void cColorSpaceCIECAM02::Stimulus(Layout layout, const double* in, double* xyz) const {
    double radius = in[1];
    double h = in[2];
    if (layout.cartesian) {
        // xyz is free until the end, so it holds the polar form.
        LabToLch(in, xyz);
        radius = xyz[1];
        h = xyz[2];
    }
    const double J = layout.lightness == 'J' ? in[0] : 100.0 * std::pow(in[0] / BrightnessScale(), 2.0);
    double C = radius;
    if (layout.colorfulness == 'M') {
        C = radius / fl4_;
    } else if (layout.colorfulness == 's') {
        const double Q = layout.lightness == 'Q' ? in[0] : std::sqrt(J / 100.0) * BrightnessScale();
        C = Q * (radius / 100.0) * (radius / 100.0) / fl4_;
    }
    Inverse(J, C, h, xyz);
}
