#pragma once

#include <cstdint>
#include <vector>

// Linear interpolation over ascending abscissae x[0..n-1]; the end segments are extended
// beyond the table. A zero-width segment gives 0.
double LinearInterpolate(const double* x, const double* y, int32_t n, double at);

// Monotone piecewise cubic Hermite interpolation (the SLATEC PCHIM/PCHFE pair).
// Derivatives: 0 on success, -1 for fewer than two points, -3 when x is not strictly increasing.
inline constexpr int32_t kPchipTooFewPoints = -1;
inline constexpr int32_t kPchipNotIncreasing = -3;
int32_t PchipDerivatives(const double* x, const double* f, int32_t n, double* d);
// Evaluates at xe[0..ne-1]; outside the table the end cubics are extended.
void PchipEvaluate(const double* x, const double* f, const double* d, int32_t n, const double* xe, int32_t ne,
                   double* fe);

// Not-a-knot cubic spline through evenly spaced values y[0..n-1], n >= 4: its second
// derivatives at the points, in units of the spacing.
std::vector<double> EvenSplineCurvatures(const double* y, int32_t n);
// The spline at position (in spacings from y[0]); outside the points the end cubics extend.
double EvenSplineValue(const double* y, const double* curvatures, int32_t n, double position);
