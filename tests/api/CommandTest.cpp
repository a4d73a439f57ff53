// Runs `pigmo delta-e` and `pigmo harmony` and checks their output, errors and exit codes.
#include <gtest/gtest.h>

#include <algorithm>
#include <sstream>
#include <string>
#include <vector>

#include "RunPigmo.h"

namespace {

struct CommandCase {
    const char* name;
    std::string arguments;  // shell words after "pigmo"
    std::string input;
    std::vector<double> expected;  // every number printed, in order; empty for errors
    std::string error;             // part of the one stderr line; empty for success
};

const CommandCase kCases[] = {
    {"ciede2000_default", "delta-e 50 2.6772 -79.7751 50 0 -82.7485", "", {2.0425}, ""},
    {"cmc_weights", "delta-e -m cmc -w 2,1 50 20 -30 55 18 -25", "", {3.42184}, ""},
    {"squared", "delta-e -m squared 50 0 0 50 3 4", "", {25}, ""},
    {"pairs_from_stdin", "delta-e -m cie76", "50 0 0 50 3 4\n\n50,0,0, 50,0,-2\n", {5, 2}, ""},
    {"complement", "harmony complement 60 34.64101615 20", "", {60, -37.6146, 13.6067}, ""},
    {"monochromatic", "harmony monochromatic 50 10 10", "", {17, 10, 10, 83, 10, 10}, ""},
    {"unknown_metric", "delta-e -m cie2000 1 2 3 4 5 6", "", {}, "unknown metric 'cie2000'"},
    {"weights_not_for_cie76", "delta-e -m cie76 -w 1,1 1 2 3 4 5 6", "", {}, "cie76 takes no weights"},
    {"wrong_weight_count", "delta-e -m ciede2000 -w 1,1 1 2 3 4 5 6", "", {}, "takes 3 weights"},
    {"five_values", "delta-e 1 2 3 4 5", "", {}, "expected 6 values"},
    {"not_a_number", "delta-e 1 2 3 4 5 abc", "", {}, "'abc' is not a number"},
    // Nothing of a failing stream is half-printed: the good first line is kept, the error names line 2.
    {"bad_stdin_line", "delta-e -m cie76", "50 0 0 50 3 4\n1 2 3\n", {5}, "line 2: expected 6 values"},
    {"unknown_harmony", "harmony opposite 50 10 10", "", {}, "unknown harmony 'opposite'"},
    {"harmony_value_count", "harmony near 50 10", "", {}, "expected 3 values"},
};

void PrintTo(const CommandCase& c, std::ostream* os) {
    *os << c.name;
}

class Commands : public testing::TestWithParam<CommandCase> {};

TEST_P(Commands, PrintTheValuesOrOneErrorLine) {
    const CommandCase& c = GetParam();
    const RunResult run = RunPigmo(c.arguments, c.input);
    const std::string& out = run.out;
    const std::string& err = run.err;

    ASSERT_NE(run.exitCode, -1);
    EXPECT_EQ(run.exitCode == 0, c.error.empty()) << err;
    std::istringstream numbers(out);
    std::vector<double> printed;
    for (double v; numbers >> v;) printed.push_back(v);
    ASSERT_EQ(printed.size(), c.expected.size()) << out;
    for (size_t i = 0; i < printed.size(); ++i) EXPECT_NEAR(printed[i], c.expected[i], 5e-5) << i;
    if (!c.error.empty()) {
        EXPECT_NE(err.find(c.error), std::string::npos) << err;
        EXPECT_EQ(std::count(err.begin(), err.end(), '\n'), 1) << err;
    }
}

INSTANTIATE_TEST_SUITE_P(DeltaEAndHarmony, Commands, testing::ValuesIn(kCases),
                         [](const auto& info) { return std::string(info.param.name); });

}  // namespace
