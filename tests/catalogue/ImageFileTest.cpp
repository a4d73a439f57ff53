// Dominant colors of image files through the C interface.
#include <gtest/gtest.h>
#include <stb/stb_image_write.h>

#include <string>
#include <vector>

#include "TempFolder.h"
#include "pigmo/bp.h"

namespace {

class ImageFile : public TempFolder {};

TEST_F(ImageFile, GivesTheColorsOfItsPixelsWithoutRepeats) {
    // Three quarters one color, the rest another, as RGBA with a transparency that must not count.
    const unsigned char left[4] = {220, 30, 30, 10}, right[4] = {30, 40, 210, 255};
    std::vector<unsigned char> rgba, argb;
    for (int i = 0; i < 64; ++i) {
        const unsigned char* color = i % 8 < 6 ? left : right;
        rgba.insert(rgba.end(), color, color + 4);
        argb.insert(argb.end(), {0, color[0], color[1], color[2]});
    }
    const std::string path = root_ + "/two.png";
    ASSERT_NE(stbi_write_png(path.c_str(), 8, 8, 4, rgba.data(), 8 * 4), 0);

    double fromPixels[15], fromFile[15];
    int pixelCount = 0, fileCount = -1;
    BPImageExtractLab(argb.data(), 8, 8, 5, fromPixels, &pixelCount);
    char error[256] = "untouched";
    ASSERT_EQ(BPImageFileExtractLab(path.c_str(), 64, 5, fromFile, &fileCount, error, sizeof error), 1);
    EXPECT_STREQ(error, "");
    ASSERT_EQ(fileCount, 2);
    for (int i = 0; i < 6; ++i) EXPECT_EQ(fromFile[i], fromPixels[i]) << i;
}

TEST_F(ImageFile, FailuresNameTheFileAndTheProblem) {
    const std::string png = root_ + "/big.png";
    const unsigned char pixels[4 * 3] = {};
    ASSERT_NE(stbi_write_png(png.c_str(), 2, 2, 3, pixels, 2 * 3), 0);
    const struct {
        std::string path;
        long long maxPixels;
        std::string message;
    } cases[] = {
        {root_ + "/missing.png", 100,
         "cannot open image '" + root_ + "/missing.png': no such file or directory"},
        {Write("notes.txt", "no image"), 100, "cannot decode image '" + root_ + "/notes.txt': "},
        {root_, 100, "cannot open image '" + root_ + "': is a directory"},
        {png, 3, "image '" + png + "' is 2 x 2 pixels (0.0 megapixels), above the limit of 3 pixels"},
    };
    for (const auto& c : cases) {
        double lab[3] = {7, 7, 7};
        int count = -1;
        char error[512];
        EXPECT_EQ(BPImageFileExtractLab(c.path.c_str(), c.maxPixels, 1, lab, &count, error, sizeof error), 0);
        EXPECT_EQ(std::string(error).substr(0, c.message.size()), c.message);
        EXPECT_EQ(count, 0);
        EXPECT_EQ(lab[0], 7);
    }
    double lab[3];
    int count = -1;
    EXPECT_EQ(BPImageFileExtractLab(nullptr, 100, 1, lab, &count, nullptr, 0), 0);
    EXPECT_EQ(BPImageFileExtractLab(png.c_str(), 100, 0, lab, &count, nullptr, 0), 0);
    EXPECT_EQ(BPImageFileExtractLab(png.c_str(), 100, 1, nullptr, &count, nullptr, 0), 0);
    EXPECT_EQ(count, 0);
}

}  // namespace
