#pragma once

#include <cstdint>
#include <vector>

#include "ColorSpace.h"
#include "ColorSpaceStruct.h"
#include "IlluminantStruct.h"

struct FixedWeightingSet;

// How the spectral node turns bands into tristimulus values.
enum class SpectralIntegration : int32_t {
    Direct = 0,        // weights on the band grid itself
    OneNanometre = 1,  // spectrum resampled to 1 nm, weights at 1 nm
    Sprague = 2,       // 1-nm weights reduced onto the bands with Sprague coefficients
    Lagrange = 3,      // the same with cubic Lagrange coefficients
    FixedTable = 4,    // a precomputed 10-nm weighting set
};

// Sampled spectrum to CIE XYZ through tristimulus weights fixed at construction, normalised so
// that the perfect diffuser gives the illuminant's relative white with Y = 1; also resamples
// spectra between the source and the destination wavelength grids.
class PIGMO_API cColorSpaceSpectral : public cColorSpace {
public:
    cColorSpaceSpectral(const ColorSpaceStruct& source, const ColorSpaceStruct& destination);

    // How spectra of a description are integrated: decided here alone, from the description.
    static SpectralIntegration IntegrationFor(const ColorSpaceStruct& source);

    void ToXYZ(const double* in, double* out) override;
    void FromXYZ(const double* in, double* out) override;  // not invertible: leaves out untouched
    void ToSpectral(const double* in, double* out) override;
    void FromSpectral(const double* in, double* out) override;

    SpectralIntegration Mode() const { return mode_; }
    int32_t WorkingBandCount() const { return workingBandCount_; }
    const IlluminantStruct& Illuminant() const { return illuminant_; }
    // Normalisation factor of channel 0 (X), 1 (Y) or 2 (Z); 0 for a channel without weight.
    double Scale(int channel) const { return scale_[channel]; }

private:
    struct WeightVector {
        std::vector<double> weights;  // weights[i] applies to band first + i
        int32_t first = 0;
        int32_t last = -1;
    };

    void UseFixedTable(const FixedWeightingSet& set);
    void BuildOnSampleGrid(const ColorSpaceStruct& source, double gridStart, int32_t gridCount,
                           const std::vector<double>& illuminant);
    void BuildByReduction(const ColorSpaceStruct& source, double gridStart, int32_t gridCount,
                          const std::vector<double>& illuminant);
    void ReduceSprague(const std::vector<double>& product, double gridStart,
                       std::vector<double>& weights) const;
    void ReduceLagrange(const std::vector<double>& product, double gridStart,
                        std::vector<double>& weights) const;
    void Resample(const std::vector<double>& from, const std::vector<double>& to, const double* in,
                  double* out);

    int32_t workingBandCount_ = 0;
    int32_t sourceBandCount_ = 0;
    double sourceStep_ = 0.0;
    double start_ = 0.0;
    double end_ = 0.0;
    double workingStep_ = 0.0;
    WeightVector weights_[3];            // X, Y, Z
    double scale_[3] = {0.0, 0.0, 0.0};  // X, Y, Z
    std::vector<double> workingWavelengths_;
    std::vector<double> derivatives_;
    std::vector<double> resampled_;
    bool emissive_ = false;
    bool sameGrid_ = false;
    std::vector<double> sourceGrid_;
    std::vector<double> destinationGrid_;
    IlluminantStruct illuminant_;
    SpectralIntegration mode_;
};
