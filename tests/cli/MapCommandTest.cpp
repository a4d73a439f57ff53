// "pigmo map" end to end: the built tool loads the real plug-in, keeps scenes and renders them.
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
const std::string kCentroidBook = std::string(PIGMO_PALETTE_SOURCE_DIR) + "ISCC-NBS Centroid Colors.cxf";

std::string Quoted(const std::string& text) {
    return "'" + text + "'";
}

// The sRGB transfer function of IEC 61966-2-1, to 8 bits.
int Srgb8(double linear) {
    const double v = std::clamp(linear, 0.0, 1.0);
    return static_cast<int>(std::lround(255.0 * (v <= 0.0031308 ? 12.92 * v : 1.055 * std::pow(v, 1 / 2.4) - 0.055)));
}

struct Decoded {
    int width = 0, height = 0, channels = 0;
    std::vector<int> samples;
};

// An 8-bit or 16-bit PNG's samples as they are in the file.
Decoded DecodePng(const std::string& path, bool sixteen) {
    Decoded image;
    if (sixteen) {
        const std::unique_ptr<stbi_us, void (*)(void*)> data(
            stbi_load_16(path.c_str(), &image.width, &image.height, &image.channels, 0), stbi_image_free);
        if (data) image.samples.assign(data.get(), data.get() + image.width * image.height * image.channels);
    } else {
        const std::unique_ptr<stbi_uc, void (*)(void*)> data(
            stbi_load(path.c_str(), &image.width, &image.height, &image.channels, 0), stbi_image_free);
        if (data) image.samples.assign(data.get(), data.get() + image.width * image.height * image.channels);
    }
    return image;
}

class MapCommand : public TempFolder {
protected:
    std::string Scene() const { return root_ + "/scene.json"; }
    std::string Image() const { return root_ + "/image.png"; }

    static RunResult Map(const std::string& arguments, const std::string& prefix = "") {
        return RunPigmo("map " + arguments, "", prefix);
    }
    void MustRun(const std::string& arguments) {
        const RunResult result = Map(arguments);
        ASSERT_EQ(result.exitCode, 0) << arguments << ": " << result.err;
        EXPECT_EQ(result.err, "") << arguments;
    }
    nlohmann::json Show() {
        const RunResult result = Map("show " + Quoted(Scene()) + " --json");
        EXPECT_EQ(result.exitCode, 0) << result.err;
        return nlohmann::json::parse(result.out);
    }
    // A parameter of the scene's map, as the scene file holds it.
    nlohmann::json Parameter(const std::string& id) const {
        return nlohmann::json::parse(ReadWholeFile(Scene()))["maps"][0]["parameters"][id]["value"];
    }
    // The one color every pixel of the rendered image has; fails when they differ.
    std::array<int, 3> RenderedColor() {
        const RunResult result = Map("render " + Quoted(Scene()) + " -o " + Quoted(Image()) + " --size 16");
        EXPECT_EQ(result.exitCode, 0) << result.err;
        const Decoded image = DecodePng(Image(), false);
        EXPECT_EQ(image.width, 16);
        EXPECT_EQ(image.channels, 3);
        if (image.samples.size() != 16u * 16u * 3u) return {-1, -1, -1};
        const std::array<int, 3> first{image.samples[0], image.samples[1], image.samples[2]};
        for (std::size_t i = 0; i < image.samples.size(); ++i) EXPECT_EQ(image.samples[i], first[i % 3]) << i;
        return first;
    }
    std::string Copy(const std::string& book) {
        const std::string path = root_ + "/book.cxf";
        std::filesystem::copy_file(book, path);
        return path;
    }
};

// The picked color's own values: what the scene keeps of it.
void ExpectPixelIsThePickedColor(const std::array<int, 3>& pixel, const nlohmann::json& linear,
                                 const nlohmann::json& sRGB) {
    for (int c = 0; c < 3; ++c) {
        EXPECT_EQ(pixel[c], Srgb8(linear[c].get<double>())) << c;
        EXPECT_NEAR(pixel[c], sRGB[c].get<double>(), 0.5 + 1e-3) << c;
    }
}

TEST_F(MapCommand, NewMapPickedAndRenderedIsThePickedColorEverywhere) {
    MustRun("new " + Quoted(Scene()));
    // A new map takes the first system palette and its first color.
    EXPECT_EQ(Show()["selected"], 0);
    MustRun("pick " + Quoted(Scene()) + " 5");
    EXPECT_EQ(Parameter("1"), 5);
    ExpectPixelIsThePickedColor(RenderedColor(), Parameter("5"), Parameter("4"));
}

