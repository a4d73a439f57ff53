#pragma once

// Weighting functions of red, green, blue and visual density, 380 to 780 nm at 10 nm.
inline constexpr int kDensityChannelCount = 4;
inline constexpr int kDensityWeightCount = 41;
inline constexpr double kDensityWeightStart = 380.0, kDensityWeightStep = 10.0;

extern const double kDensityWeights[kDensityChannelCount][kDensityWeightCount];
