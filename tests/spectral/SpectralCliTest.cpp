// pigmo translate with spectral sources, run as a user would.
#include <gtest/gtest.h>

#include <algorithm>
#include <sstream>
#include <string>
#include <vector>

#include "RunPigmo.h"

namespace {

RunResult Translate(const std::string& arguments, const std::string& input = "") {
    return RunPigmo("translate " + arguments, input);
}

std::string Repeat(const std::string& value, int count, const char* separator = " ") {
    std::string text;
    for (int i = 0; i < count; ++i) text += (i ? separator : "") + value;
    return text;
}

std::vector<double> Numbers(const std::string& line) {
    std::istringstream stream(line);
    std::vector<double> values;
    for (double v; stream >> v;) values.push_back(v);
    return values;
}

TEST(SpectralCli, ConvertsSpectraFromTheLineAndFromStandardInput) {
    const struct {
        std::string arguments, input;
        std::vector<double> expected;
        double tolerance;
    } cases[] = {
        {"spectral lab " + Repeat("1.0", 36), "", {100, 0, 0}, 1e-9},
        {"spectral xyz " + Repeat("1", 36), "", {0.96422, 1, 0.82521}, 1e-9},
        {"spectral lab --illuminant d65 " + Repeat("1", 36), "", {100, 0, 0}, 1e-9},
        {"spectral xyz --illuminant d65 " + Repeat("1", 36), "", {0.95047, 1, 1.08883}, 1e-9},
        {"spectral xyz --observer 1 " + Repeat("1", 36), "", {0.96720, 1, 0.81427}, 1e-9},
        {"spectral lab --start 400 --end 700 " + Repeat("1", 31), "", {100, 0, 0}, 1e-9},
        {"spectral density", Repeat("0.1", 36) + "\n", {0.99999, 0.99998, 1, 0.9998}, 1e-9},
        {"spectral xyz --emissive", Repeat("1", 36, ",") + "\n", {68.3, 68.3, 68.3}, 0.03},
        {"spectral spectral --to-start 400 --to-end 420 " + Repeat("0.5", 36), "", {0.5, 0.5, 0.5}, 1e-12},
    };
    for (const auto& c : cases) {
        const RunResult run = Translate(c.arguments, c.input);
        ASSERT_EQ(run.exitCode, 0) << c.arguments << "\n" << run.err;
        const std::vector<double> values = Numbers(run.out);
        ASSERT_EQ(values.size(), c.expected.size()) << c.arguments << "\n" << run.out;
        for (size_t i = 0; i < values.size(); ++i)
            EXPECT_NEAR(values[i], c.expected[i], c.tolerance) << c.arguments;
    }
}

TEST(SpectralCli, RefusesBadDescriptionsWithOneLine) {
    const struct {
        std::string arguments, message;
    } cases[] = {
        {"spectral lab --illuminant daylight 1", "--illuminant: daylight needs a temperature"},
        {"spectral lab --illuminant f5 1", "unknown illuminant 'f5'"},
        {"spectral lab --from-start 800 1", "--from-end (730 nm) must lie above --from-start (800 nm)"},
        {"spectral lab --step 0 1", "--step: must be positive"},
        {"spectral lab --weighting 9 1", "--weighting: expected a method from 0 to 5"},
        {"spectral lab 1 1 1", "expected 36 values"},
        {"lab spectral 50 0 0", "spectral values come only from spectral values"},
    };
    for (const auto& c : cases) {
        const RunResult run = Translate(c.arguments);
        EXPECT_NE(run.exitCode, 0) << c.arguments;
        EXPECT_EQ(run.out, "") << c.arguments;
        EXPECT_NE(run.err.find(c.message), std::string::npos) << c.arguments << "\n" << run.err;
        EXPECT_EQ(std::count(run.err.begin(), run.err.end(), '\n'), 1) << run.err;
    }
}

}  // namespace
