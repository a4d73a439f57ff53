#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

#include "ColorSpaceSpectral.h"
#include "IlluminantSampler.h"
#include "IlluminantSetup.h"

namespace {

IlluminantStruct Make(int kind, double temperature, int observer = 0) {
    IlluminantStruct il;
    il.observer = observer;
    il.SetIlluminant(static_cast<IlluminantKind>(kind), temperature);
    return il;
}

struct KindCase {
    int kind;
    double temperature;
    int kindAfter;
    double start, end, step;
    int count;
};

class IlluminantKinds : public testing::TestWithParam<KindCase> {};

TEST_P(IlluminantKinds, ProduceTheirTables) {
    const KindCase& k = GetParam();
    const IlluminantStruct il = Make(k.kind, k.temperature);
    EXPECT_EQ(il.kind, k.kindAfter);
    EXPECT_EQ(il.valueCount, k.count);
    EXPECT_EQ(static_cast<int>(il.values.size()), k.count);
    EXPECT_EQ(il.tableStart, k.start);
    EXPECT_EQ(il.tableEnd, k.end);
    EXPECT_EQ(il.tableStep, k.step);
    if (k.kindAfter == 0) {
        EXPECT_EQ(il.relativeWhite[0], 1.0);
        EXPECT_EQ(il.relativeWhite[2], 1.0);
    }
}

INSTANTIATE_TEST_SUITE_P(
    All, IlluminantKinds,
    testing::Values(KindCase{1, 5003, 1, 300, 830, 5, 107}, KindCase{1, 6504, 1, 300, 830, 1, 531},
                    KindCase{1, 5503, 1, 300, 830, 5, 107}, KindCase{1, 9000, 1, 300, 830, 1, 531},
                    KindCase{2, 6500, 2, 300, 830, 1, 531}, KindCase{3, 0, 3, 300, 830, 1, 531},
                    KindCase{4, 0, 0, 0, 0, 0, 0}, KindCase{5, 0, 5, 320, 830, 5, 103},
                    KindCase{6, 0, 6, 300, 830, 1, 531}, KindCase{7, 0, 7, 380, 780, 5, 81},
                    KindCase{11, 0, 0, 0, 0, 0, 0}, KindCase{18, 0, 18, 380, 780, 5, 81},
                    KindCase{19, 0, 0, 0, 0, 0, 0}, KindCase{2, 0, 0, 0, 0, 0, 0},
                    KindCase{1, -100, 0, 0, 0, 0, 0}));

TEST(IlluminantWhite, TabulatedRowsForTheStandardObservers) {
    const struct {
        int kind;
        double temperature;
        int observer;
        double x, z;
    } cases[] = {{1, 5003, 0, 0.96422, 0.82521},      {1, 5503, 0, 0.95682, 0.92149},
                 {1, 6504, 1, 0.94811, 1.07304},      {3, 0, 0, 1.09850, 0.35580},
                 {5, 0, 1, 0.97285, 1.16145},         {17, 0, 0, 1.00962, 0.6435},
                 {1, 5003.00005, 0, 0.96422, 0.82521}};
    for (const auto& c : cases) {
        const IlluminantStruct il = Make(c.kind, c.temperature, c.observer);
        EXPECT_EQ(il.relativeWhite[0], c.x) << c.kind;
        EXPECT_EQ(il.relativeWhite[1], 1.0) << c.kind;
        EXPECT_EQ(il.relativeWhite[2], c.z) << c.kind;
        EXPECT_EQ(il.colorTemperature, c.kind == 3 ? 2856.0 : c.temperature)
            << "a table white keeps the temperature";
    }
    // D55 is the D50 table tilted, not the D50 table itself.
    EXPECT_NE(Make(1, 5503).values, Make(1, 5003).values);
}

TEST(IlluminantWhite, ComputedWhitesMatchPublishedValues) {
    // 0.01 K off the table row: the D65 table (tilted by a negligible amount) is integrated.
    const IlluminantStruct d65 = Make(1, 6504.01);
    EXPECT_NEAR(d65.relativeWhite[0], 0.95047, 5e-6);
    EXPECT_NEAR(d65.relativeWhite[2], 1.08883, 5e-6);
    EXPECT_NEAR(d65.colorTemperature, 6504, 3);
    // A as a Planckian radiator at 2856 K with c2 = 1.4388e-2 m K; CIE A is defined with
    // 1.435e-2 at 2848 K, which moves the white by about 1e-4.
    const IlluminantStruct a = Make(2, 2856);
    EXPECT_NEAR(a.relativeWhite[0], 1.09850, 2e-4);
    EXPECT_NEAR(a.relativeWhite[2], 0.35585, 2e-4);
    // The equal-energy white with the physiological observer.
    const IlluminantStruct e = Make(6, 0, 2);
    for (double v : e.relativeWhite) EXPECT_NEAR(v, 1.0, 2e-3);
    // A white the table has only for 2 degrees is computed for 10 degrees.
    const IlluminantStruct f1 = Make(7, 0, 1);
    EXPECT_NE(f1.relativeWhite[0], Make(7, 0, 0).relativeWhite[0]);
    EXPECT_NEAR(f1.relativeWhite[0], 0.9483, 0.01);
}

TEST(Robertson, CorrelatedTemperatureOfKnownWhites) {
    const double d65[3] = {0.95047, 1, 1.08883};
    const double a[3] = {1.09850, 1, 0.35585};
    EXPECT_NEAR(RobertsonTemperature(d65, 0), 6504, 3);
    EXPECT_NEAR(RobertsonTemperature(a, 0), 2856, 3);
    // On the locus at the 325 mired line, where the printed table has u = 0.24702.
    const double u = 0.24792, v = 0.34655;
    const double x = 3 * u / (2 * u - 8 * v + 4), y = 2 * v / (2 * u - 8 * v + 4);
    const double onLine[3] = {x / y, 1, (1 - x - y) / y};
    EXPECT_NEAR(RobertsonTemperature(onLine, 0), 1e6 / 325, 0.5);
    const double black[3] = {0, 0, 0};
    EXPECT_EQ(RobertsonTemperature(black, 1234), 5004);
    const double ember[3] = {1.895, 1, 0.0143};  // about 1000 K, redder than the last line
    EXPECT_EQ(RobertsonTemperature(ember, 1234), 1234);
}

TEST(Robertson, PlanckianAndDaylightTemperaturesComeBack) {
    double previousCct = 0, previousZ = 0;
    for (double t : {2000.0, 3000.0, 3200.0, 4000.0, 6500.0, 10000.0}) {
        EXPECT_NEAR(Make(2, t).colorTemperature, t, t * 1e-3) << t;
        const IlluminantStruct daylight = Make(1, t);
        EXPECT_NEAR(daylight.colorTemperature, t, t * 0.05) << t;
        EXPECT_GT(daylight.colorTemperature, previousCct);
        EXPECT_GT(daylight.relativeWhite[2], previousZ);
        previousCct = daylight.colorTemperature;
        previousZ = daylight.relativeWhite[2];
    }
}

IlluminantStruct Table(double start, double step, const std::vector<double>& values) {
    IlluminantStruct il;
    il.kind = 5;
    il.tableStart = start;
    il.tableStep = step;
    il.valueCount = static_cast<int32_t>(values.size());
    il.tableEnd = start + (values.size() - 1) * step;
    il.values = values;
    return il;
}

TEST(IlluminantSampler, KernelsReproduceSmoothTablesAndKnots) {
    auto cubic = [](double l) {
        return 50 + 0.3 * (l - 500) - 2e-4 * std::pow(l - 500, 2) + 1e-6 * std::pow(l - 500, 3);
    };
    for (double step : {5.0, 10.0}) {
        std::vector<double> values;
        for (double l = 380; l <= 780; l += step) values.push_back(cubic(l));
        const IlluminantStruct il = Table(380, step, values);
        for (SpectralIntegration mode : {SpectralIntegration::Sprague, SpectralIntegration::Lagrange}) {
            const std::vector<double> out = SampleIlluminant(il, mode, 360, 1, 471);
            EXPECT_EQ(out[0], values.front());   // below the table: first value
            EXPECT_EQ(out[470], values.back());  // beyond: last value
            // Exact for a cubic away from the ends; the end extrapolation only approximates it.
            for (int l = 380; l <= 780; l += 7) {
                const bool inner = l >= 380 + 2 * step && l <= 780 - 2 * step;
                EXPECT_NEAR(out[l - 360], cubic(l), inner ? 1e-9 : 0.01) << step << " " << l;
            }
        }
    }
    EXPECT_EQ(SampleIlluminant(IlluminantStruct{}, SpectralIntegration::Sprague, 380, 10, 3),
              std::vector<double>(3, 100.0));
}

TEST(IlluminantSampler, GeneralSamplerKeepsLinePowerOnCoarseGrids) {
    std::vector<double> values(401, 10.0);
    values[143] = 510.0;  // an emission line at 523 nm
    const IlluminantStruct il = Table(380, 1, values);
    const std::vector<double> out = SampleIlluminant(il, SpectralIntegration::Direct, 380, 10, 41);
    double power = 0;
    for (double v : out) power += v * 10;
    EXPECT_NEAR(power, 41 * 10 * 10 + 500, 1e-9);  // the flat part plus the whole line
    EXPECT_GT(out[14], out[15]);                   // 520 is nearer the line than 530
    EXPECT_EQ(SampleIlluminant(il, SpectralIntegration::Direct, 370, 10, 1)[0], 0.0);  // outside the table
}

TEST(IlluminantSampler, KernelGridOffTheTableGridFallsBackToTheGeneralSampler) {
    const IlluminantStruct il = Table(362, 5, std::vector<double>(80, 42.0));
    const std::vector<double> out = SampleIlluminant(il, SpectralIntegration::Sprague, 360, 1, 471);
    EXPECT_EQ(out[0], 0.0);  // general sampler: nothing below the table
    EXPECT_NEAR(out[100], 42.0, 1e-12);
}

}  // namespace
