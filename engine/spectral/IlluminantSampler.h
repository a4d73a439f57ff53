#pragma once

#include <cstdint>
#include <vector>

#include "ColorSpaceSpectral.h"
#include "IlluminantStruct.h"

// The illuminant's power at start + i * step for i < count. Kind 0 is 100 everywhere. Sprague
// and Lagrange modes interpolate a 5- or 10-nm table to whole nanometres with their own
// kernels when the grid is the table's 1-nm refinement; everything else takes the monotone
// cubic, 0 outside the table, corrected for table lines between coarser target samples.
std::vector<double> SampleIlluminant(const IlluminantStruct& illuminant, SpectralIntegration mode,
                                     double start, double step, int32_t count);