TEST_F(MapCommand, ShowGivesTheBookAndThePickedColor) {
    MustRun("new " + Quoted(Scene()) + " --book " + Quoted(kTestBook) + " --pick 2");
    const nlohmann::json shown = Show();
    const RunResult book = RunPigmo("book " + Quoted(kTestBook) + " --json");
    ASSERT_EQ(book.exitCode, 0);
    const nlohmann::json colors = nlohmann::json::parse(book.out)["colors"];
    const nlohmann::json& picked = colors[2];

    EXPECT_EQ(shown["scene"], Scene());
    EXPECT_EQ(shown["map"], "Map #1");
    EXPECT_EQ(shown["book"], std::filesystem::path(kTestBook).lexically_normal().string());
    EXPECT_EQ(shown["colors"], colors.size());
    EXPECT_EQ(shown["selected"], 2);
    EXPECT_EQ(shown["name"], picked["name"]);
    EXPECT_EQ(shown["category"], picked["category"]);
    EXPECT_EQ(shown["tags"], picked["tags"]);
    for (const char* triple : {"srgb", "linear_rgb", "lab"}) {
        ASSERT_EQ(shown[triple].size(), 3u) << triple;
        for (int i = 0; i < 3; ++i)
            EXPECT_EQ(shown[triple][i].get<float>(), picked[triple][i].get<float>()) << triple << " " << i;
    }
    ASSERT_EQ(shown["reflectance"].size(), picked["reflectance"].size());
    for (std::size_t i = 0; i < shown["reflectance"].size(); ++i)
        EXPECT_EQ(shown["reflectance"][i].get<float>(), picked["reflectance"][i].get<float>()) << i;

    const RunResult text = Map("show " + Quoted(Scene()));
    ASSERT_EQ(text.exitCode, 0);
    EXPECT_NE(text.out.find("selected:     2\n"), std::string::npos) << text.out;
    EXPECT_NE(text.out.find("name:         " + picked["name"].get<std::string>() + "\n"), std::string::npos);

    // -1 clears the pick: nothing is shown and the map renders black.
    MustRun("pick " + Quoted(Scene()) + " -1");
    EXPECT_EQ(Show()["name"], "");
    EXPECT_EQ(RenderedColor(), (std::array<int, 3>{0, 0, 0}));
}

TEST_F(MapCommand, AnotherBookClearsThePickButKeepsTheRenderedColor) {
    MustRun("new " + Quoted(Scene()) + " --book " + Quoted(kTestBook) + " --pick 3");
    const nlohmann::json before = Show();
    const std::array<int, 3> pixel = RenderedColor();
    MustRun("book " + Quoted(Scene()) + " " + Quoted(kCentroidBook));
    const nlohmann::json after = Show();
    EXPECT_EQ(after["selected"], -1);
    EXPECT_EQ(after["book"], std::filesystem::path(kCentroidBook).lexically_normal().string());
    EXPECT_EQ(after["colors"], 267);
    EXPECT_EQ(after["name"], before["name"]);
    EXPECT_EQ(after["linear_rgb"], before["linear_rgb"]);
    EXPECT_EQ(RenderedColor(), pixel);
}

// The product's promise: a saved scene renders its color without the book.
TEST_F(MapCommand, SceneWhoseBookHasGoneStillRendersItsColor) {
    const std::string book = Copy(kTestBook);
    MustRun("new " + Quoted(Scene()) + " --book " + Quoted(book) + " --pick 1");
    nlohmann::json before = Show();
    const std::array<int, 3> pixel = RenderedColor();
    std::filesystem::remove(book);

    const RunResult render = Map("render " + Quoted(Scene()) + " -o " + Quoted(Image()) + " --size 16");
    EXPECT_EQ(render.exitCode, 0);
    EXPECT_EQ(render.err, "Pigmo Color Map: ColorBook file '" + book + "' doesn't exist\n");
    EXPECT_EQ(RenderedColor(), pixel);
    nlohmann::json after = Show();
    EXPECT_EQ(after["colors"], 0);
    before.erase("colors");
    after.erase("colors");
    EXPECT_EQ(after, before);
}

struct FailingCase {
    const char* name;
    std::string arguments;  // ROOT is the test's folder, SCENE the scene
    std::string message;
};

class FailingCommands : public MapCommand, public testing::WithParamInterface<FailingCase> {};

TEST_P(FailingCommands, ChangeNoFile) {
    MustRun("new " + Quoted(Scene()) + " --book " + Quoted(kTestBook) + " --pick 1");
    Write("not-a-book.cxf", "<nothing/>");
    Write("file", "");
    const std::string scene = ReadWholeFile(Scene());
    std::vector<std::filesystem::path> before;
    for (const auto& entry : std::filesystem::directory_iterator(root_)) before.push_back(entry.path());

    std::string arguments = GetParam().arguments, message = GetParam().message;
    for (std::string* text : {&arguments, &message}) {
        for (const auto& [word, value] : {std::pair<std::string, std::string>{"SCENE", Quoted(Scene())}, {"ROOT", root_}})
            for (std::size_t at; (at = text->find(word)) != std::string::npos;) text->replace(at, word.size(), value);
    }
    const RunResult result = Map(arguments);
    EXPECT_EQ(result.exitCode, 1);
    EXPECT_NE(result.err.find(message), std::string::npos) << result.err;
    EXPECT_EQ(ReadWholeFile(Scene()), scene);
    std::vector<std::filesystem::path> after;
    for (const auto& entry : std::filesystem::directory_iterator(root_)) after.push_back(entry.path());
    std::sort(before.begin(), before.end());
    std::sort(after.begin(), after.end());
    EXPECT_EQ(after, before);
}

