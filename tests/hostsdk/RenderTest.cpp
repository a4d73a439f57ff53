// What the host makes of a map's shading: flat renders and the sample sphere in 8-bit sRGB, PNG
// files of them, and the viewport's bitmaps and textures.
#include <gtest/gtest.h>
#include <stb/stb_image.h>

#include <array>
#include <cstdlib>
#include <memory>
#include <stdexcept>
#include <string>

#include "FakeMap.h"
#include "Png.h"
#include "Render.h"
#include "ViewportTextures.h"

namespace {

using Pigmo::Host::Image;

class Rendering : public testing::Test {
protected:
    void SetUp() override { map_ = static_cast<Fake::Map*>(static_cast<Texmap*>(Fake::Class().Create(FALSE))); }
    void TearDown() override { map_->DeleteThis(); }
    void Tint(float r, float g, float b) { map_->GetParamBlock(0)->SetValue(Fake::kTint, 0, AColor(r, g, b, 1.0f)); }
    static const std::uint8_t* Pixel(const Image& image, int x, int y) {
        return &image.rgb[(static_cast<std::size_t>(y) * image.width + x) * 3];
    }

    Fake::Map* map_ = nullptr;
};

struct EncodingCase {
    float linear;
    std::uint8_t encoded;  // IEC 61966-2-1 sRGB, rounded
};

class Encoding : public Rendering, public testing::WithParamInterface<EncodingCase> {};

TEST_P(Encoding, EveryPixelIsTheShadedColorInSrgb) {
    const float v = GetParam().linear;
    Tint(v, 0.0f, 1.0f);
    const Image image = Pigmo::Host::RenderFlat(*map_, 3);
    ASSERT_EQ(image.width, 3);
    ASSERT_EQ(image.rgb.size(), 27u);
    for (int i = 0; i < 9; ++i) {
        EXPECT_EQ(image.rgb[i * 3], GetParam().encoded);
        EXPECT_EQ(image.rgb[i * 3 + 1], 0);
        EXPECT_EQ(image.rgb[i * 3 + 2], 255);
    }
    EXPECT_EQ(map_->shadings, 9);
}

INSTANTIATE_TEST_SUITE_P(Cases, Encoding,
                         testing::Values(EncodingCase{0.0f, 0}, EncodingCase{0.001f, 3}, EncodingCase{0.0031308f, 10},
                                         EncodingCase{0.2f, 124}, EncodingCase{0.5f, 188}, EncodingCase{0.9f, 243},
                                         EncodingCase{1.0f, 255}, EncodingCase{2.0f, 255}, EncodingCase{-1.0f, 0}));

TEST_F(Rendering, SizesOutsideTheRangeAreRefused) {
    for (const int size : {0, Pigmo::Host::kMaxRenderSize + 1}) {
        EXPECT_THROW(Pigmo::Host::RenderFlat(*map_, size), std::invalid_argument);
        EXPECT_THROW(Pigmo::Host::RenderSphere(*map_, size), std::invalid_argument);
    }
}

TEST_F(Rendering, SphereIsLitFromTheUpperLeftOverAChecker) {
    Tint(1.0f, 0.0f, 0.0f);
    const int n = 64;
    const Image image = Pigmo::Host::RenderSphere(*map_, n);
    // The checker: a dark square at the corner, a light one beside it (linear 0.05 and 0.25).
    EXPECT_EQ(Pixel(image, 1, 1)[0], 63);
    EXPECT_EQ(Pixel(image, n / 8 + 1, 1)[0], 137);
    EXPECT_EQ(Pixel(image, n / 8 + 1, 1)[1], 137);
    // The sphere has the map's color: red only, brightest towards the light, and on the side turned
    // away lit by the ambient light alone (linear 0.15).
    const std::uint8_t* lit = Pixel(image, n / 2 - 9, n / 2 - 11);
    const std::uint8_t* centre = Pixel(image, n / 2, n / 2);
    const std::uint8_t* away = Pixel(image, n / 2 + 16, n / 2 + 16);
    for (const std::uint8_t* pixel : {lit, centre, away}) {
        EXPECT_EQ(pixel[1], 0);
        EXPECT_EQ(pixel[2], 0);
    }
    EXPECT_GT(lit[0], centre[0]);
    EXPECT_GT(centre[0], away[0]);
    EXPECT_EQ(away[0], 108);
    EXPECT_GT(map_->shadings, 0);
}

TEST_F(Rendering, PngHoldsTheImageExactly) {
    Image image;
    image.width = 5;
    image.height = 2;
    for (int i = 0; i < 30; ++i) image.rgb.push_back(static_cast<std::uint8_t>(i * 8));
    const std::string png = Pigmo::Host::EncodePng(image);
    int width = 0, height = 0, channels = 0;
    const std::unique_ptr<stbi_uc, void (*)(void*)> decoded(
        stbi_load_from_memory(reinterpret_cast<const stbi_uc*>(png.data()), static_cast<int>(png.size()), &width,
                              &height, &channels, 0),
        stbi_image_free);
    ASSERT_NE(decoded, nullptr);
    EXPECT_EQ(width, 5);
    EXPECT_EQ(height, 2);
    EXPECT_EQ(channels, 3);
    EXPECT_EQ(std::vector<std::uint8_t>(decoded.get(), decoded.get() + 30), image.rgb);
}

TEST_F(Rendering, SixteenBitPngKeepsEveryChannel) {
    const BMM_Color_64 pixels[] = {{0, 1, 256, 65535}, {65535, 32767, 258, 0}, {4660, 22136, 39612, 57072}};
    const std::string png = Pigmo::Host::EncodePng16(3, 1, pixels);
    int width = 0, height = 0, channels = 0;
    const std::unique_ptr<stbi_us, void (*)(void*)> decoded(
        stbi_load_16_from_memory(reinterpret_cast<const stbi_uc*>(png.data()), static_cast<int>(png.size()), &width,
                                 &height, &channels, 0),
        stbi_image_free);
    ASSERT_NE(decoded, nullptr);
    ASSERT_EQ(width * height, 3);
    ASSERT_EQ(channels, 4);
    for (int i = 0; i < 3; ++i) {
        const stbi_us* p = decoded.get() + i * 4;
        EXPECT_EQ((BMM_Color_64{p[0], p[1], p[2], p[3]}), pixels[i]) << i;
    }
    EXPECT_THROW(Pigmo::Host::EncodePng16(0, 1, pixels), std::runtime_error);
}

// Each pixel different, so any mix-up of rows or columns shows.
Bitmap Numbered(int width, int height) {
    Bitmap bitmap(width, height);
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            const BMM_Color_64 pixel{WORD(x), WORD(y), WORD(x * 100 + y), 0xFFFF};
            bitmap.PutPixels(x, y, 1, &pixel);
        }
    }
    return bitmap;
}

