#pragma once

#include <cstdint>

// One ISCC-NBS centroid color. lab holds L*, a*, b* together so callers can take it as a triple.
struct IsccNbsCentroid {
    const char* name;
    double lab[3];
    int32_t category;  // 1-based
};

inline constexpr int32_t kIsccNbsCentroidCount = 267;
inline constexpr int32_t kIsccNbsCategoryCount = 19;

// In catalogue order (index 0 is centroid 1); each category is one contiguous run.
extern const IsccNbsCentroid kIsccNbsCentroids[kIsccNbsCentroidCount];
extern const char* const kIsccNbsCategoryNames[kIsccNbsCategoryCount];
