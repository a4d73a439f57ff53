#include "ColorDifference.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <numbers>

#include "ColorSpaceTable.h"
#include "ColorTranslator.h"
#include "ElementaryFunctions.h"
#include "MathEngine.h"

namespace {

constexpr double kTwoPi = 2.0 * std::numbers::pi;
constexpr double kDegreesPerRadian = 180.0 / std::numbers::pi;
constexpr double kPow25To7 = 6103515625.0;  // 25^7

double Pow7(double x) {
    const double x2 = x * x;
    const double x3 = x2 * x;
    return x3 * x3 * x;
}

// The first three columns of the first `rows` rows, as a CIELAB collection.
cMatrixDC LabRows(const cMatrixDC& source, int32_t rows, const ColorSpaceStruct& lab) {
    cMatrixDC out(rows, 3);
    for (int32_t i = 0; i < rows; ++i) std::copy_n(source.Row(i), 3, out.Row(i));
    out.SetDescription(&lab);
    return out;
}

// Both inputs passed through a CIELAB-to-CIELAB engine; false when the engine refuses them.
bool TranslateLabPair(const cMatrixDC& reference, const cMatrixDC& sample, int32_t rows,
                      cMatrixDC& outReference, cMatrixDC& outSample) {
    const ColorSpaceStruct lab = cColorSpaceTable::DefaultDescription(ColorSpaceCode::Lab);
    cColorTranslator translator;
    translator.SetSource(lab);
    translator.SetDestination(lab);
    outReference.SetDescription(&lab);
    outSample.SetDescription(&lab);
    return translator.TranslateCollection(LabRows(reference, rows, lab), outReference) == 0 &&
           translator.TranslateCollection(LabRows(sample, rows, lab), outSample) == 0;
}

// Terms shared by CMC and CIE94; the hue difference squared is what ΔL² and ΔC² leave of ΔE76².
struct ChromaTerms {
    double C1;
    double dL;
    double dC;
    double dH2;
};

ChromaTerms ChromaDifference(const double* lab1, const double* lab2) {
    const double C1 = std::sqrt(lab1[1] * lab1[1] + lab1[2] * lab1[2]);
    const double C2 = std::sqrt(lab2[1] * lab2[1] + lab2[2] * lab2[2]);
    const double dL = lab1[0] - lab2[0];
    const double da = lab1[1] - lab2[1];
    const double db = lab1[2] - lab2[2];
    const double dC = C1 - C2;
    // Rounding can leave a tiny negative remainder.
    const double dH2 = std::max(0.0, dL * dL + da * da + db * db - dL * dL - dC * dC);
    return {C1, dL, dC, dH2};
}

}  // namespace

cDeltaEBase::~cDeltaEBase() = default;

int32_t cDeltaEBase::ComparableRows(const cMatrixDC& reference, const cMatrixDC& sample) {
    if (reference.Columns() < 3 || sample.Columns() < 3) return 0;
    return std::min(reference.Rows(), sample.Rows());
}

cMatrixDC cDeltaEBase::CalculateDeltaEPerRow(const cMatrixDC& reference, const cMatrixDC& sample) const {
    const int32_t rows = ComparableRows(reference, sample);
    cMatrixDC result(rows, 1);
    for (int32_t i = 0; i < rows; ++i) result.At(i, 0) = CalculateDeltaE(reference.Row(i), sample.Row(i));
    return result;
}

cMatrixDC cDeltaEBase::CalculateDeltaEPerRowConverted(const cMatrixDC& reference,
                                                      const cMatrixDC& sample) const {
    const int32_t rows = ComparableRows(reference, sample);
    cMatrixDC convertedReference, convertedSample;
    if (!TranslateLabPair(reference, sample, rows, convertedReference, convertedSample))
        return cMatrixDC(0, 1);
    return CalculateDeltaEPerRow(convertedReference, convertedSample);
}

double cDeltaEBase::CalculateMeanDeltaE(const cMatrixDC& reference, const cMatrixDC& sample) const {
    const cMatrixDC perRow = CalculateDeltaEPerRow(reference, sample);
    double sum = 0.0;
    for (int32_t i = 0; i < perRow.Rows(); ++i) sum += perRow.At(i, 0);
    return sum / perRow.Rows();  // 0/0 = NaN without rows
}

