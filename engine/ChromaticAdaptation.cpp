#include "ChromaticAdaptation.h"

#include "Matrix3.h"

namespace {

// Cone-response matrices to four decimals, as published; results depend on the rounding.
constexpr double kBradford[9] = {0.8951, 0.2664, -0.1614, -0.7502, 1.7135, 0.0367, 0.0389, -0.0685, 1.0296};
constexpr double kSharp[9] = {1.2694, -0.0988, -0.1706, -0.8364, 1.8006, 0.0357, 0.0297, -0.0315, 1.0018};
constexpr double kCMCCAT2000[9] = {0.7982, 0.3389, -0.1371, -0.5918, 1.5512, 0.0406, 0.0008, 0.0239, 0.9753};

const double* ConeMatrix(AdaptationMethod method) {
    switch (method) {
        case AdaptationMethod::Bradford:
            return kBradford;
        case AdaptationMethod::Sharp:
            return kSharp;
        case AdaptationMethod::CMCCAT2000:
            return kCMCCAT2000;
        case AdaptationMethod::CAT02:
            return kCat02Matrix;
        default:
            return nullptr;
    }
}

}  // namespace

ChromaticAdaptation::ChromaticAdaptation(AdaptationMethod method, const double* sourceWhite,
                                         const double* destinationWhite)
    : method_(method), matrix_{1.0, 0.0, 0.0, 0.0, 1.0, 0.0, 0.0, 0.0, 1.0} {
    if (method == AdaptationMethod::XYZScaling) {
        for (int i = 0; i < 3; ++i) matrix_[4 * i] = destinationWhite[i] / sourceWhite[i];
        return;
    }
    const double* cone = ConeMatrix(method);
    if (cone == nullptr) return;
    double rhoSource[3];
    double rhoDestination[3];
    Multiply3(cone, sourceWhite, rhoSource);
    Multiply3(cone, destinationWhite, rhoDestination);
    // inverse(cone) * diag(rhoDestination / rhoSource) * cone
    double scaled[9];
    for (int i = 0; i < 3; ++i) {
        const double gain = rhoDestination[i] / rhoSource[i];
        for (int j = 0; j < 3; ++j) scaled[3 * i + j] = gain * cone[3 * i + j];
    }
    double inverse[9];
    Invert3(cone, inverse);
    for (int i = 0; i < 3; ++i) {
        for (int j = 0; j < 3; ++j) {
            matrix_[3 * i + j] = inverse[3 * i] * scaled[j] + inverse[3 * i + 1] * scaled[3 + j] +
                                 inverse[3 * i + 2] * scaled[6 + j];
        }
    }
}

void ChromaticAdaptation::Apply(double* xyz) const {
    Multiply3(matrix_, xyz, xyz);
}
