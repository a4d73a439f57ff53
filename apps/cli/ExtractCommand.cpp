#include <charconv>
#include <cstdio>
#include <memory>
#include <nlohmann/json.hpp>
#include <stdexcept>
#include <string>
#include <vector>

#include "ColorInformation.h"
#include "Commands.h"
#include "ImageFile.h"
#include "Output.h"
#include "Progress.h"
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

// The whole text one integer from 1 to 267.
int ParseCount(const std::string& text) {
    int value = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value);
    if (error != std::errc() || end != text.data() + text.size() || value < 1 || value > 267) {
        throw std::invalid_argument("--count: '" + text + "' is not a whole number from 1 to 267");
    }
    return value;
}

std::vector<DominantColor> Dominant(Pigmo::DecodedImage& image, int count) {
    const std::vector<double> lab = Pigmo::DominantLab(image, count);
    std::vector<DominantColor> colors;
    for (size_t i = 0; i < lab.size(); i += 3) {
        const double* mean = &lab[i];
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

void PrintJson(const ExtractArguments& arguments, const Pigmo::DecodedImage& image,
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
    Pigmo::DecodedImage image;
    {
        Progress progress("extract");
        progress.Set("decoding " + arguments.image);
        image = Pigmo::LoadImageFile(arguments.image, arguments.maxPixels, "--max-pixels");
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
