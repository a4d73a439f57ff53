#pragma once

#include <cstdint>
#include <vector>

// The CIE 2006 observer's functions are tabulated at 1 nm from 390 to 830 nm.
inline constexpr double kCie2006TableStart = 390.0;
inline constexpr int32_t kCie2006TableCount = 441;

// Row-major matrix from the cone fundamentals l-bar, m-bar, s-bar of this age and field size
// (energy based, each with peak 1) to x-bar, y-bar, z-bar, derived as CIE 170-2 derives it:
// y-bar is the field's luminous efficiency from l-bar and m-bar with peak 1, z-bar is s-bar with
// y-bar's area, and x-bar, also with y-bar's area and with its chromaticity minimum on the
// reference one, is fitted to the CIE 1931 and 1964 chromaticities blended for the field size.
void DeriveCie2006Transformation(double age, double fieldSize, double matrix[9]);

// x-bar, y-bar, z-bar of the CIE 2006 observer: kCie2006TableCount rows of three from
// kCie2006TableStart. The field size is limited to 1 to 10 degrees. At age 32 with 2 or 10 degrees
// the published CIE 170-2 matrices apply, for any other observer the derived one.
std::vector<double> Cie2006ColorMatchingFunctions(double age, double fieldSize);