double cDeltaEBase::CalculateMeanDeltaEConverted(const cMatrixDC& reference, const cMatrixDC& sample) const {
    const int32_t rows = ComparableRows(reference, sample);
    cMatrixDC convertedReference, convertedSample;
    if (!TranslateLabPair(reference, sample, rows, convertedReference, convertedSample)) {
        return std::numeric_limits<double>::quiet_NaN();
    }
    return CalculateMeanDeltaE(convertedReference, convertedSample);
}

double cCIE1976ColorDifference::CalculateDeltaE(const double* reference, const double* sample) const {
    const double dL = reference[0] - sample[0];
    const double da = reference[1] - sample[1];
    const double db = reference[2] - sample[2];
    return std::sqrt(dL * dL + da * da + db * db);
}

cMatrixDC cCIE1976ColorDifference::CalculateDeltaEPerRow(const cMatrixDC& reference,
                                                         const cMatrixDC& sample) const {
    const int32_t rows = ComparableRows(reference, sample);
    cMatrixDC difference(rows, 3);
    for (int32_t i = 0; i < rows; ++i) {
        for (int32_t k = 0; k < 3; ++k) difference.At(i, k) = reference.At(i, k) - sample.At(i, k);
    }
    cMatrixDC ones(3, 1);
    std::fill_n(ones.Values(), 3, 1.0);
    cMatrixDC squares, sums, result;
    theMathEngine.Power(difference, 2.0, squares);
    theMathEngine.Product(squares, ones, sums);  // row sums
    theMathEngine.Sqrt(sums, result);
    return result;
}

std::unique_ptr<cDeltaEBase> cCIE1976ColorDifference::Clone() const {
    return std::make_unique<cCIE1976ColorDifference>(*this);
}

double cCMCColorDifference::CalculateDeltaE(const double* reference, const double* sample) const {
    const ChromaTerms t = ChromaDifference(reference, sample);
    const double L1 = reference[0];
    const double SL = L1 < 16.0 ? 0.511 : 0.040975 * L1 / (1.0 + 0.01765 * L1);
    const double SC = 0.0638 * t.C1 / (1.0 + 0.0131 * t.C1) + 0.638;
    const double C1to4 = t.C1 * t.C1 * t.C1 * t.C1;
    const double F = std::sqrt(C1to4 / (C1to4 + 1900.0));
    double H1 = std::atan2(reference[2], reference[1]) * kDegreesPerRadian;
    if (H1 < 0.0) H1 += 360.0;
    constexpr double kRadiansPerDegree = std::numbers::pi / 180.0;
    const double T = (H1 >= 164.0 && H1 <= 345.0)
                         ? 0.56 + std::fabs(0.2 * std::cos((H1 + 168.0) * kRadiansPerDegree))
                         : 0.36 + std::fabs(0.4 * std::cos((H1 + 35.0) * kRadiansPerDegree));
    const double SH = SC * (F * T + 1.0 - F);
    const double lTerm = t.dL / (l_ * SL);
    const double cTerm = t.dC / (c_ * SC);
    return std::sqrt(lTerm * lTerm + cTerm * cTerm + t.dH2 / (SH * SH));
}

std::unique_ptr<cDeltaEBase> cCMCColorDifference::Clone() const {
    return std::make_unique<cCMCColorDifference>(*this);
}

double cCIE1994ColorDifference::CalculateDeltaE(const double* reference, const double* sample) const {
    const ChromaTerms t = ChromaDifference(reference, sample);
    const double SC = 1.0 + K1_ * t.C1;
    const double SH = 1.0 + K2_ * t.C1;
    const double lTerm = t.dL / kL_;
    const double cTerm = t.dC / (kC_ * SC);
    const double hScale = kH_ * SH;
    return std::sqrt(lTerm * lTerm + cTerm * cTerm + t.dH2 / (hScale * hScale));
}

std::unique_ptr<cDeltaEBase> cCIE1994ColorDifference::Clone() const {
    return std::make_unique<cCIE1994ColorDifference>(*this);
}

