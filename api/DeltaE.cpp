#include "CentroidLookup.h"
#include "ColorDifference.h"
#include "pigmo/bp.h"

namespace {

// No difference can be negative, so -1 tells a caller it passed no color.
constexpr double kNoColor = -1.0;

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

}  // extern "C"
