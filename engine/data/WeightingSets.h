#pragma once

#include <cstdint>

// Precomputed tristimulus weights for 10-nm bands from 360 to 780 nm (sums near 100).
inline constexpr int kFixedWeightingRows = 43;
inline constexpr double kFixedWeightingStart = 360.0, kFixedWeightingEnd = 780.0;

struct FixedWeightingSet {
    int32_t kind;                            // illuminant kind it belongs to
    double colorTemperature;                 // for daylight; 0 otherwise
    int32_t method;                          // weighting method that selects it
    double weights[3][kFixedWeightingRows];  // X, Y, Z
    double white[3];
};

inline constexpr int kFixedWeightingSetCount = 4;
extern const FixedWeightingSet kFixedWeightingSets[kFixedWeightingSetCount];
