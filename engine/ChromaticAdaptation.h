#pragma once

#include <cstdint>

#include "Export.h"

// Von Kries-type adaptation of connection-space XYZ from a source white to a destination white.
class PIGMO_API ChromaticAdaptation {
public:
    enum Method : int32_t {
        kNone = 0,
        kXYZScaling = 1,
        kBradford = 2,
        kSharp = 3,
        kCMCCAT2000 = 4,
        kCAT02 = 5
    };

    // Methods outside 0..5 give the identity.
    ChromaticAdaptation(int32_t method, const double* sourceWhite, const double* destinationWhite);

    int32_t MethodCode() const { return method_; }
    const double* Matrix() const { return matrix_; }  // 3x3, row-major
    // In place on the first three values.
    void Apply(double* xyz) const;

private:
    int32_t method_;
    double matrix_[9];
};
