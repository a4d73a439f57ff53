#pragma once

#include <memory>
#include <string>
#include <vector>

namespace Pigmo {

// RGBA as decoded, one byte per channel, width x height pixels.
struct DecodedImage {
    std::unique_ptr<unsigned char, void (*)(void*)> rgba{nullptr, nullptr};
    int width = 0;
    int height = 0;
};

// Decodes a PNG, JPEG, BMP or TGA file. The header is read first, so a small file declaring more
// than maxPixels pixels is refused unread. Throws std::runtime_error naming the file and the problem;
// limitName, when not empty, follows the size text in parentheses to say which setting to change.
DecodedImage LoadImageFile(const std::string& path, long long maxPixels, const std::string& limitName);

// Dominant colors of the image as BPImageExtractLab finds them, L*, a*, b* one after the other, up to
// count of them, without the repeats that follow once no group stands apart. Reorders the image's
// channels in place.
std::vector<double> DominantLab(DecodedImage& image, int count);

}  // namespace Pigmo
