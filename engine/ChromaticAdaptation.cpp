#include "ChromaticAdaptation.h"

#include "Matrix3.h"

namespace {

// Cone-response matrices to four decimals, as published; results depend on the rounding.
constexpr double kConeMatrices[4][9] = {
    {0.8951, 0.2664, -0.1614, -0.7502, 1.7135, 0.0367, 0.0389, -0.0685, 1.0296},   // Bradford
    {1.2694, -0.0988, -0.1706, -0.8364, 1.8006, 0.0357, 0.0297, -0.0315, 1.0018},  // Sharp
    {0.7982, 0.3389, -0.1371, -0.5918, 1.5512, 0.0406, 0.0008, 0.0239, 0.9753},    // CMCCAT2000
    {0.7328, 0.4296, -0.1624, -0.7036, 1.6975, 0.0061, 0.0030, 0.0136, 0.9834},    // CAT02
};

}  // namespace

ChromaticAdaptation::ChromaticAdaptation(int32_t method, const double* sourceWhite,
                                         const double* destinationWhite)
    : method_(method), matrix_{1.0, 0.0, 0.0, 0.0, 1.0, 0.0, 0.0, 0.0, 1.0} {
    if (method == kXYZScaling) {
        for (int i = 0; i < 3; ++i) matrix_[4 * i] = destinationWhite[i] / sourceWhite[i];
        return;
    }
    if (method < kBradford || method > kCAT02) return;
    const double* cone = kConeMatrices[method - kBradford];
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
