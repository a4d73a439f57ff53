#include "DescriptionOptions.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <iterator>
#include <sstream>
#include <stdexcept>

#include "ColorSpaceTable.h"

namespace {

using enum ColorSpaceCode;

constexpr int kMaxBands = 100000;

// ParseNumber for an option; flag is the option as typed, for messages.
double ParseOptionNumber(const std::string& flag, const std::string& text) {
    try {
        return ParseNumber(text);
    } catch (const std::invalid_argument& e) {
        throw std::invalid_argument(flag + ": " + e.what());
    }
}

// Comma-separated numbers of an option.
std::vector<double> ParseList(const std::string& flag, const std::string& text) {
    std::vector<double> values;
    std::string item;
    std::istringstream stream(text);
    while (std::getline(stream, item, ',')) values.push_back(ParseOptionNumber(flag, item));
    if (!text.empty() && text.back() == ',') throw std::invalid_argument(flag + ": empty value after ','");
    return values;
}

void ApplyWhite(const std::string& flag, const std::string& text, ColorSpaceStruct& description) {
    const std::vector<double> white = ParseList(flag, text);
    if (white.size() != 3) throw std::invalid_argument(flag + ": expected X,Y,Z, got '" + text + "'");
    for (double v : white) {
        // A zero or negative white component turns Lab and Yxy values into divisions by zero.
        if (!(v > 0.0))
            throw std::invalid_argument(flag + ": components must be positive, got '" + text + "'");
    }
    std::copy(white.begin(), white.end(), description.whitePoint);
}

void ApplyObserver(const std::string& flag, const std::string& text, ColorSpaceStruct& description) {
    if (text != "0" && text != "1" && text != "2") {
        throw std::invalid_argument(flag + ": expected 0, 1 or 2, got '" + text + "'");
    }
    description.observer = text[0] - '0';
}

double ParsePositive(const std::string& flag, const std::string& text) {
    const double value = ParseOptionNumber(flag, text);
    if (!(value > 0.0)) throw std::invalid_argument(flag + ": must be positive, got '" + text + "'");
    return value;
}

void ApplyAge(const std::string& flag, const std::string& text, ColorSpaceStruct& description) {
    description.observerAge = ParsePositive(flag, text);
}

void ApplyField(const std::string& flag, const std::string& text, ColorSpaceStruct& description) {
    description.fieldSize = ParsePositive(flag, text);
}

void ApplyStart(const std::string& flag, const std::string& text, ColorSpaceStruct& description) {
    description.wavelengthStart = ParseOptionNumber(flag, text);
}

void ApplyEnd(const std::string& flag, const std::string& text, ColorSpaceStruct& description) {
    description.wavelengthEnd = ParseOptionNumber(flag, text);
}

void ApplyStep(const std::string& flag, const std::string& text, ColorSpaceStruct& description) {
    description.wavelengthStep = ParsePositive(flag, text);
}

void ApplyWeighting(const std::string& flag, const std::string& text, ColorSpaceStruct& description) {
    if (text.size() != 1 || text[0] < '0' || text[0] > '0' + static_cast<int>(WeightingMethod::Lagrange)) {
        throw std::invalid_argument(flag + ": expected a method from 0 to 5, got '" + text + "'");
    }
    description.weighting = text[0] - '0';
}

void ApplyEmissive(const std::string&, const std::string&, ColorSpaceStruct& description) {
    description.emissive = true;
}

struct NamedIlluminant {
    const char* name;
    IlluminantKind kind;
    double temperature;  // 0: given after the colon, for daylight and Planckian light
};

constexpr NamedIlluminant kIlluminants[] = {
    {"d50", IlluminantKind::Daylight, 5003.0},
    {"d55", IlluminantKind::Daylight, 5503.0},
    {"d65", IlluminantKind::Daylight, 6504.0},
    {"d75", IlluminantKind::Daylight, 7504.0},
    {"daylight", IlluminantKind::Daylight, 0.0},
    {"planckian", IlluminantKind::Planckian, 0.0},
    {"a", IlluminantKind::A, 2856.0},
    {"c", IlluminantKind::C, 0.0},
    {"e", IlluminantKind::E, 0.0},
    {"f1", IlluminantKind::F1, 0.0},
    {"f2", IlluminantKind::F2, 0.0},
    {"f3", IlluminantKind::F3, 0.0},
    {"f7", IlluminantKind::F7, 0.0},
    {"f8", IlluminantKind::F8, 0.0},
    {"f9", IlluminantKind::F9, 0.0},
    {"f10", IlluminantKind::F10, 0.0},
    {"f11", IlluminantKind::F11, 0.0},
    {"f12", IlluminantKind::F12, 0.0},
};

bool ByTemperature(const NamedIlluminant& il) {
    return il.temperature == 0.0 &&
           (il.kind == IlluminantKind::Daylight || il.kind == IlluminantKind::Planckian);
}

// The white belongs to the observer the colors are seen with.
void Illuminate(ColorSpaceStruct& description, IlluminantKind kind, double temperature) {
    description.illuminant = IlluminantStruct{};
    description.illuminant.observer = description.observer;
    description.illuminant.observerAge = description.observerAge;
    description.illuminant.fieldSize = description.fieldSize;
    description.illuminant.SetIlluminant(kind, temperature);
    description.hasIlluminant = true;
}

std::string IlluminantNames() {
    std::string names = "none";
    for (const NamedIlluminant& il : kIlluminants) {
        names += std::string(", ") + il.name + (ByTemperature(il) ? ":KELVIN" : "");
    }
    return names;
}

void ApplyIlluminant(const std::string& flag, const std::string& text, ColorSpaceStruct& description) {
    if (text == "none") {
        description.hasIlluminant = false;
        description.illuminant = IlluminantStruct{};
        return;
    }
    const size_t colon = text.find(':');
    const std::string name = text.substr(0, colon);
    for (const NamedIlluminant& il : kIlluminants) {
        if (name != il.name) continue;
        const bool byTemperature = ByTemperature(il);
        if (byTemperature != (colon != std::string::npos)) {
            throw std::invalid_argument(
                flag + ": " + name +
                (byTemperature ? " needs a temperature, as in " + name + ":6500" : " takes no temperature"));
        }
        const double temperature =
            byTemperature ? ParsePositive(flag, text.substr(colon + 1)) : il.temperature;
        Illuminate(description, il.kind, temperature);
        return;
    }
    throw std::invalid_argument(flag + ": unknown illuminant '" + text + "' (use " + IlluminantNames() + ")");
}

void ApplyRange(const std::string& flag, const std::string& text, ColorSpaceStruct& description) {
    const std::vector<double> range = ParseList(flag, text);
    const int32_t channels = description.GetChannelCount();
    if (range.size() != static_cast<size_t>(2 * channels)) {
        throw std::invalid_argument(flag + ": expected MIN,MAX for each of the " + std::to_string(channels) +
                                    " channels, got " + std::to_string(range.size()) + " values");
    }
    for (int32_t c = 0; c < channels; ++c) {
        const double lo = range[2 * c], hi = range[2 * c + 1];
        // An empty range has no scale factor.
        if (!(lo < hi))
            throw std::invalid_argument(flag + ": channel " + std::to_string(c) + " needs MIN < MAX");
        description.SetMinimum(c, lo);
        description.SetMaximum(c, hi);
    }
}

void ApplyViewingPreset(const std::string& flag, const std::string& text, ColorSpaceStruct& description) {
    if (text.size() != 1 || text[0] < '0' || text[0] > '6') {
        throw std::invalid_argument(flag + ": expected a preset from 0 to 6, got '" + text + "'");
    }
    description.ApplyViewingPreset(text[0] - '0');
}

void ApplyViewing(const std::string& flag, const std::string& text, ColorSpaceStruct& description) {
    const std::vector<double> viewing = ParseList(flag, text);
    if (viewing.size() != 6)
        throw std::invalid_argument(flag + ": expected Yb,La,c,Nc,V5,F, got '" + text + "'");
    // The appearance model divides by each of these.
    if (!(viewing[0] > 0.0 && viewing[1] > 0.0 && viewing[2] > 0.0)) {
        throw std::invalid_argument(flag + ": Yb, La and c must be positive, got '" + text + "'");
    }
    std::copy(viewing.begin(), viewing.end(), description.viewingConditions);
}

struct DescriptionOption {
    const char* name;
    const char* valueName;
    const char* help;
    void (*apply)(const std::string& flag, const std::string& text, ColorSpaceStruct& description);
};

// Applied in this order; the range comes last because its size follows the channel count.
constexpr DescriptionOption kOptions[] = {
    {"white", "X,Y,Z",
     "white point relative to Y = 1 (default D50 0.96422,1,0.82521; sRGB and linear sRGB: their D65 "
     "white 0.9505,1,1.089)",
     ApplyWhite},
    {"observer", "N", "standard observer: 0 CIE 1931 2 degree (default), 1 CIE 1964 10 degree, 2 CIE 2006",
     ApplyObserver},
    {"age", "YEARS", "age of the CIE 2006 observer (default 32)", ApplyAge},
    {"field", "DEGREES", "field size of the CIE 2006 observer, 1 to 10 (default 2)", ApplyField},
    {"start", "NM", "first wavelength of spectral values (default 380)", ApplyStart},
    {"end", "NM", "last wavelength of spectral values (default 730)", ApplyEnd},
    {"step", "NM", "wavelength step of spectral values (default 10)", ApplyStep},
    {"weighting", "N",
     "spectral weighting: 0 direct, 1 one-nanometre, 2 and 3 fixed 10-nm tables, 4 Sprague (default), 5 "
     "Lagrange",
     ApplyWeighting},
    {"emissive", nullptr, "spectral values are radiances: equal-energy light, results times 68.3",
     ApplyEmissive},
    {"illuminant", "KIND[:KELVIN]",
     "light of spectral values and of the white: none, d50 (spectral default), d55, d65, d75, "
     "daylight:KELVIN, "
     "planckian:KELVIN, a, c, e, f1-f3, f7-f12",
     ApplyIlluminant},
    {"viewing-preset", "N",
     "viewing conditions of the CIECAM02 spaces: preset 0 (default; Yb 50, La 300, average surround) to 6",
     ApplyViewingPreset},
    {"viewing", "Yb,La,c,Nc,V5,F",
     "viewing conditions of the CIECAM02 spaces: background Yb, adapting luminance La in cd/m2, surround c "
     "and Nc, unused fifth value, adaptation F (overrides the preset)",
     ApplyViewing},
    {"range", "MIN,MAX,...", "value range of every channel, MIN,MAX per channel (default: the space's own)",
     ApplyRange},
};

struct NamedAdaptation {
    const char* name;
    AdaptationMethod method;
};

constexpr NamedAdaptation kAdaptations[] = {
    {"none", AdaptationMethod::None},
    {"xyz-scaling", AdaptationMethod::XYZScaling},
    {"bradford", AdaptationMethod::Bradford},
    {"sharp", AdaptationMethod::Sharp},
    {"cmccat2000", AdaptationMethod::CMCCAT2000},
    {"cat02", AdaptationMethod::CAT02},
};

std::string AdaptationNames() {
    std::string names;
    for (const NamedAdaptation& a : kAdaptations) names += std::string(names.empty() ? "" : ", ") + a.name;
    return names;
}

}  // namespace

