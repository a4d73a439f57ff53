#include "ColorSpaceStruct.h"

#include <cmath>
#include <cstring>
#include <limits>

#include "ColorSpaceTable.h"

namespace {

// Viewing conditions of the appearance spaces; the third value is the surround's c factor.
constexpr double kViewingPresets[7][6] = {
    {50.0, 300.0, 0.69, 1.0, 1.0, 1.0}, {30.0, 30.0, 0.69, 1.0, 1.0, 1.0},
    {30.0, 100.0, 0.69, 1.0, 1.0, 1.0}, {30.0, 18.0, 0.69, 1.0, 1.0, 1.0},
    {20.0, 18.0, 0.59, 0.95, 1.0, 0.9}, {0.01, 1.0, 0.525, 0.8, 1.0, 0.9},
    {50.0, 8.0, 0.41, 0.8, 1.0, 0.9},
};

// Channel counts of the multi-channel codes 48..64 and 65..83.
constexpr int32_t kMultiChannelA[] = {1, 2, 3, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12, 13, 14, 15, 16};
constexpr int32_t kMultiChannelB[] = {1, 2, 3, 3, 4, 4, 5, 6, 6, 7, 8, 9, 10, 11, 12, 13, 14, 15, 16};

constexpr double kLchChromaMaximum = 181.01933598376;  // 128 * sqrt(2)

enum class RangeKind { Unit, LabLike, LchLike, Byte };

RangeKind RangeKindOf(int32_t code) {
    using enum ColorSpaceCode;
    switch (static_cast<ColorSpaceCode>(code)) {
        case Lab:
        case LabWithoutNode:
        case CIECAM02_JChab:
        case CIECAM02_JMhab:
        case LinearHueLab:
        case CIECAM02_JChabBrightness:
            return RangeKind::LabLike;
        case Lch:
        case CIECAM97s:
        case CIECAM02_JCh:
        case CIECAM02_JMh:
        case LinearHueLch:
            return RangeKind::LchLike;
        case SRGB:
        case LinearSRGB:
            return RangeKind::Byte;
        default:
            return RangeKind::Unit;
    }
}

// Byte-wise, so that identical NaN payloads match and 0.0 differs from -0.0.
bool SameBits(double a, double b) {
    return std::memcmp(&a, &b, sizeof a) == 0;
}

}  // namespace

ColorSpaceStruct::ColorSpaceStruct() {
    ApplyViewingPreset(0);
}

std::unique_ptr<ColorSpaceStruct> ColorSpaceStruct::Clone() const {
    return std::make_unique<ColorSpaceStruct>(*this);
}

int32_t ColorSpaceStruct::BandCount(double start, double end, double step) {
    const double bands = (end - start) / step + 0.5;
    // A zero step or a reversed grid has no bands rather than an undefined count.
    if (!std::isfinite(bands) || bands < 0.0 || bands >= std::numeric_limits<int32_t>::max()) return 0;
    return static_cast<int32_t>(bands) + 1;
}

ColorSpaceStruct ColorSpaceStruct::BookSpectrum(IlluminantKind illuminantKind, double temperature) {
    ColorSpaceStruct description;
    description.SetType(ColorSpaceCode::Spectral);
    description.wavelengthStart = 380.0;
    description.wavelengthEnd = 730.0;
    description.wavelengthStep = 10.0;
    description.illuminant.SetIlluminant(illuminantKind, temperature);
    description.hasIlluminant = true;
    return description;
}

int32_t ColorSpaceStruct::ChannelCountOf(int32_t code) {
    if (const ColorSpaceEntry* entry = cColorSpaceTable::Find(code)) return entry->channels;
    if (code >= 48 && code <= 64) return kMultiChannelA[code - 48];
    if (code >= 65 && code <= 83) return kMultiChannelB[code - 65];
    using enum ColorSpaceCode;
    switch (static_cast<ColorSpaceCode>(code)) {
        // The spaces without a node built here.
        case LabWithoutNode:
        case WithoutNode:
        case CIECAM97s:
        case LinearHueLch:
        case LinearHueLab:
        case CIECAM02_JChabBrightness:
            return 3;
        default:
            return 0;
    }
}

int32_t ColorSpaceStruct::GetChannelCount() const {
    if (Is(ColorSpaceCode::Spectral) || Is(ColorSpaceCode::UVOnOff))
        return BandCount(wavelengthStart, wavelengthEnd, wavelengthStep);
    return ChannelCountOf(type);
}

double ColorSpaceStruct::DefaultMinimum(int32_t code, int32_t channel) {
    switch (RangeKindOf(code)) {
        case RangeKind::LabLike:
            return channel == 1 || channel == 2 ? -128.0 : 0.0;
        default:
            return 0.0;
    }
}

