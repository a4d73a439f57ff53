#include <algorithm>
#include <cmath>
#include <cstdio>
#include <memory>
#include <new>
#include <nlohmann/json.hpp>
#include <stdexcept>
#include <string>
#include <vector>

#include "ColorBookReader.h"
#include "Commands.h"
#include "Output.h"
#include "PaletteDiscovery.h"
#include "Paths.h"
#include "Progress.h"
#include "Settings.h"
#include "ValueLines.h"

namespace {

struct BookArguments {
    std::string file;
    bool json = false;
};

std::vector<double> Triple(const float* values) {
    return {values[0], values[1], values[2]};
}

std::string HtmlCode(const float* sRGB) {
    return Pigmo::HtmlColorCode(sRGB[0], sRGB[1], sRGB[2]);
}

std::string Format(const char* format, const float* values) {
    char text[192];
    std::snprintf(text, sizeof text, format, values[0], values[1], values[2]);
    return text;
}

// Colors whose reflectance curve derives nothing, or whose points say other wavelengths than the
// ones their values are read as: 36 bands from 380 nm by 10 nm.
class CurveCheck {
public:
    void Check(const Pigmo::ColorInformation& color, const std::vector<double>& wavelengths) {
        constexpr int kBands = Pigmo::ColorInformation::kBandCount;
        std::string why;
        if (!wavelengths.empty() && wavelengths.size() != kBands) {
            why = std::to_string(wavelengths.size()) + (wavelengths.size() == 1 ? " value" : " values");
        }
        for (std::size_t i = 0; why.empty() && i < wavelengths.size(); ++i) {
            const double expected = 380.0 + 10.0 * static_cast<double>(i);
            if (!std::isnan(wavelengths[i]) && std::fabs(wavelengths[i] - expected) > 1e-6) {
                char text[96];
                std::snprintf(text, sizeof text, "point %zu says %g nm, read as %g nm", i + 1, wavelengths[i],
                              expected);
                why = text;
            }
        }
        if (why.empty()) return;
        if (++count_ <= kNamed)
            named_ += (named_.empty() ? "" : "; ") + Printable(color.GetName()) + " (" + why + ")";
    }

    // One line on stderr for the whole book.
    void Report() const {
        if (count_ == 0) return;
        std::string more = count_ > kNamed ? "; and " + std::to_string(count_ - kNamed) + " more" : "";
        std::fprintf(
            stderr,
            "pigmo book: warning: %zu %s a reflectance curve that is not read as 36 bands from 380 to "
            "730 nm by 10 nm: %s%s\n",
            count_, count_ == 1 ? "color has" : "colors have", named_.c_str(), more.c_str());
    }

private:
    static constexpr std::size_t kNamed = 5;
    std::size_t count_ = 0;
    std::string named_;
};

// Prints each color as the reader hands it over, so a book of any size lists in little memory.
class BookPrinter final : public Pigmo::ColorBookVisitor {
public:
    BookPrinter(std::string path, bool json)
        : path_(std::move(path)), json_(json), progress_(std::make_unique<Progress>("book")) {}

    void Begin(const std::string& palette, std::size_t colorCount) override {
        count_ = colorCount;
        if (json_) {
            WriteOut("{\n  \"file\": " + JsonString(path_) + ",\n  \"palette\": " + JsonString(palette) +
                     ",\n  \"colors\": [");
            return;
        }
        WriteOut((palette.empty() ? "(unnamed palette)" : Printable(palette)) + " (" +
                 std::to_string(colorCount) + (colorCount == 1 ? " color)\n" : " colors)\n") +
                 Printable(path_) + "\n");
    }

    void Color(const Pigmo::ColorInformation& color, const std::vector<double>& wavelengths) override {
        ++index_;
        progress_->Update(
            [this] { return "color " + std::to_string(index_) + " of " + std::to_string(count_); });
        curves_.Check(color, wavelengths);
        WriteOut(json_ ? JsonColor(color) : TextColor(color));
    }

    void End() {
        progress_.reset();  // before the warnings
        if (json_) WriteOut(index_ == 0 ? "]\n}\n" : "\n  ]\n}\n");
        curves_.Report();
    }

private:
    // Names come from the file as bytes; invalid UTF-8 is replaced rather than failing the listing.
    static std::string JsonString(const std::string& text) { return JsonText(nlohmann::ordered_json(text)); }

