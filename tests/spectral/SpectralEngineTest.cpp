#include <gtest/gtest.h>

#include <cmath>
#include <cstdio>
#include <vector>

#include "ColorSpaceSpectral.h"
#include "ColorTranslator.h"

namespace {

ColorSpaceStruct Books(int kind = 1, double temperature = 5003) {
    ColorSpaceStruct d;
    d.SetType(2);
    d.wavelengthStart = 380;
    d.wavelengthEnd = 730;
    d.wavelengthStep = 10;
    d.hasIlluminant = true;
    d.illuminant.SetIlluminant(kind, temperature);
    return d;
}

ColorSpaceStruct Of(int type, const ColorSpaceStruct& white) {
    ColorSpaceStruct d;
    d.SetType(type);
    d.hasIlluminant = white.hasIlluminant;
    d.illuminant = white.illuminant;
    return d;
}

TEST(SpectralEngine, PerfectWhiteIsLab100UnderItsOwnIlluminant) {
    for (auto [kind, temperature] : {std::pair{1, 5003.0}, {1, 6504.0}, {2, 6500.0}, {13, 0.0}}) {
        const ColorSpaceStruct source = Books(kind, temperature);
        cColorTranslator engine;
        engine.SetSource(source);
        ASSERT_EQ(engine.SetDestination(Of(3, source)), 0);
        ASSERT_EQ(engine.NodeCount(), 2);
        const std::vector<double> white(36, 1.0);
        double lab[3] = {-1, -1, -1};
        ASSERT_EQ(engine.Translate(white.data(), lab), 0);
        EXPECT_NEAR(lab[0], 100.0, 1e-9) << kind;
        EXPECT_NEAR(lab[1], 0.0, 1e-9) << kind;
        EXPECT_NEAR(lab[2], 0.0, 1e-9) << kind;
    }
}

TEST(SpectralEngine, NodeSelectionForSpectralSources) {
    const ColorSpaceStruct books = Books();
    ColorSpaceStruct fine = Books();
    fine.wavelengthStart = 400;
    fine.wavelengthEnd = 700;
    fine.wavelengthStep = 5;
    ColorSpaceStruct density;
    density.SetType(1);
    ColorSpaceStruct uv = books;
    uv.SetType(46);
    ColorSpaceStruct xyz10 = Of(6, books);
    xyz10.observer = 1;
    const struct {
        ColorSpaceStruct source, destination;
        int32_t build, nodes, firstOperation;
        bool failed;
    } cases[] = {
        {books, density, 0, 1, cColorTranslator::kConvert, false},
        {books, fine, 0, 1, cColorTranslator::kToSpectral, false},
        {books, Books(1, 6504), 0, 1, cColorTranslator::kToSpectral, false},
        {books, xyz10, 0, 2, cColorTranslator::kToXYZ, false},  // a spectrum has no observer to match
        {books, Of(24, books), 0, 2, cColorTranslator::kToXYZ, false},
        {uv, Of(3, books), 0, 0, 0, true},
        {uv, books, 0, 0, 0, true},
        {Of(3, books), books, kTranslatorRefused, 0, 0, true},
        {Of(3, books), density, kTranslatorRefused, 0, 0, true},
        {density, Of(3, books), kTranslatorRefused, 0, 0, true},
    };
    for (const auto& c : cases) {
        cColorTranslator engine;
        engine.SetSource(c.source);
        EXPECT_EQ(engine.SetDestination(c.destination), c.build)
            << c.source.type << "->" << c.destination.type;
        EXPECT_EQ(engine.NodeCount(), c.nodes) << c.source.type << "->" << c.destination.type;
        if (c.nodes > 0) {
            EXPECT_EQ(engine.NodeOperation(0), c.firstOperation);
        }
        std::vector<double> in(36, 0.5), out(61, -1.0);
        EXPECT_EQ(engine.Translate(in.data(), out.data()), c.failed ? 1 : 0)
            << c.source.type << "->" << c.destination.type;
    }
}

TEST(SpectralEngine, SpectraReachEveryOtherSpaceAndOtherGrids) {
    const ColorSpaceStruct books = Books();
    std::vector<double> grey(36, 0.18);
    cColorTranslator toSrgb;
    toSrgb.SetSource(books);
    toSrgb.SetDestination(Of(6, books));
    double xyz[3];
    ASSERT_EQ(toSrgb.Translate(grey.data(), xyz), 0);
    EXPECT_NEAR(xyz[1], 0.18, 1e-12);

    cColorTranslator densities;
    ColorSpaceStruct density;
    density.SetType(1);
    densities.SetSource(books);
    densities.SetDestination(density);
    std::vector<double> d(4);
    ASSERT_EQ(densities.Translate(std::vector<double>(36, 0.1).data(), d.data()), 0);
    EXPECT_NEAR(d[2], 1.0, 1e-12);

    ColorSpaceStruct fine = books;
    fine.wavelengthStep = 5;
    cColorTranslator resample;
    resample.SetSource(books);
    resample.SetDestination(fine);
    std::vector<double> line(36), out(71);
    for (int i = 0; i < 36; ++i) line[i] = 0.01 * i;
    ASSERT_EQ(resample.Translate(line.data(), out.data()), 0);
    for (int j = 0; j < 71; ++j) EXPECT_NEAR(out[j], 0.005 * j, 1e-12);
}

// CIE 13.3 test colour samples 1-15, 380-780 nm at 5 nm.
constexpr double kTestColourSamples[15][81] = {
    {0.22, 0.24, 0.25, 0.26, 0.26, 0.25, 0.25, 0.25, 0.24, 0.24, 0.24, 0.23, 0.23, 0.23, 0.23, 0.22, 0.22,
     0.22, 0.22, 0.21, 0.21, 0.21, 0.22, 0.22, 0.22, 0.23, 0.23, 0.23, 0.23, 0.23, 0.23, 0.23, 0.24, 0.25,
     0.25, 0.26, 0.27, 0.28, 0.3,  0.32, 0.34, 0.37, 0.39, 0.41, 0.42, 0.44, 0.44, 0.45, 0.45, 0.45, 0.45,
     0.45, 0.45, 0.45, 0.45, 0.45, 0.45, 0.45, 0.45, 0.45, 0.46, 0.46, 0.46, 0.46, 0.46, 0.46, 0.46, 0.47,
     0.47, 0.47, 0.47, 0.47, 0.47, 0.47, 0.47, 0.47, 0.47, 0.47, 0.47, 0.47, 0.47},
    {0.07, 0.08, 0.09, 0.1,  0.11, 0.12, 0.12, 0.12, 0.12, 0.12, 0.12, 0.12, 0.12, 0.12, 0.13, 0.13, 0.13,
     0.13, 0.14, 0.14, 0.15, 0.16, 0.17, 0.19, 0.21, 0.23, 0.24, 0.25, 0.26, 0.26, 0.27, 0.27, 0.27, 0.28,
     0.28, 0.29, 0.3,  0.31, 0.32, 0.33, 0.34, 0.34, 0.34, 0.34, 0.34, 0.34, 0.34, 0.34, 0.34, 0.34, 0.34,
     0.34, 0.34, 0.34, 0.34, 0.34, 0.33, 0.33, 0.33, 0.33, 0.33, 0.33, 0.33, 0.33, 0.33, 0.33, 0.33, 0.33,
     0.32, 0.32, 0.32, 0.32, 0.32, 0.32, 0.32, 0.32, 0.32, 0.32, 0.32, 0.31, 0.31},
    {0.07, 0.07, 0.07, 0.07, 0.07, 0.07, 0.07, 0.07, 0.07, 0.07, 0.07, 0.07, 0.07, 0.07, 0.07, 0.08, 0.08,
     0.08, 0.09, 0.09, 0.11, 0.13, 0.15, 0.17, 0.2,  0.22, 0.24, 0.26, 0.28, 0.3,  0.34, 0.37, 0.39, 0.4,
     0.4,  0.39, 0.38, 0.37, 0.35, 0.33, 0.32, 0.3,  0.29, 0.27, 0.26, 0.26, 0.25, 0.25, 0.24, 0.24, 0.23,
     0.22, 0.22, 0.22, 0.22, 0.22, 0.22, 0.22, 0.23, 0.24, 0.25, 0.27, 0.29, 0.31, 0.34, 0.37, 0.39, 0.41,
     0.43, 0.45, 0.46, 0.47, 0.48, 0.49, 0.49, 0.5,  0.5,  0.5,  0.51, 0.51, 0.52},
    {0.07, 0.08, 0.09, 0.11, 0.12, 0.12, 0.12, 0.13, 0.13, 0.13, 0.14, 0.14, 0.14, 0.15, 0.16, 0.17, 0.19,
     0.21, 0.23, 0.25, 0.28, 0.31, 0.33, 0.35, 0.37, 0.38, 0.39, 0.39, 0.4,  0.39, 0.39, 0.38, 0.37, 0.35,
     0.34, 0.33, 0.31, 0.3,  0.28, 0.26, 0.25, 0.23, 0.21, 0.2,  0.19, 0.18, 0.17, 0.16, 0.16, 0.16, 0.15,
     0.15, 0.15, 0.15, 0.15, 0.15, 0.15, 0.15, 0.15, 0.15, 0.16, 0.16, 0.17, 0.17, 0.17, 0.17, 0.17, 0.17,
     0.17, 0.16, 0.16, 0.17, 0.17, 0.17, 0.18, 0.18, 0.19, 0.19, 0.19, 0.19, 0.2},
    {0.3,  0.31, 0.31, 0.31, 0.31, 0.32, 0.32, 0.32, 0.33, 0.33, 0.33, 0.34, 0.35, 0.35, 0.36, 0.37, 0.38,
     0.39, 0.4,  0.41, 0.42, 0.42, 0.42, 0.42, 0.41, 0.41, 0.4,  0.4,  0.39, 0.38, 0.37, 0.36, 0.35, 0.34,
     0.33, 0.32, 0.31, 0.3,  0.28, 0.27, 0.26, 0.25, 0.23, 0.22, 0.21, 0.2,  0.19, 0.19, 0.19, 0.18, 0.18,
     0.18, 0.18, 0.18, 0.18, 0.18, 0.18, 0.18, 0.18, 0.18, 0.19, 0.19, 0.19, 0.2,  0.2,  0.2,  0.2,  0.2,
     0.2,  0.2,  0.2,  0.2,  0.2,  0.2,  0.2,  0.21, 0.21, 0.21, 0.22, 0.22, 0.22},
    {0.15, 0.2,  0.27, 0.34, 0.41, 0.46, 0.49, 0.51, 0.52, 0.52, 0.53, 0.54, 0.54, 0.55, 0.56, 0.56, 0.55,
     0.55, 0.54, 0.53, 0.52, 0.5,  0.49, 0.47, 0.45, 0.43, 0.41, 0.4,  0.38, 0.36, 0.34, 0.33, 0.31, 0.29,
     0.28, 0.27, 0.25, 0.24, 0.23, 0.23, 0.23, 0.22, 0.22, 0.22, 0.22, 0.22, 0.22, 0.22, 0.22, 0.23, 0.23,
     0.24, 0.24, 0.25, 0.26, 0.26, 0.27, 0.27, 0.28, 0.28, 0.28, 0.29, 0.29, 0.3,  0.3,  0.31, 0.33, 0.34,
     0.35, 0.36, 0.38, 0.39, 0.4,  0.41, 0.43, 0.44, 0.45, 0.46, 0.47, 0.48, 0.49},
    {0.38, 0.46, 0.52, 0.55, 0.55, 0.56, 0.56, 0.56, 0.56, 0.56, 0.56, 0.55, 0.54, 0.54, 0.52, 0.51, 0.49,
     0.47, 0.45, 0.43, 0.41, 0.39, 0.36, 0.34, 0.32, 0.31, 0.3,  0.29, 0.28, 0.27, 0.27, 0.26, 0.26, 0.26,
     0.26, 0.26, 0.26, 0.26, 0.26, 0.25, 0.25, 0.26, 0.27, 0.28, 0.3,  0.32, 0.34, 0.36, 0.38, 0.39, 0.4,
     0.41, 0.42, 0.43, 0.44, 0.45, 0.45, 0.46, 0.46, 0.47, 0.47, 0.47, 0.47, 0.48, 0.48, 0.49, 0.5,  0.5,
     0.51, 0.52, 0.53, 0.53, 0.54, 0.55, 0.55, 0.56, 0.57, 0.57, 0.58, 0.58, 0.58},
    {0.1,  0.13, 0.17, 0.24, 0.32, 0.42, 0.46, 0.48, 0.49, 0.49, 0.48, 0.47, 0.46, 0.45, 0.44, 0.43, 0.41,
     0.4,  0.38, 0.37, 0.35, 0.34, 0.33, 0.31, 0.3,  0.29, 0.28, 0.28, 0.27, 0.26, 0.26, 0.25, 0.25, 0.25,
     0.25, 0.26, 0.26, 0.27, 0.27, 0.27, 0.28, 0.28, 0.3,  0.32, 0.35, 0.38, 0.43, 0.48, 0.53, 0.57, 0.6,
     0.63, 0.65, 0.66, 0.68, 0.69, 0.69, 0.7,  0.71, 0.71, 0.71, 0.72, 0.72, 0.72, 0.72, 0.72, 0.72, 0.72,
     0.73, 0.73, 0.73, 0.73, 0.73, 0.73, 0.73, 0.73, 0.73, 0.73, 0.73, 0.73, 0.73},
    {0.066, 0.062, 0.058, 0.055, 0.052, 0.052, 0.051, 0.050, 0.050, 0.049, 0.048, 0.047, 0.046, 0.044,
     0.042, 0.041, 0.038, 0.035, 0.033, 0.031, 0.030, 0.029, 0.028, 0.028, 0.028, 0.029, 0.030, 0.030,
     0.031, 0.031, 0.032, 0.032, 0.033, 0.034, 0.035, 0.037, 0.041, 0.044, 0.048, 0.052, 0.060, 0.076,
     0.102, 0.136, 0.190, 0.256, 0.336, 0.418, 0.505, 0.581, 0.641, 0.682, 0.717, 0.740, 0.758, 0.770,
     0.781, 0.790, 0.797, 0.803, 0.809, 0.814, 0.819, 0.824, 0.828, 0.830, 0.831, 0.833, 0.835, 0.836,
     0.836, 0.837, 0.838, 0.839, 0.839, 0.839, 0.839, 0.839, 0.839, 0.839, 0.839},
    {0.05, 0.05, 0.06, 0.06, 0.07, 0.07, 0.07, 0.07, 0.07, 0.07, 0.07, 0.07, 0.08, 0.08, 0.08, 0.09, 0.1,
     0.1,  0.11, 0.13, 0.14, 0.16, 0.19, 0.22, 0.26, 0.31, 0.37, 0.42, 0.47, 0.51, 0.55, 0.58, 0.61, 0.63,
     0.65, 0.67, 0.68, 0.69, 0.69, 0.7,  0.7,  0.7,  0.71, 0.71, 0.71, 0.71, 0.71, 0.71, 0.71, 0.71, 0.71,
     0.71, 0.71, 0.71, 0.72, 0.72, 0.72, 0.72, 0.73, 0.73, 0.73, 0.74, 0.74, 0.74, 0.75, 0.75, 0.75, 0.75,
     0.75, 0.75, 0.76, 0.76, 0.76, 0.76, 0.76, 0.76, 0.76, 0.76, 0.76, 0.76, 0.76},
    {0.11, 0.12, 0.13, 0.13, 0.13, 0.12, 0.12, 0.11, 0.11, 0.11, 0.1,  0.1,  0.11, 0.11, 0.11, 0.12, 0.12,
     0.13, 0.15, 0.17, 0.19, 0.22, 0.25, 0.29, 0.33, 0.35, 0.36, 0.35, 0.35, 0.33, 0.31, 0.29, 0.27, 0.25,
     0.23, 0.21, 0.19, 0.17, 0.15, 0.14, 0.13, 0.11, 0.11, 0.1,  0.1,  0.09, 0.09, 0.09, 0.09, 0.08, 0.08,
     0.08, 0.08, 0.08, 0.08, 0.08, 0.08, 0.08, 0.09, 0.09, 0.1,  0.11, 0.13, 0.14, 0.16, 0.18, 0.2,  0.22,
     0.24, 0.26, 0.27, 0.28, 0.29, 0.3,  0.31, 0.31, 0.32, 0.32, 0.33, 0.33, 0.34},
    {0.12, 0.1,  0.09, 0.08, 0.08, 0.07, 0.06, 0.07, 0.08, 0.09, 0.12, 0.16, 0.21, 0.26, 0.3,  0.33, 0.35,
     0.35, 0.34, 0.33, 0.31, 0.28, 0.26, 0.23, 0.2,  0.18, 0.15, 0.13, 0.11, 0.09, 0.08, 0.06, 0.05, 0.04,
     0.04, 0.03, 0.03, 0.02, 0.02, 0.02, 0.02, 0.02, 0.02, 0.02, 0.02, 0.02, 0.02, 0.02, 0.02, 0.02, 0.02,
     0.02, 0.02, 0.02, 0.02, 0.02, 0.02, 0.02, 0.03, 0.03, 0.04, 0.04, 0.06, 0.07, 0.1,  0.13, 0.17, 0.21,
     0.26, 0.31, 0.35, 0.4,  0.45, 0.49, 0.52, 0.55, 0.58, 0.6,  0.62, 0.63, 0.65},
    {0.1,  0.13, 0.16, 0.21, 0.26, 0.31, 0.34, 0.35, 0.36, 0.36, 0.36, 0.37, 0.37, 0.37, 0.37, 0.37, 0.38,
     0.38, 0.38, 0.39, 0.4,  0.41, 0.42, 0.43, 0.44, 0.45, 0.46, 0.47, 0.47, 0.47, 0.47, 0.48, 0.48, 0.49,
     0.51, 0.53, 0.55, 0.58, 0.62, 0.65, 0.68, 0.7,  0.72, 0.73, 0.74, 0.74, 0.75, 0.75, 0.75, 0.75, 0.75,
     0.75, 0.75, 0.75, 0.75, 0.75, 0.75, 0.75, 0.75, 0.75, 0.75, 0.75, 0.75, 0.75, 0.75, 0.75, 0.75, 0.74,
     0.74, 0.74, 0.75, 0.75, 0.75, 0.75, 0.75, 0.75, 0.75, 0.75, 0.75, 0.75, 0.75},
    {0.04, 0.04, 0.04, 0.04, 0.04, 0.04, 0.04, 0.04, 0.04, 0.04, 0.04, 0.04, 0.04, 0.05, 0.05, 0.05, 0.05,
     0.05, 0.05, 0.05, 0.06, 0.06, 0.06, 0.07, 0.08, 0.08, 0.09, 0.1,  0.11, 0.12, 0.13, 0.14, 0.15, 0.15,
     0.16, 0.15, 0.15, 0.14, 0.13, 0.13, 0.12, 0.11, 0.11, 0.1,  0.1,  0.1,  0.09, 0.09, 0.09, 0.09, 0.09,
     0.09, 0.08, 0.08, 0.08, 0.08, 0.09, 0.09, 0.09, 0.1,  0.1,  0.11, 0.12, 0.14, 0.15, 0.17, 0.19, 0.21,
     0.23, 0.24, 0.26, 0.28, 0.29, 0.31, 0.33, 0.34, 0.35, 0.37, 0.38, 0.39, 0.4},
    {0.13, 0.14, 0.15, 0.15, 0.16, 0.16, 0.16, 0.17, 0.17, 0.18, 0.18, 0.19, 0.2,  0.21, 0.22, 0.23, 0.24,
     0.24, 0.25, 0.25, 0.26, 0.26, 0.27, 0.28, 0.28, 0.29, 0.3,  0.3,  0.3,  0.29, 0.28, 0.28, 0.27, 0.28,
     0.28, 0.29, 0.29, 0.29, 0.29, 0.28, 0.29, 0.31, 0.35, 0.4,  0.44, 0.47, 0.49, 0.51, 0.52, 0.54, 0.54,
     0.55, 0.56, 0.57, 0.57, 0.58, 0.58, 0.59, 0.59, 0.59, 0.6,  0.6,  0.61, 0.61, 0.61, 0.61, 0.62, 0.62,
     0.62, 0.62, 0.62, 0.61, 0.61, 0.61, 0.61, 0.61, 0.61, 0.61, 0.61, 0.61, 0.61},
};

// The 36-band grid of the books against the full 5-nm curve, under D65 and the 1931 observer.
TEST(SpectralEngine, TestColourSamplesOnTheBookGridStayCloseToTheFineGrid) {
    ColorSpaceStruct fine = Books(1, 6504);
    fine.wavelengthEnd = 780;
    fine.wavelengthStep = 5;
    const ColorSpaceStruct coarse = Books(1, 6504);
    cColorTranslator fineEngine, coarseEngine;
    fineEngine.SetSource(fine);
    fineEngine.SetDestination(Of(3, fine));
    coarseEngine.SetSource(coarse);
    coarseEngine.SetDestination(Of(3, coarse));
    double largest = 0;
    int worst = 0;
    for (int s = 0; s < 15; ++s) {
        double bands[36];
        for (int b = 0; b < 36; ++b) bands[b] = kTestColourSamples[s][2 * b];
        double a[3], b[3];
        ASSERT_EQ(fineEngine.Translate(kTestColourSamples[s], a), 0);
        ASSERT_EQ(coarseEngine.Translate(bands, b), 0);
        const double difference =
            std::sqrt(std::pow(a[0] - b[0], 2) + std::pow(a[1] - b[1], 2) + std::pow(a[2] - b[2], 2));
        if (difference > largest) {
            largest = difference;
            worst = s + 1;
        }
        EXPECT_GT(difference, 0.0);
    }
    std::printf("largest Delta E*ab, 36 bands vs 5 nm: %.4f (TCS%02d)\n", largest, worst);
    EXPECT_LT(largest, 0.6);
}

}  // namespace
