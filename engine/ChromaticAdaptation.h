#pragma once

#include <cstdint>

#include "Export.h"

// Chromatic adaptation methods, with their stored values.
enum class AdaptationMethod : int32_t {
    None = 0,
    XYZScaling = 1,
    Bradford = 2,
    Sharp = 3,
    CMCCAT2000 = 4,
    CAT02 = 5,
};

// CAT02's cone-response matrix to four decimals, as published; results depend on the rounding.
inline constexpr double kCat02Matrix[9] = {0.7328, 0.4296, -0.1624, -0.7036, 1.6975,
                                           0.0061, 0.0030, 0.0136,  0.9834};

// Von Kries-type adaptation of connection-space XYZ from a source white to a destination white.
class PIGMO_API ChromaticAdaptation {
public:
    // Methods outside the named ones give the identity.
    ChromaticAdaptation(AdaptationMethod method, const double* sourceWhite, const double* destinationWhite);

    AdaptationMethod Method() const { return method_; }
    const double* Matrix() const { return matrix_; }  // 3x3, row-major
    // In place on the first three values.
    void Apply(double* xyz) const;

private:
    AdaptationMethod method_;
    double matrix_[9];
};
