#include "ViewportTextures.h"

#include <cstdlib>

namespace Pigmo::Host {

namespace {

// A texture of the viewport: the bitmap it was made from.
class DIBTexture final : public TexHandle {
public:
    explicit DIBTexture(BITMAPINFO* dib) : dib_(dib) {}
    ~DIBTexture() override { std::free(dib_); }
    DIBTexture(const DIBTexture&) = delete;
    DIBTexture& operator=(const DIBTexture&) = delete;

    DWORD_PTR GetHandle() override { return reinterpret_cast<DWORD_PTR>(dib_); }
    void DeleteThis() override { delete this; }

private:
    BITMAPINFO* dib_;
};

}  // namespace

TexHandle* ViewportTextures::CreateHandle(BITMAPINFO* bminf) {
    return bminf != nullptr ? new DIBTexture(bminf) : nullptr;
}

BITMAPINFO* ViewportTextures::BitmapToDIB(Bitmap* bm, int, BOOL, BOOL) {
    if (bm == nullptr) return nullptr;
    const int width = bm->Width(), height = bm->Height();
    const std::size_t pixels = static_cast<std::size_t>(width) * static_cast<std::size_t>(height);
    auto* dib = static_cast<BITMAPINFO*>(std::malloc(sizeof(BITMAPINFO) + pixels * sizeof(BMM_Color_64)));
    if (dib == nullptr) return nullptr;
    dib->bmiHeader = BITMAPINFOHEADER{};
    dib->bmiHeader.biWidth = width;
    dib->bmiHeader.biHeight = height;
    dib->bmiHeader.biBitCount = 64;
    dib->bmiHeader.biSizeImage = static_cast<DWORD>(pixels * sizeof(BMM_Color_64));
    auto* out = reinterpret_cast<BMM_Color_64*>(dib + 1);
    for (int y = 0; y < height; ++y) bm->GetPixels(0, y, width, out + static_cast<std::size_t>(y) * width);
    return dib;
}

const BMM_Color_64* DIBPixels(const BITMAPINFO* dib) {
    return reinterpret_cast<const BMM_Color_64*>(dib + 1);
}

}  // namespace Pigmo::Host
