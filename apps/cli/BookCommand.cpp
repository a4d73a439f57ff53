#include <algorithm>
#include <cstdio>
#include <memory>
#include <nlohmann/json.hpp>
#include <stdexcept>
#include <string>
#include <vector>

#include "ColorBookReader.h"
#include "Commands.h"
#include "PaletteDiscovery.h"
#include "Paths.h"
#include "ValueLines.h"

namespace {

struct BookArguments {
    std::string file;
    bool json = false;
};

std::vector<double> Triple(const float* values) {
    return {values[0], values[1], values[2]};
}

// #RRGGBB from the 0..255 sRGB values, truncated.
std::string HtmlCode(const float* sRGB) {
    char code[8];
    int channels[3];
    for (int i = 0; i < 3; ++i) channels[i] = static_cast<int>(std::clamp(sRGB[i], 0.0f, 255.0f));
    std::snprintf(code, sizeof code, "#%02X%02X%02X", channels[0], channels[1], channels[2]);
    return code;
}

std::string Format(const char* format, const float* values) {
    char text[192];
    std::snprintf(text, sizeof text, format, values[0], values[1], values[2]);
    return text;
}

std::string TextListing(const std::string& path, const std::string& palette,
                        const std::vector<Pigmo::ColorInformation>& colors) {
    std::string out = (palette.empty() ? "(unnamed palette)" : palette) + " (" +
                      std::to_string(colors.size()) + (colors.size() == 1 ? " color)\n" : " colors)\n") +
                      path + "\n";
    for (std::size_t i = 0; i < colors.size(); ++i) {
        const Pigmo::ColorInformation& color = colors[i];
        std::string tags;
        for (int t = 0; t < color.GetTagCount(); ++t)
            tags += (t > 0 ? ", " : "") + std::string(color.GetTag(t));
        out += "\n" + std::to_string(i + 1) + "  " + color.GetName() + "\n";
        out += "   category:    " + std::string(color.GetCategory()) + "\n";
        out += "   L*a*b*:      " + Format("%.2f %.2f %.2f", color.GetLab()) + "\n";
        out += "   sRGB:        " + Format("%.2f %.2f %.2f", color.GetSRGB()) + "  " +
               HtmlCode(color.GetSRGB()) + "\n";
        out += "   linear RGB:  " + Format("%.4f %.4f %.4f", color.GetLinearRGB()) + "\n";
        out += "   tags:        " + tags + "\n";
        out += "   reflectance: " + std::to_string(color.GetSpectralReflectanceCount()) + " values\n";
    }
    return out;
}

std::string JsonListing(const std::string& path, const std::string& palette,
                        const std::vector<Pigmo::ColorInformation>& colors) {
    nlohmann::json list = nlohmann::json::array();
    for (const Pigmo::ColorInformation& color : colors) {
        std::vector<std::string> tags;
        for (int t = 0; t < color.GetTagCount(); ++t) tags.emplace_back(color.GetTag(t));
        const float* curve = color.GetSpectralReflectance();
        list.push_back(
            {{"name", color.GetName()},
             {"category", color.GetCategory()},
             {"lab", Triple(color.GetLab())},
             {"srgb", Triple(color.GetSRGB())},
             {"html", HtmlCode(color.GetSRGB())},
             {"linear_rgb", Triple(color.GetLinearRGB())},
             {"tags", tags},
             {"reflectance", std::vector<double>(curve, curve + color.GetSpectralReflectanceCount())}});
    }
    // Names come from the file as bytes; invalid UTF-8 is replaced rather than failing the listing.
    const nlohmann::json book = {{"file", path}, {"palette", palette}, {"colors", list}};
    return book.dump(2, ' ', false, nlohmann::json::error_handler_t::replace) + "\n";
}

void RunBook(const BookArguments& arguments) {
    std::string path = arguments.file;
    if (path.empty() && !Pigmo::FindDefaultPalettePath(path))
        throw std::runtime_error("no system palette found; give a FILE or set PIGMO_INSTALL_LOCATION");
    std::vector<Pigmo::ColorInformation> colors;
    const char* error = nullptr;
    if (!Pigmo::LoadColorBook(path.c_str(), colors, &error)) {
        const std::string text = error != nullptr ? error : "cannot read the book";
        // The "doesn't exist" text names the file already.
        throw std::runtime_error(text.find(path) != std::string::npos ? text : path + ": " + text);
    }
    const std::string palette = Pigmo::PaletteDisplayName(path.c_str());
    const std::string shown = Pigmo::Platform::NativePath(path);
    const std::string listing =
        arguments.json ? JsonListing(shown, palette, colors) : TextListing(shown, palette, colors);
    if (std::fputs(listing.c_str(), stdout) < 0) throw std::runtime_error("cannot write the output");
}

}  // namespace

void AddBookCommand(CLI::App& app, int& exitCode) {
    auto arguments = std::make_shared<BookArguments>();
    CLI::App* command = app.add_subcommand("book", "List the colors of a CxF 2.1 color book");
    command->add_option("FILE", arguments->file, "the book; without it, the first system palette");
    command->add_flag("--json", arguments->json, "print the book as JSON, reflectance curves included");
    command->footer(
        "For each color: name, category, L*a*b* (D50), sRGB (0..255) with its #RRGGBB code, linear RGB "
        "(0..1, what the map renders), tags and the number of reflectance values. Values the book leaves out "
        "are derived: CIELAB from a 36-band curve or else from the book's sRGB, linear RGB from the book's "
        "sRGB or else from the curve; what cannot be derived is 0.\n"
        "Example: pigmo book \"ISCC-NBS Centroid Colors.cxf\"");
    command->callback(
        [arguments, &exitCode] { exitCode = RunCommand("book", [&] { RunBook(*arguments); }); });
}