double cCIEDE2000::CalculateDeltaE(const double* reference, const double* sample) const {
    constexpr double kPi = std::numbers::pi;
    const double L1 = reference[0], a1 = reference[1], b1 = reference[2];
    const double L2 = sample[0], a2 = sample[1], b2 = sample[2];

    const double Cm = 0.5 * (std::sqrt(a1 * a1 + b1 * b1) + std::sqrt(a2 * a2 + b2 * b2));
    const double Cm7 = Pow7(Cm);
    const double G = 0.5 * (1.0 - std::sqrt(Cm7 / (Cm7 + kPow25To7)));
    const double a1p = (1.0 + G) * a1;
    const double a2p = (1.0 + G) * a2;
    const double C1p = std::sqrt(a1p * a1p + b1 * b1);
    const double C2p = std::sqrt(a2p * a2p + b2 * b2);

    // The adjustments below select rather than branch: they depend on random hues.
    using Elementary::Select;
    auto hue = [](double ap, double b, auto atan2) {
        if (std::fabs(ap) + std::fabs(b) == 0.0) return 0.0;
        const double h = atan2(b, ap);
        return Select(h < 0.0, h + kTwoPi, h);
    };
    const auto fast = [](double y, double x) { return Elementary::Atan2(y, x); };
    const double h1p = hue(a1p, b1, fast);
    const double h2p = hue(a2p, b2, fast);

    const double dLp = L2 - L1;
    const double dCp = C2p - C1p;
    const double CpProduct = C1p * C2p;
    // Whether the hues lie more than pi apart: the sign of the cross product tells, except for hues
    // opposite to within rounding, where the formula jumps and the decision stays with the
    // standard library's correctly rounded angles (the published boundary pairs rely on them).
    const double cross = a1p * b2 - b1 * a2p;
    bool apart = ((cross < 0.0) & (h2p > h1p)) | ((cross > 0.0) & (h2p < h1p));
    if (std::fabs(cross) <= 1e-9 * CpProduct && a1p * a2p + b1 * b2 < 0.0) {
        const auto rounded = [](double y, double x) { return std::atan2(y, x); };
        apart = std::fabs(hue(a1p, b1, rounded) - hue(a2p, b2, rounded)) > kPi;
    }
    double dhp = h2p - h1p;
    dhp = Select(apart, dhp - std::copysign(kTwoPi, dhp), dhp);
    if (CpProduct == 0.0) dhp = 0.0;
    const double dHp = 2.0 * std::sqrt(CpProduct) * Elementary::SinNearZero(0.5 * dhp);

    const double Lmp = 0.5 * (L1 + L2);
    const double Cmp = 0.5 * (C1p + C2p);
    double hmp;
    if (CpProduct == 0.0) {
        hmp = h1p + h2p;
    } else {
        hmp = 0.5 * (h1p + h2p);
        hmp = Select(apart, hmp - kPi, hmp);
        hmp = Select(hmp < 0.0, hmp + kTwoPi, hmp);
    }

    // T from one sine/cosine pair through the multiple-angle identities instead of four cosines.
    double s1, c1;
    Elementary::SinCos(hmp, s1, c1);
    const double c2 = c1 * c1 - s1 * s1, s2 = 2.0 * s1 * c1;
    const double c3 = c2 * c1 - s2 * s1, s3 = s2 * c1 + c2 * s1;
    const double c4 = c2 * c2 - s2 * s2, s4 = 2.0 * s2 * c2;
    constexpr double kCos30 = 0.8660254037844387, kSin30 = 0.5;
    constexpr double kCos6 = 0.9945218953682733, kSin6 = 0.10452846326765347;
    constexpr double kCos63 = 0.4539904997395468, kSin63 = 0.8910065241883679;
    const double T = 1.0 - 0.17 * (c1 * kCos30 + s1 * kSin30) + 0.24 * c2 + 0.32 * (c3 * kCos6 - s3 * kSin6) -
                     0.20 * (c4 * kCos63 + s4 * kSin63);

    const double Lm50 = (Lmp - 50.0) * (Lmp - 50.0);
    const double SL = 1.0 + 0.015 * Lm50 / std::sqrt(20.0 + Lm50);
    const double SC = 1.0 + 0.045 * Cmp;
    const double SH = 1.0 + 0.015 * Cmp * T;

    const double hmpDegreesOff = (hmp * kDegreesPerRadian - 275.0) * (1.0 / 25.0);
    const double dTheta = 0.5235987756087708 * Elementary::Exp(-hmpDegreesOff * hmpDegreesOff);
    const double Cmp7 = Pow7(Cmp);
    const double RC = 2.0 * std::sqrt(Cmp7 / (Cmp7 + kPow25To7));
    const double RT = -Elementary::SinNearZero(2.0 * dTheta) * RC;

    const double l = dLp / (kL_ * SL);
    const double c = dCp / (kC_ * SC);
    const double h = dHp / (kH_ * SH);
    return std::sqrt(l * l + c * c + h * h + RT * c * h);
}

std::unique_ptr<cDeltaEBase> cCIEDE2000::Clone() const {
    return std::make_unique<cCIEDE2000>(*this);
}
