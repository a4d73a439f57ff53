#pragma once

#include <cstdint>
#include <memory>
#include <vector>

#include "ColorSpaceStruct.h"
#include "Export.h"

// A block of doubles, rows by columns, row-major, with an optional description of its color space.
class PIGMO_API cDataCollection {
public:
    cDataCollection() = default;
    cDataCollection(int32_t rows, int32_t columns);
    cDataCollection(const cDataCollection& other);
    cDataCollection& operator=(const cDataCollection& other);
    virtual ~cDataCollection();

    // Returns 0. The contents are not kept when the element count grows.
    virtual int32_t Resize(int32_t rows, int32_t columns);

    int32_t Rows() const { return rows_; }
    int32_t Columns() const { return columns_; }
    double* Values() { return values_.data(); }
    const double* Values() const { return values_.data(); }
    double* Row(int32_t row) { return values_.data() + static_cast<size_t>(row) * columns_; }
    const double* Row(int32_t row) const { return values_.data() + static_cast<size_t>(row) * columns_; }
    double& At(int32_t row, int32_t column) { return Row(row)[column]; }
    double At(int32_t row, int32_t column) const { return Row(row)[column]; }

    const ColorSpaceStruct* Description() const { return description_.get(); }
    void SetDescription(const ColorSpaceStruct* description);  // clones; null clears

protected:
    int32_t rows_ = 0;
    int32_t columns_ = 0;
    int32_t capacity_ = 0;
    std::vector<double> values_;
    std::unique_ptr<ColorSpaceStruct> description_;
};

// Matrix form of a data collection, the operand type of cMathEngine and the batch metrics.
class PIGMO_API cMatrixDC : public cDataCollection {
public:
    using cDataCollection::cDataCollection;
};
