#include <gtest/gtest.h>

#include <cmath>
#include <vector>

#include "ColorSpaceSpectral.h"

namespace {

ColorSpaceStruct Spectral(double start, double end, double step, int weighting, int kind = 1,
                          double temperature = 5003, int observer = 0) {
    ColorSpaceStruct d;
    d.SetType(2);
    d.wavelengthStart = start;
    d.wavelengthEnd = end;
    d.wavelengthStep = step;
    d.weighting = weighting;
    d.observer = observer;
    d.hasIlluminant = true;
    d.illuminant.observer = observer;
    d.illuminant.SetIlluminant(static_cast<IlluminantKind>(kind), temperature);
    return d;
}

std::vector<double> Ramp(int bands) {
    std::vector<double> v(bands);
    for (int i = 0; i < bands; ++i) v[i] = 0.1 + 0.8 * std::pow(std::sin(0.11 * i), 2);
    return v;
}

std::vector<double> Xyz(const ColorSpaceStruct& d, const std::vector<double>& spectrum) {
    cColorSpaceSpectral node(d, d);
    std::vector<double> out(3, -7.0);
    node.ToXYZ(spectrum.data(), out.data());
    return out;
}

TEST(SpectralNode, PerfectDiffuserGivesTheIlluminantWhiteInEveryComputedMode) {
    for (int weighting : {4, 0, 1, 5}) {
        const std::vector<double> xyz = Xyz(Spectral(380, 730, 10, weighting), std::vector<double>(36, 1.0));
        EXPECT_NEAR(xyz[0], 0.96422, 1e-14) << weighting;
        EXPECT_NEAR(xyz[1], 1.0, 1e-14) << weighting;
        EXPECT_NEAR(xyz[2], 0.82521, 1e-14) << weighting;
        EXPECT_EQ(Xyz(Spectral(380, 730, 10, weighting), std::vector<double>(36, 0.0)),
                  std::vector<double>(3, 0.0));
    }
    // The fixed sets carry their own rounding: sums of three-decimal weights.
    const std::vector<double> fixed = Xyz(Spectral(380, 730, 10, 2), std::vector<double>(36, 1.0));
    EXPECT_NEAR(fixed[0], 0.96422, 5e-5);
    EXPECT_NEAR(fixed[1], 1.0, 5e-5);
    EXPECT_NEAR(fixed[2], 0.82521, 5e-5);
}

TEST(SpectralNode, MethodsAgreeClosely) {
    const std::vector<double> sample = Ramp(36);
    const std::vector<double> sprague = Xyz(Spectral(380, 730, 10, 4), sample);
    for (int weighting : {0, 1, 2, 5}) {
        const std::vector<double> other = Xyz(Spectral(380, 730, 10, weighting), sample);
        double largest = 0;
        for (int c = 0; c < 3; ++c) largest = std::max(largest, std::fabs(other[c] - sprague[c]));
        EXPECT_GT(largest, 1e-6) << weighting;  // a different integration, not the same weights
        EXPECT_LT(largest, 5e-3) << weighting;
    }
}

TEST(SpectralNode, ModeSelection) {
    using M = SpectralIntegration;
    const struct {
        ColorSpaceStruct description;
        SpectralIntegration mode;
    } cases[] = {
        // clang-format off
        {Spectral(380, 730, 10, 4), M::Sprague},           {Spectral(380, 730, 5, 4), M::Sprague},
        {Spectral(380, 720, 20, 4), M::OneNanometre},      {Spectral(380.5, 730.5, 10, 4), M::OneNanometre},
        {Spectral(380.5, 730.5, 10, 5), M::OneNanometre},  {Spectral(380, 730, 10, 5), M::Lagrange},
        {Spectral(380, 730, 10, 1), M::OneNanometre},      {Spectral(380, 730, 10, 0), M::Direct},
        {Spectral(380, 730, 10, 7), M::Direct},            {Spectral(380, 730, 10, 2), M::FixedTable},
        {Spectral(380, 730, 10, 3), M::FixedTable},        {Spectral(380, 730, 10, 2, 3, 0), M::FixedTable},
        {Spectral(380, 730, 10, 2, 13, 0), M::FixedTable}, {Spectral(380, 730, 10, 3, 3, 0), M::Sprague},
        {Spectral(380, 730, 10, 2, 1, 6504), M::Sprague},  {Spectral(380, 730, 10, 2, 1, 5003, 1), M::Sprague},
        {Spectral(385, 735, 10, 2), M::Sprague},           {Spectral(380, 720, 20, 2), M::OneNanometre},
        {Spectral(380, 420, 10, 4), M::OneNanometre},  // too few bands for the end kernel
        // clang-format on
    };
    for (const auto& c : cases) {
        const cColorSpaceSpectral node(c.description, c.description);
        EXPECT_EQ(node.Mode(), c.mode)
            << c.description.wavelengthStart << " " << c.description.wavelengthStep << " w"
            << c.description.weighting << " kind " << c.description.illuminant.kind;
    }
}

TEST(SpectralNode, FixedSetCarriesTheRowsOutsideTheBandsOnTheEndBands) {
    // With bands 400-700 the rows 360-390 land on band 0 and 710-780 on the last band, so the
    // white is still the full table sum.
    const std::vector<double> xyz = Xyz(Spectral(400, 700, 10, 2), std::vector<double>(31, 1.0));
    const std::vector<double> full = Xyz(Spectral(380, 730, 10, 2), std::vector<double>(36, 1.0));
    for (int c = 0; c < 3; ++c) EXPECT_NEAR(xyz[c], full[c], 1e-12);
}

TEST(SpectralNode, EmissiveUsesTheObserversOwnEqualEnergyWhiteAndTheLuminousFactor) {
    for (int observer : {0, 1, 2}) {
        ColorSpaceStruct d = Spectral(380, 730, 10, 4, 1, 5003, observer);
        d.emissive = true;
        IlluminantStruct equalEnergy;
        equalEnergy.observer = observer;
        equalEnergy.SetIlluminant(IlluminantKind::E, 0);
        const std::vector<double> xyz = Xyz(d, std::vector<double>(36, 1.0));
        EXPECT_NEAR(xyz[1], 68.3, 1e-9) << observer;
        EXPECT_NEAR(xyz[0], 68.3 * equalEnergy.relativeWhite[0], 1e-9) << observer;
        EXPECT_NEAR(xyz[2], 68.3 * equalEnergy.relativeWhite[2], 1e-9) << observer;
    }
}

TEST(SpectralNode, UnavailableIlluminantActsAsNone) {
    const std::vector<double> sample = Ramp(36);
    EXPECT_EQ(Xyz(Spectral(380, 730, 10, 4, 11, 0), sample), Xyz(Spectral(380, 730, 10, 4, 0, 0), sample));
    const std::vector<double> none = Xyz(Spectral(380, 730, 10, 4, 0, 0), std::vector<double>(36, 1.0));
    for (double v : none) EXPECT_NEAR(v, 1.0, 1e-14);
}

TEST(SpectralNode, DegenerateGridsStayFinite) {
    // Too few bands for a cubic: weights 0, channels 0, never inf or NaN.
    EXPECT_EQ(Xyz(Spectral(380, 400, 10, 5), {1, 1, 1}), std::vector<double>(3, 0.0));
    // Zero-width range and zero step: nothing written.
    EXPECT_EQ(Xyz(Spectral(500, 500, 10, 4), {1}), std::vector<double>(3, -7.0));
    EXPECT_EQ(Xyz(Spectral(380, 730, 0, 0), {1}), std::vector<double>(3, -7.0));
    // z-bar ends below a grid of 800-900 nm: its whole weight sits on the first band.
    std::vector<double> infrared(11, 0.0);
    infrared[0] = 1.0;
    const std::vector<double> xyz = Xyz(Spectral(800, 900, 10, 0), infrared);
    EXPECT_NEAR(xyz[2], 0.82521, 1e-12);
    EXPECT_LT(xyz[1], 1.0);
}

TEST(SpectralNode, ResamplesBetweenGrids) {
    const ColorSpaceStruct coarse = Spectral(380, 730, 10, 4);
    const std::vector<double> sample = Ramp(36);
    std::vector<double> copy(36, 0.0);
    cColorSpaceSpectral same(coarse, Spectral(380, 730, 10, 0, 1, 6504));
    same.ToSpectral(sample.data(), copy.data());
    EXPECT_EQ(copy, sample);

    // A straight line survives the monotone cubic exactly, both ways.
    const ColorSpaceStruct fine = Spectral(400, 700, 5, 4);
    std::vector<double> line(36), fineOut(61), back(36);
    for (int i = 0; i < 36; ++i) line[i] = 0.2 + 0.01 * i;
    cColorSpaceSpectral node(coarse, fine);
    node.ToSpectral(line.data(), fineOut.data());
    for (int j = 0; j < 61; ++j) EXPECT_NEAR(fineOut[j], 0.2 + 0.01 * (400 + 5 * j - 380) / 10, 1e-12) << j;
    node.FromSpectral(fineOut.data(), back.data());
    for (int i = 0; i < 36; ++i) EXPECT_NEAR(back[i], line[i], 1e-12) << i;
}

}  // namespace