INSTANTIATE_TEST_SUITE_P(
    Cases, FailingCommands,
    testing::Values(
        FailingCase{"MissingBook", "book SCENE ROOT/gone.cxf",
                    "Pigmo Color Map: ColorBook file 'ROOT/gone.cxf' doesn't exist\npigmo map book: cannot use the book"},
        FailingCase{"NotABook", "book SCENE ROOT/not-a-book.cxf", "Pigmo Color Map: Specified file is not a valid CXF ColorBook"},
        FailingCase{"PickBeyondTheBook", "pick SCENE 999", "pigmo map pick: no color 999 to pick: the book has"},
        FailingCase{"PickBelowMinusOne", "pick SCENE -2", "no color -2 to pick"},
        FailingCase{"OutputInAFile", "render SCENE -o ROOT/file/image.png", "cannot write ROOT/file/image.png: not a directory"}),
    [](const testing::TestParamInfo<FailingCase>& info) { return info.param.name; });

TEST_F(MapCommand, SaveThatCannotBeWrittenLeavesTheScene) {
    MustRun("new " + Quoted(Scene()) + " --book " + Quoted(kTestBook) + " --pick 1");
    const std::string scene = ReadWholeFile(Scene());
    // A file-size limit fails the write as a full disk would, and holds for root too. One block (512
    // bytes in sh) leaves room for the message, not for the scene.
    ASSERT_GT(scene.size(), 1024u);
    const RunResult result = Map("pick " + Quoted(Scene()) + " 2", "trap '' XFSZ; ulimit -f 1;");
    EXPECT_EQ(result.exitCode, 1);
    EXPECT_EQ(result.err, "pigmo map pick: cannot write " + Scene() + ": file too large\n");
    EXPECT_EQ(ReadWholeFile(Scene()), scene);
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator(root_), {}), 1);
}

TEST_F(MapCommand, NewWithABookThatCannotBeReadWritesNothing) {
    const RunResult result = Map("new " + Quoted(Scene()) + " --book " + Quoted(root_ + "/gone.cxf"));
    EXPECT_EQ(result.exitCode, 1);
    EXPECT_NE(result.err.find("Pigmo Color Map: ColorBook file"), std::string::npos) << result.err;
    EXPECT_FALSE(std::filesystem::exists(Scene()));
}

TEST_F(MapCommand, RefusedSceneIsNamedWithItsLine) {
    Write("scene.json", "{\n  \"format\": \"pigmo-scene\",\n  \"version\": 1,\n  \"maps\": [\n");
    const RunResult result = Map("show " + Quoted(Scene()));
    EXPECT_EQ(result.exitCode, 1);
    EXPECT_EQ(result.err.rfind("pigmo map show: " + Scene() + ": line 5, column 1: syntax error", 0), 0u) << result.err;
}

TEST_F(MapCommand, ViewportImageIsTheClampedColorIn16Bits) {
    MustRun("new " + Quoted(Scene()) + " --book " + Quoted(kTestBook) + " --pick 4");
    MustRun("viewport " + Quoted(Scene()) + " -o " + Quoted(Image()));
    const Decoded image = DecodePng(Image(), true);
    ASSERT_EQ(image.width, 64);
    ASSERT_EQ(image.height, 64);
    ASSERT_EQ(image.channels, 4);
    const nlohmann::json linear = Parameter("5");
    std::array<int, 4> expected{0, 0, 0, 65535};
    for (int c = 0; c < 3; ++c) expected[c] = static_cast<int>(std::clamp(linear[c].get<float>(), 0.0f, 1.0f) * 65535.0);
    for (std::size_t i = 0; i < image.samples.size(); ++i) EXPECT_EQ(image.samples[i], expected[i % 4]) << i;
}

TEST_F(MapCommand, MentalRayShaderGetsTheLinearColor) {
    MustRun("new " + Quoted(Scene()) + " --book " + Quoted(kTestBook) + " --pick 0");
    const RunResult result = Map("mr " + Quoted(Scene()) + " --json");
    ASSERT_EQ(result.exitCode, 0) << result.err;
    const nlohmann::json shader = nlohmann::json::parse(result.out);
    EXPECT_EQ(shader["shader"], "adsk_Utility_ColorPassThrough");
    EXPECT_EQ(shader["name"], "Map #1 (Pigmo Kromalo Plug-in)");
    nlohmann::json color = Parameter("5");
    color.push_back(1.0);
    EXPECT_EQ(shader["color"], color);
}

}  // namespace
