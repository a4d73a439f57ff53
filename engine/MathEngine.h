#pragma once

#include "DataCollection.h"
#include "Export.h"

// Stateless matrix operations on cMatrixDC; used through the one global instance.
class PIGMO_API cMathEngine {
public:
    virtual ~cMathEngine();
    // result = a * b, resized to a.Rows() x b.Columns().
    virtual bool Product(const cMatrixDC& a, const cMatrixDC& b, cMatrixDC& result) const;
    // Element-wise power with an exponent matrix of the same shape.
    virtual bool Power(const cMatrixDC& a, const cMatrixDC& exponents, cMatrixDC& result) const;
    virtual bool Power(const cMatrixDC& a, double exponent, cMatrixDC& result) const;
    virtual bool Exp(const cMatrixDC& a, cMatrixDC& result) const;
    virtual bool Sqrt(const cMatrixDC& a, cMatrixDC& result) const;
    virtual double FrobeniusNorm(const cMatrixDC& a) const;
};

PIGMO_API extern const cMathEngine theMathEngine;