TEST(Viewport, BitmapFollowsItsHeaderTopRowFirst) {
    Bitmap bitmap = Numbered(3, 2);
    Pigmo::Host::ViewportTextures viewport;
    EXPECT_EQ(viewport.Size(), 64);
    BITMAPINFO* dib = viewport.BitmapToDIB(&bitmap, 0, FALSE, FALSE);
    ASSERT_NE(dib, nullptr);
    EXPECT_EQ(dib->bmiHeader.biSize, sizeof(BITMAPINFOHEADER));
    EXPECT_EQ(dib->bmiHeader.biWidth, 3);
    EXPECT_EQ(dib->bmiHeader.biHeight, 2);
    EXPECT_EQ(dib->bmiHeader.biBitCount, 64);
    EXPECT_EQ(dib->bmiHeader.biSizeImage, 6 * 8u);
    const BMM_Color_64* pixels = Pigmo::Host::DIBPixels(dib);
    EXPECT_EQ(static_cast<const void*>(pixels), static_cast<const void*>(dib + 1));
    for (int y = 0; y < 2; ++y)
        for (int x = 0; x < 3; ++x) EXPECT_EQ(pixels[y * 3 + x], (BMM_Color_64{WORD(x), WORD(y), WORD(x * 100 + y), 0xFFFF}));

    // The texture keeps the bitmap and frees it with itself.
    TexHandle* texture = viewport.CreateHandle(dib);
    ASSERT_NE(texture, nullptr);
    EXPECT_EQ(texture->GetHandle(), reinterpret_cast<DWORD_PTR>(dib));
    texture->DeleteThis();
    EXPECT_EQ(viewport.CreateHandle(nullptr), nullptr);
    EXPECT_EQ(viewport.BitmapToDIB(nullptr, 0, FALSE, FALSE), nullptr);
    EXPECT_EQ(Pigmo::Host::ViewportTextures(128).Size(), 128);
}

TEST(Viewport, BitmapPixelsStayInside) {
    Bitmap bitmap = Numbered(4, 3);
    BMM_Color_64 row[4];
    EXPECT_EQ(bitmap.GetPixels(1, 2, 3, row), 1);
    EXPECT_EQ(row[2], (BMM_Color_64{3, 2, 302, 0xFFFF}));
    for (const auto& [x, y, n] : {std::array{2, 0, 3}, {0, 3, 1}, {-1, 0, 1}, {0, 0, -1}}) {
        EXPECT_EQ(bitmap.GetPixels(x, y, n, row), 0) << x << " " << y << " " << n;
        EXPECT_EQ(bitmap.PutPixels(x, y, n, row), 0) << x << " " << y << " " << n;
    }
}

struct BitmapCase {
    int type, width, height;
    bool made;
};

class Manager : public testing::TestWithParam<BitmapCase> {};

TEST_P(Manager, MakesTrueColorBitmapsOfSensibleSize) {
    BitmapInfo info;
    info.SetType(GetParam().type);
    info.SetWidth(GetParam().width);
    info.SetHeight(GetParam().height);
    Bitmap* bitmap = TheManager->Create(&info);
    EXPECT_EQ(bitmap != nullptr, GetParam().made);
    if (bitmap != nullptr) {
        EXPECT_EQ(bitmap->Width(), GetParam().width);
        EXPECT_EQ(bitmap->Height(), GetParam().height);
        bitmap->DeleteThis();
    }
}

INSTANTIATE_TEST_SUITE_P(Cases, Manager,
                         testing::Values(BitmapCase{BMM_TRUE_32, 64, 64, true}, BitmapCase{BMM_TRUE_32, 4096, 1, true},
                                         BitmapCase{5, 64, 64, false}, BitmapCase{BMM_TRUE_32, 0, 64, false},
                                         BitmapCase{BMM_TRUE_32, 64, -1, false},
                                         BitmapCase{BMM_TRUE_32, 4097, 1, false}));

}  // namespace
