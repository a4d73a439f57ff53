#pragma once

#include <algorithm>
#include <cmath>

namespace Pigmo::ColorMap {

// Truncation towards zero, as the controls compute pixels and color bytes, saturated far outside any
// window so that a wild value from a scene cannot overflow the conversion.
inline int Truncate(double value) {
    if (std::isnan(value)) return 0;
    return static_cast<int>(std::clamp(value, -1.0e9, 1.0e9));
}

}  // namespace Pigmo::ColorMap
