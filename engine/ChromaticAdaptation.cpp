#include "ChromaticAdaptation.h"

namespace {

// Cone-response matrices to four decimals, as published; results depend on the rounding.
constexpr double kConeMatrices[4][9] = {
    {0.8951, 0.2664, -0.1614, -0.7502, 1.7135, 0.0367, 0.0389, -0.0685, 1.0296},   // Bradford
    {1.2694, -0.0988, -0.1706, -0.8364, 1.8006, 0.0357, 0.0297, -0.0315, 1.0018},  // Sharp
    {0.7982, 0.3389, -0.1371, -0.5918, 1.5512, 0.0406, 0.0008, 0.0239, 0.9753},    // CMCCAT2000
    {0.7328, 0.4296, -0.1624, -0.7036, 1.6975, 0.0061, 0.0030, 0.0136, 0.9834},    // CAT02
};

void Multiply(const double* m, const double* v, double* out) {
    for (int i = 0; i < 3; ++i) out[i] = m[3 * i] * v[0] + m[3 * i + 1] * v[1] + m[3 * i + 2] * v[2];
}

void Invert(const double* m, double* inverse) {
    const double c00 = m[4] * m[8] - m[5] * m[7];
    const double c01 = m[5] * m[6] - m[3] * m[8];
    const double c02 = m[3] * m[7] - m[4] * m[6];
    const double det = m[0] * c00 + m[1] * c01 + m[2] * c02;
    inverse[0] = c00 / det;
    inverse[1] = (m[2] * m[7] - m[1] * m[8]) / det;
    inverse[2] = (m[1] * m[5] - m[2] * m[4]) / det;
    inverse[3] = c01 / det;
    inverse[4] = (m[0] * m[8] - m[2] * m[6]) / det;
    inverse[5] = (m[2] * m[3] - m[0] * m[5]) / det;
    inverse[6] = c02 / det;
    inverse[7] = (m[1] * m[6] - m[0] * m[7]) / det;
    inverse[8] = (m[0] * m[4] - m[1] * m[3]) / det;
}

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
    Multiply(cone, sourceWhite, rhoSource);
    Multiply(cone, destinationWhite, rhoDestination);
    // inverse(cone) * diag(rhoDestination / rhoSource) * cone
    double scaled[9];
    for (int i = 0; i < 3; ++i) {
        const double gain = rhoDestination[i] / rhoSource[i];
        for (int j = 0; j < 3; ++j) scaled[3 * i + j] = gain * cone[3 * i + j];
    }
    double inverse[9];
    Invert(cone, inverse);
    for (int i = 0; i < 3; ++i) {
        for (int j = 0; j < 3; ++j) {
            matrix_[3 * i + j] = inverse[3 * i] * scaled[j] + inverse[3 * i + 1] * scaled[3 + j] +
                                 inverse[3 * i + 2] * scaled[6 + j];
        }
    }
}

void ChromaticAdaptation::Apply(double* xyz) const {
    const double in[3] = {xyz[0], xyz[1], xyz[2]};
    Multiply(matrix_, in, xyz);
}
