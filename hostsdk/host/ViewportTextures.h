#pragma once

#include "bitmap.h"
#include "imtl.h"

namespace Pigmo::Host {

// The viewport's side of map textures: the size it asks for, device-independent bitmaps of 64 bits a
// pixel (BMM_Color_64, top row first, right after the header) and handles that keep them.
class HostExport ViewportTextures final : public TexHandleMaker {
public:
    explicit ViewportTextures(int size = 64) : size_(size) {}

    int Size() override { return size_; }
    // Takes the bitmap; the handle's value is its address. Null for a null bitmap.
    TexHandle* CreateHandle(BITMAPINFO* bminf) override;
    // A bitmap of bm's own size, allocated with malloc; null for a null bm or when memory runs out.
    // The viewport here takes any size, so no size is forced and no flag applies.
    BITMAPINFO* BitmapToDIB(Bitmap* bm, int extraFlags, BOOL forceW, BOOL forceH) override;

private:
    int size_;
};

// The pixels that follow a bitmap's header.
HostExport const BMM_Color_64* DIBPixels(const BITMAPINFO* dib);

}  // namespace Pigmo::Host
