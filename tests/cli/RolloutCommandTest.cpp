// "pigmo map rollout": the map's editor panel rendered headless to a PNG.
#include <gtest/gtest.h>
#include <stb/stb_image.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <filesystem>
#include <fstream>
#include <memory>
#include <nlohmann/json.hpp>
#include <string>
#include <vector>

#include "RunPigmo.h"
#include "TempFolder.h"

namespace {

const std::string kTestBook = std::string(PIGMO_PALETTE_SOURCE_DIR) + "Test Color Samples.cxf";

struct Png {
    int width = 0, height = 0;
    std::vector<unsigned char> rgb;
    std::array<int, 3> At(int x, int y) const {
        const std::size_t at = (static_cast<std::size_t>(y) * width + x) * 3u;
        return {rgb[at], rgb[at + 1], rgb[at + 2]};
    }
};

Png Read(const std::string& path) {
    Png png;
    int channels = 0;
    const std::unique_ptr<stbi_uc, void (*)(void*)> data(
        stbi_load(path.c_str(), &png.width, &png.height, &channels, 3), stbi_image_free);
    if (data) png.rgb.assign(data.get(), data.get() + png.width * png.height * 3);
    return png;
}

class RolloutCommand : public TempFolder {
protected:
    void SetUp() override {
        TempFolder::SetUp();
        const RunResult made = RunPigmo("map new '" + Scene() + "' --book '" + kTestBook + "' --pick 4");
        ASSERT_EQ(made.exitCode, 0) << made.err;
    }
    std::string Scene() const { return root_ + "/scene.json"; }
    std::string Panel() const { return root_ + "/panel.png"; }
    RunResult Rollout(const std::string& options) {
        return RunPigmo("map rollout '" + Scene() + "' -o '" + Panel() + "' " + options);
    }
};

// Each scale repeats every pixel of the panel scale x scale times.
class RolloutScale : public RolloutCommand, public testing::WithParamInterface<int> {};

TEST_P(RolloutScale, EnlargesEveryPixel) {
    RunResult result = Rollout("");
    ASSERT_EQ(result.exitCode, 0) << result.err;
    EXPECT_EQ(result.err, "");
    const Png one = Read(Panel());
    ASSERT_GT(one.width, 0);
    result = Rollout("--scale " + std::to_string(GetParam()));
    ASSERT_EQ(result.exitCode, 0) << result.err;
    const Png scaled = Read(Panel());
    const int s = GetParam();
    ASSERT_EQ(scaled.width, one.width * s);
    ASSERT_EQ(scaled.height, one.height * s);
    for (int y = 0; y < scaled.height; ++y)
        for (int x = 0; x < scaled.width; ++x)
            if (scaled.At(x, y) != one.At(x / s, y / s)) FAIL() << "pixel " << x << "," << y;
}

INSTANTIATE_TEST_SUITE_P(Scales, RolloutScale, testing::Values(1, 2, 3));

// The panel as a person sees it: 217 x 405 dialog units in the host's grey, with the picked color
// in the swatch.
TEST_F(RolloutCommand, ShowsThePanelWithThePickedColor) {
    const RunResult result = Rollout("");
    ASSERT_EQ(result.exitCode, 0) << result.err;
    const Png panel = Read(Panel());
    // The dialog's base units, from its size in pixels.
    const double unitX = std::round(panel.width * 4.0 / 217) / 4,
                 unitY = std::round(panel.height * 8.0 / 405) / 8;
    EXPECT_NEAR(panel.width, 217 * unitX, 0.5);
    EXPECT_NEAR(panel.height, 405 * unitY, 0.5);
    EXPECT_EQ(panel.At(1, 1), (std::array<int, 3>{197, 197, 197}));

    const RunResult shown = RunPigmo("map show '" + Scene() + "' --json");
    ASSERT_EQ(shown.exitCode, 0);
    const nlohmann::json sRGB = nlohmann::json::parse(shown.out)["srgb"];
    std::array<int, 3> picked{};
    // The swatch takes each channel as a 32-bit fraction of 255, rounded.
    for (int c = 0; c < 3; ++c)
        picked[c] = static_cast<int>(static_cast<float>(sRGB[c].get<float>() / 255.0) * 255.0 + 0.5);
    const int x = static_cast<int>((7 + 67 / 2) * unitX), y = static_cast<int>((224 + 69 / 2) * unitY);
    EXPECT_EQ(panel.At(x, y), picked);
}

TEST_F(RolloutCommand, AFailingCommandWritesNoFile) {
    std::ofstream(Panel()) << "kept";
    struct Case {
        std::string arguments;
        std::string error;
    };
    const Case cases[] = {
        {"map rollout '" + root_ + "/missing.json' -o '" + Panel() + "'", root_ + "/missing.json"},
        {"map rollout '" + Scene() + "' -o '" + Panel() + "' --scale 0", "--scale"},
        {"map rollout '" + Scene() + "' -o '" + Panel() + "' --scale 9", "--scale"},
        {"map rollout '" + Scene() + "' -o '" + root_ + "/no/such/folder/panel.png'",
         root_ + "/no/such/folder"},
    };
    for (const Case& c : cases) {
        const RunResult result = RunPigmo(c.arguments);
        EXPECT_EQ(result.exitCode, c.arguments.find("--scale") != std::string::npos ? 2 : 1) << c.arguments;
        EXPECT_NE(result.err.find(c.error), std::string::npos) << result.err;
        EXPECT_EQ(std::count(result.err.begin(), result.err.end(), '\n'), 1) << result.err;
        EXPECT_EQ(ReadWholeFile(Panel()), "kept");
    }
    EXPECT_FALSE(std::filesystem::exists(root_ + "/no"));
}

}  // namespace
