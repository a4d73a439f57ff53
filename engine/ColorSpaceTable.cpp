#include "ColorSpaceTable.h"

#include <algorithm>
#include <iterator>

#include "ColorSpaceSRGB.h"

namespace {

using enum ColorSpaceCode;

constexpr ColorSpaceEntry kSpaces[] = {
    {Spectral, "spectral", 0},
    {Density, "density", 4},
    {XYZ, "xyz", 3},
    {Yxy, "yxy", 3},
    {Lab, "lab", 3},
    {Lch, "lch", 3},
    {SRGB, "srgb", 3},
    {LinearSRGB, "linear-srgb", 3},
    {LinearRIMM, "rimm", 3},
    {Lux, "lux", 1},
    {CIECAM02_JCh, "ciecam02-jch", 3},
    {CIECAM02_JMh, "ciecam02-jmh", 3},
    {CIECAM02_Jsh, "ciecam02-jsh", 3},
    {CIECAM02_JChab, "ciecam02-jchab", 3},
    {CIECAM02_JMhab, "ciecam02-jmhab", 3},
    {CIECAM02_Jshab, "ciecam02-jshab", 3},
    {CIECAM02_QCh, "ciecam02-qch", 3},
    {CIECAM02_QMh, "ciecam02-qmh", 3},
    {CIECAM02_Qsh, "ciecam02-qsh", 3},
    {CIECAM02_QChab, "ciecam02-qchab", 3},
    {CIECAM02_QMhab, "ciecam02-qmhab", 3},
    {CIECAM02_Qshab, "ciecam02-qshab", 3},
};

}  // namespace

std::span<const ColorSpaceEntry> cColorSpaceTable::All() {
    return kSpaces;
}

const ColorSpaceEntry* cColorSpaceTable::Find(std::string_view name) {
    const auto found = std::find_if(std::begin(kSpaces), std::end(kSpaces),
                                    [name](const ColorSpaceEntry& entry) { return name == entry.name; });
    return found == std::end(kSpaces) ? nullptr : &*found;
}

const ColorSpaceEntry* cColorSpaceTable::Find(int32_t code) {
    const auto found =
        std::find_if(std::begin(kSpaces), std::end(kSpaces),
                     [code](const ColorSpaceEntry& entry) { return CodeValue(entry.code) == code; });
    return found == std::end(kSpaces) ? nullptr : &*found;
}

ColorSpaceStruct cColorSpaceTable::DefaultDescription(int32_t code) {
    if (code == CodeValue(Spectral))
        return ColorSpaceStruct::BookSpectrum(kBookIlluminantKind, kBookIlluminantTemperature);
    ColorSpaceStruct description;
    description.SetType(code);
    if (code == CodeValue(SRGB) || code == CodeValue(LinearSRGB))
        cColorSpaceSRGB::White(description.whitePoint);
    return description;
}
