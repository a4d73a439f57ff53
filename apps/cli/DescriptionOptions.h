#pragma once

#include <CLI/CLI.hpp>
#include <cstdint>
#include <string>
#include <vector>

#include "ChromaticAdaptation.h"
#include "ColorSpaceStruct.h"

// Which description of a conversion an option applies to.
enum class ConversionSide { From, To };

// What a command may say about the two descriptions of a conversion. Every description option
// comes as --NAME (both sides), --from-NAME and --to-NAME; the form for one side wins over the
// form for both. New description options are rows of the table in DescriptionOptions.cpp.
class DescriptionOptions {
public:
    DescriptionOptions();

    // Adds the options to a command; this object must outlive its parsing.
    void AddTo(CLI::App& command);

    // The description of one side: the code, the default white of the space, then the options in
    // table order. Throws std::invalid_argument with a one-line message naming the option.
    ColorSpaceStruct Describe(ConversionSide side, int32_t code) const;

    // Chromatic adaptation method of the engine from --adapt.
    AdaptationMethod Adaptation() const;

    // A destination without a white of its own takes the light of a spectral source, so that the
    // source's perfect white is the destination's white (as the color books convert).
    void ShareLight(const ColorSpaceStruct& source, ColorSpaceStruct& destination) const;

private:
    // Whether an option of the table was given for a side, in its own or its both-sides form.
    bool Gives(ConversionSide side, const std::string& name) const;

    struct Given {
        std::string both, from, to;
    };
    std::vector<Given> given_;  // one per row of the option table
    std::string adapt_ = "none";
};

// Code of a FROM or TO argument: a name of ColorSpaceNames() or a number from 1 to 84.
// Throws std::invalid_argument.
int32_t ParseColorSpace(const std::string& text);

// "lab (3)" for a named space, "code 5" otherwise; for messages.
std::string DescribeColorSpace(int32_t code);

// "xyz (6), yxy (8), ..." for help texts.
std::string ColorSpaceNames();

// Strict number: the whole text is one finite decimal number. Throws std::invalid_argument.
double ParseNumber(const std::string& text);

// L*, a*, b* of one color from exactly three strict numbers. Throws std::invalid_argument.
void ParseLab(const std::vector<std::string>& values, double* lab);
