#include "bitmap.h"

#include <algorithm>
#include <new>

namespace {

// The largest side the bitmap manager makes; the viewport asks for far less.
constexpr int kMaxBitmapSide = 4096;

bool Inside(int x, int y, int n, int width, int height) {
    return x >= 0 && y >= 0 && y < height && n >= 0 && static_cast<long long>(x) + n <= width;
}

}  // namespace

int Bitmap::Fill(const BMM_Color_64& color) {
    std::fill(pixels_.begin(), pixels_.end(), color);
    return 1;
}

int Bitmap::GetPixels(int x, int y, int n, BMM_Color_64* pixels) const {
    if (pixels == nullptr || !Inside(x, y, n, width_, height_)) return 0;
    std::copy_n(pixels_.begin() + (static_cast<std::ptrdiff_t>(y) * width_ + x), n, pixels);
    return 1;
}

int Bitmap::PutPixels(int x, int y, int n, const BMM_Color_64* pixels) {
    if (pixels == nullptr || !Inside(x, y, n, width_, height_)) return 0;
    std::copy_n(pixels, n, pixels_.begin() + (static_cast<std::ptrdiff_t>(y) * width_ + x));
    return 1;
}

Bitmap* BitmapManager::Create(BitmapInfo* bi) {
    if (bi == nullptr || bi->Type() != BMM_TRUE_32) return nullptr;
    const int width = bi->Width(), height = bi->Height();
    if (width <= 0 || height <= 0 || width > kMaxBitmapSide || height > kMaxBitmapSide) return nullptr;
    try {
        return new Bitmap(width, height);
    } catch (const std::bad_alloc&) {
        return nullptr;
    }
}

namespace {
BitmapManager hostBitmapManager;
}

// A test may point this at a manager of its own, one that fails, for instance.
BitmapManager* TheManager = &hostBitmapManager;
