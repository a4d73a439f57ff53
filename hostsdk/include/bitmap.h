#pragma once

// Bitmaps: the host's images, made through its bitmap manager.

#include <vector>

#include "assetmanagement.h"
#include "maxtypes.h"

// 16 bits a channel.
struct BMM_Color_64 {
    WORD r = 0, g = 0, b = 0, a = 0;
    bool operator==(const BMM_Color_64& other) const = default;
};

inline constexpr int BMM_TRUE_32 = 6;

// Device-independent bitmap header. The stand-in viewport keeps 16-bit channels: biBitCount 64, the
// pixels follow the header as BMM_Color_64, top row first.
struct BITMAPINFOHEADER {
    DWORD biSize = sizeof(BITMAPINFOHEADER);
    LONG biWidth = 0;
    LONG biHeight = 0;
    WORD biPlanes = 1;
    WORD biBitCount = 0;
    DWORD biCompression = 0;
    DWORD biSizeImage = 0;
};
struct BITMAPINFO {
    BITMAPINFOHEADER bmiHeader;
};

class HostExport BitmapInfo {
public:
    void SetType(int type) { type_ = type; }
    int Type() const { return type_; }
    void SetWidth(int width) { width_ = width; }
    void SetHeight(int height) { height_ = height; }
    int Width() const { return width_; }
    int Height() const { return height_; }
    void SetAsset(const MaxSDK::AssetManagement::AssetUser& asset) { asset_ = asset; }
    const MaxSDK::AssetManagement::AssetUser& GetAsset() const { return asset_; }

private:
    int type_ = 0;
    int width_ = 0;
    int height_ = 0;
    MaxSDK::AssetManagement::AssetUser asset_;
};

class HostExport Bitmap {
public:
    Bitmap(int width, int height) : width_(width), height_(height), pixels_(std::size_t(width) * height) {}
    virtual ~Bitmap() = default;
    int Width() const { return width_; }
    int Height() const { return height_; }
    int Fill(const BMM_Color_64& color);
    // Reads or writes n pixels of row y from column x; false outside the bitmap.
    int GetPixels(int x, int y, int n, BMM_Color_64* pixels) const;
    int PutPixels(int x, int y, int n, const BMM_Color_64* pixels);
    virtual void DeleteThis() { delete this; }

private:
    int width_;
    int height_;
    std::vector<BMM_Color_64> pixels_;
};

class HostExport BitmapManager {
public:
    virtual ~BitmapManager() = default;
    // A new bitmap as bi describes it, or null when it cannot be made.
    virtual Bitmap* Create(BitmapInfo* bi);
};

extern HostExport BitmapManager* TheManager;
