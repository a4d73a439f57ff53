#include <cstdio>
#include <memory>
#include <nlohmann/json.hpp>
#include <stdexcept>
#include <string>
#include <vector>

#include "ColorTranslator.h"
#include "Commands.h"
#include "DescriptionOptions.h"
#include "Output.h"
#include "ValueLines.h"

namespace {

struct TranslateArguments {
    std::string from;
    std::string to;
    std::vector<std::string> values;
    bool json = false;
    DescriptionOptions descriptions;
};

// Converts one color at a time and prints each result as one whole line.
class ColorLineConverter {
public:
    explicit ColorLineConverter(const TranslateArguments& arguments) : json_(arguments.json) {
        fromCode_ = ParseColorSpace(arguments.from);
        toCode_ = ParseColorSpace(arguments.to);
        const ColorSpaceStruct source = arguments.descriptions.Describe(ConversionSide::From, fromCode_);
        ColorSpaceStruct destination = arguments.descriptions.Describe(ConversionSide::To, toCode_);
        arguments.descriptions.ShareLight(source, destination);
        translator_.SetAdaptation(arguments.descriptions.Adaptation());
        translator_.SetSource(source);
        translator_.SetDestination(destination);
        if (translator_.IsFailed()) throw std::runtime_error(PairText() + translator_.FailureReason());
        in_.resize(source.GetChannelCount());
        out_.resize(destination.GetChannelCount());
        if (in_.empty() || out_.empty()) {
            throw std::runtime_error(PairText() + DescribeColorSpace(in_.empty() ? fromCode_ : toCode_) +
                                     " has no channels");
        }
    }

    void Convert(const std::vector<std::string>& values) {
        if (values.size() != in_.size()) {
            throw std::runtime_error("expected " + std::to_string(in_.size()) + " values for " +
                                     DescribeColorSpace(fromCode_) + ", got " +
                                     std::to_string(values.size()));
        }
        for (size_t i = 0; i < values.size(); ++i) in_[i] = ParseNumber(values[i]);
        if (translator_.Translate(in_.data(), out_.data()) != 0) {
            throw std::runtime_error(PairText() + "the conversion failed");
        }
        try {
            RequireFinite(out_.data(), out_.size());
        } catch (const std::runtime_error& e) {
            throw std::runtime_error(PairText() + e.what());
        }
        WriteOut(json_ ? JsonLine() : TextLine());
    }

private:
    // Start of every message about the pair itself.
    std::string PairText() const {
        return "cannot convert from " + DescribeColorSpace(fromCode_) + " to " + DescribeColorSpace(toCode_) +
               ": ";
    }

    std::string TextLine() const {
        std::string line;
        char number[32];
        for (double v : out_) {
            std::snprintf(number, sizeof number, "%.10g", v);
            if (!line.empty()) line += ' ';
            line += number;
        }
        return line + '\n';
    }

    std::string JsonLine() const {
        const nlohmann::json record = {
            {"from", fromCode_}, {"to", toCode_}, {"input", in_}, {"output", out_}};
        return record.dump() + '\n';
    }

    bool json_;
    int32_t fromCode_ = 0;
    int32_t toCode_ = 0;
    cColorTranslator translator_;
    std::vector<double> in_;
    std::vector<double> out_;
};

int RunTranslate(const TranslateArguments& arguments) {
    return RunCommand("translate", [&] {
        ColorLineConverter converter(arguments);
        ForEachValueLine(arguments.values,
                         [&](const std::vector<std::string>& values) { converter.Convert(values); });
    });
}

}  // namespace

void AddTranslateCommand(CLI::App& app, int& exitCode) {
    auto arguments = std::make_shared<TranslateArguments>();
    CLI::App* command = app.add_subcommand("translate", "Convert colors from one color space to another");
    command->add_option("FROM", arguments->from, "source color space: a name or a code from 1 to 84")
        ->required();
    command->add_option("TO", arguments->to, "destination color space: a name or a code from 1 to 84")
        ->required();
    command->add_option(
        "VALUES", arguments->values,
        "the values of one color; without them, one color per line is read from standard input");
    command->add_flag("--json", arguments->json, "print each color as a JSON object with input and output");
    arguments->descriptions.AddTo(*command);
    command->footer(
        "Color spaces by name: " + ColorSpaceNames() +
        ".\n"
        "Each converted color is printed on one line with 10 significant digits. Scales: XYZ and "
        "Yxy with Y = 1 "
        "for the white; Lab L* 0..100; LCh hue in degrees; sRGB 0..255; linear sRGB reads 0..255 "
        "and writes 0..1.\n"
        "Spectral values are reflectance factors (1 for the perfect white), by default 36 bands from "
        "380 to 730 nm under D50 with the 2-degree observer; their destination shares that light.\n"
        "Example: pigmo translate lab srgb 100 0 0");
    command->callback([arguments, &exitCode] { exitCode = RunTranslate(*arguments); });
}
