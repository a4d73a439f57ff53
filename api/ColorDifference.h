#pragma once

#include <memory>

#include "DataCollection.h"
#include "Export.h"

// A color-difference formula over CIELAB triples (L*, a*, b*). Batch operations take one color per
// row in the first three columns and stop at the smaller row count of the two inputs.
class PIGMO_API cDeltaEBase {
public:
    virtual ~cDeltaEBase();

    // Difference of a sample from a reference; asymmetric formulas weight by the reference.
    virtual double CalculateDeltaE(const double* reference, const double* sample) const = 0;
    // One row per compared pair, one column.
    virtual cMatrixDC CalculateDeltaEPerRow(const cMatrixDC& reference, const cMatrixDC& sample) const;
    // As above, on copies first passed through a CIELAB-to-CIELAB conversion engine.
    virtual cMatrixDC CalculateDeltaEPerRowConverted(const cMatrixDC& reference,
                                                     const cMatrixDC& sample) const;
    // Mean over the compared rows; NaN when there are none.
    virtual double CalculateMeanDeltaE(const cMatrixDC& reference, const cMatrixDC& sample) const;
    virtual double CalculateMeanDeltaEConverted(const cMatrixDC& reference, const cMatrixDC& sample) const;
    virtual std::unique_ptr<cDeltaEBase> Clone() const = 0;

protected:
    // Rows both inputs can supply a full triple for.
    static int32_t ComparableRows(const cMatrixDC& reference, const cMatrixDC& sample);
};

// CIE76: Euclidean distance in CIELAB.
class PIGMO_API cCIE1976ColorDifference : public cDeltaEBase {
public:
    double CalculateDeltaE(const double* reference, const double* sample) const override;
    cMatrixDC CalculateDeltaEPerRow(const cMatrixDC& reference, const cMatrixDC& sample) const override;
    std::unique_ptr<cDeltaEBase> Clone() const override;
};

// CMC l:c, weighted by the reference color.
class PIGMO_API cCMCColorDifference : public cDeltaEBase {
public:
    cCMCColorDifference(double l, double c) : l_(l), c_(c) {}
    double CalculateDeltaE(const double* reference, const double* sample) const override;
    std::unique_ptr<cDeltaEBase> Clone() const override;

private:
    double l_;
    double c_;
};

// CIE94 with the graphic-arts constants, weighted by the reference color.
class PIGMO_API cCIE1994ColorDifference : public cDeltaEBase {
public:
    cCIE1994ColorDifference(double kL, double kC, double kH) : kL_(kL), kC_(kC), kH_(kH) {}
    double CalculateDeltaE(const double* reference, const double* sample) const override;
    std::unique_ptr<cDeltaEBase> Clone() const override;

private:
    double kL_;
    double kC_;
    double kH_;
    double K1_ = 0.045;
    double K2_ = 0.015;
};

// CIEDE2000.
class PIGMO_API cCIEDE2000 : public cDeltaEBase {
public:
    cCIEDE2000(double kL, double kC, double kH) : kL_(kL), kC_(kC), kH_(kH) {}
    double CalculateDeltaE(const double* reference, const double* sample) const override;
    std::unique_ptr<cDeltaEBase> Clone() const override;

private:
    double kL_;
    double kC_;
    double kH_;
};
