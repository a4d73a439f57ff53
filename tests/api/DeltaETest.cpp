#include <gtest/gtest.h>

#include <array>
#include <cmath>
#include <functional>
#include <numbers>
#include <vector>

#include "ColorDifference.h"
#include "pigmo/bp.h"

namespace {

struct LabPair {
    double lab1[3];
    double lab2[3];
    double expected;
};

// Sharma, Wu & Dalal (2005), Table 1; pairs 21 to 24 use the unrounded second colors.
const LabPair kSharmaPairs[] = {
    {{50.0000, 2.6772, -79.7751}, {50.0000, 0.0000, -82.7485}, 2.0425},
    {{50.0000, 3.1571, -77.2803}, {50.0000, 0.0000, -82.7485}, 2.8615},
    {{50.0000, 2.8361, -74.0200}, {50.0000, 0.0000, -82.7485}, 3.4412},
    {{50.0000, -1.3802, -84.2814}, {50.0000, 0.0000, -82.7485}, 1.0000},
    {{50.0000, -1.1848, -84.8006}, {50.0000, 0.0000, -82.7485}, 1.0000},
    {{50.0000, -0.9009, -85.5211}, {50.0000, 0.0000, -82.7485}, 1.0000},
    {{50.0000, 0.0000, 0.0000}, {50.0000, -1.0000, 2.0000}, 2.3669},
    {{50.0000, -1.0000, 2.0000}, {50.0000, 0.0000, 0.0000}, 2.3669},
    {{50.0000, 2.4900, -0.0010}, {50.0000, -2.4900, 0.0009}, 7.1792},
    {{50.0000, 2.4900, -0.0010}, {50.0000, -2.4900, 0.0010}, 7.1792},
    {{50.0000, 2.4900, -0.0010}, {50.0000, -2.4900, 0.0011}, 7.2195},
    {{50.0000, 2.4900, -0.0010}, {50.0000, -2.4900, 0.0012}, 7.2195},
    {{50.0000, -0.0010, 2.4900}, {50.0000, 0.0009, -2.4900}, 4.8045},
    {{50.0000, -0.0010, 2.4900}, {50.0000, 0.0010, -2.4900}, 4.8045},
    {{50.0000, -0.0010, 2.4900}, {50.0000, 0.0011, -2.4900}, 4.7461},
    {{50.0000, 2.5000, 0.0000}, {50.0000, 0.0000, -2.5000}, 4.3065},
    {{50.0000, 2.5000, 0.0000}, {73.0000, 25.0000, -18.0000}, 27.1492},
    {{50.0000, 2.5000, 0.0000}, {61.0000, -5.0000, 29.0000}, 22.8977},
    {{50.0000, 2.5000, 0.0000}, {56.0000, -27.0000, -3.0000}, 31.9030},
    {{50.0000, 2.5000, 0.0000}, {58.0000, 24.0000, 15.0000}, 19.4535},
    {{50.0000, 2.5000, 0.0000}, {50.0000, 3.17359627958174, 0.585353074312861}, 1.0000},
    {{50.0000, 2.5000, 0.0000}, {50.0000, 3.29722210201375, 7.94802472674044E-09}, 1.0000},
    {{50.0000, 2.5000, 0.0000}, {50.0000, 1.86342083563163, 0.575651399700511}, 1.0000},
    {{50.0000, 2.5000, 0.0000}, {50.0000, 3.25917204763466, 0.334992094209014}, 1.0000},
    {{60.2574, -34.0099, 36.2677}, {60.4626, -34.1751, 39.4387}, 1.2644},
    {{63.0109, -31.0961, -5.8663}, {62.8187, -29.7946, -4.0864}, 1.2630},
    {{61.2901, 3.7196, -5.3901}, {61.4292, 2.2480, -4.9620}, 1.8731},
    {{35.0831, -44.1164, 3.7933}, {35.0232, -40.0716, 1.5901}, 1.8645},
    {{22.7233, 20.0904, -46.6940}, {23.0331, 14.9730, -42.5619}, 2.0373},
    {{36.4612, 47.8580, 18.3852}, {36.2715, 50.5065, 21.2231}, 1.4146},
    {{90.8027, -2.0831, 1.4410}, {91.1528, -1.6435, 0.0447}, 1.4441},
    {{90.9257, -0.5406, -0.9208}, {88.6381, -0.8985, -0.7239}, 1.5381},
    {{6.7747, -0.2908, -2.4247}, {5.8714, -0.0985, -2.2286}, 0.6377},
    {{2.0776, 0.0795, -1.1350}, {0.9033, -0.0636, -0.5514}, 0.9082},
};

void PrintTo(const LabPair& p, std::ostream* os) {
    *os << p.expected;
}

class Ciede2000Published : public testing::TestWithParam<LabPair> {};

TEST_P(Ciede2000Published, MatchesToFourDecimalsInBothOrders) {
    const LabPair& p = GetParam();
    EXPECT_NEAR(BPCalculateDeltaE2000(p.lab1, p.lab2, 1, 1, 1), p.expected, 5e-5);
    EXPECT_NEAR(BPCalculateDeltaE2000(p.lab2, p.lab1, 1, 1, 1), p.expected, 5e-5);
}

INSTANTIATE_TEST_SUITE_P(Sharma2005, Ciede2000Published, testing::ValuesIn(kSharmaPairs));

// The weighted formulas, with reference and sample in the order given.
struct WeightedCase {
    const char* name;
    std::function<double(const double*, const double*)> metric;
    double lab1[3];
    double lab2[3];
    double expected;
    double tolerance;
};

using Metric = std::function<double(const double*, const double*)>;

Metric Cmc(double l, double c) {
    return [=](const double* x, const double* y) { return BPCalculateDeltaECMC(x, y, l, c); };
}
Metric E94(double kL) {
    return [=](const double* x, const double* y) { return BPCalculateDeltaE94(x, y, kL, 1, 1); };
}
Metric E2000() {
    return [](const double* x, const double* y) { return BPCalculateDeltaE2000(x, y, 1, 1, 1); };
}

const WeightedCase kWeightedCases[] = {
    {"cie76", BPCalculateDeltaE, {50, 0, 0}, {50, 3, 4}, 5.0, 1e-12},
    {"squared", BPCalculateDistanceSquared, {50, 0, 0}, {50, 3, 4}, 25.0, 1e-12},
    {"cie94_neutral_reference", E94(1), {50, 0, 0}, {50, 3, 4}, 5.0, 1e-12},
    {"cmc_2_1", Cmc(2, 1), {50, 20, -30}, {55, 18, -25}, 3.42184, 5e-6},
    {"cmc_2_1_exchanged", Cmc(2, 1), {55, 18, -25}, {50, 20, -30}, 3.50099, 5e-6},
    {"cmc_1_1", Cmc(1, 1), {50, 20, -30}, {55, 18, -25}, 5.24780, 5e-6},
    {"cie94", E94(1), {50, 20, -30}, {55, 18, -25}, 5.44188, 5e-6},
    {"cie94_exchanged", E94(1), {55, 18, -25}, {50, 20, -30}, 5.52394, 5e-6},
    {"ciede2000", E2000(), {50, 20, -30}, {55, 18, -25}, 5.50085, 5e-6},
    // Weights scale their term: only lightness differs, so kL = 2 halves ΔE94.
    {"cie94_lightness_weight", E94(2), {40, 10, 10}, {50, 10, 10}, 5.0, 1e-12},
};

void PrintTo(const WeightedCase& c, std::ostream* os) {
    *os << c.name;
}

class WeightedMetrics : public testing::TestWithParam<WeightedCase> {};

TEST_P(WeightedMetrics, GiveTheReferenceValue) {
    const WeightedCase& c = GetParam();
    EXPECT_NEAR(c.metric(c.lab1, c.lab2), c.expected, c.tolerance);
}

TEST_P(WeightedMetrics, IdenticalColorsDifferByZero) {
    const WeightedCase& c = GetParam();
    for (const double* lab : {c.lab1, c.lab2}) EXPECT_EQ(c.metric(lab, lab), 0.0);
    const double neutral[3] = {35, 0, 0};
    EXPECT_EQ(c.metric(neutral, neutral), 0.0);
}

TEST_P(WeightedMetrics, NullColorGivesMinusOne) {
    const WeightedCase& c = GetParam();
    EXPECT_EQ(c.metric(nullptr, c.lab2), -1.0);
    EXPECT_EQ(c.metric(c.lab1, nullptr), -1.0);
}

INSTANTIATE_TEST_SUITE_P(Exports, WeightedMetrics, testing::ValuesIn(kWeightedCases),
                         [](const auto& info) { return std::string(info.param.name); });

// A chroma-30 color whose hue angle, as atan2 in degrees, is exactly the given value.
std::array<double, 3> LabAtExactHue(double hueDegrees) {
    const double h = hueDegrees * std::numbers::pi / 180;
    std::array<double, 3> lab = {50, 30 * std::cos(h), 30 * std::sin(h)};
    for (int step = 0; step < 1000; ++step) {
        double hue = std::atan2(lab[2], lab[1]) * 57.29577951308232;
        if (hue < 0) hue += 360;
        if (hue == hueDegrees) break;
        lab[2] = std::nextafter(lab[2], hue < hueDegrees ? lab[2] + std::copysign(1.0, lab[1])
                                                         : lab[2] - std::copysign(1.0, lab[1]));
    }
    return lab;
}

// Branch edges of CMC weighting: L1 = 16 takes the formula, hues 164 and 345 degrees the 0.56
// branch. Expected values from the published formula; the other side differs by about 1e-3.
TEST(CmcBranches, BoundariesUseTheDocumentedSide) {
    const double atSixteen[3] = {16, 0, 0}, lighter[3] = {17, 0, 0};
    EXPECT_NEAR(BPCalculateDeltaECMC(atSixteen, lighter, 1, 1), 1.956070775, 1e-9);
    for (const auto& [hueDegrees, expected] : {std::pair{164.0, 1.0115979165}, {345.0, 1.0093926986}}) {
        const std::array<double, 3> ref = LabAtExactHue(hueDegrees);
        // The sample turns 0.05 rad in hue only, so only the SH term counts.
        const double h2 = std::atan2(ref[2], ref[1]) + 0.05;
        const double sample[3] = {50, 30 * std::cos(h2), 30 * std::sin(h2)};
        EXPECT_NEAR(BPCalculateDeltaECMC(ref.data(), sample, 1, 1), expected, 1e-9) << hueDegrees;
    }
}

cMatrixDC Colors(std::vector<std::vector<double>> rows) {
    cMatrixDC m(static_cast<int32_t>(rows.size()), static_cast<int32_t>(rows.empty() ? 3 : rows[0].size()));
    for (size_t i = 0; i < rows.size(); ++i) {
        for (size_t k = 0; k < rows[i].size(); ++k) m.At(int32_t(i), int32_t(k)) = rows[i][k];
    }
    return m;
}

std::vector<std::unique_ptr<cDeltaEBase>> AllMetrics() {
    std::vector<std::unique_ptr<cDeltaEBase>> metrics;
    metrics.push_back(std::make_unique<cCIE1976ColorDifference>());
    metrics.push_back(std::make_unique<cCMCColorDifference>(2, 1));
    metrics.push_back(std::make_unique<cCIE1994ColorDifference>(1, 2, 1));
    metrics.push_back(std::make_unique<cCIEDE2000>(1, 1, 2));
    return metrics;
}

TEST(BatchMetrics, RowsMatchSinglePairsAndStopAtTheShorterInput) {
    // Extra columns are ignored; the sample has one row fewer than the reference.
    const cMatrixDC reference = Colors({{50, 20, -30, 9}, {60, -10, 5, 9}, {20, 0, 0, 9}, {70, 5, 5, 9}});
    const cMatrixDC sample = Colors({{55, 18, -25}, {61, -12, 8}, {22, 1, -1}});
    for (const auto& metric : AllMetrics()) {
        for (const bool converted : {false, true}) {
            const cMatrixDC perRow = converted ? metric->CalculateDeltaEPerRowConverted(reference, sample)
                                               : metric->CalculateDeltaEPerRow(reference, sample);
            ASSERT_EQ(perRow.Rows(), 3);
            ASSERT_EQ(perRow.Columns(), 1);
            double sum = 0;
            for (int32_t i = 0; i < 3; ++i) {
                const double single = metric->CalculateDeltaE(reference.Row(i), sample.Row(i));
                EXPECT_NEAR(perRow.At(i, 0), single, 1e-9) << i;
                sum += single;
            }
            const double mean = converted ? metric->CalculateMeanDeltaEConverted(reference, sample)
                                          : metric->CalculateMeanDeltaE(reference, sample);
            EXPECT_NEAR(mean, sum / 3, 1e-9);
        }
    }
}

TEST(BatchMetrics, NoComparableRowsGiveAnEmptyResultAndNaNMean) {
    const cMatrixDC empty(0, 3);
    const cMatrixDC narrow = Colors({{50, 1}});  // two columns: no triple to read
    const cMatrixDC one = Colors({{50, 1, 1}});
    for (const auto& metric : AllMetrics()) {
        EXPECT_EQ(metric->CalculateDeltaEPerRow(empty, one).Rows(), 0);
        EXPECT_EQ(metric->CalculateDeltaEPerRow(narrow, one).Rows(), 0);
        EXPECT_TRUE(std::isnan(metric->CalculateMeanDeltaE(one, empty)));
        EXPECT_TRUE(std::isnan(metric->CalculateMeanDeltaEConverted(one, narrow)));
    }
}

TEST(BatchMetrics, ClonesKeepTheirParameters) {
    const double lab1[3] = {50, 20, -30}, lab2[3] = {55, 18, -25};
    for (const auto& metric : AllMetrics()) {
        const std::unique_ptr<cDeltaEBase> copy = metric->Clone();
        EXPECT_EQ(copy->CalculateDeltaE(lab1, lab2), metric->CalculateDeltaE(lab1, lab2));
    }
}

// The C array functions over all the published pairs at once, in both orders, and with each
// formula's weights equal to its single-pair function.
TEST(ArrayDifferences, MatchThePublishedPairsAndTheSinglePairFunctions) {
    std::vector<double> first, second;
    for (const LabPair& p : kSharmaPairs) {
        first.insert(first.end(), p.lab1, p.lab1 + 3);
        second.insert(second.end(), p.lab2, p.lab2 + 3);
    }
    const size_t count = std::size(kSharmaPairs);
    std::vector<double> out(count + 1, 42.0);
    ASSERT_EQ(BPCalculateDeltaE2000Array(second.data(), first.data(), out.data(), count, 1, 1, 1), 1);
    for (size_t i = 0; i < count; ++i) EXPECT_NEAR(out[i], kSharmaPairs[i].expected, 5e-5) << i;
    EXPECT_EQ(out[count], 42.0);

    const std::function<int(double*)> arrays[] = {
        [&](double* o) { return BPCalculateDeltaEArray(first.data(), second.data(), o, count); },
        [&](double* o) { return BPCalculateDeltaECMCArray(first.data(), second.data(), o, count, 2, 1); },
        [&](double* o) { return BPCalculateDeltaE94Array(first.data(), second.data(), o, count, 2, 1, 1); },
        [&](double* o) { return BPCalculateDeltaE2000Array(first.data(), second.data(), o, count, 1, 2, 1); },
    };
    const Metric singles[] = {BPCalculateDeltaE, Cmc(2, 1), E94(2), [](const double* x, const double* y) {
                                  return BPCalculateDeltaE2000(x, y, 1, 2, 1);
                              }};
    for (size_t m = 0; m < std::size(arrays); ++m) {
        ASSERT_EQ(arrays[m](out.data()), 1);
        for (size_t i = 0; i < count; ++i) EXPECT_EQ(out[i], singles[m](&first[3 * i], &second[3 * i])) << m;
    }
}

TEST(ArrayDifferences, NullPointersWriteNothing) {
    const double lab[3] = {50, 0, 0};
    double out = 42.0;
    EXPECT_EQ(BPCalculateDeltaEArray(nullptr, lab, &out, 1), 0);
    EXPECT_EQ(BPCalculateDeltaECMCArray(lab, nullptr, &out, 1, 2, 1), 0);
    EXPECT_EQ(BPCalculateDeltaE94Array(lab, lab, nullptr, 1, 1, 1, 1), 0);
    EXPECT_EQ(BPCalculateDeltaE2000Array(nullptr, nullptr, &out, 1, 1, 1, 1), 0);
    EXPECT_EQ(out, 42.0);
    EXPECT_EQ(BPCalculateDeltaE2000Array(lab, lab, &out, 0, 1, 1, 1), 1);
    EXPECT_EQ(out, 42.0);
}

}  // namespace
