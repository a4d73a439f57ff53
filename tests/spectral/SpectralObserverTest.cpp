#include <gtest/gtest.h>

#include <algorithm>

#include "ObserverSampler.h"

namespace {

double At(const SampledFunction& f, int index) {
    return f.values[index - f.first];
}

int PeakWavelength(const SampledFunction& f, double start, double step) {
    const auto it = std::max_element(f.values.begin(), f.values.end());
    return static_cast<int>(start + (f.first + (it - f.values.begin())) * step);
}

TEST(ObserverSampler, TrimsToThePositiveStretchOfTheStandardTables) {
    const struct {
        int observer, channel, first, last;
    } cases[] = {{0, 1, 0, 470}, {0, 2, 0, 289}, {1, 2, 0, 199}, {1, 0, 0, 470}};
    for (const auto& c : cases) {
        const SampledFunction f = SampleObserver(c.observer, 32, 2, 360, 1, 471, true)[c.channel];
        EXPECT_EQ(f.first, c.first) << c.observer << c.channel;
        EXPECT_EQ(f.last, c.last) << c.observer << c.channel;
        EXPECT_EQ(static_cast<int>(f.values.size()), f.last - f.first + 1);
    }
    // Off the table grid: linear interpolation; beyond the end: the end segment, floored at 0.
    const SampledFunction y = SampleObserver(0, 32, 2, 554.5, 1, 1, false)[1];
    EXPECT_DOUBLE_EQ(y.values[0], (0.9997482 + 1.0) / 2);
    const SampledFunction z = SampleObserver(0, 32, 2, 640, 10, 5, false)[2];
    EXPECT_GT(z.values[0], 0.0);
    EXPECT_EQ(z.values[2], 0.0);  // 660 nm, past the tabulated end of z-bar
}

TEST(ObserverSampler, Cie2006FunctionsArePositiveWithPeaksWhereTheModelPutsThem) {
    const int expectedPeak[3][2] = {{590, 605}, {540, 560}, {440, 450}};
    const ObserverFunctions functions = SampleObserver(2, 32, 2, 390, 1, 391, false);
    for (int c = 0; c < 3; ++c) {
        const SampledFunction& f = functions[c];
        for (double v : f.values) EXPECT_GE(v, 0.0);
        const int peak = PeakWavelength(f, 390, 1);
        EXPECT_GE(peak, expectedPeak[c][0]) << c;
        EXPECT_LE(peak, expectedPeak[c][1]) << c;
    }
    const SampledFunction& y = functions[1];
    EXPECT_NEAR(*std::max_element(y.values.begin(), y.values.end()), 1.0, 1e-3);
}

TEST(ObserverSampler, Cie2006ChangesWithAgeAndFieldSizeInThePublishedDirections) {
    // The lens yellows with age: less short-wave sensitivity relative to the z-bar peak.
    auto shortWaveRatio = [](double age) {
        const SampledFunction z = SampleObserver(2, age, 2, 390, 5, 79, false)[2];
        return At(z, 2) / *std::max_element(z.values.begin(), z.values.end());  // 400 nm
    };
    EXPECT_GT(shortWaveRatio(20), shortWaveRatio(32));
    EXPECT_GT(shortWaveRatio(32), shortWaveRatio(60));
    EXPECT_GT(shortWaveRatio(60), shortWaveRatio(80));

    // A larger field has less macular pigment: more luminous sensitivity near 460 nm.
    auto blueLuminance = [](double field) {
        const SampledFunction y = SampleObserver(2, 32, field, 390, 5, 79, false)[1];
        return At(y, 14) / *std::max_element(y.values.begin(), y.values.end());  // 460 nm
    };
    EXPECT_LT(blueLuminance(1), blueLuminance(2));
    EXPECT_LT(blueLuminance(2), blueLuminance(10));
    // The field is limited to 1 to 10 degrees.
    EXPECT_EQ(blueLuminance(10), blueLuminance(30));
    EXPECT_EQ(blueLuminance(1), blueLuminance(0.2));
}

}  // namespace
