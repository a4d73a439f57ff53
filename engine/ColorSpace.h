#pragma once

#include "Export.h"

// A conversion node: converts one color between its space and the connection space,
// CIE XYZ relative to a white of Y = 1, or directly between two spaces (Convert).
// Operations that a node does not implement leave the output untouched.
class PIGMO_API cColorSpace {
public:
    virtual ~cColorSpace();
    virtual void ToXYZ(const double* in, double* out) = 0;
    virtual void FromXYZ(const double* in, double* out) = 0;
    virtual void ToSpectral(const double* in, double* out);
    virtual void FromSpectral(const double* in, double* out);
    virtual void ToComponents(const double* in, double* out);
    virtual void FromComponents(const double* in, double* out);
    virtual void Convert(const double* in, double* out);

    // Shared by the LCh node, the direct nodes and the appearance nodes; both may work in place.
    static void LabToLch(const double* in, double* out);
    static void LchToLab(const double* in, double* out);
};
