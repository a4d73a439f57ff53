#pragma once

#include "ColorSpace.h"

// CIE XYZ with Y of the white = 1: the connection space itself.
class PIGMO_API cColorSpaceXYZ : public cColorSpace {
public:
    void ToXYZ(const double* in, double* out) override;
    void FromXYZ(const double* in, double* out) override;
};
