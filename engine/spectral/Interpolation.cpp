#include "Interpolation.h"

#include <algorithm>
#include <cmath>

namespace {

// Index lo of the segment [x[lo], x[lo + 1]] that holds at, ends extended.
int32_t Segment(const double* x, int32_t n, double at) {
    if (at < x[0]) return 0;
    if (at > x[n - 1]) return n - 2;
    int32_t lo = 0, hi = n - 1;
    while (hi - lo > 1) {
        const int32_t mid = (lo + hi) / 2;
        if (at < x[mid]) {
            hi = mid;
        } else {
            lo = mid;
        }
    }
    return lo;
}

// Sign agreement of two numbers: -1, 0 or 1.
double SignTest(double a, double b) {
    return (a > 0.0 ? 1.0 : a < 0.0 ? -1.0 : 0.0) * (b > 0.0 ? 1.0 : b < 0.0 ? -1.0 : 0.0);
}

}  // namespace

double LinearInterpolate(const double* x, const double* y, int32_t n, double at) {
    if (n <= 0) return 0.0;
    if (n == 1) return y[0];
    const int32_t lo = Segment(x, n, at);
    const double width = x[lo + 1] - x[lo];
    if (width == 0.0) return 0.0;
    const double t = (at - x[lo]) / width;
    return (1.0 - t) * y[lo] + t * y[lo + 1];
}

int32_t PchipDerivatives(const double* x, const double* f, int32_t n, double* d) {
    if (n < 2) return kPchipTooFewPoints;
    for (int32_t i = 1; i < n; ++i) {
        if (!(x[i] > x[i - 1])) return kPchipNotIncreasing;
    }
    double h1 = x[1] - x[0];
    double del1 = (f[1] - f[0]) / h1;
    if (n == 2) {
        d[0] = d[1] = del1;
        return 0;
    }
    double h2 = x[2] - x[1];
    double del2 = (f[2] - f[1]) / h2;
    double hsum = h1 + h2;

    // Three-point end formula, kept shape preserving.
    d[0] = ((h1 + hsum) / hsum) * del1 + (-h1 / hsum) * del2;
    if (SignTest(d[0], del1) <= 0.0) {
        d[0] = 0.0;
    } else if (SignTest(del1, del2) < 0.0 && std::fabs(d[0]) > std::fabs(3.0 * del1)) {
        d[0] = 3.0 * del1;
    }

    for (int32_t i = 1; i < n - 1; ++i) {
        if (i > 1) {
            h1 = h2;
            h2 = x[i + 1] - x[i];
            hsum = h1 + h2;
            del1 = del2;
            del2 = (f[i + 1] - f[i]) / h2;
        }
        d[i] = 0.0;
        if (SignTest(del1, del2) > 0.0) {
            // Brodlie's weighted harmonic mean keeps the interpolant monotone.
            const double hsumt3 = 3.0 * hsum;
            const double w1 = (hsum + h1) / hsumt3;
            const double w2 = (hsum + h2) / hsumt3;
            const double dmax = std::max(std::fabs(del1), std::fabs(del2));
            const double dmin = std::min(std::fabs(del1), std::fabs(del2));
            d[i] = dmin / (w1 * (del1 / dmax) + w2 * (del2 / dmax));
        }
    }

    d[n - 1] = (-h2 / hsum) * del1 + ((h2 + hsum) / hsum) * del2;
    if (SignTest(d[n - 1], del2) <= 0.0) {
        d[n - 1] = 0.0;
    } else if (SignTest(del1, del2) < 0.0 && std::fabs(d[n - 1]) > std::fabs(3.0 * del2)) {
        d[n - 1] = 3.0 * del2;
    }
    return 0;
}

void PchipEvaluate(const double* x, const double* f, const double* d, int32_t n, const double* xe, int32_t ne,
                   double* fe) {
    int32_t i = 0;
    for (int32_t k = 0; k < ne; ++k) {
        // Targets usually ascend: walk on from the last segment, search only when they do not.
        if (xe[k] < x[i] && i > 0) {
            i = Segment(x, n, xe[k]);
        } else {
            while (i < n - 2 && xe[k] >= x[i + 1]) ++i;
        }
        const double h = x[i + 1] - x[i];
        const double delta = (f[i + 1] - f[i]) / h;
        const double del1 = (d[i] - delta) / h;
        const double del2 = (d[i + 1] - delta) / h;
        const double c2 = -(del1 + del1 + del2);
        const double c3 = (del1 + del2) / h;
        const double t = xe[k] - x[i];
        fe[k] = f[i] + t * (d[i] + t * (c2 + t * c3));
    }
}

std::vector<double> EvenSplineCurvatures(const double* y, int32_t n) {
    // Rows 1 to n - 2 of m[i-1] + 4 m[i] + m[i+1] = 6 (y[i-1] - 2 y[i] + y[i+1]). Not-a-knot ends,
    // m[0] = 2 m[1] - m[2] and its mirror, turn the first and last rows into 6 m = 6 (...).
    std::vector<double> m(n, 0.0);
    const int32_t rows = n - 2;
    std::vector<double> diagonal(rows, 4.0), upper(rows, 1.0), rhs(rows);
    for (int32_t r = 0; r < rows; ++r) rhs[r] = 6.0 * (y[r] - 2.0 * y[r + 1] + y[r + 2]);
    diagonal[0] = diagonal[rows - 1] = 6.0;
    upper[0] = 0.0;
    for (int32_t r = 1; r < rows; ++r) {
        const double lower = r == rows - 1 ? 0.0 : 1.0;
        const double w = lower / diagonal[r - 1];
        diagonal[r] -= w * upper[r - 1];
        rhs[r] -= w * rhs[r - 1];
    }
    m[rows] = rhs[rows - 1] / diagonal[rows - 1];
    for (int32_t r = rows - 2; r >= 0; --r) m[r + 1] = (rhs[r] - upper[r] * m[r + 2]) / diagonal[r];
    m[0] = 2.0 * m[1] - m[2];
    m[n - 1] = 2.0 * m[n - 2] - m[n - 3];
    return m;
}

double EvenSplineValue(const double* y, const double* curvatures, int32_t n, double position) {
    const int32_t i = std::clamp(static_cast<int32_t>(std::floor(position)), 0, n - 2);
    const double u = position - i;
    const double v = 1.0 - u;
    return v * y[i] + u * y[i + 1] +
           ((v * v * v - v) * curvatures[i] + (u * u * u - u) * curvatures[i + 1]) / 6.0;
}
