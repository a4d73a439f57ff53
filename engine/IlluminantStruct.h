#pragma once

#include <cstdint>
#include <vector>

#include "Export.h"

// Kinds of light source, with their stored values.
enum class IlluminantKind : int32_t {
    None = 0,
    Daylight = 1,  // CIE daylight at a color temperature
    Planckian = 2,
    A = 3,
    B = 4,  // no data: becomes None
    C = 5,
    E = 6,
    F1 = 7,
    F2 = 8,
    F3 = 9,
    F4 = 10,  // F4 to F6: no data, become None
    F5 = 11,
    F6 = 12,
    F7 = 13,
    F8 = 14,
    F9 = 15,
    F10 = 16,
    F11 = 17,
    F12 = 18,
};

// Light source of spectral evaluation: its spectral power table and the white it produces.
struct PIGMO_API IlluminantStruct {
    int32_t kind = 0;  // an IlluminantKind
    double colorTemperature = 0.0;
    double tableStart = 0.0;
    double tableEnd = 0.0;
    double tableStep = 0.0;
    int32_t valueCount = 0;
    std::vector<double> values;
    double relativeWhite[3] = {1.0, 1.0, 1.0};
    int32_t observer = 0;
    double observerAge = 32.0;
    double fieldSize = 2.0;

    // Exact comparison of the defining fields; the relative white is derived and not compared,
    // and a record without values equals one with values when the other fields agree.
    bool operator==(const IlluminantStruct& other) const;
    bool operator!=(const IlluminantStruct& other) const { return !(*this == other); }

    // Becomes the illuminant of a kind (daylight and Planckian at temperature kelvin) with its
    // spectral power table and its relative white for this record's observer; kinds without
    // data become 0. A computed white replaces the temperature by its correlated temperature.
    void SetIlluminant(IlluminantKind kind, double temperature);
    IlluminantKind Kind() const { return static_cast<IlluminantKind>(kind); }
};
