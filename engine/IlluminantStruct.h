#pragma once

#include <cstdint>
#include <vector>

#include "Export.h"

// Light source of spectral evaluation: its spectral power table and the white it produces.
struct PIGMO_API IlluminantStruct {
    int32_t kind = 0;  // 0 none, 1 daylight, 2 Planckian, 3 A, 5 C, 6 E, 7-9 F1-F3, 13-18 F7-F12
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
    void SetIlluminant(int32_t kind, double temperature);
};
