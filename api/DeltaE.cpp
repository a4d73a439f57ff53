#include "CentroidLookup.h"
#include "ColorDifference.h"
#include "pigmo/bp.h"

namespace {

// No difference can be negative, so -1 tells a caller it passed no color.
constexpr double kNoColor = -1.0;

// Runs one difference over count pairs of rows.
template <typename Difference>
int PerPair(const double* lab1, const double* lab2, double* out, size_t count, const Difference& difference) {
    if (lab1 == nullptr || lab2 == nullptr || out == nullptr) return 0;
    for (size_t i = 0; i < count; ++i) out[i] = difference.CalculateDeltaE(lab1 + 3 * i, lab2 + 3 * i);
    return 1;
}

}  // namespace

extern "C" {

double BPCalculateDeltaE(const double* lab1, const double* lab2) {
    if (lab1 == nullptr || lab2 == nullptr) return kNoColor;
    return cCIE1976ColorDifference().CalculateDeltaE(lab1, lab2);
}

double BPCalculateDeltaECMC(const double* lab1, const double* lab2, double l, double c) {
    if (lab1 == nullptr || lab2 == nullptr) return kNoColor;
    return cCMCColorDifference(l, c).CalculateDeltaE(lab1, lab2);
}

double BPCalculateDeltaE94(const double* lab1, const double* lab2, double kL, double kC, double kH) {
    if (lab1 == nullptr || lab2 == nullptr) return kNoColor;
    return cCIE1994ColorDifference(kL, kC, kH).CalculateDeltaE(lab1, lab2);
}

double BPCalculateDeltaE2000(const double* lab1, const double* lab2, double kL, double kC, double kH) {
    if (lab1 == nullptr || lab2 == nullptr) return kNoColor;
    return cCIEDE2000(kL, kC, kH).CalculateDeltaE(lab1, lab2);
}

double BPCalculateDistanceSquared(const double* lab1, const double* lab2) {
    if (lab1 == nullptr || lab2 == nullptr) return kNoColor;
    return cCentroidLookup::DistanceSquared(lab1, lab2);
}

int BPCalculateDeltaEArray(const double* lab1, const double* lab2, double* out, size_t count) {
    return PerPair(lab1, lab2, out, count, cCIE1976ColorDifference());
}

int BPCalculateDeltaECMCArray(const double* lab1, const double* lab2, double* out, size_t count, double l,
                              double c) {
    return PerPair(lab1, lab2, out, count, cCMCColorDifference(l, c));
}

int BPCalculateDeltaE94Array(const double* lab1, const double* lab2, double* out, size_t count, double kL,
                             double kC, double kH) {
    return PerPair(lab1, lab2, out, count, cCIE1994ColorDifference(kL, kC, kH));
}

int BPCalculateDeltaE2000Array(const double* lab1, const double* lab2, double* out, size_t count, double kL,
                               double kC, double kH) {
    return PerPair(lab1, lab2, out, count, cCIEDE2000(kL, kC, kH));
}

}  // extern "C"
