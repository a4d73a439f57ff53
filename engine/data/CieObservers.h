#pragma once

// Colour-matching functions at 1 nm from 360 nm. z-bar is kept only while the CIE tabulates it
// above zero (1931: to 649 nm, 1964: to 559 nm); the sampler extends each table past its end.
inline constexpr double kCmfStart = 360.0;
inline constexpr int kCie1931XYCount = 471;
inline constexpr int kCie1931ZCount = 290;
inline constexpr int kCie1964XYCount = 471;
inline constexpr int kCie1964ZCount = 200;

extern const double kCie1931X[kCie1931XYCount];
extern const double kCie1931Y[kCie1931XYCount];
extern const double kCie1931Z[kCie1931ZCount];
extern const double kCie1964X[kCie1964XYCount];
extern const double kCie1964Y[kCie1964XYCount];
extern const double kCie1964Z[kCie1964ZCount];