DescriptionOptions::DescriptionOptions() : given_(std::size(kOptions)) {}

void DescriptionOptions::AddTo(CLI::App& command) {
    for (size_t i = 0; i < std::size(kOptions); ++i) {
        const DescriptionOption& option = kOptions[i];
        const std::string name = option.name;
        if (option.valueName == nullptr) {
            // A switch: given means "true".
            command.add_flag("--" + name, given_[i].both, std::string(option.help) + ", both sides")
                ->group("Descriptions");
            command.add_flag("--from-" + name, given_[i].from, "the same, source only")
                ->group("Descriptions");
            command.add_flag("--to-" + name, given_[i].to, "the same, destination only")
                ->group("Descriptions");
            continue;
        }
        command.add_option("--" + name, given_[i].both, std::string(option.help) + ", both sides")
            ->type_name(option.valueName)
            ->group("Descriptions");
        command.add_option("--from-" + name, given_[i].from, "the same, source only")
            ->type_name(option.valueName)
            ->group("Descriptions");
        command.add_option("--to-" + name, given_[i].to, "the same, destination only")
            ->type_name(option.valueName)
            ->group("Descriptions");
    }
    command
        .add_option("--adapt", adapt_, "chromatic adaptation between the two whites: " + AdaptationNames())
        ->type_name("METHOD")
        ->default_str("none")
        ->group("Descriptions");
}

