#pragma once

#include "ColorSpace.h"

// Direct CIELAB to LCh for two descriptions of the same white.
class PIGMO_API cColorSpaceLabtoLch : public cColorSpace {
public:
    void ToXYZ(const double*, double*) override {}
    void FromXYZ(const double*, double*) override {}
    void Convert(const double* in, double* out) override;
};
