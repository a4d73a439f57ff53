#include <gtest/gtest.h>

#include <array>
#include <atomic>
#include <cmath>
#include <cstring>
#include <thread>
#include <vector>

#include "pigmo/bp.h"

namespace {

using Conversion = int (*)(const double*, double*);

struct ConversionCase {
    const char* name;
    Conversion convert;
    std::vector<double> in;
    std::array<double, 3> expected;
    double tolerance;
};

const std::vector<double> kWhiteReflector(36, 1.0);

const ConversionCase kConversionCases[] = {
    // sRGB's D65 white seen against the D50 white, without adaptation.
    {"srgb_white", BPConvertsRGB2Lab, {255, 255, 255}, {100.0, -2.3829, -19.3737}, 5e-5},
    {"srgb_black", BPConvertsRGB2Lab, {0, 0, 0}, {0, 0, 0}, 1e-12},
    {"linear_white", BPConvertsLinearRGB2Lab, {255, 255, 255}, {100.0, -2.3829, -19.3737}, 5e-5},
    {"lab_white", BPConvertLab2sRGB, {100, 0, 0}, {255.0, 252.27, 220.85}, 5e-3},
    {"lab_black", BPConvertLab2sRGB, {0, 0, 0}, {0, 0, 0}, 1e-12},
    {"lab_grey", BPConvertLab2sRGB, {50, 0, 0}, {128.20, 117.56, 102.04}, 5e-3},
    {"lab_white_linear", BPConvertLab2LinearsRGB, {100, 0, 0}, {1.17600, 0.97581, 0.72195}, 5e-6},
    // Only XYZ is clamped at zero, so blue stays negative.
    {"lab_negative_z", BPConvertLab2LinearsRGB, {10, 0, 100}, {0.017875, 0.010602, -0.0016923}, 5e-7},
    {"lab_to_lch", BPConvertLab2LCh, {50, 0, -10}, {50, 10, 270}, 1e-12},
    {"lch_to_lab", BPConvertLCh2Lab, {50, 10, 90}, {50, 0, 10}, 0},
    {"reflector_lab", BPConvert36BandSpectral2LabD502, kWhiteReflector, {100, 0, 0}, 1e-9},
    {"reflector_linear",
     BPConvert36BandSpectral2LinearsRGB,
     kWhiteReflector,
     {1 / 255.0, 1 / 255.0, 1 / 255.0},
     2e-5},
};

void PrintTo(const ConversionCase& c, std::ostream* os) {
    *os << c.name;
}

class Conversions : public testing::TestWithParam<ConversionCase> {};

TEST_P(Conversions, GiveTheReferenceValue) {
    const ConversionCase& c = GetParam();
    double out[3] = {};
    ASSERT_EQ(c.convert(c.in.data(), out), 1);
    for (int k = 0; k < 3; ++k) EXPECT_NEAR(out[k], c.expected[k], c.tolerance) << "channel " << k;
}

TEST_P(Conversions, NullPointersFailWithTheDiagnosticLine) {
    const ConversionCase& c = GetParam();
    double out[3] = {-7, -7, -7};
    testing::internal::CaptureStdout();
    const int nullOut = c.convert(c.in.data(), nullptr);
    const int nullIn = c.convert(nullptr, out);
    EXPECT_EQ(testing::internal::GetCapturedStdout(), "translate status: 1\ntranslate status: 1\n");
    EXPECT_EQ(nullOut, 0);
    EXPECT_EQ(nullIn, 0);
    for (double v : out) EXPECT_EQ(v, -7);
}

INSTANTIATE_TEST_SUITE_P(Exports, Conversions, testing::ValuesIn(kConversionCases),
                         [](const auto& info) { return std::string(info.param.name); });

TEST(Conversions, InputsAreNotClampedExceptBySRGBEncoding) {
    const double bright[3] = {150, 0, 0};
    double rgb[3], linear[3];
    ASSERT_EQ(BPConvertLab2sRGB(bright, rgb), 1);
    for (double v : rgb) EXPECT_EQ(v, 255.0);
    ASSERT_EQ(BPConvertLab2LinearsRGB(bright, linear), 1);
    EXPECT_GT(linear[1], 1.5);
}

// Threads start together, so they also race to build the engines, and convert varied colors many
// times; every result must equal the one the main thread gets afterwards, bit for bit.
TEST(Conversions, ConcurrentCallsReproduceSingleThreadResults) {
    constexpr int kVariants = 7, kThreads = 8;
    const size_t caseCount = std::size(kConversionCases);
    auto convert = [](size_t k, int variant) {  // NaN on failure, which never compares equal
        std::vector<double> in = kConversionCases[k].in;
        for (double& v : in) v += variant * 0.25;
        std::array<double, 3> out{};
        if (kConversionCases[k].convert(in.data(), out.data()) != 1) out.fill(std::nan(""));
        return out;
    };
    using Results = std::vector<std::array<double, 3>>;  // by variant, then case
    std::vector<Results> seen(kThreads, Results(kVariants * caseCount));
    std::atomic<int> changed{0};
    std::atomic<bool> go{false};
    std::vector<std::thread> threads;
    for (int t = 0; t < kThreads; ++t) {
        threads.emplace_back([&, t] {
            while (!go.load()) std::this_thread::yield();
            for (int i = 0; i < 3000; ++i) {
                for (size_t step = 0; step < caseCount; ++step) {
                    const size_t k = (step + t) % caseCount;
                    const int variant = (i + t) % kVariants;
                    const std::array<double, 3> out = convert(k, variant);
                    std::array<double, 3>& first = seen[t][variant * caseCount + k];
                    if (i < kVariants) {
                        first = out;
                    } else {
                        changed += out != first;
                    }
                }
            }
        });
    }
    go = true;
    for (std::thread& thread : threads) thread.join();
    EXPECT_EQ(changed.load(), 0);
    for (int variant = 0; variant < kVariants; ++variant) {
        for (size_t k = 0; k < caseCount; ++k) {
            const std::array<double, 3> expected = convert(k, variant);
            for (int t = 0; t < kThreads; ++t) {
                EXPECT_EQ(seen[t][variant * caseCount + k], expected)
                    << kConversionCases[k].name << " " << variant;
            }
        }
    }
}

// Whole arrays on several threads at once, through the plain engine path and the one with a
// destination range; each result must be the single-color function's, bit for bit.
TEST(Conversions, ArraysOnSeveralThreadsGiveTheSingleColorResults) {
    using Batch = int (*)(const double*, double*, size_t);
    const struct {
        Conversion single;
        Batch batch;
        size_t width;
    } cases[] = {{BPConvertsRGB2Lab, BPConvertsRGB2LabArray, 3},
                 {BPConvert36BandSpectral2LinearsRGB, BPConvert36BandSpectral2LinearsRGBArray, 36}};
    constexpr size_t kColors = 500;
    for (const auto& c : cases) {
        std::vector<double> in(kColors * c.width);
        for (size_t i = 0; i < in.size(); ++i)
            in[i] = std::fmod(i * 0.618034, 1.0) * (c.width == 3 ? 255 : 1);
        std::vector<double> expected(3 * kColors);
        for (size_t k = 0; k < kColors; ++k) ASSERT_EQ(c.single(&in[k * c.width], &expected[3 * k]), 1);
        std::atomic<int> mismatches{0};
        std::vector<std::thread> threads;
        for (int t = 0; t < 4; ++t) {
            threads.emplace_back([&] {
                std::vector<double> out(3 * kColors);
                for (int round = 0; round < 50; ++round) {
                    mismatches += c.batch(in.data(), out.data(), kColors) != 1;
                    mismatches += std::memcmp(out.data(), expected.data(), out.size() * sizeof(double)) != 0;
                }
            });
        }
        for (std::thread& thread : threads) thread.join();
        EXPECT_EQ(mismatches.load(), 0);
    }
}

}  // namespace
