#include <gtest/gtest.h>
#include <pigmo/bp.h>

#include <cmath>
#include <memory>
#include <vector>

#include "ColorInformation.h"

namespace {

using Pigmo::ColorInformation;

enum class LabFrom { Given, Curve, RGB, Zero };
enum class LinearFrom { Given, Curve, Zero };

const std::vector<float> kOnes36(36, 1.0f);
const std::vector<float> kRamp35 = [] {
    std::vector<float> ramp(35);
    for (int i = 0; i < 35; ++i) ramp[i] = 0.02f * static_cast<float>(i);
    return ramp;
}();

struct RecordCase {
    const char* label;
    const float* lab;
    const float* rgb;
    const std::vector<float>* curve;  // null: a null pointer with curveCount values
    int curveCount;
    LabFrom labFrom;
    LinearFrom linearFrom;
    int storedCount;
};

const float kLab50[3] = {50, 0, 0};
const float kRGB[3] = {255, 127.5f, 0};
// sRGB (1, 0.5, 0) decoded: the sRGB transfer function's published midpoint 0.214041.
const float kRGBLinear[3] = {1.0f, 0.214041f, 0.0f};

class RecordConstruction : public testing::TestWithParam<RecordCase> {};

TEST_P(RecordConstruction, DerivesWhatTheBookLeavesOut) {
    const RecordCase& c = GetParam();
    const ColorInformation record("n", "c", c.lab, c.rgb, c.curve ? c.curve->data() : nullptr, c.curveCount,
                                  nullptr);

    const std::vector<double> curve =
        c.curve ? std::vector<double>(c.curve->begin(), c.curve->end()) : std::vector<double>();
    double lab[3] = {0, 0, 0};
    if (c.labFrom == LabFrom::Given) {
        for (int i = 0; i < 3; ++i) lab[i] = c.lab[i];
    } else if (c.labFrom == LabFrom::Curve) {
        ASSERT_EQ(BPConvert36BandSpectral2LabD502(curve.data(), lab), 1);
    } else if (c.labFrom == LabFrom::RGB) {
        const double rgb[3] = {c.rgb[0], c.rgb[1], c.rgb[2]};
        ASSERT_EQ(BPConvertsRGB2Lab(rgb, lab), 1);
    }
    double sRGB[3];
    ASSERT_EQ(BPConvertLab2sRGB(lab, sRGB), 1);
    double linear[3] = {0, 0, 0};
    if (c.linearFrom == LinearFrom::Given) {
        for (int i = 0; i < 3; ++i) linear[i] = kRGBLinear[i];
    } else if (c.linearFrom == LinearFrom::Curve) {
        ASSERT_EQ(BPConvert36BandSpectral2LinearsRGB(curve.data(), linear), 1);
        for (double& v : linear) v *= 255.0;
    }

    for (int i = 0; i < 3; ++i) {
        EXPECT_NEAR(record.GetLab()[i], lab[i], 1e-4) << "Lab " << i;
        EXPECT_NEAR(record.GetSRGB()[i], sRGB[i], 1e-3) << "sRGB " << i;
        EXPECT_NEAR(record.GetLinearRGB()[i], linear[i], 1e-5) << "linear " << i;
    }
    EXPECT_EQ(record.GetSpectralReflectanceCount(), c.storedCount);
    EXPECT_EQ(record.GetSpectralReflectance() == nullptr, c.storedCount == 0);
    if (c.storedCount > 0) {
        EXPECT_EQ(record.GetSpectralReflectance()[c.storedCount - 1], c.curve->back());
    }
    EXPECT_EQ(record.GetTagCount(), 0);
}

// clang-format off
INSTANTIATE_TEST_SUITE_P(
    Cases, RecordConstruction,
    testing::Values(
        RecordCase{"LabOnly", kLab50, nullptr, nullptr, 0, LabFrom::Given, LinearFrom::Zero, 0},
        RecordCase{"CurveOnly", nullptr, nullptr, &kOnes36, 36, LabFrom::Curve, LinearFrom::Curve, 36},
        RecordCase{"BookValuesWin", kLab50, kRGB, &kOnes36, 36, LabFrom::Given, LinearFrom::Given, 36},
        RecordCase{"RGBOnly", nullptr, kRGB, nullptr, 0, LabFrom::RGB, LinearFrom::Given, 0},
        RecordCase{"CurveBeatsRGBForLab", nullptr, kRGB, &kOnes36, 36, LabFrom::Curve, LinearFrom::Given, 36},
        RecordCase{"Curve35DerivesNothing", nullptr, nullptr, &kRamp35, 35, LabFrom::Zero, LinearFrom::Zero, 35},
        RecordCase{"NullValuesCount1", nullptr, nullptr, nullptr, 1, LabFrom::Zero, LinearFrom::Zero, 0},
        RecordCase{"NullValuesCount36", nullptr, nullptr, nullptr, 36, LabFrom::Zero, LinearFrom::Zero, 0}),
    [](const testing::TestParamInfo<RecordCase>& info) { return info.param.label; });
// clang-format on

TEST(Record, TagsAndCopiesAreOwned) {
    const std::vector<std::string> tags = {"first", "second"};
    const float curve[3] = {0.1f, 0.2f, 0.3f};
    auto original = std::make_unique<ColorInformation>("name", "category", kLab50, kRGB, curve, 3, &tags);
    ColorInformation copy = *original;
    ColorInformation assigned("x", "y", nullptr, nullptr, nullptr, 0, nullptr);
    assigned = copy;
    EXPECT_EQ(copy.GetTagCount(), 2);
    EXPECT_STREQ(copy.GetTag(1), "second");
    EXPECT_EQ(copy.GetTag(2), nullptr);
    EXPECT_NE(copy.GetName(), original->GetName());
    EXPECT_NE(copy.GetSpectralReflectance(), original->GetSpectralReflectance());
    const std::vector<float> lab(original->GetLab(), original->GetLab() + 3);
    original.reset();  // the copies must not share its storage
    for (const ColorInformation* record : {&copy, &assigned}) {
        EXPECT_STREQ(record->GetName(), "name");
        EXPECT_STREQ(record->GetCategory(), "category");
        EXPECT_STREQ(record->GetTag(0), "first");
        EXPECT_EQ(record->GetSpectralReflectance()[2], 0.3f);
        EXPECT_EQ(std::vector<float>(record->GetLab(), record->GetLab() + 3), lab);
    }
}

struct HtmlCase {
    double red, green, blue;
    const char* code;
};

class HtmlCode : public testing::TestWithParam<HtmlCase> {};

// Truncated, red first, clamped; a round trip's error below a hundredth does not drop a level.
TEST_P(HtmlCode, IsTheTruncatedTripleRedFirst) {
    const HtmlCase& c = GetParam();
    EXPECT_EQ(Pigmo::HtmlColorCode(c.red, c.green, c.blue), c.code);
}

INSTANTIATE_TEST_SUITE_P(Cases, HtmlCode,
                         testing::Values(HtmlCase{254.6, 0.4, 128.6, "#FE0080"},
                                         HtmlCase{219.999235, 39.995777, 30.000668, "#DC281E"},
                                         HtmlCase{219.98, 1.5, 16.0, "#DB0110"},
                                         HtmlCase{-5.0, 300.0, std::nan(""), "#00FF00"}));

}  // namespace
