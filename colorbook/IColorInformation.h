#pragma once

namespace Pigmo {

// Read view of one color, shared by a book's records and the map's current color, so the
// display code shows either alike. Nothing is ever deleted through this interface.
class IColorInformation {
public:
    virtual const char* GetName() const = 0;
    virtual const char* GetCategory() const = 0;
    // Gamma-encoded sRGB, 0 to 255.
    virtual const float* GetSRGB() const = 0;
    // Linear sRGB, 0 to 1: what the map renders.
    virtual const float* GetLinearRGB() const = 0;
    // L*, a*, b* relative to D50.
    virtual const float* GetLab() const = 0;
    // First reflectance value, or null when there is no curve.
    virtual const float* GetSpectralReflectance() const = 0;
    virtual int GetSpectralReflectanceCount() const = 0;
    // Null when index is not below GetTagCount().
    virtual const char* GetTag(unsigned int index) const = 0;
    virtual int GetTagCount() const = 0;

protected:
    ~IColorInformation() = default;
};

}  // namespace Pigmo
