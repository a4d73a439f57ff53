#pragma once

// Isotemperature lines for correlated colour temperature: mired, CIE 1960 u and v on the
// Planckian locus, and the slope of the line.
struct RobertsonLine {
    double mired, u, v, slope;
};

inline constexpr int kRobertsonLineCount = 31;
extern const RobertsonLine kRobertsonLines[kRobertsonLineCount];
