#pragma once

#include <cstdint>

// Tabulated whites (X and Z with Y = 1) of the common illuminants for the 1931 and 1964
// observers; a NaN cell is not tabulated and is computed instead.
struct RelativeWhiteRow {
    int32_t kind;
    double colorTemperature;  // daylight only; 0 otherwise
    double white2[2];         // X, Z, 2-degree observer
    double white10[2];        // X, Z, 10-degree observer
};

inline constexpr int kRelativeWhiteCount = 15;
extern const RelativeWhiteRow kRelativeWhites[kRelativeWhiteCount];
