#include "Png.h"

#include <png.h>

#include <algorithm>
#include <cstdint>
#include <new>
#include <stdexcept>
#include <vector>

namespace Pigmo::Host {

namespace {

// libpng reports errors by longjmp; the rows are made beforehand so nothing with a destructor is
// skipped by the jump.
std::string Encode(int width, int height, int bitDepth, int colorType, bool sRGB, const std::vector<png_bytep>& rows) {
    if (width <= 0 || height <= 0) throw std::runtime_error("a PNG needs at least one pixel");
    std::string bytes;
    png_structp png = png_create_write_struct(PNG_LIBPNG_VER_STRING, nullptr, nullptr, nullptr);
    png_infop info = png != nullptr ? png_create_info_struct(png) : nullptr;
    if (info == nullptr) {
        png_destroy_write_struct(&png, nullptr);
        throw std::runtime_error("cannot make a PNG: out of memory");
    }
    const auto append = [](png_structp p, png_bytep data, png_size_t length) {
        // No exception may cross libpng's C frames.
        try {
            static_cast<std::string*>(png_get_io_ptr(p))->append(reinterpret_cast<const char*>(data), length);
        } catch (const std::bad_alloc&) {
            png_error(p, "out of memory");
        }
    };
    if (setjmp(png_jmpbuf(png)) != 0) {
        png_destroy_write_struct(&png, &info);
        throw std::runtime_error("cannot make a PNG");
    }
    png_set_write_fn(png, &bytes, append, nullptr);
    png_set_IHDR(png, info, static_cast<png_uint_32>(width), static_cast<png_uint_32>(height), bitDepth, colorType,
                 PNG_INTERLACE_NONE, PNG_COMPRESSION_TYPE_DEFAULT, PNG_FILTER_TYPE_DEFAULT);
    if (sRGB) png_set_sRGB(png, info, PNG_sRGB_INTENT_PERCEPTUAL);
    png_write_info(png, info);
    png_write_image(png, const_cast<png_bytepp>(rows.data()));
    png_write_end(png, nullptr);
    png_destroy_write_struct(&png, &info);
    return bytes;
}

}  // namespace

std::string EncodePng(const Image& image) {
    std::vector<std::uint8_t> pixels = image.rgb;
    std::vector<png_bytep> rows(static_cast<std::size_t>(std::max(image.height, 0)));
    for (std::size_t y = 0; y < rows.size(); ++y) rows[y] = pixels.data() + y * static_cast<std::size_t>(image.width) * 3u;
    return Encode(image.width, image.height, 8, PNG_COLOR_TYPE_RGB, true, rows);
}

std::string EncodePng16(int width, int height, const BMM_Color_64* pixels) {
    if (width <= 0 || height <= 0) throw std::runtime_error("a PNG needs at least one pixel");
    // PNG keeps 16-bit samples most significant byte first.
    const std::size_t count = static_cast<std::size_t>(width) * static_cast<std::size_t>(height);
    std::vector<std::uint8_t> bytes(count * 8u);
    for (std::size_t i = 0; i < count; ++i) {
        const WORD channels[4] = {pixels[i].r, pixels[i].g, pixels[i].b, pixels[i].a};
        for (int c = 0; c < 4; ++c) {
            bytes[i * 8 + c * 2] = static_cast<std::uint8_t>(channels[c] >> 8);
            bytes[i * 8 + c * 2 + 1] = static_cast<std::uint8_t>(channels[c] & 0xFF);
        }
    }
    std::vector<png_bytep> rows(static_cast<std::size_t>(height));
    for (std::size_t y = 0; y < rows.size(); ++y) rows[y] = bytes.data() + y * static_cast<std::size_t>(width) * 8u;
    // The viewport's values are the map's linear ones; they go in untagged, as the viewport shows them.
    return Encode(width, height, 16, PNG_COLOR_TYPE_RGB_ALPHA, false, rows);
}

}  // namespace Pigmo::Host
