#include "Render.h"

#include <cmath>
#include <stdexcept>
#include <string>

namespace Pigmo::Host {

namespace {

struct Linear {
    float r = 0, g = 0, b = 0;
};

std::uint8_t Encode(float linear) {
    // NaN and everything below 0 shows as black.
    const double v = !(linear > 0.0f) ? 0.0 : linear >= 1.0f ? 1.0 : linear;
    const double encoded = v <= 0.0031308 ? 12.92 * v : 1.055 * std::pow(v, 1.0 / 2.4) - 0.055;
    return static_cast<std::uint8_t>(std::lround(encoded * 255.0));
}

Image Blank(int size) {
    if (size < 1 || size > kMaxRenderSize)
        throw std::invalid_argument("a render is 1 to " + std::to_string(kMaxRenderSize) + " pixels wide, not " +
                                    std::to_string(size));
    Image image;
    image.width = image.height = size;
    image.rgb.resize(static_cast<std::size_t>(size) * static_cast<std::size_t>(size) * 3u);
    return image;
}

void Put(Image& image, int x, int y, const Linear& color) {
    std::uint8_t* pixel = &image.rgb[(static_cast<std::size_t>(y) * image.width + x) * 3u];
    pixel[0] = Encode(color.r);
    pixel[1] = Encode(color.g);
    pixel[2] = Encode(color.b);
}

Linear Shade(Texmap& map) {
    ShadeContext sc;
    sc.doMaps = TRUE;
    const AColor color = map.EvalColor(sc);
    return {color.r, color.g, color.b};
}

// The sample scene, in units of the image side: the sphere's radius, the checker's squares, the
// light (a unit vector towards the upper left, in front) and the light the sphere gets everywhere.
constexpr double kRadius = 0.42;
constexpr int kCheckers = 8;
constexpr double kLight[3] = {-0.48, 0.6, 0.64};
constexpr float kAmbient = 0.15f;
constexpr float kCheckerDark = 0.05f, kCheckerLight = 0.25f;

// What one point of the image shows: the lit sphere where it is, the checker elsewhere.
Linear Sample(Texmap& map, double u, double v) {
    const double x = (u - 0.5) / kRadius, y = (0.5 - v) / kRadius;
    const double r2 = x * x + y * y;
    if (r2 > 1.0) {
        const bool dark = (static_cast<int>(u * kCheckers) + static_cast<int>(v * kCheckers)) % 2 == 0;
        const float level = dark ? kCheckerDark : kCheckerLight;
        return {level, level, level};
    }
    const double z = std::sqrt(1.0 - r2);
    const double facing = std::max(0.0, x * kLight[0] + y * kLight[1] + z * kLight[2]);
    const float light = kAmbient + (1.0f - kAmbient) * static_cast<float>(facing);
    const Linear albedo = Shade(map);
    return {albedo.r * light, albedo.g * light, albedo.b * light};
}

}  // namespace

Image RenderFlat(Texmap& map, int size) {
    Image image = Blank(size);
    for (int y = 0; y < size; ++y)
        for (int x = 0; x < size; ++x) Put(image, x, y, Shade(map));
    return image;
}

Image RenderSphere(Texmap& map, int size) {
    Image image = Blank(size);
    for (int y = 0; y < size; ++y) {
        for (int x = 0; x < size; ++x) {
            // A 2 x 2 grid of samples smooths the sphere's edge.
            Linear sum;
            for (int sy = 0; sy < 2; ++sy) {
                for (int sx = 0; sx < 2; ++sx) {
                    const Linear s = Sample(map, (x + 0.25 + 0.5 * sx) / size, (y + 0.25 + 0.5 * sy) / size);
                    sum.r += s.r / 4;
                    sum.g += s.g / 4;
                    sum.b += s.b / 4;
                }
            }
            Put(image, x, y, sum);
        }
    }
    return image;
}

}  // namespace Pigmo::Host
