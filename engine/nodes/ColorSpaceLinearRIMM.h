#pragma once

#include "ColorSpace.h"

// Linear RIMM RGB (ROMM primaries, D50), unit scale both ways.
class PIGMO_API cColorSpaceLinearRIMM : public cColorSpace {
public:
    void ToXYZ(const double* in, double* out) override;
    void FromXYZ(const double* in, double* out) override;
};
