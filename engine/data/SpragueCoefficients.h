#pragma once

// CIE 167:2005, Sprague interpolation coefficients and end extrapolation
// Rows are the offset in nm into a 10-nm interval; every row sums to kSpragueDivisor. A 5-nm
// interval uses rows 0, 2, 4, 6 and 8.
inline constexpr double kSpragueDivisor = 160000.0;
inline constexpr double kSpragueCoefficients[11][6] = {
    {0, 0, 160000, 0, 0, 0},
    {1215, -9381, 157614, 12094, -1581, 39},
    {2048, -15616, 149504, 27904, -4096, 256},
    {2401, -18431, 135394, 47594, -7651, 693},
    {2304, -18176, 116224, 70144, -11776, 1280},
    {1875, -15625, 93750, 93750, -15625, 1875},
    {1280, -11776, 70144, 116224, -18176, 2304},
    {693, -7651, 47594, 135394, -18431, 2401},
    {256, -4096, 27904, 149504, -15616, 2048},
    {39, -1581, 12094, 157614, -9381, 1215},
    {0, 0, 0, 160000, 0, 0},
};
// Two virtual values beyond an end from the six nearest real ones (nearest first): [0] is the
// outer (two beyond), [1] the inner (one beyond).
inline constexpr double kSpragueEndDivisor = 209.0;
inline constexpr double kSpragueEnd[2][6] = {
    {884, -1960, 3033, -2648, 1080, -180},
    {508, -540, 488, -367, 144, -24},
};
