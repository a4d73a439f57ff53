#include <gtest/gtest.h>

#include <cmath>
#include <vector>

#include "ColorSpaceDensity.h"

namespace {

ColorSpaceStruct Grid(double start, double end, double step) {
    ColorSpaceStruct d;
    d.SetType(2);
    d.wavelengthStart = start;
    d.wavelengthEnd = end;
    d.wavelengthStep = step;
    return d;
}

std::vector<double> Densities(const std::vector<double>& spectrum, const ColorSpaceStruct& source,
                              const ColorSpaceStruct& destination) {
    cColorSpaceDensity node(destination, source);
    std::vector<double> out(4, -1.0);
    node.Convert(spectrum.data(), out.data());
    return out;
}

TEST(SpectralDensity, PublishedExamples) {
    ColorSpaceStruct density;
    density.SetType(1);
    const ColorSpaceStruct books = Grid(380, 730, 10);
    std::vector<double> half(36, 1.0);
    for (int i = 18; i < 36; ++i) half[i] = 0.5;  // 560 nm upward
    const struct {
        std::vector<double> spectrum;
        double expected[4];
        double tolerance;
    } cases[] = {
        {std::vector<double>(36, 1.0), {0, 0, 0, 0}, 0.0},
        {std::vector<double>(36, 0.1), {0.99999, 0.99998, 1.0, 0.9998}, 1e-9},
        {half, {0.99999 * std::log10(2.0), NAN, 0.0, NAN}, 1e-6},
    };
    for (const auto& c : cases) {
        const std::vector<double> d = Densities(c.spectrum, books, density);
        for (int k = 0; k < 4; ++k) {
            if (!std::isnan(c.expected[k])) {
                EXPECT_NEAR(d[k], c.expected[k], c.tolerance) << k;
            }
        }
    }
}

TEST(SpectralDensity, WeightsFollowTheGridAndIgnoreUnweightedBlackBands) {
    ColorSpaceStruct density;
    density.SetType(1);
    // A finer grid carries the 10-nm functions by interpolation: sums double at 5 nm.
    const std::vector<double> fine = Densities(std::vector<double>(81, 0.1), Grid(380, 780, 5), density);
    EXPECT_NEAR(fine[2], 2.0, 0.01);
    // Black where the red function has no weight leaves red finite; blue sees the black.
    std::vector<double> spectrum(36, 0.5);
    for (int i = 0; i < 10; ++i) spectrum[i] = 0.0;  // 380-470 nm
    const std::vector<double> d = Densities(spectrum, Grid(380, 730, 10), density);
    EXPECT_NEAR(d[0], 0.99999 * std::log10(2.0), 1e-9);
    EXPECT_TRUE(std::isinf(d[2]));
    // An illuminant as reference: densities relative to its power near 100.
    density.hasIlluminant = true;
    density.illuminant.SetIlluminant(IlluminantKind::E, 0);
    const std::vector<double> e = Densities(std::vector<double>(36, 1.0), Grid(380, 730, 10), density);
    EXPECT_NEAR(e[2], 2.0, 1e-9);
}

}  // namespace
