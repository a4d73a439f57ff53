#pragma once

#include <limits>

// Inputs of the physiological observer model, 390 to 780 nm at 5 nm.
inline constexpr double kCie2006Start = 390.0, kCie2006Step = 5.0;
inline constexpr int kCie2006Count = 79;
// The S-cone absorbance is not tabulated above 615 nm: it is taken as no absorbance at all.
inline constexpr double kNotTabulated = -std::numeric_limits<double>::infinity();

struct Cie2006Row {
    double macular;           // relative macular pigment density, peak 1
    double lensAgeing;        // lens component that grows with age
    double lensFixed;         // lens component independent of age
    double logAbsorbance[3];  // log10 low-density absorbance of the L, M and S cones
};

extern const Cie2006Row kCie2006Inputs[kCie2006Count];

// XYZ from cone fundamentals goes through the inverse of this LMS-from-XYZ matrix (row-major).
// clang-format off
inline constexpr double kCie2006LmsFromXyz[9] = {
    0.38971, 0.68898, -0.07868,
    -0.22981, 1.18340, 0.04641,
    0.0, 0.0, 1.0};
// clang-format on
