// What every command shares: the exit status, --version, help with an example, and --json output
// that says what the text says.
#include <gtest/gtest.h>

#include <nlohmann/json.hpp>
#include <sstream>
#include <string>

#include "RunPigmo.h"

namespace {

struct StatusCase {
    const char* arguments;
    int exitCode;
};

class ExitStatus : public testing::TestWithParam<StatusCase> {};

TEST_P(ExitStatus, SaysSuccessFailureOrWrongUsage) {
    const RunResult run = RunPigmo(GetParam().arguments);
    EXPECT_EQ(run.exitCode, GetParam().exitCode) << GetParam().arguments << ": " << run.err;
    // A failure or a usage error says why in one line; success says nothing on stderr.
    if (GetParam().exitCode == 0) {
        EXPECT_EQ(run.err, "");
    } else {
        EXPECT_EQ(run.err.find('\n'), run.err.size() - 1) << run.err;
    }
}

INSTANTIATE_TEST_SUITE_P(
    Commands, ExitStatus,
    testing::Values(StatusCase{"name 50 0 0", 0}, StatusCase{"--help", 0}, StatusCase{"map render --help", 0},
                    StatusCase{"", 2}, StatusCase{"nosuch", 2}, StatusCase{"name", 2},
                    StatusCase{"delta-e --bogus 1 2 3 4 5 6", 2}, StatusCase{"extract img.png --count", 2},
                    StatusCase{"map render scene.json", 2}, StatusCase{"name 50 0", 1},
                    StatusCase{"book /nonexistent/book.cxf", 1}, StatusCase{"translate density lab 1 1 1", 1},
                    StatusCase{"map show /nonexistent/scene.json", 1}));

TEST(Version, NamesProgramAndVersion) {
    const RunResult run = RunPigmo("--version");
    EXPECT_EQ(run.exitCode, 0);
    EXPECT_TRUE(run.out.starts_with("pigmo ")) << run.out;
    EXPECT_EQ(run.out.substr(6), std::string(PIGMO_VERSION) + "\n");
}

TEST(Help, EverySubcommandGivesAnExampleOfItself) {
    for (const char* command :
         {"translate", "delta-e", "harmony", "name", "extract", "book", "palettes", "map new", "map pick",
          "map book", "map show", "map render", "map viewport", "map rollout", "map mr"}) {
        const RunResult run = RunPigmo(std::string(command) + " --help");
        EXPECT_EQ(run.exitCode, 0) << command;
        EXPECT_NE(run.out.find(std::string("Example: pigmo ") + command), std::string::npos) << command;
    }
}

// The numbers of a text line, in order.
std::vector<double> Numbers(const std::string& text) {
    std::vector<double> numbers;
    std::istringstream words(text);
    std::string word;
    while (words >> word) {
        try {
            size_t used = 0;
            const double value = std::stod(word, &used);
            if (used == word.size()) numbers.push_back(value);
        } catch (const std::exception&) {
        }
    }
    return numbers;
}

struct JsonCase {
    const char* arguments;
    const char* pointer;  // where the JSON holds what the text prints
};

class JsonOutput : public testing::TestWithParam<JsonCase> {};

TEST_P(JsonOutput, HoldsWhatTheTextPrints) {
    const RunResult text = RunPigmo(GetParam().arguments);
    const RunResult json = RunPigmo(std::string(GetParam().arguments) + " --json");
    ASSERT_EQ(text.exitCode, 0) << text.err;
    ASSERT_EQ(json.exitCode, 0) << json.err;
    const nlohmann::json document = nlohmann::json::parse(json.out);
    std::vector<double> values;
    const nlohmann::json& held = document.at(nlohmann::json::json_pointer(GetParam().pointer));
    if (held.is_array()) {
        for (const nlohmann::json& item : held) {
            if (item.is_array()) {
                for (double v : item) values.push_back(v);
            } else {
                values.push_back(item);
            }
        }
    } else {
        values.push_back(held);
    }
    const std::vector<double> printed = Numbers(text.out);
    ASSERT_EQ(values.size(), printed.size()) << text.out << json.out;
    for (size_t i = 0; i < printed.size(); ++i)
        EXPECT_NEAR(values[i], printed[i], 1e-8 * (1 + std::abs(printed[i])));
}

INSTANTIATE_TEST_SUITE_P(Commands, JsonOutput,
                         testing::Values(JsonCase{"delta-e -m cmc 50 20 -30 55 18 -25", "/difference"},
                                         JsonCase{"harmony triadic 60 30 20", "/companions"},
                                         JsonCase{"harmony complement 60 30 20", "/companions"},
                                         JsonCase{"translate lab srgb 50 10 -20", "/output"}));

TEST(JsonOutput, NameAndPalettesGiveTheirFields) {
    const nlohmann::json name = nlohmann::json::parse(RunPigmo("name 50 -20 10 --json").out);
    const RunResult text = RunPigmo("name 50 -20 10");
    EXPECT_NE(text.out.find("index: " + std::to_string(name.at("index").get<int>()) + "\n"),
              std::string::npos);
    EXPECT_NE(text.out.find("name: " + name.at("name").get<std::string>() + "\n"), std::string::npos);

    const nlohmann::json palettes = nlohmann::json::parse(RunPigmo("palettes --json").out);
    ASSERT_FALSE(palettes.empty());
    for (const nlohmann::json& palette : palettes) {
        EXPECT_TRUE(palette.at("kind") == "system" || palette.at("kind") == "user");
        EXPECT_TRUE(std::filesystem::exists(palette.at("path").get<std::string>()));
    }
}

}  // namespace
