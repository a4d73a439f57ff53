#pragma once

#include <cstddef>

#include "ColorSpace.h"
#include "ColorSpaceStruct.h"

// CIELAB relative to the white of its description.
class PIGMO_API cColorSpaceLab : public cColorSpace {
public:
    explicit cColorSpaceLab(const ColorSpaceStruct& description);
    void ToXYZ(const double* in, double* out) override;
    void FromXYZ(const double* in, double* out) override;
    // FromXYZ of many colors, each step over all of them: the colors' steps then overlap.
    void FromXYZ(const double (*xyz)[3], double (*lab)[3], size_t count) const;

    const double* White() const { return white_; }
    // fx, fy, fz of an L*, a*, b* triple.
    static void LabToF(const double* lab, double* f);
    // White-relative component of one f value; the caller supplies t cubed, as the nodes cube differently.
    static double InverseF(double t, double cube);

private:
    double white_[3];
};
