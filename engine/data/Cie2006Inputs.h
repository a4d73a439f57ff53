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

// CIE 170-2:2015, l-bar, m-bar, s-bar to x-bar, y-bar, z-bar of the 2- and 10-degree observers (row-major)
// clang-format off
inline constexpr double kCie2015Matrix2[9] = {
    1.94735469, -1.41445123, 0.36476327,
    0.68990272, 0.34832189, 0.0,
    0.0, 0.0, 1.93485343};
inline constexpr double kCie2015Matrix10[9] = {
    1.93986443, -1.34664359, 0.43044935,
    0.69283932, 0.34967567, 0.0,
    0.0, 0.0, 2.14687945};
// clang-format on
