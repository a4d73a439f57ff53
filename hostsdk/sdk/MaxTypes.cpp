#include "maxtypes.h"

#include <algorithm>

Interval& Interval::operator&=(const Interval& other) {
    if (Empty() || other.Empty()) {
        SetEmpty();
        return *this;
    }
    start_ = std::max(start_, other.start_);
    end_ = std::min(end_, other.end_);
    if (start_ > end_) SetEmpty();
    return *this;
}

void Matrix3::IdentityMatrix() {
    for (int row = 0; row < 4; ++row)
        for (int column = 0; column < 3; ++column) rows_[row][column] = row == column ? 1.0f : 0.0f;
}

bool Matrix3::IsIdentity() const {
    for (int row = 0; row < 4; ++row)
        for (int column = 0; column < 3; ++column)
            if (rows_[row][column] != (row == column ? 1.0f : 0.0f)) return false;
    return true;
}
