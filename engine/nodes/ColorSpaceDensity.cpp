#include "ColorSpaceDensity.h"

#include <algorithm>
#include <cmath>

#include "DensityWeights.h"
#include "IlluminantSampler.h"
#include "Interpolation.h"

cColorSpaceDensity::cColorSpaceDensity(const ColorSpaceStruct& destination, const ColorSpaceStruct& source) {
    const double start = source.wavelengthStart;
    const double end = source.wavelengthEnd;
    bandCount_ = ColorSpaceStruct::BandCount(start, end, source.wavelengthStep);

    if (destination.hasIlluminant) {
        reference_ = SampleIlluminant(destination.illuminant, SpectralIntegration::Direct, start,
                                      source.wavelengthStep, bandCount_);
    } else {
        reference_.assign(bandCount_, 1.0);
    }

    double wavelengths[kDensityWeightCount];
    for (int i = 0; i < kDensityWeightCount; ++i)
        wavelengths[i] = kDensityWeightStart + i * kDensityWeightStep;
    const double tableEnd = wavelengths[kDensityWeightCount - 1];
    for (int c = 0; c < kChannels; ++c) {
        const double* table = kDensityWeights[c];
        weights_[c].resize(bandCount_);
        for (int32_t k = 0; k < bandCount_; ++k) {
            const double lambda =
                bandCount_ == 1 ? start : start + (static_cast<double>(k) / (bandCount_ - 1)) * (end - start);
            double w = lambda < wavelengths[0] ? table[0]
                       : lambda > tableEnd
                           ? table[kDensityWeightCount - 1]
                           : LinearInterpolate(wavelengths, table, kDensityWeightCount, lambda);
            weights_[c][k] = std::clamp(w, 0.0, 1e20);
        }
    }
}

void cColorSpaceDensity::ToXYZ(const double*, double*) {}

void cColorSpaceDensity::FromXYZ(const double*, double*) {}

void cColorSpaceDensity::Convert(const double* in, double* out) {
    for (int c = 0; c < kChannels; ++c) {
        double density = 0.0;
        for (int32_t k = 0; k < bandCount_; ++k) {
            // A band the function does not weigh adds nothing, even where its reflectance is 0.
            if (weights_[c][k] != 0.0) density -= weights_[c][k] * std::log10(in[k] / reference_[k]);
        }
        out[c] = density;
    }
}