double ColorSpaceStruct::DefaultMaximum(int32_t code, int32_t channel) {
    switch (RangeKindOf(code)) {
        case RangeKind::LabLike:
            return channel == 0 ? 100.0 : channel == 1 || channel == 2 ? 128.0 : 255.0;
        case RangeKind::LchLike:
            return channel == 0 ? 100.0 : channel == 1 ? kLchChromaMaximum : channel == 2 ? 360.0 : 255.0;
        case RangeKind::Byte:
            return 255.0;
        default:
            return 1.0;
    }
}

// A range array made before the grid of a spectral code changed may be shorter than the channel
// count; channels it does not cover keep their default.
double ColorSpaceStruct::GetMinimum(int32_t channel) const {
    if (minimum.empty()) return DefaultMinimum(type, channel);
    if (channel < 0 || channel >= GetChannelCount()) return 0.0;
    return static_cast<size_t>(channel) < minimum.size() ? minimum[channel] : DefaultMinimum(type, channel);
}

double ColorSpaceStruct::GetMaximum(int32_t channel) const {
    if (maximum.empty()) return DefaultMaximum(type, channel);
    if (channel < 0 || channel >= GetChannelCount()) return 0.0;
    return static_cast<size_t>(channel) < maximum.size() ? maximum[channel] : DefaultMaximum(type, channel);
}

bool ColorSpaceStruct::SetType(int32_t code) {
    if (code >= 28 && code <= 36) return false;
    type = code;
    minimum.clear();
    maximum.clear();
    return true;
}

bool ColorSpaceStruct::IsCompatible(const ColorSpaceStruct*) const {
    return false;
}

namespace {

// Brings a range array to the channel count, filling new entries with the code's default.
template <typename Default>
bool StoreBound(std::vector<double>& bounds, int32_t count, int32_t channel, double value, Default fallback) {
    if (channel < 0 || channel >= count) return false;
    for (int32_t i = static_cast<int32_t>(bounds.size()); i < count; ++i) bounds.push_back(fallback(i));
    bounds[channel] = value;
    return true;
}

}  // namespace

bool ColorSpaceStruct::SetMaximum(int32_t channel, double value) {
    return StoreBound(maximum, GetChannelCount(), channel, value,
                      [this](int32_t i) { return DefaultMaximum(type, i); });
}

bool ColorSpaceStruct::SetMinimum(int32_t channel, double value) {
    return StoreBound(minimum, GetChannelCount(), channel, value,
                      [this](int32_t i) { return DefaultMinimum(type, i); });
}

void ColorSpaceStruct::ApplyViewingPreset(int32_t preset) {
    if (preset < 0 || preset > 6) return;
    std::memcpy(viewingConditions, kViewingPresets[preset], sizeof viewingConditions);
}

bool ColorSpaceStruct::HasDefaultRanges() const {
    if (minimum.empty() && maximum.empty()) return true;
    const int32_t count = GetChannelCount();
    for (int32_t i = 0; i < count; ++i) {
        if (GetMinimum(i) != DefaultMinimum(type, i) || GetMaximum(i) != DefaultMaximum(type, i))
            return false;
    }
    return true;
}

const double* ColorSpaceStruct::EffectiveWhite() const {
    return hasIlluminant ? illuminant.relativeWhite : whitePoint;
}

namespace {

bool SameBounds(const ColorSpaceStruct& a, const ColorSpaceStruct& b, bool maximum) {
    const bool aHas = !(maximum ? a.maximum : a.minimum).empty();
    const bool bHas = !(maximum ? b.maximum : b.minimum).empty();
    if (aHas != bHas) return false;
    if (!aHas) return true;
    const int32_t count = a.GetChannelCount();
    for (int32_t i = 0; i < count; ++i) {
        const double x = maximum ? a.GetMaximum(i) : a.GetMinimum(i);
        const double y = maximum ? b.GetMaximum(i) : b.GetMinimum(i);
        if (!SameBits(x, y)) return false;
    }
    return true;
}

}  // namespace

bool ColorSpaceStruct::SameSpace(const ColorSpaceStruct& a, const ColorSpaceStruct& b) {
    if (a.type != b.type || a.observer != b.observer || a.observerAge != b.observerAge ||
        a.fieldSize != b.fieldSize) {
        return false;
    }
    if (!SameWhite(a, b)) return false;
    if (a.wavelengthStart != b.wavelengthStart || a.wavelengthEnd != b.wavelengthEnd ||
        a.wavelengthStep != b.wavelengthStep) {
        return false;
    }
    for (int i = 0; i < 6; ++i) {
        if (a.viewingConditions[i] != b.viewingConditions[i]) return false;
    }
    return a.weighting == b.weighting;
}

bool ColorSpaceStruct::Equals(const ColorSpaceStruct* other) const {
    return other != nullptr && SameSpace(*this, *other) && SameBounds(*this, *other, false) &&
           SameBounds(*this, *other, true);
}

bool ColorSpaceStruct::SameWhite(const ColorSpaceStruct& a, const ColorSpaceStruct& b) {
    if (a.hasIlluminant) return a.illuminant == b.illuminant;
    for (int i = 0; i < 3; ++i) {
        if (a.whitePoint[i] != b.whitePoint[i]) return false;
    }
    return true;
}
