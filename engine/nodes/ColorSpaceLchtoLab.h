#pragma once

#include "ColorSpace.h"

// Direct LCh to CIELAB for two descriptions of the same white.
class PIGMO_API cColorSpaceLchtoLab : public cColorSpace {
public:
    void ToXYZ(const double*, double*) override {}
    void FromXYZ(const double*, double*) override {}
    void Convert(const double* in, double* out) override;
};
