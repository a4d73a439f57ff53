#include <gtest/gtest.h>

#include <array>
#include <cmath>

#include "ColorSpaceLab.h"
#include "ColorSpaceLch.h"
#include "ColorSpaceLinearRIMM.h"
#include "ColorSpaceSRGB.h"
#include "ColorSpaceYxy.h"

namespace {

using Triple = std::array<double, 3>;

void ExpectNear(const Triple& actual, const Triple& expected, double tolerance) {
    for (int i = 0; i < 3; ++i) EXPECT_NEAR(actual[i], expected[i], tolerance) << "channel " << i;
}

TEST(LabNode, WhiteBlackAndThresholds) {
    cColorSpaceLab lab{ColorSpaceStruct()};
    Triple xyz{};
    Triple back{};
    lab.ToXYZ(Triple{100, 0, 0}.data(), xyz.data());
    ExpectNear(xyz, {0.96422, 1.0, 0.82521}, 1e-15);
    lab.FromXYZ(xyz.data(), back.data());
    ExpectNear(back, {100, 0, 0}, 1e-12);
    // fy = 16/116 takes the linear branch and gives exactly 0.
    lab.ToXYZ(Triple{0, 0, 0}.data(), xyz.data());
    EXPECT_EQ(xyz[1], 0.0);
    // The cube above fy = 0.2069 (not 6/29), the 7.7867 slope below it.
    lab.ToXYZ(Triple{116.0 * 0.20691 - 16.0, 0, 0}.data(), xyz.data());
    EXPECT_DOUBLE_EQ(xyz[1], std::pow(0.20691, 3.0));
    lab.ToXYZ(Triple{116.0 * 0.2068 - 16.0, 0, 0}.data(), xyz.data());
    EXPECT_NEAR(xyz[1], (0.2068 - 16.0 / 116.0) / 7.7867, 1e-15);
    // Y/Yn of exactly 0.008856 takes the linear branch.
    lab.FromXYZ(Triple{0.0, 0.008856, 0.0}.data(), back.data());
    EXPECT_NEAR(back[0], 116.0 * (7.7867 * 0.008856 + 16.0 / 116.0) - 16.0, 1e-12);
}

TEST(LabAndLchNodes, OnlyLchClampsNegativeComponents) {
    const ColorSpaceStruct d;
    cColorSpaceLab lab(d);
    cColorSpaceLch lch(d);
    const Triple labColor{50, 0, 150};
    Triple fromLab{};
    lab.ToXYZ(labColor.data(), fromLab.data());
    EXPECT_LT(fromLab[2], 0.0);
    Triple lchColor{};
    cColorSpace::LabToLch(labColor.data(), lchColor.data());
    Triple fromLch{};
    lch.ToXYZ(lchColor.data(), fromLch.data());
    EXPECT_EQ(fromLch[2], 0.0);
    EXPECT_NEAR(fromLch[1], fromLab[1], 1e-12);
}

TEST(LabToLch, HueQuadrants) {
    const std::pair<Triple, Triple> cases[] = {{{50, 0, -10}, {50, 10, 270}},
                                               {{50, -10, 0}, {50, 10, 180}},
                                               {{50, 0, 0}, {50, 0, 0}},
                                               {{50, 10, 0}, {50, 10, 0}},
                                               {{50, 3, 4}, {50, 5, 53.13010235415598}},
                                               {{50, 3, -4}, {50, 5, 306.86989764584405}}};
    for (const auto& [lab, lch] : cases) {
        Triple out{};
        cColorSpace::LabToLch(lab.data(), out.data());
        ExpectNear(out, lch, 1e-12);
    }
}

TEST(LchToLab, QuadrantSignsAndAxes) {
    const double h = 7.0710678118654755;  // 10 / sqrt(2)
    const std::pair<Triple, Triple> cases[] = {{{50, 10, 45}, {50, h, h}},
                                               {{50, 10, 135}, {50, -h, h}},
                                               {{50, 10, 225}, {50, -h, -h}},
                                               {{50, 10, 315}, {50, h, -h}},
                                               {{50, 10, 180}, {50, -10, 0}},
                                               // Hues outside one turn keep their direction.
                                               {{50, 10, 405}, {50, h, h}},
                                               {{50, 10, -135}, {50, -h, -h}},
                                               {{50, 10, -90}, {50, 0, -10}}};
    for (const auto& [lch, lab] : cases) {
        Triple out{};
        cColorSpace::LchToLab(lch.data(), out.data());
        ExpectNear(out, lab, 1e-12);
    }
    // The vertical axes are exact, also in place.
    Triple v{50, 10, 90};
    cColorSpace::LchToLab(v.data(), v.data());
    EXPECT_EQ(v, (Triple{50, 0, 10}));
    v = {50, 10, 270};
    cColorSpace::LchToLab(v.data(), v.data());
    EXPECT_EQ(v, (Triple{50, 0, -10}));
}

TEST(SRGBNode, WhiteClampingAndThreshold) {
    cColorSpaceSRGB srgb;
    Triple xyz{};
    Triple rgb{};
    srgb.ToXYZ(Triple{255, 255, 255}.data(), xyz.data());
    ExpectNear(xyz, {0.9505, 1.0, 1.089}, 1e-12);
    srgb.FromXYZ(xyz.data(), rgb.data());
    EXPECT_EQ(rgb, (Triple{255, 255, 255}));
    srgb.FromXYZ(Triple{2.0, -1.0, 0.5}.data(), rgb.data());
    for (double v : rgb) {
        EXPECT_GE(v, 0.0);
        EXPECT_LE(v, 255.0);
    }
    // c = 0.04045 exactly is linearised by division.
    srgb.ToXYZ(Triple{0.04045 * 255.0, 0, 0}.data(), xyz.data());
    EXPECT_NEAR(xyz[1], 0.2126 * 0.04045 / 12.92, 1e-15);

    EXPECT_EQ(cColorSpaceSRGB::EncodeSRGB(-0.1), 0.0);
    EXPECT_EQ(cColorSpaceSRGB::EncodeSRGB(1.5), 1.0);
    EXPECT_DOUBLE_EQ(cColorSpaceSRGB::EncodeSRGB(0.0031308), 12.92 * 0.0031308);
    EXPECT_NEAR(cColorSpaceSRGB::EncodeSRGB(0.5), 0.7353569830524495, 1e-12);
    EXPECT_TRUE(std::isnan(cColorSpaceSRGB::EncodeSRGB(std::nan(""))));
}

TEST(SRGBNode, RoundTripWithinEightBitRounding) {
    cColorSpaceSRGB srgb;
    for (int r = 0; r <= 255; r += 15) {
        for (int g = 0; g <= 255; g += 51) {
            for (int b = 0; b <= 255; b += 85) {
                const Triple in{double(r), double(g), double(b)};
                Triple xyz{};
                Triple back{};
                srgb.ToXYZ(in.data(), xyz.data());
                srgb.FromXYZ(xyz.data(), back.data());
                ExpectNear(back, in, 0.5);
            }
        }
    }
}

TEST(YxyNode, BlackAndZeroY) {
    ColorSpaceStruct d;
    cColorSpaceYxy yxy(d);
    Triple out{1, 1, 1};
    yxy.ToXYZ(Triple{0.5, 0.3, 0.0}.data(), out.data());
    EXPECT_EQ(out, (Triple{0, 0, 0}));
    yxy.FromXYZ(Triple{0, 0, 0}.data(), out.data());
    const double sum = 0.96422 + 1.0 + 0.82521;
    ExpectNear(out, {0.0, 0.96422 / sum, 1.0 / sum}, 1e-15);

    d.whitePoint[0] = d.whitePoint[1] = d.whitePoint[2] = 0.0;
    cColorSpaceYxy(d).FromXYZ(Triple{0, 0, 0}.data(), out.data());
    ExpectNear(out, {0.0, 1.0 / 3.0, 1.0 / 3.0}, 1e-15);
}

TEST(LinearRIMMNode, FourDecimalMatrices) {
    cColorSpaceLinearRIMM rimm;
    Triple out{};
    rimm.ToXYZ(Triple{1, 1, 1}.data(), out.data());
    ExpectNear(out, {0.9642, 1.0, 0.8249}, 1e-12);
    rimm.FromXYZ(Triple{0, 0, 1}.data(), out.data());
    ExpectNear(out, {-0.0511, 0.0205, 1.2123}, 1e-12);
    // The two four-decimal matrices are not exact inverses.
    Triple xyz{};
    rimm.ToXYZ(Triple{0.5, 0.2, 0.1}.data(), xyz.data());
    rimm.FromXYZ(xyz.data(), out.data());
    ExpectNear(out, {0.500044, 0.199980, 0.100003}, 1e-6);
}

}  // namespace
