#pragma once

#include <cstdint>

#include "IlluminantStruct.h"

// Fills a record for an illuminant kind: its spectral power table, then its relative white
// (from the white table for the 1931 and 1964 observers where tabulated, otherwise computed from
// the table with the record's observer, in which case colorTemperature becomes the correlated
// colour temperature of that white). Kinds without data become kind 0.
void ApplyIlluminant(IlluminantStruct& record, int32_t kind, double temperature);

// Correlated colour temperature of a white by Robertson's isotemperature lines. previous is
// returned when the white lies beyond the lines; a white of X + Y + Z = 0 gives 5004 K.
double RobertsonTemperature(const double white[3], double previous);
