#pragma once

#include "ColorSpaceLab.h"

// CIE LCh(ab) relative to the white of its description; hue in degrees.
class PIGMO_API cColorSpaceLch : public cColorSpace {
public:
    explicit cColorSpaceLch(const ColorSpaceStruct& description);
    void ToXYZ(const double* in, double* out) override;
    void FromXYZ(const double* in, double* out) override;

private:
    cColorSpaceLab lab_;
};
