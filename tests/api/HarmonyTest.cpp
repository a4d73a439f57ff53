#include <gtest/gtest.h>

#include <array>
#include <cmath>
#include <numbers>
#include <vector>

#include "pigmo/bp.h"

namespace {

constexpr double kChroma = 40;

std::array<double, 3> LabAtHue(double lightness, double hueDegrees, double chroma = kChroma) {
    const double h = hueDegrees * std::numbers::pi / 180;
    return {lightness, chroma * std::cos(h), chroma * std::sin(h)};
}

double HueOf(const double* lab) {
    double lch[3];
    EXPECT_EQ(BPConvertLab2LCh(lab, lch), 1);
    return lch[2];
}

using PairHarmony = int (*)(const double*, double*, double*);

struct RotationCase {
    const char* name;
    double inputHue;
    PairHarmony harmony;  // null: the complement
    std::vector<double> expectedHues;
    double tolerance;
};

const RotationCase kRotations[] = {
    {"complement_of_30", 30, nullptr, {160.11}, 0.01},
    {"near_of_30", 30, BPHarmonyGetNearNeighbor, {8.31, 42.93}, 0.01},
    {"triadic_of_30", 30, BPHarmonyGetTriadic, {257.38, 97.61}, 0.01},
    // Sector boundaries: hue 25 is wheel angle 0, hue 0 is wheel angle 330.
    {"complement_of_25", 25, nullptr, {150}, 0.01},
    {"complement_of_0", 0, nullptr, {120}, 0.01},
    {"near_of_0", 0, BPHarmonyGetNearNeighbor, {320, 25}, 0.01},
    // Far neighbours of wheel angle 0 land on wheel angles 210 and 150.
    {"far_of_25", 25, BPHarmonyGetFarNeighbor, {190, 120}, 0.01},
};

void PrintTo(const RotationCase& c, std::ostream* os) {
    *os << c.name;
}

class HueRotations : public testing::TestWithParam<RotationCase> {};

TEST_P(HueRotations, LandOnTheExpectedHuesAndKeepLightnessAndChroma) {
    const RotationCase& c = GetParam();
    const auto in = LabAtHue(60, c.inputHue);
    double out[2][3];
    const int status =
        c.harmony ? c.harmony(in.data(), out[0], out[1]) : BPHarmonyGetComplement(in.data(), out[0]);
    ASSERT_EQ(status, 1);
    for (size_t i = 0; i < c.expectedHues.size(); ++i) {
        EXPECT_NEAR(HueOf(out[i]), c.expectedHues[i], c.tolerance) << "output " << i;
        EXPECT_NEAR(out[i][0], 60, 1e-9);
        EXPECT_NEAR(std::hypot(out[i][1], out[i][2]), kChroma, 1e-9);
    }
}

INSTANTIATE_TEST_SUITE_P(Exports, HueRotations, testing::ValuesIn(kRotations),
                         [](const auto& info) { return std::string(info.param.name); });

TEST(Monochromatic, StepsLightnessAndKeepsHueAndChroma) {
    struct Case {
        double L, darker, lighter;
    };
    for (const Case& c : {Case{50, 17, 83}, Case{70, 10, 37}, Case{30, 63, 90}, Case{5, 38, 71},
                          Case{33, 10, 66}, Case{67, 10, 34}}) {
        const auto in = LabAtHue(c.L, 200);
        double out1[3], out2[3];
        ASSERT_EQ(BPHarmonyGetMonochromatic(in.data(), out1, out2), 1);
        EXPECT_NEAR(out1[0], c.darker, 1e-9) << c.L;
        EXPECT_NEAR(out2[0], c.lighter, 1e-9) << c.L;
        for (const double* out : {out1, out2}) {
            EXPECT_NEAR(out[1], in[1], 1e-9);
            EXPECT_NEAR(out[2], in[2], 1e-9);
        }
    }
}

TEST(Rotations, NeutralColorsStayNeutralAndNeighboursUndoEachOther) {
    const double grey[3] = {40, 0, 0};
    double out1[3], out2[3];
    for (PairHarmony harmony : {BPHarmonyGetNearNeighbor, BPHarmonyGetFarNeighbor, BPHarmonyGetTriadic}) {
        ASSERT_EQ(harmony(grey, out1, out2), 1);
        for (const double* out : {out1, out2}) EXPECT_EQ(std::hypot(out[1], out[2]), 0.0);
    }
    for (double hue = 0.5; hue < 360; hue += 7.3) {
        const auto in = LabAtHue(50, hue);
        double back1[3], back2[3];
        ASSERT_EQ(BPHarmonyGetNearNeighbor(in.data(), out1, out2), 1);
        ASSERT_EQ(BPHarmonyGetNearNeighbor(out2, back1, back2), 1);
        double error = std::fabs(HueOf(back1) - hue);
        error = std::min(error, 360 - error);
        EXPECT_LT(error, 0.3) << hue;  // the two maps invert each other to about 0.2 degree
    }
}

TEST(Rotations, MissingInputFailsWithoutWritingOutputs) {
    double out1[3] = {-7, -7, -7}, out2[3] = {-7, -7, -7};
    testing::internal::CaptureStdout();
    EXPECT_EQ(BPHarmonyGetTriadic(nullptr, out1, out2), 0);
    EXPECT_EQ(BPHarmonyGetMonochromatic(nullptr, out1, out2), 0);
    EXPECT_EQ(BPHarmonyGetComplement(nullptr, out1), 0);
    testing::internal::GetCapturedStdout();
    for (const double* out : {out1, out2}) {
        for (int k = 0; k < 3; ++k) EXPECT_EQ(out[k], -7);
    }
}

}  // namespace
