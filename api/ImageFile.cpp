#include "ImageFile.h"

#include <stb/stb_image.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstring>
#include <stdexcept>

#include "RegularFile.h"
#include "pigmo/bp.h"

namespace Pigmo {

DecodedImage LoadImageFile(const std::string& path, long long maxPixels, const std::string& limitName) {
    std::string problem;
    const int fd = Platform::OpenRegularFile(path, problem);
    if (fd < 0) throw std::runtime_error("cannot open image '" + path + "': " + problem);
    const std::unique_ptr<FILE, int (*)(FILE*)> file(fdopen(fd, "rb"), std::fclose);
    if (!file) {
        close(fd);
        throw std::runtime_error("cannot open image '" + path + "': " + Platform::SystemErrorText(errno));
    }
    DecodedImage image;
    image.rgba = {nullptr, stbi_image_free};
    int channels = 0;
    if (stbi_info_from_file(file.get(), &image.width, &image.height, &channels) != 0) {
        const long long pixels = static_cast<long long>(image.width) * static_cast<long long>(image.height);
        if (pixels > maxPixels) {
            char text[160];
            std::snprintf(text, sizeof text,
                          "is %d x %d pixels (%.1f megapixels), above the limit of %lld pixels", image.width,
                          image.height, static_cast<double>(pixels) / 1e6, maxPixels);
            throw std::runtime_error("image '" + path + "' " + text +
                                     (limitName.empty() ? "" : " (" + limitName + ")"));
        }
        image.rgba.reset(stbi_load_from_file(file.get(), &image.width, &image.height, &channels, 4));
    }
    if (!image.rgba) {
        const char* reason = stbi_failure_reason();
        throw std::runtime_error("cannot decode image '" + path +
                                 "': " + (reason ? reason : "unknown error"));
    }
    return image;
}

std::vector<double> DominantLab(DecodedImage& image, int count) {
    // The extraction reads byte 0 as padding and then red, green, blue: turn RGBA into ARGB in place.
    unsigned char* pixel = image.rgba.get();
    const size_t pixels = static_cast<size_t>(image.width) * static_cast<size_t>(image.height);
    for (size_t i = 0; i < pixels; ++i, pixel += 4) {
        const unsigned char alpha = pixel[3];
        pixel[3] = pixel[2];
        pixel[2] = pixel[1];
        pixel[1] = pixel[0];
        pixel[0] = alpha;
    }
    // Below 1 the extraction gives its default of 10 colors.
    std::vector<double> lab(3 * static_cast<size_t>(count < 1 ? 10 : count));
    int found = 0;
    BPImageExtractLab(image.rgba.get(), image.width, image.height, count, lab.data(), &found);
    // Once no group stands apart the last pick repeats; the repeats say nothing new.
    int distinct = found > 0 ? 1 : 0;
    while (distinct < found &&
           std::memcmp(&lab[3 * distinct], &lab[3 * (distinct - 1)], 3 * sizeof(double)) != 0)
        ++distinct;
    lab.resize(3 * static_cast<size_t>(distinct));
    return lab;
}

}  // namespace Pigmo

extern "C" int BPImageFileExtractLab(const char* path, long long maxPixels, int colourCount, double* labOut,
                                     int* countOut, char* errorText, size_t errorTextSize) {
    if (countOut != nullptr) *countOut = 0;
    if (errorText != nullptr && errorTextSize > 0) errorText[0] = 0;
    try {
        if (path == nullptr || labOut == nullptr || colourCount < 1)
            throw std::invalid_argument("no image path, no output or a count below 1");
        Pigmo::DecodedImage image = Pigmo::LoadImageFile(path, maxPixels, "");
        const std::vector<double> lab = Pigmo::DominantLab(image, colourCount);
        std::memcpy(labOut, lab.data(), lab.size() * sizeof(double));
        if (countOut != nullptr) *countOut = static_cast<int>(lab.size() / 3);
        return 1;
    } catch (const std::exception& error) {
        if (errorText != nullptr && errorTextSize > 0)
            std::snprintf(errorText, errorTextSize, "%s", error.what());
    } catch (...) {
        if (errorText != nullptr && errorTextSize > 0)
            std::snprintf(errorText, errorTextSize, "out of memory");
    }
    return 0;
}
