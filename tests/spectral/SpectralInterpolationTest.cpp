#include <gtest/gtest.h>

#include <vector>

#include "Interpolation.h"

namespace {

TEST(LinearInterpolation, InterpolatesInsideAndExtendsTheEndSegments) {
    const double x[] = {0, 1, 3};
    const double y[] = {0, 2, 0};
    const struct {
        double at, expected;
    } cases[] = {{0.5, 1.0}, {1.0, 2.0}, {2.0, 1.0}, {-1.0, -2.0}, {4.0, -1.0}, {3.0, 0.0}};
    for (const auto& c : cases) EXPECT_DOUBLE_EQ(LinearInterpolate(x, y, 3, c.at), c.expected) << c.at;
    const double flat[] = {2, 2};
    EXPECT_EQ(LinearInterpolate(flat, y, 2, 2.0), 0.0);  // zero-width segment
}

TEST(Pchip, RejectsTooFewPointsAndUnorderedAbscissae) {
    double d[3];
    const double x1[] = {1}, f[] = {1, 2, 3};
    EXPECT_EQ(PchipDerivatives(x1, f, 1, d), kPchipTooFewPoints);
    const double unordered[] = {0, 2, 2};
    EXPECT_EQ(PchipDerivatives(unordered, f, 3, d), kPchipNotIncreasing);
    const double two[] = {0, 4};
    ASSERT_EQ(PchipDerivatives(two, f, 2, d), 0);
    EXPECT_DOUBLE_EQ(d[0], 0.25);
    EXPECT_DOUBLE_EQ(d[1], 0.25);
}

TEST(Pchip, ReproducesLinesAndKnotsAndPreservesMonotonicity) {
    // A straight line is reproduced everywhere, also beyond the ends.
    const std::vector<double> x = {0, 1, 2.5, 4, 7};
    std::vector<double> line(x.size()), d(x.size());
    for (size_t i = 0; i < x.size(); ++i) line[i] = 3 * x[i] - 1;
    ASSERT_EQ(PchipDerivatives(x.data(), line.data(), 5, d.data()), 0);
    const std::vector<double> at = {-1, 0.3, 2.5, 5.2, 8};
    std::vector<double> out(at.size());
    PchipEvaluate(x.data(), line.data(), d.data(), 5, at.data(), 5, out.data());
    for (size_t i = 0; i < at.size(); ++i) EXPECT_NEAR(out[i], 3 * at[i] - 1, 1e-12) << at[i];

    // A step stays within its data and never turns back (no overshoot, unlike a spline).
    const std::vector<double> step = {0, 0, 1, 1, 1};
    ASSERT_EQ(PchipDerivatives(x.data(), step.data(), 5, d.data()), 0);
    double previous = -1;
    for (double t = 0; t <= 7; t += 0.05) {
        double v;
        PchipEvaluate(x.data(), step.data(), d.data(), 5, &t, 1, &v);
        EXPECT_GE(v, previous - 1e-15) << t;
        EXPECT_GE(v, 0.0);
        EXPECT_LE(v, 1.0);
        previous = v;
    }
    // Knots are hit exactly, and a local extremum gets a flat tangent.
    const std::vector<double> peak = {0, 2, 1, 3, 0};
    ASSERT_EQ(PchipDerivatives(x.data(), peak.data(), 5, d.data()), 0);
    EXPECT_EQ(d[1], 0.0);
    EXPECT_EQ(d[3], 0.0);
    PchipEvaluate(x.data(), peak.data(), d.data(), 5, x.data(), 5, out.data());
    for (size_t i = 0; i < x.size(); ++i) EXPECT_NEAR(out[i], peak[i], 1e-12);
}

TEST(EvenSpline, ReproducesCubicsAndPassesThroughItsPoints) {
    // Not-a-knot ends reproduce any cubic, between the points and just beyond them.
    auto cubic = [](double t) { return 0.5 - 1.5 * t + 0.25 * t * t - 0.02 * t * t * t; };
    for (int n : {4, 5, 9}) {
        std::vector<double> y(n);
        for (int i = 0; i < n; ++i) y[i] = cubic(i);
        const std::vector<double> curvatures = EvenSplineCurvatures(y.data(), n);
        for (double t = -0.5; t <= n - 0.5; t += 0.25) {
            EXPECT_NEAR(EvenSplineValue(y.data(), curvatures.data(), n, t), cubic(t), 1e-12) << n << " " << t;
        }
    }
    // Through any data it meets its points.
    const std::vector<double> bumpy = {0, 3, -1, 4, 4, 0, 2};
    const std::vector<double> curvatures = EvenSplineCurvatures(bumpy.data(), 7);
    for (int i = 0; i < 7; ++i)
        EXPECT_NEAR(EvenSplineValue(bumpy.data(), curvatures.data(), 7, i), bumpy[i], 1e-12);
}

}  // namespace