ColorSpaceStruct DescriptionOptions::Describe(ConversionSide side, int32_t code) const {
    if (!ColorSpaceStruct().SetType(code)) {
        throw std::invalid_argument(DescribeColorSpace(code) + " needs an extended description");
    }
    ColorSpaceStruct description = cColorSpaceTable::DefaultDescription(code);
    const char* prefix = side == ConversionSide::From ? "--from-" : "--to-";
    for (size_t i = 0; i < std::size(kOptions); ++i) {
        const std::string& own = side == ConversionSide::From ? given_[i].from : given_[i].to;
        if (!own.empty()) {
            kOptions[i].apply(prefix + std::string(kOptions[i].name), own, description);
        } else if (!given_[i].both.empty()) {
            kOptions[i].apply("--" + std::string(kOptions[i].name), given_[i].both, description);
        }
    }
    if (description.Is(Spectral)) {
        // The default light again, for the observer the options chose.
        if (!Gives(side, "illuminant"))
            Illuminate(description, kBookIlluminantKind, kBookIlluminantTemperature);
        if (!(description.wavelengthEnd > description.wavelengthStart)) {
            char text[128];
            std::snprintf(text, sizeof text, "%send (%g nm) must lie above %sstart (%g nm)", prefix,
                          description.wavelengthEnd, prefix, description.wavelengthStart);
            throw std::invalid_argument(text);
        }
        // The engine keeps tables of every band; a fine grid would take gigabytes before any input.
        const double bands = std::floor((description.wavelengthEnd - description.wavelengthStart) /
                                        description.wavelengthStep) +
                             1.0;
        if (!(bands <= kMaxBands)) {
            char text[192];
            std::snprintf(text, sizeof text,
                          "the grid %g to %g nm by %g nm has %.0f bands; at most %d are allowed (%sstep)",
                          description.wavelengthStart, description.wavelengthEnd, description.wavelengthStep,
                          bands, kMaxBands, prefix);
            throw std::invalid_argument(text);
        }
    }
    return description;
}

