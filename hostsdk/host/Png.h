#pragma once

#include <string>

#include "Render.h"
#include "bitmap.h"

namespace Pigmo::Host {

// The image as an 8-bit RGB PNG file's bytes. Throws std::runtime_error when libpng fails.
HostExport std::string EncodePng(const Image& image);

// width x height pixels (rows top first) as a 16-bit RGBA PNG, the channels unchanged.
HostExport std::string EncodePng16(int width, int height, const BMM_Color_64* pixels);

}  // namespace Pigmo::Host
