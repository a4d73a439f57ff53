#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string_view>

#include "ColorSpaceStruct.h"
#include "Export.h"

// The color-space codes with a name. Stored descriptions and the C interface keep the integer;
// codes without a name here (the encodings 28 to 45, the multi-channel spaces 48 to 83) stay
// plain integers.
enum class ColorSpaceCode : int32_t {
    None = 0,
    Density = 1,
    Spectral = 2,
    Lab = 3,
    Lch = 4,
    LabWithoutNode = 5,
    XYZ = 6,
    WithoutNode = 7,
    Yxy = 8,
    CIECAM97s = 9,
    CIECAM02_JCh = 10,
    CIECAM02_JMh = 11,
    CIECAM02_Jsh = 12,
    CIECAM02_JChab = 13,
    CIECAM02_JMhab = 14,
    CIECAM02_Jshab = 15,
    CIECAM02_QCh = 16,
    CIECAM02_QMh = 17,
    CIECAM02_Qsh = 18,
    CIECAM02_QChab = 19,
    CIECAM02_QMhab = 20,
    CIECAM02_Qshab = 21,
    LinearHueLch = 22,
    LinearHueLab = 23,
    SRGB = 24,
    LinearSRGB = 25,
    LinearRIMM = 26,
    Lux = 27,
    UVOnOff = 46,
    CIECAM02_JChabBrightness = 47,
    PrincipalComponents = 84,
};

inline constexpr int32_t kLastColorSpaceCode = 84;

constexpr int32_t CodeValue(ColorSpaceCode code) {
    return static_cast<int32_t>(code);
}

// One space the engine converts, as people and programs name it.
struct ColorSpaceEntry {
    ColorSpaceCode code;
    const char* name;
    int32_t channels;  // 0 for the spectral spaces, whose count follows their grid
};

// The light of spectral values unless told otherwise: the color books' D50.
inline constexpr IlluminantKind kBookIlluminantKind = IlluminantKind::Daylight;
inline constexpr double kBookIlluminantTemperature = 5003.0;

// The engine's one table of the spaces it converts: names, channel counts, default descriptions.
class PIGMO_API cColorSpaceTable {
public:
    // In the order help texts list them.
    static std::span<const ColorSpaceEntry> All();
    static const ColorSpaceEntry* Find(std::string_view name);
    static const ColorSpaceEntry* Find(int32_t code);

    // The description a space has unless told otherwise: sRGB and linear sRGB at the white of
    // their own primaries, spectral values on the color books' grid under D50, every other space
    // at the D50 white.
    static ColorSpaceStruct DefaultDescription(int32_t code);
    static ColorSpaceStruct DefaultDescription(ColorSpaceCode code) {
        return DefaultDescription(CodeValue(code));
    }
};
