// Runs the built pigmo binary and checks what it prints and how it exits.
#include <gtest/gtest.h>

#include <cctype>
#include <nlohmann/json.hpp>
#include <sstream>
#include <string>
#include <vector>

#include "RunPigmo.h"

namespace {

// ARGS are shell words after "pigmo translate".
RunResult RunTranslate(const std::string& args, const std::string& input = "") {
    return RunPigmo("translate " + args, input);
}

std::vector<std::vector<double>> ParseLines(const std::string& text) {
    std::vector<std::vector<double>> lines;
    std::istringstream stream(text);
    for (std::string line; std::getline(stream, line);) {
        std::istringstream values(line);
        lines.emplace_back();
        for (double v; values >> v;) lines.back().push_back(v);
    }
    return lines;
}

struct ConversionCase {
    const char* name;
    std::string args;
    std::vector<std::vector<double>> expected;
    double tolerance;
    std::string input = "";
};

class TranslateConverts : public ::testing::TestWithParam<ConversionCase> {};

TEST_P(TranslateConverts, PrintsOneLinePerColor) {
    const ConversionCase& c = GetParam();
    const RunResult run = RunTranslate(c.args, c.input);
    ASSERT_EQ(run.exitCode, 0) << run.err;
    EXPECT_EQ(run.err, "");
    const auto lines = ParseLines(run.out);
    ASSERT_EQ(lines.size(), c.expected.size()) << run.out;
    for (size_t i = 0; i < lines.size(); ++i) {
        ASSERT_EQ(lines[i].size(), c.expected[i].size()) << run.out;
        for (size_t j = 0; j < lines[i].size(); ++j) {
            EXPECT_NEAR(lines[i][j], c.expected[i][j], c.tolerance) << "line " << i << " value " << j;
        }
    }
}

const std::string kSRGBWhite = "0.9505,1,1.089";
const std::vector<std::vector<double>> kLabWhiteAsSRGB = {{255, 252.27, 220.85}};
const std::vector<std::vector<double>> kSRGBWhiteAsLab = {{100, -2.3829, -19.3737}};

INSTANTIATE_TEST_SUITE_P(
    Cli, TranslateConverts,
    ::testing::Values(
        // Lab is D50-relative and sRGB D65-relative; without adaptation the Lab white is not sRGB white.
        ConversionCase{"LabWhiteToSRGB", "lab srgb 100 0 0", kLabWhiteAsSRGB, 0.005},
        ConversionCase{"SRGBWhiteToLab", "srgb lab 255 255 255", kSRGBWhiteAsLab, 5e-5},
        ConversionCase{"LinearSRGBWhiteToLab", "linear-srgb lab 255 255 255", kSRGBWhiteAsLab, 5e-5},
        // The negative Z of this Lab color is clamped before the matrix; the blue result stays negative.
        ConversionCase{
            "NumericCodesLabToLinearSRGB", "3 25 10 0 100", {{0.017875, 0.010602, -0.0016923}}, 5e-7},
        ConversionCase{"NegativeValuesAreNotOptions", "lab lch 50 0 -10", {{50, 10, 270}}, 1e-9},
        ConversionCase{"LchToLab", "lch lab 50 10 90", {{50, 0, 10}}, 0.0},
        ConversionCase{"RimmToXYZ", "rimm xyz 1 1 1", {{0.9642, 1.0, 0.8249}}, 1e-9},
        ConversionCase{"XYZToLux", "xyz lux 0.3 0.6 0.9", {{0.6}}, 1e-9},
        // Black has no chromaticity; Yxy reports the white's, D50 by default.
        ConversionCase{"XYZBlackToYxy", "xyz yxy 0 0 0", {{0, 0.345669, 0.358496}}, 1e-6},
        ConversionCase{"StandardInputLinesCommasAndBlankLines",
                       "lab srgb",
                       {{255, 252.27, 220.85}, {0, 0, 0}},
                       0.005,
                       "100 0 0\n\n  0, 0, 0\r\n"},
        // Bradford maps the D50 white onto the sRGB white exactly, so Lab white becomes sRGB white.
        ConversionCase{
            "BradfordToTheSRGBWhite", "--adapt bradford lab srgb 100 0 0", {{255, 255, 255}}, 1e-6},
        ConversionCase{"DestinationRange",
                       "--to-range 0,1,0,1,0,1 lab srgb 100 0 0",
                       {{1.0, 252.27 / 255, 220.85 / 255}},
                       5e-5},
        ConversionCase{"SourceRange", "--from-range 0,1,0,1,0,1 srgb lab 1 1 1", kSRGBWhiteAsLab, 5e-5},
        ConversionCase{"RangesOnBothSidesOnlyRescale",
                       "--range 0,1,-1,1,-1,1 --to-range 0,100,-128,128,-128,128 lab lab 0.5 0.5 -0.25",
                       {{50, 64, -32}},
                       1e-9},
        ConversionCase{
            "DestinationWhite", "--to-white " + kSRGBWhite + " xyz lab 0.9505 1 1.089", {{100, 0, 0}}, 1e-9},
        ConversionCase{"SideWhiteWinsOverBothSides",
                       "--white 1,1,1 --to-white " + kSRGBWhite + " xyz lab 0.9505 1 1.089",
                       {{100, 0, 0}},
                       1e-9},
        ConversionCase{
            "WhiteForBothSides", "--white " + kSRGBWhite + " lab xyz 100 0 0", {{0.9505, 1, 1.089}}, 1e-9},
        ConversionCase{"SameObserverOnBothSides", "--observer 1 lab lab 50 1 2", {{50, 1, 2}}, 0.0},
        // The CIE 159 worked example of CIECAM02.
        ConversionCase{"Ciecam02WorkedExample",
                       "--to-white 0.9888,0.9,0.3203 --to-viewing 18,200,0.69,1,1,1 xyz ciecam02-jch "
                       "0.1931 0.2393 0.1014",
                       {{48.0314, 38.7788, 191.0456}},
                       5e-5},
        ConversionCase{"Ciecam02WorkedExampleBack",
                       "--from-white 0.9888,0.9,0.3203 --from-viewing 18,200,0.69,1,1,1 ciecam02-jch xyz "
                       "48.0314 38.7788 191.0456",
                       {{0.1931, 0.2393, 0.1014}},
                       5e-5}),
    [](const auto& info) { return std::string(info.param.name); });

struct FailureCase {
    const char* name;
    std::string args;
    std::string messagePart;
    std::string input = "";
    std::string expectedOut = "";  // colors converted before the failing one
};

class TranslateFails : public ::testing::TestWithParam<FailureCase> {};

TEST_P(TranslateFails, ReportsOneLineAndPrintsNothingOfTheColor) {
    const FailureCase& c = GetParam();
    const RunResult run = RunTranslate(c.args, c.input);
    EXPECT_NE(run.exitCode, 0);
    EXPECT_EQ(run.out, c.expectedOut);
    ASSERT_FALSE(run.err.empty());
    EXPECT_EQ(run.err.find('\n'), run.err.size() - 1) << run.err;
    EXPECT_NE(run.err.find(c.messagePart), std::string::npos) << run.err;
}

INSTANTIATE_TEST_SUITE_P(
    Cli, TranslateFails,
    ::testing::Values(
        FailureCase{"SourceWithoutNode", "5 3 1 2 3",
                    "cannot convert from code 5 to lab (3): no conversion from code 5"},
        FailureCase{"DestinationWithoutNode", "lab 7 1 2 3", "no conversion to code 7"},
        FailureCase{"MultiChannelSpace", "60 xyz 1 2 3", "code 60"},
        FailureCase{"DifferentObservers", "--from-observer 1 lab lab 50 0 0", "different observers"},
        FailureCase{"SpectralDestination", "lab 2 50 0 0", "spectral values come only from spectral values"},
        FailureCase{"DensitySource", "density lab 0.1 0.2 0.3 0.4", "densities convert only to the same"},
        FailureCase{"DensityFromLab", "lab density 50 0 0", "densities come only from spectral values"},
        FailureCase{"TooFewValues", "lab srgb 1 2", "expected 3 values for lab (3), got 2"},
        FailureCase{"TooManyValues", "xyz lux 1 2 3 4", "got 4"},
        FailureCase{"NotANumber", "lab srgb 1 x 2", "'x' is not a number"},
        FailureCase{"TrailingGarbage", "lab srgb 1 2 3abc", "'3abc' is not a number"},
        FailureCase{"NaNIsRefused", "lab srgb 1 nan 2", "'nan' is not a number"},
        FailureCase{"UnknownName", "lab cmyk 1 2 3", "unknown color space 'cmyk'"},
        FailureCase{"ViewingNeedsSixValues", "--to-viewing 18,200,0.69 xyz ciecam02-jch 0.2 0.2 0.2",
                    "--to-viewing: expected Yb,La,c,Nc,V5,F"},
        FailureCase{"ViewingPresetOutOfRange", "--viewing-preset 7 xyz ciecam02-jch 0.2 0.2 0.2",
                    "--viewing-preset: expected a preset from 0 to 6"},
        FailureCase{"CodeZero", "0 lab 1 2 3", "unknown color space '0'"},
        FailureCase{"CodeAboveTheTable", "lab 85 1 2 3", "unknown color space '85'"},
        FailureCase{"EncodingNeedsExtendedDescription", "30 lab 1 2 3", "needs an extended description"},
        FailureCase{"UnknownAdaptation", "--adapt vonkries lab srgb 1 2 3",
                    "--adapt: unknown method 'vonkries'"},
        FailureCase{"WhiteWithZero", "--white 1,0,1 lab xyz 1 2 3", "--white: components must be positive"},
        FailureCase{"WhiteWithTwoValues", "--to-white 1,1 lab xyz 1 2 3", "--to-white: expected X,Y,Z"},
        FailureCase{"ObserverOutOfRange", "--observer 3 lab xyz 1 2 3", "--observer: expected 0, 1 or 2"},
        FailureCase{"RangeWithWrongCount", "--to-range 0,1 lab srgb 1 2 3",
                    "--to-range: expected MIN,MAX for each of the 3 channels, got 2"},
        FailureCase{"EmptyRange", "--from-range 0,0,0,1,0,1 srgb lab 1 1 1",
                    "--from-range: channel 0 needs MIN < MAX"},
        FailureCase{"RangeWithText", "--range 0,1,a,1,0,1 srgb lab 1 1 1", "--range: 'a' is not a number"},
        FailureCase{"MissingDestination", "lab", "TO"},
        // Colors before the bad line are converted; the bad line prints nothing.
        FailureCase{"BadLineOnStandardInput", "lab lch", "line 2: expected 3 values",
                    "50 0 -10\n50 0\n50 0 10\n", "50 10 270\n"}),
    [](const auto& info) { return std::string(info.param.name); });

// Ten significant digits, so results can be fed back without visible loss.
TEST(TranslateOutput, KeepsTenSignificantDigits) {
    const RunResult run = RunTranslate("lab srgb 50 10 10");
    ASSERT_EQ(run.exitCode, 0) << run.err;
    std::istringstream values(run.out);
    for (std::string token; values >> token;) {
        size_t digits = 0;
        for (char ch : token.substr(token.find_first_not_of("-0.")))
            digits += std::isdigit(static_cast<unsigned char>(ch)) ? 1 : 0;
        EXPECT_GE(digits, 10u) << token;
    }
}

TEST(TranslateOutput, JsonHoldsInputAndOutput) {
    const RunResult run = RunTranslate("--json lab lch", "50 0 -10\n50 -10 0\n");
    ASSERT_EQ(run.exitCode, 0) << run.err;
    std::istringstream lines(run.out);
    std::vector<nlohmann::json> records;
    for (std::string line; std::getline(lines, line);) records.push_back(nlohmann::json::parse(line));
    ASSERT_EQ(records.size(), 2u);
    EXPECT_EQ(records[0]["from"], 3);
    EXPECT_EQ(records[0]["to"], 4);
    EXPECT_EQ(records[0]["input"], nlohmann::json({50.0, 0.0, -10.0}));
    const double expected[2][3] = {{50, 10, 270}, {50, 10, 180}};
    for (int r = 0; r < 2; ++r) {
        ASSERT_EQ(records[r]["output"].size(), 3u);
        for (int i = 0; i < 3; ++i) EXPECT_NEAR(records[r]["output"][i].get<double>(), expected[r][i], 1e-9);
    }
}

TEST(TranslateOutput, HelpNamesSpacesAndOptions) {
    const RunResult run = RunTranslate("--help");
    EXPECT_EQ(run.exitCode, 0);
    for (const char* part : {"linear-srgb", "--from-white", "--to-range", "--adapt", "standard input"})
        EXPECT_NE(run.out.find(part), std::string::npos) << part;
}

}  // namespace
