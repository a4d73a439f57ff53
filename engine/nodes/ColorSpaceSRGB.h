#pragma once

#include <cstddef>

#include "ColorSpace.h"

// sRGB, gamma-encoded on 0..255; its XYZ is relative to the D65 white of the primaries.
class PIGMO_API cColorSpaceSRGB : public cColorSpace {
public:
    void ToXYZ(const double* in, double* out) override;
    // ToXYZ of many colors, each step over all of them: the colors' steps then overlap.
    void ToXYZ(const double (*in)[3], double (*xyz)[3], size_t count) const;
    void FromXYZ(const double* in, double* out) override;

    // Linear value of one gamma-encoded value on 0..1.
    static double DecodeSRGB(double c);
    // Gamma-encodes one linear value, clamped to 0..1.
    static double EncodeSRGB(double v);
    // The white the node reaches: XYZ of 255, 255, 255 normalised to Y = 1.
    static void White(double* white);
    // The primaries' matrices on linear values 0..1, shared with the linear node.
    static void LinearToXYZ(const double* rgb, double* xyz);
    static void XYZToLinear(const double* xyz, double* rgb);
};
