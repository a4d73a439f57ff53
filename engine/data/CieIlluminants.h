#pragma once

// Relative spectral power tables of the built-in illuminants (evenly spaced, nm).
inline constexpr double kIlluminantD50Start = 300.0, kIlluminantD50Step = 5.0;
inline constexpr int kIlluminantD50Count = 107;
inline constexpr double kIlluminantD65Start = 300.0, kIlluminantD65Step = 1.0;
inline constexpr int kIlluminantD65Count = 531;
inline constexpr double kIlluminantCStart = 320.0, kIlluminantCStep = 5.0;
inline constexpr int kIlluminantCCount = 103;
inline constexpr double kFluorescentStart = 380.0, kFluorescentStep = 5.0;
inline constexpr int kFluorescentCount = 81;
// Rows: F1, F2, F3, F7, F8, F9, F10, F11, F12.
inline constexpr int kFluorescentTableCount = 9;

extern const double kIlluminantD50[kIlluminantD50Count];
extern const double kIlluminantD65[kIlluminantD65Count];
extern const double kIlluminantC[kIlluminantCCount];
extern const double kIlluminantF[kFluorescentTableCount][kFluorescentCount];
