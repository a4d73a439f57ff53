#pragma once

#include <array>
#include <cstdint>
#include <vector>

// One colour-matching function on an evenly spaced target grid. values[i] belongs to target
// index first + i; without trimming first is 0 and last is count - 1.
struct SampledFunction {
    std::vector<double> values;
    int32_t first = 0;
    int32_t last = -1;
};

// x-bar, y-bar, z-bar.
using ObserverFunctions = std::array<SampledFunction, 3>;

// The functions of observer 0 (CIE 1931 2-degree), 1 (CIE 1964 10-degree) or 2 (CIE 2006
// physiological observer of the given age and field size). Beyond its table a function continues
// its end segment, never below 0. With trim set only the positive stretch is kept; a function
// without positive values comes back empty (last < first).
ObserverFunctions SampleObserver(int32_t observer, double age, double fieldSize, double start, double step,
                                 int32_t count, bool trim);