    std::string JsonColor(const Pigmo::ColorInformation& color) const {
        std::vector<std::string> tags;
        for (int t = 0; t < color.GetTagCount(); ++t) tags.emplace_back(color.GetTag(t));
        const float* curve = color.GetSpectralReflectance();
        const nlohmann::ordered_json record = {
            {"name", color.GetName()},
            {"category", color.GetCategory()},
            {"lab", Triple(color.GetLab())},
            {"srgb", Triple(color.GetSRGB())},
            {"html", HtmlCode(color.GetSRGB())},
            {"linear_rgb", Triple(color.GetLinearRGB())},
            {"tags", tags},
            {"reflectance", std::vector<double>(curve, curve + color.GetSpectralReflectanceCount())}};
        return (index_ == 1 ? "\n    " : ",\n    ") + JsonText(record);
    }

    std::string TextColor(const Pigmo::ColorInformation& color) const {
        std::string tags;
        for (int t = 0; t < color.GetTagCount(); ++t)
            tags += (t > 0 ? ", " : "") + Printable(color.GetTag(t));
        return "\n" + std::to_string(index_) + "  " + Printable(color.GetName()) + "\n" +
               "   category:    " + Printable(color.GetCategory()) + "\n" +
               "   L*a*b*:      " + Format("%.2f %.2f %.2f", color.GetLab()) + "\n" +
               "   sRGB:        " + Format("%.2f %.2f %.2f", color.GetSRGB()) + "  " +
               HtmlCode(color.GetSRGB()) + "\n" +
               "   linear RGB:  " + Format("%.4f %.4f %.4f", color.GetLinearRGB()) + "\n" +
               "   tags:        " + tags + "\n" +
               "   reflectance: " + std::to_string(color.GetSpectralReflectanceCount()) + " values\n";
    }

    std::string path_;
    bool json_;
    std::size_t index_ = 0;
    std::size_t count_ = 0;
    CurveCheck curves_;
    std::unique_ptr<Progress> progress_;
};

void RunBook(const BookArguments& arguments) {
    std::string path = arguments.file;
    if (path.empty()) {
        for (const std::string& problem : Pigmo::Platform::UnusableSettings())
            std::fprintf(stderr, "pigmo book: warning: %s\n", Printable(problem).c_str());
        if (!Pigmo::FindDefaultPalettePath(path))
            throw std::runtime_error("no system palette found; give a FILE or set PIGMO_INSTALL_LOCATION");
    }
    BookPrinter printer(Pigmo::Platform::NativePath(path), arguments.json);
    const char* error = nullptr;
    Pigmo::ColorBookFailure failure;
    if (!Pigmo::ReadColorBook(path.c_str(), printer, &error, &failure)) {
        if (failure.outOfMemory) throw std::bad_alloc();
        throw std::runtime_error(Pigmo::ColorBookFailureText(path.c_str(), error, failure));
    }
    printer.End();
}

}  // namespace

void AddBookCommand(CLI::App& app, int& exitCode) {
    auto arguments = std::make_shared<BookArguments>();
    CLI::App* command = app.add_subcommand("book", "List the colors of a CxF 2.1 color book");
    command->add_option("FILE", arguments->file, "the book; without it, the first system palette");
    command->add_flag("--json", arguments->json,
                      "print the book as JSON, one color per line, reflectance curves included");
    command->footer(
        "For each color: name, category, L*a*b* (D50), sRGB (0..255) with its #RRGGBB code, linear RGB "
        "(0..1, what the map renders), tags and the number of reflectance values. Values the book leaves out "
        "are derived: CIELAB from a 36-band curve or else from the book's sRGB, linear RGB from the book's "
        "sRGB or else from the curve; what cannot be derived is 0. Reflectance values are read in the "
        "book's order as 36 bands from 380 to 730 nm by 10 nm; colors whose curves do not fit that are "
        "named in one warning on stderr. Control characters in names are shown as escapes (\\n, \\x1b).\n"
        "Example: pigmo book \"ISCC-NBS Centroid Colors.cxf\"");
    command->callback(
        [arguments, &exitCode] { exitCode = RunCommand("book", [&] { RunBook(*arguments); }); });
}
