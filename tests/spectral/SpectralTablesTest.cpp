// Built-in CIE tables against published checkpoints, so that a mistyped value fails.
#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <numeric>
#include <string>

#include "Cie2006Inputs.h"
#include "CieIlluminants.h"
#include "CieObservers.h"
#include "DensityWeights.h"
#include "RobertsonLines.h"
#include "SpragueCoefficients.h"
#include "WeightingSets.h"

namespace {

double Sum(const double* v, int n) {
    return std::accumulate(v, v + n, 0.0);
}

struct TableCase {
    const char* name;
    const double* values;
    int count;
    double sum;  // published validation sum (NaN: none published)
    int checkIndex;
    double checkValue;
    double last;
};

class PublishedTable : public testing::TestWithParam<TableCase> {};

TEST_P(PublishedTable, MatchesSumAndCheckpoints) {
    const TableCase& t = GetParam();
    if (!std::isnan(t.sum)) {
        EXPECT_NEAR(Sum(t.values, t.count), t.sum, 1e-9 * t.sum) << t.name;
    }
    EXPECT_DOUBLE_EQ(t.values[t.checkIndex], t.checkValue) << t.name;
    EXPECT_DOUBLE_EQ(t.values[t.count - 1], t.last) << t.name;
}

constexpr double kNoSum = std::numeric_limits<double>::quiet_NaN();

INSTANTIATE_TEST_SUITE_P(
    Cie, PublishedTable,
    testing::Values(
        TableCase{"x1931", kCie1931X, kCie1931XYCount, 106.865469489595, 240, 1.0622, 0.000001251141},
        TableCase{"y1931", kCie1931Y, kCie1931XYCount, 106.8569171011719, 195, 1.0, 0.000000451810},
        TableCase{"z1931", kCie1931Z, kCie1931ZCount, 106.892251278636, 119, 0.8566193, 0.000001333333},
        TableCase{"x1964", kCie1964X, kCie1964XYCount, 116.648519508908, 119, 0.089388, 0.00000155314},
        TableCase{"y1964", kCie1964Y, kCie1964XYCount, 116.661877102312, 197, 1.0, 0.0000006297},
        TableCase{"z1964", kCie1964Z, kCie1964ZCount, 116.673980514647, 119, 0.81828, 0.000047},
        TableCase{"D65", kIlluminantD65, kIlluminantD65Count, 40852.204, 119, 93.2372, 60.3125},
        TableCase{"D50", kIlluminantD50, kIlluminantD50Count, kNoSum, 52, 100.0, 74.44},
        TableCase{"C", kIlluminantC, 93, 7327.20, 25, 123.45, 59.10},
        TableCase{"C_extended", kIlluminantC, kIlluminantCCount, kNoSum, 93, 78.91, 74.44}),
    [](const auto& info) { return std::string(info.param.name); });

// Chromaticity of each table on its own grid with the 1931 functions: a shifted or mistyped row
// moves it off the published value.
struct WhiteCase {
    const char* name;
    const double* values;
    double start, step;
    int count;
    double x, y;
};

class TableWhite : public testing::TestWithParam<WhiteCase> {};

TEST_P(TableWhite, ChromaticityMatchesPublished) {
    const WhiteCase& w = GetParam();
    double xyz[3] = {0, 0, 0};
    const double* cmf[3] = {kCie1931X, kCie1931Y, kCie1931Z};
    const int counts[3] = {kCie1931XYCount, kCie1931XYCount, kCie1931ZCount};
    for (int i = 0; i < w.count; ++i) {
        const int row = static_cast<int>(w.start + i * w.step - kCmfStart);
        for (int c = 0; c < 3; ++c) {
            if (row >= 0 && row < counts[c]) xyz[c] += w.values[i] * cmf[c][row];
        }
    }
    const double sum = xyz[0] + xyz[1] + xyz[2];
    EXPECT_NEAR(xyz[0] / sum, w.x, 1e-4) << w.name;
    EXPECT_NEAR(xyz[1] / sum, w.y, 1e-4) << w.name;
}

INSTANTIATE_TEST_SUITE_P(
    Cie, TableWhite,
    testing::Values(WhiteCase{"D65", kIlluminantD65, 300, 1, kIlluminantD65Count, 0.3127, 0.3290},
                    WhiteCase{"D50", kIlluminantD50, 300, 5, kIlluminantD50Count, 0.3457, 0.3585},
                    WhiteCase{"C", kIlluminantC, 320, 5, 93, 0.31006, 0.31616},
                    WhiteCase{"F1", kIlluminantF[0], 380, 5, 81, 0.3131, 0.3371},
                    WhiteCase{"F2", kIlluminantF[1], 380, 5, 81, 0.3721, 0.3751},
                    WhiteCase{"F3", kIlluminantF[2], 380, 5, 81, 0.4091, 0.3941},
                    WhiteCase{"F7", kIlluminantF[3], 380, 5, 81, 0.3129, 0.3292},
                    WhiteCase{"F8", kIlluminantF[4], 380, 5, 81, 0.3458, 0.3586},
                    WhiteCase{"F9", kIlluminantF[5], 380, 5, 81, 0.3741, 0.3727},
                    WhiteCase{"F10", kIlluminantF[6], 380, 5, 81, 0.3458, 0.3588},
                    WhiteCase{"F11", kIlluminantF[7], 380, 5, 81, 0.3805, 0.3769},
                    WhiteCase{"F12", kIlluminantF[8], 380, 5, 81, 0.4370, 0.4042}),
    [](const auto& info) { return std::string(info.param.name); });

TEST(SmallTables, RobertsonLinesAreThePublishedOnesWithTheCorrectedLine) {
    EXPECT_DOUBLE_EQ(kRobertsonLines[0].u, 0.18006);
    EXPECT_DOUBLE_EQ(kRobertsonLines[0].slope, -0.24341);
    EXPECT_DOUBLE_EQ(kRobertsonLines[30].mired, 600);
    EXPECT_DOUBLE_EQ(kRobertsonLines[30].slope, -116.45);
    EXPECT_DOUBLE_EQ(kRobertsonLines[19].mired, 325);
    EXPECT_DOUBLE_EQ(kRobertsonLines[19].u, 0.24792);
    for (int i = 1; i < kRobertsonLineCount; ++i) {
        EXPECT_GT(kRobertsonLines[i].mired, kRobertsonLines[i - 1].mired) << i;
        EXPECT_GT(kRobertsonLines[i].u, kRobertsonLines[i - 1].u) << i;
        EXPECT_GT(kRobertsonLines[i].v, kRobertsonLines[i - 1].v) << i;
        EXPECT_LT(kRobertsonLines[i].slope, kRobertsonLines[i - 1].slope) << i;
    }
}

TEST(SmallTables, Cie2006InputsHaveThePublishedShape) {
    EXPECT_DOUBLE_EQ(kCie2006Inputs[14].macular, 1.0);                                      // 460 nm
    EXPECT_DOUBLE_EQ(kCie2006Inputs[32].macular, 0.0);                                      // 550 nm
    EXPECT_NEAR(kCie2006Inputs[2].lensAgeing + kCie2006Inputs[2].lensFixed, 1.7649, 1e-9);  // 400 nm
    EXPECT_DOUBLE_EQ(kCie2006Inputs[45].logAbsorbance[2], -6.25482);                        // 615 nm
    EXPECT_EQ(kCie2006Inputs[46].logAbsorbance[2], kNotTabulated);                          // 620 nm
    for (int c = 0; c < 3; ++c) {
        double peak = -10;
        for (const Cie2006Row& row : kCie2006Inputs) peak = std::max(peak, row.logAbsorbance[c]);
        EXPECT_NEAR(peak, 0.0, 1e-4) << c;
    }
}

TEST(SmallTables, WeightingSetsSumToTheirWhites) {
    for (const FixedWeightingSet& set : kFixedWeightingSets) {
        for (int c = 0; c < 3; ++c) {
            EXPECT_NEAR(Sum(set.weights[c], kFixedWeightingRows), set.white[c], 0.01) << set.kind << " " << c;
        }
    }
}

TEST(SmallTables, DensityWeightsSumAsPublished) {
    const double sums[4] = {0.99999, 0.99998, 1.0, 0.99989};
    for (int c = 0; c < kDensityChannelCount; ++c) {
        EXPECT_NEAR(Sum(kDensityWeights[c], kDensityWeightCount), sums[c], 1e-12) << c;
    }
}

TEST(SmallTables, SpragueRowsPreserveConstants) {
    for (const auto& row : kSpragueCoefficients) EXPECT_EQ(Sum(row, 6), kSpragueDivisor);
    for (const auto& row : kSpragueEnd) EXPECT_EQ(Sum(row, 6), kSpragueEndDivisor);
}

}  // namespace
