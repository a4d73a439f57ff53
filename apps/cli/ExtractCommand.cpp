#include <stb/stb_image.h>
#include <unistd.h>

#include <cerrno>
#include <charconv>
#include <cmath>
#include <cstdio>
#include <cstring>
#include <memory>
#include <nlohmann/json.hpp>
#include <stdexcept>
#include <string>
#include <vector>

#include "ColorInformation.h"
#include "Commands.h"
#include "Output.h"
#include "Progress.h"
#include "RegularFile.h"
#include "ValueLines.h"
#include "pigmo/bp.h"

namespace {

struct ExtractArguments {
    std::string image;
    std::string count = "10";
    long long maxPixels = 100'000'000;
    bool json = false;
};

struct DominantColor {
    double lab[3];
    std::string hex;
    int centroid;
};

// RGBA as decoded, one byte per channel, width x height pixels.
struct DecodedImage {
    std::unique_ptr<unsigned char, void (*)(void*)> rgba{nullptr, stbi_image_free};
    int width = 0;
    int height = 0;
};

// Reads the header before decoding, so a small file declaring a huge image is refused unread.
DecodedImage Load(const std::string& path, long long maxPixels) {
    std::string problem;
    const int fd = Pigmo::Platform::OpenRegularFile(path, problem);
    if (fd < 0) throw std::runtime_error("cannot open image '" + path + "': " + problem);
    const std::unique_ptr<FILE, int (*)(FILE*)> file(fdopen(fd, "rb"), std::fclose);
    if (!file) {
        close(fd);
        throw std::runtime_error("cannot open image '" + path +
                                 "': " + Pigmo::Platform::SystemErrorText(errno));
    }
    DecodedImage image;
    int channels = 0;
    if (stbi_info_from_file(file.get(), &image.width, &image.height, &channels) != 0) {
        const long long pixels = static_cast<long long>(image.width) * static_cast<long long>(image.height);
        if (pixels > maxPixels) {
            char text[160];
            std::snprintf(text, sizeof text,
                          "is %d x %d pixels (%.1f megapixels), above the limit of %lld pixels", image.width,
                          image.height, static_cast<double>(pixels) / 1e6, maxPixels);
            throw std::runtime_error("image '" + path + "' " + text + " (--max-pixels)");
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

// The whole text one integer from 1 to 267.
int ParseCount(const std::string& text) {
    int value = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value);
    if (error != std::errc() || end != text.data() + text.size() || value < 1 || value > 267) {
        throw std::invalid_argument("--count: '" + text + "' is not a whole number from 1 to 267");
    }
    return value;
}

std::vector<DominantColor> Dominant(DecodedImage& image, int count) {
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
    std::vector<double> lab(3 * static_cast<size_t>(count));
    int found = 0;
    BPImageExtractLab(image.rgba.get(), image.width, image.height, count, lab.data(), &found);
    std::vector<DominantColor> colors;
    for (int i = 0; i < found; ++i) {
        const double* mean = &lab[3 * static_cast<size_t>(i)];
        // Once no group stands apart the last pick repeats; the repeats say nothing new.
        if (i > 0 && mean[0] == mean[-3] && mean[1] == mean[-2] && mean[2] == mean[-1]) break;
        DominantColor color{{mean[0], mean[1], mean[2]}, {}, BPCentroidGetForLab(mean)};
        double rgb[3];
        if (BPConvertLab2sRGB(mean, rgb) != 1 || color.centroid < 1) {
            throw std::runtime_error("a dominant color could not be converted");
        }
        color.hex = Pigmo::HtmlColorCode(rgb[0], rgb[1], rgb[2]);
        colors.push_back(color);
    }
    return colors;
}

void PrintJson(const ExtractArguments& arguments, const DecodedImage& image,
               const std::vector<DominantColor>& colors) {
    nlohmann::json list = nlohmann::json::array();
    for (const DominantColor& color : colors) {
        list.push_back({{"lab", {color.lab[0], color.lab[1], color.lab[2]}},
                        {"srgb", color.hex},
                        {"centroid", color.centroid},
                        {"name", BPCentroidGetName(color.centroid)},
                        {"category", BPCentroidGetCategoryName(BPCentroidGetCategory(color.centroid))}});
    }
    const nlohmann::json document = {
        {"image", arguments.image}, {"width", image.width}, {"height", image.height}, {"colors", list}};
    WriteOut(document.dump(2, ' ', false, nlohmann::json::error_handler_t::replace) + "\n");
}

void PrintText(const std::vector<DominantColor>& colors) {
    std::printf("#   L*      a*       b*       sRGB     ISCC-NBS name\n");
    for (size_t i = 0; i < colors.size(); ++i) {
        const DominantColor& color = colors[i];
        std::printf("%-3zu %-7.2f %-8.2f %-8.2f %s  %s\n", i + 1, color.lab[0], color.lab[1], color.lab[2],
                    color.hex.c_str(), BPCentroidGetName(color.centroid));
    }
}

void RunExtract(const ExtractArguments& arguments) {
    const int count = ParseCount(arguments.count);
    std::vector<DominantColor> colors;
    DecodedImage image;
    {
        Progress progress("extract");
        progress.Set("decoding " + arguments.image);
        image = Load(arguments.image, arguments.maxPixels);
        progress.Set("finding the dominant colors of " + std::to_string(image.width) + " x " +
                     std::to_string(image.height) + " pixels");
        colors = Dominant(image, count);
    }
    if (arguments.json) {
        PrintJson(arguments, image, colors);
    } else {
        PrintText(colors);
    }
}

}  // namespace

void AddExtractCommand(CLI::App& app, int& exitCode) {
    auto arguments = std::make_shared<ExtractArguments>();
    CLI::App* command = app.add_subcommand("extract", "Dominant colors of an image");
    command->add_option("IMAGE", arguments->image, "PNG, JPEG, BMP or TGA file")->required();
    command->add_option("-n,--count", arguments->count, "How many colors, at most (1 to 267)")
        ->type_name("N")
        ->capture_default_str();
    command->add_option("--max-pixels", arguments->maxPixels, "Refuse images with more pixels than this")
        ->type_name("N")
        ->check(
            [](const std::string& text) { return text.starts_with('-') ? "'" + text + "' is negative" : ""; })
        ->capture_default_str();
    command->add_flag("--json", arguments->json, "Print a JSON document instead of a table");
    command->footer(
        "Samples every second pixel in each direction, groups the samples by nearest ISCC-NBS centroid and"
        " picks the largest group, then each time the group farthest from those picked, weighted by its"
        " size. Each color is the mean CIELAB (D50 white) of its group, shown with its sRGB hex code and the"
        " name of its nearest centroid. Fewer colors come out when fewer groups stand apart. Transparency is"
        " ignored.\n"
        "Example: pigmo extract photo.jpg -n 5");
    command->callback(
        [arguments, &exitCode] { exitCode = RunCommand("extract", [&] { RunExtract(*arguments); }); });
}
