#pragma once

#include <cstdint>
#include <vector>

#include "imtl.h"

namespace Pigmo::Host {

// An image of 8-bit sRGB pixels, red, green, blue, rows top first.
struct HostExport Image {
    int width = 0;
    int height = 0;
    std::vector<std::uint8_t> rgb;
};

// The sides a render may have.
inline constexpr int kMaxRenderSize = 4096;

// The map itself, size x size: one shading call (maps on) per pixel, each linear channel clamped to
// 0..1, encoded with the sRGB transfer function and rounded to 8 bits. Throws std::invalid_argument
// for a size outside 1..kMaxRenderSize.
HostExport Image RenderFlat(Texmap& map, int size);

// The material editor's sample: a sphere shaded with the map, lit by one light from the upper left
// and some ambient light, over a checker background; computed in linear light with four samples a
// pixel, then encoded as RenderFlat does.
HostExport Image RenderSphere(Texmap& map, int size);

}  // namespace Pigmo::Host