bool DescriptionOptions::Gives(ConversionSide side, const std::string& name) const {
    for (size_t i = 0; i < std::size(kOptions); ++i) {
        if (name != kOptions[i].name) continue;
        const std::string& own = side == ConversionSide::From ? given_[i].from : given_[i].to;
        return !own.empty() || !given_[i].both.empty();
    }
    return false;
}

void DescriptionOptions::ShareLight(const ColorSpaceStruct& source, ColorSpaceStruct& destination) const {
    if (!source.Is(Spectral) || !source.hasIlluminant || destination.Is(Spectral) ||
        destination.Is(Density) || destination.Is(SRGB) || destination.Is(LinearSRGB) ||
        Gives(ConversionSide::To, "white") || Gives(ConversionSide::To, "illuminant")) {
        return;
    }
    destination.hasIlluminant = true;
    destination.illuminant = source.illuminant;
}

AdaptationMethod DescriptionOptions::Adaptation() const {
    for (const NamedAdaptation& a : kAdaptations) {
        if (adapt_ == a.name) return a.method;
    }
    throw std::invalid_argument("--adapt: unknown method '" + adapt_ + "' (use " + AdaptationNames() + ")");
}

int32_t ParseColorSpace(const std::string& text) {
    if (const ColorSpaceEntry* space = cColorSpaceTable::Find(text)) return CodeValue(space->code);
    int32_t code = 0;
    const char* end = text.data() + text.size();
    const auto [ptr, ec] = std::from_chars(text.data(), end, code);
    if (text.empty() || ec != std::errc() || ptr != end || code < 1 || code > kLastColorSpaceCode) {
        throw std::invalid_argument("unknown color space '" + text + "' (use a code from 1 to 84 or one of " +
                                    ColorSpaceNames() + ")");
    }
    return code;
}

std::string DescribeColorSpace(int32_t code) {
    if (const ColorSpaceEntry* space = cColorSpaceTable::Find(code))
        return std::string(space->name) + " (" + std::to_string(code) + ")";
    return "code " + std::to_string(code);
}

std::string ColorSpaceNames() {
    std::string names;
    for (const ColorSpaceEntry& space : cColorSpaceTable::All()) {
        if (!names.empty()) names += ", ";
        names += std::string(space.name) + " (" + std::to_string(CodeValue(space.code)) + ")";
    }
    return names;
}

void ParseLab(const std::vector<std::string>& values, double* lab) {
    if (values.size() != 3)
        throw std::invalid_argument("expected 3 values (L a b), got " + std::to_string(values.size()));
    for (int i = 0; i < 3; ++i) lab[i] = ParseNumber(values[i]);
}

double ParseNumber(const std::string& text) {
    // from_chars takes no leading '+', which people type; "+-1" stays an error.
    const size_t start = text.size() > 1 && text[0] == '+' && text[1] != '-' ? 1 : 0;
    double value = 0.0;
    const char* end = text.data() + text.size();
    const auto [ptr, ec] = std::from_chars(text.data() + start, end, value);
    if (text.size() == start || ptr != end || (ec != std::errc() && ec != std::errc::result_out_of_range) ||
        std::isnan(value)) {
        throw std::invalid_argument("'" + text + "' is not a number");
    }
    if (ec == std::errc::result_out_of_range) {
        // Too small to hold is 0 (or the nearest subnormal), as strtod rounds it; too large is refused.
        value = std::strtod(text.c_str() + start, nullptr);
        if (std::isinf(value)) throw std::invalid_argument("'" + text + "' is too large");
    }
    if (!std::isfinite(value)) throw std::invalid_argument("'" + text + "' is not a finite number");
    return value;
}
