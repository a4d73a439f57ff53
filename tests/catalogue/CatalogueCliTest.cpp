// Runs the built pigmo binary's name and extract commands.
#include <gtest/gtest.h>
#include <stb/stb_image_write.h>

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <nlohmann/json.hpp>
#include <sstream>
#include <string>
#include <vector>

#include "RunPigmo.h"
#include "TempFolder.h"
#include "pigmo/bp.h"

namespace {

class PigmoCli : public TempFolder {
protected:
    // An RGB PNG whose left three quarters are one color and the rest another.
    std::string WritePng(const unsigned char* left, const unsigned char* right) const {
        const int width = 8, height = 8;
        std::vector<unsigned char> rgb;
        for (int y = 0; y < height; ++y) {
            for (int x = 0; x < width; ++x) {
                const unsigned char* color = x < 6 ? left : right;
                rgb.insert(rgb.end(), color, color + 3);
            }
        }
        const std::string path = root_ + "/image.png";
        EXPECT_NE(stbi_write_png(path.c_str(), width, height, 3, rgb.data(), width * 3), 0);
        return path;
    }
};

std::string NameOf(const unsigned char* rgb) {
    const double in[3] = {double(rgb[0]), double(rgb[1]), double(rgb[2])};
    double lab[3];
    BPConvertsRGB2Lab(in, lab);
    return BPCentroidGetName(BPCentroidGetForLab(lab));
}

TEST_F(PigmoCli, NamePrintsTheNearestCentroid) {
    RunResult run = RunPigmo("name 80.656948 27.535981 8.233154");
    ASSERT_EQ(run.exitCode, 0) << run.err;
    EXPECT_EQ(run.out, "index: 1\nname: Vivid Pink\ncategory: 1 Red/Pink\ndistance: 0.0000\n");
}

TEST_F(PigmoCli, ExtractListsDominantColorsLargestFirst) {
    const unsigned char red[3] = {220, 30, 30}, blue[3] = {30, 40, 210};
    const std::string image = WritePng(red, blue);
    RunResult run = RunPigmo("extract " + image + " -n 5");
    ASSERT_EQ(run.exitCode, 0) << run.err;
    std::vector<std::string> lines;
    std::istringstream text(run.out);
    for (std::string line; std::getline(text, line);) lines.push_back(line);
    // A heading, then the two groups once each although five were allowed.
    ASSERT_EQ(lines.size(), 3u) << run.out;
    EXPECT_NE(lines[1].find("#DC1E1E  " + NameOf(red)), std::string::npos) << lines[1];
    EXPECT_NE(lines[2].find("#1E28D2  " + NameOf(blue)), std::string::npos) << lines[2];

    run = RunPigmo("extract --json -n 1 " + image);
    ASSERT_EQ(run.exitCode, 0) << run.err;
    const auto document = nlohmann::json::parse(run.out);
    EXPECT_EQ(document["width"], 8);
    ASSERT_EQ(document["colors"].size(), 1u);
    EXPECT_EQ(document["colors"][0]["srgb"], "#DC1E1E");
    EXPECT_EQ(document["colors"][0]["name"], NameOf(red));
    EXPECT_EQ(document["colors"][0]["lab"].size(), 3u);
}

TEST_F(PigmoCli, ErrorsAreOneLineOnStandardError) {
    Write("notes.txt", "not an image\n");
    const std::string cases[][2] = {
        {"name 50 1", "expected 3 values"},
        {"name 1 2 3 4", "expected 3 values"},
        {"name 50 abc 0", "'abc' is not a number"},
        {"name", "LAB is required"},
        {"extract", "IMAGE is required"},
        {"extract " + root_ + "/missing.png", "no such file or directory"},
        {"extract " + root_ + "/notes.txt", "cannot decode image"},
        {"extract " + root_ + "/notes.txt" + " -n 0", "not a whole number from 1 to 267"},
        {"extract " + root_ + "/notes.txt" + " -n many", "not a whole number from 1 to 267"},
    };
    for (const auto& [args, message] : cases) {
        const RunResult run = RunPigmo(args);
        EXPECT_NE(run.exitCode, 0) << args;
        EXPECT_EQ(run.out, "") << args;
        EXPECT_EQ(std::count(run.err.begin(), run.err.end(), '\n'), 1) << args << ": " << run.err;
        EXPECT_NE(run.err.find(message), std::string::npos) << args << ": " << run.err;
    }
}

}  // namespace
