#include "ColorSpaceSpectral.h"

#include <algorithm>
#include <cmath>

#include "IlluminantSampler.h"
#include "Interpolation.h"
#include "ObserverSampler.h"
#include "SpragueCoefficients.h"
#include "WeightingSets.h"

namespace {

constexpr double kFirstSampleWavelength = 360.0;  // first wavelength of the colour-matching tables
constexpr double kSampleSpan = 470.0;             // 360 to 830 nm
constexpr double kEmissiveFactor = 68.3;          // lm/W over the unit radiance scale used here

bool IsKernelStep(double step) {
    return step == 10.0 || step == 5.0;
}

std::vector<double> EvenGrid(double start, double step, int32_t count) {
    std::vector<double> grid(static_cast<size_t>(std::max(count, 0)));
    for (int32_t i = 0; i < count; ++i) grid[i] = start + i * step;
    return grid;
}

// The precomputed set for reflectance under the description's own light on 10-nm bands that fall
// on the sets' rows, with the 2-degree observer; null when there is none.
const FixedWeightingSet* FixedSetFor(const ColorSpaceStruct& source) {
    const double firstRow = (source.wavelengthStart - kFixedWeightingStart) / 10.0;
    if (source.emissive || !source.hasIlluminant || source.observer != 0 ||
        std::fabs(source.wavelengthStep - 10.0) > 1e-8 || std::fabs(firstRow - std::round(firstRow)) > 1e-8) {
        return nullptr;
    }
    const IlluminantStruct& il = source.illuminant;
    for (const FixedWeightingSet& set : kFixedWeightingSets) {
        if (set.kind == il.kind && set.method == source.weighting &&
            (il.Kind() != IlluminantKind::Daylight ||
             std::fabs(il.colorTemperature - set.colorTemperature) <= 1e-4)) {
            return &set;
        }
    }
    return nullptr;
}

// Adds amount to a band, spreading what falls on the two virtual bands beyond either end over
// the six nearest real bands as Sprague's end extrapolation does.
void AddToBand(std::vector<double>& weights, int32_t band, double amount) {
    const int32_t n = static_cast<int32_t>(weights.size());
    if (band >= 0 && band < n) {
        weights[band] += amount;
        return;
    }
    const bool low = band < 0;
    const int32_t beyond = low ? -band : band - (n - 1);
    const double* spread = kSpragueEnd[beyond == 2 ? 0 : 1];
    for (int k = 0; k < 6; ++k) weights[low ? k : n - 1 - k] += amount * spread[k] / kSpragueEndDivisor;
}

}  // namespace

SpectralIntegration cColorSpaceSpectral::IntegrationFor(const ColorSpaceStruct& source) {
    using enum SpectralIntegration;
    // The kernels reduce 1-nm weights onto 5- or 10-nm bands that start on a whole nanometre;
    // Sprague's end extrapolation also reads six bands.
    const double offset = source.wavelengthStart - kFirstSampleWavelength;
    const bool kernelGrid =
        IsKernelStep(source.wavelengthStep) && std::fabs(offset - std::trunc(offset)) <= 1e-10;
    const bool sprague =
        kernelGrid &&
        ColorSpaceStruct::BandCount(source.wavelengthStart, source.wavelengthEnd, source.wavelengthStep) >= 6;
    switch (static_cast<WeightingMethod>(source.weighting)) {
        case WeightingMethod::OneNanometre:
            return OneNanometre;
        case WeightingMethod::FixedTableA:
        case WeightingMethod::FixedTableB:
            // Without a matching set the weights are computed, by Sprague where its kernel applies.
            if (FixedSetFor(source)) return FixedTable;
            return sprague ? Sprague : OneNanometre;
        case WeightingMethod::Sprague:
            return sprague ? Sprague : OneNanometre;
        case WeightingMethod::Lagrange:
            return kernelGrid ? Lagrange : OneNanometre;
        default:
            return Direct;
    }
}

cColorSpaceSpectral::cColorSpaceSpectral(const ColorSpaceStruct& source, const ColorSpaceStruct& destination)
    : mode_(IntegrationFor(source)) {
    emissive_ = source.emissive;
    start_ = source.wavelengthStart;
    end_ = source.wavelengthEnd;
    sourceStep_ = source.wavelengthStep;
    sourceBandCount_ = ColorSpaceStruct::BandCount(start_, end_, sourceStep_);

    sameGrid_ = destination.wavelengthStart == start_ && destination.wavelengthEnd == end_ &&
                destination.wavelengthStep == sourceStep_;
    sourceGrid_ = EvenGrid(start_, sourceStep_, sourceBandCount_);
    if (!sameGrid_) {
        destinationGrid_ =
            EvenGrid(destination.wavelengthStart, destination.wavelengthStep,
                     ColorSpaceStruct::BandCount(destination.wavelengthStart, destination.wavelengthEnd,
                                                 destination.wavelengthStep));
    }
    // Scratch for the monotone cubic, shared by every resampling between these grids.
    derivatives_.resize(std::max(sourceGrid_.size(), destinationGrid_.size()));

    if (emissive_) {
        // Equal energy gives equal X, Y and Z only through the functions it is computed with.
        illuminant_.observer = source.observer;
        illuminant_.observerAge = source.observerAge;
        illuminant_.fieldSize = source.fieldSize;
        illuminant_.SetIlluminant(IlluminantKind::E, 0.0);
    } else if (source.hasIlluminant) {
        illuminant_ = source.illuminant;
    }

    workingStep_ = mode_ == SpectralIntegration::Direct ? sourceStep_ : 1.0;
    // A reversed, empty or degenerate grid leaves the node inert.
    if (end_ == start_ || !(sourceStep_ > 0.0) || sourceBandCount_ <= 0) {
        workingBandCount_ = 0;
        return;
    }
    workingBandCount_ = ColorSpaceStruct::BandCount(start_, end_, workingStep_);

    if (mode_ == SpectralIntegration::FixedTable) {
        UseFixedTable(*FixedSetFor(source));
        workingStep_ = sourceStep_;
        return;
    }

    illuminant_.observer = source.observer;

    // The sample grid: the colour-matching range 360 to 830 nm, shifted onto the bands' phase.
    int32_t sampleCount = static_cast<int32_t>(kSampleSpan / workingStep_ + 1.0);
    const double offset = start_ - kFirstSampleWavelength;
    const double phase = offset - std::trunc(offset / workingStep_) * workingStep_;
    if (phase > 0.0) --sampleCount;
    const double gridStart = kFirstSampleWavelength + phase;
    const std::vector<double> illuminant =
        SampleIlluminant(illuminant_, mode_, gridStart, workingStep_, sampleCount);

    if (mode_ == SpectralIntegration::Sprague || mode_ == SpectralIntegration::Lagrange) {
        BuildByReduction(source, gridStart, sampleCount, illuminant);
    } else {
        BuildOnSampleGrid(source, gridStart, sampleCount, illuminant);
    }

    double sums[3];
    for (int c = 0; c < 3; ++c) {
        sums[c] = 0.0;
        for (double w : weights_[c].weights) sums[c] += w;
    }
    // A channel without weight (too few bands for the kernel, a function outside the grid)
    // stays 0 instead of dividing by zero.
    scale_[1] = sums[1] != 0.0 ? 1.0 / sums[1] : 0.0;
    scale_[0] = sums[0] != 0.0 ? illuminant_.relativeWhite[0] / sums[0] : 0.0;
    scale_[2] = sums[2] != 0.0 ? illuminant_.relativeWhite[2] / sums[2] : 0.0;

    if (mode_ == SpectralIntegration::OneNanometre) {
        workingWavelengths_ = EvenGrid(start_, workingStep_, workingBandCount_);
        resampled_.resize(workingBandCount_);
    }
}

void cColorSpaceSpectral::UseFixedTable(const FixedWeightingSet& set) {
    // Rows outside the measured bands are carried by the end bands.
    const int32_t rowOffset = static_cast<int32_t>(std::lround((start_ - kFixedWeightingStart) / 10.0));
    for (int c = 0; c < 3; ++c) {
        WeightVector& vector = weights_[c];
        vector.weights.assign(sourceBandCount_, 0.0);
        vector.first = 0;
        vector.last = sourceBandCount_ - 1;
        for (int32_t row = 0; row < kFixedWeightingRows; ++row) {
            const int32_t band = std::clamp(row - rowOffset, 0, sourceBandCount_ - 1);
            vector.weights[band] += set.weights[c][row];
        }
        scale_[c] = 0.01;
    }
}

void cColorSpaceSpectral::BuildOnSampleGrid(const ColorSpaceStruct& source, double gridStart,
                                            int32_t gridCount, const std::vector<double>& illuminant) {
    const int32_t shift = static_cast<int32_t>(std::lround((gridStart - start_) / workingStep_));
    const ObserverFunctions functions = SampleObserver(source.observer, source.observerAge, source.fieldSize,
                                                       gridStart, workingStep_, gridCount, true);
    for (int c = 0; c < 3; ++c) {
        const SampledFunction& f = functions[c];
        WeightVector& vector = weights_[c];
        if (f.last < f.first) continue;
        vector.first = std::max(f.first + shift, 0);
        vector.last = std::min(f.last + shift, workingBandCount_ - 1);
        if (vector.first > vector.last) {
            // The whole function lies beyond one end of the bands: that end band carries it.
            vector.first = vector.last = f.last + shift < 0 ? 0 : workingBandCount_ - 1;
        }
        vector.weights.assign(vector.last - vector.first + 1, 0.0);
        for (int32_t j = f.first; j <= f.last; ++j) {
            const int32_t band = std::clamp(j + shift, vector.first, vector.last);
            vector.weights[band - vector.first] += f.values[j - f.first] * illuminant[j];
        }
    }
}

void cColorSpaceSpectral::BuildByReduction(const ColorSpaceStruct& source, double gridStart,
                                           int32_t gridCount, const std::vector<double>& illuminant) {
    const ObserverFunctions functions = SampleObserver(source.observer, source.observerAge, source.fieldSize,
                                                       gridStart, 1.0, gridCount, false);
    for (int c = 0; c < 3; ++c) {
        const SampledFunction& f = functions[c];
        std::vector<double> product(gridCount);
        for (int32_t j = 0; j < gridCount; ++j) product[j] = illuminant[j] * f.values[j];
        WeightVector& vector = weights_[c];
        vector.weights.assign(sourceBandCount_, 0.0);
        if (mode_ == SpectralIntegration::Sprague) {
            ReduceSprague(product, gridStart, vector.weights);
        } else {
            ReduceLagrange(product, gridStart, vector.weights);
        }
        vector.first = 0;
        vector.last = sourceBandCount_ - 1;
    }
    workingStep_ = sourceStep_;
}

void cColorSpaceSpectral::ReduceSprague(const std::vector<double>& product, double gridStart,
                                        std::vector<double>& weights) const {
    const int32_t n = static_cast<int32_t>(weights.size());
    const int32_t step = static_cast<int32_t>(sourceStep_);
    const int32_t rowStride = 10 / step;
    const int32_t startNm = static_cast<int32_t>(std::lround(start_));
    const int32_t firstNm = static_cast<int32_t>(std::lround(gridStart));
    for (size_t j = 0; j < product.size(); ++j) {
        const int32_t d = firstNm + static_cast<int32_t>(j) - startNm;
        const double p = product[j];
        if (d <= 0) {
            weights[0] += p * kSpragueDivisor;
            continue;
        }
        const int32_t q = d / step;
        if (q > n - 2) {
            weights[n - 1] += p * kSpragueDivisor;
            continue;
        }
        const double* row = kSpragueCoefficients[(d % step) * rowStride];
        for (int k = 0; k < 6; ++k) {
            if (row[k] != 0.0) AddToBand(weights, q - 2 + k, row[k] * p);
        }
    }
    for (double& w : weights) w /= kSpragueDivisor;
}

void cColorSpaceSpectral::ReduceLagrange(const std::vector<double>& product, double gridStart,
                                         std::vector<double>& weights) const {
    const int32_t n = static_cast<int32_t>(weights.size());
    if (n < 4) return;  // no cubic through fewer than four bands: the weights stay 0
    const int32_t step = static_cast<int32_t>(sourceStep_);
    const int32_t startNm = static_cast<int32_t>(std::lround(start_));
    const int32_t firstNm = static_cast<int32_t>(std::lround(gridStart));
    for (size_t j = 0; j < product.size(); ++j) {
        const double lambda = firstNm + static_cast<double>(j);
        const int32_t base = (firstNm + static_cast<int32_t>(j) - startNm) / step - 1;
        double nodes[4];
        for (int m = 0; m < 4; ++m) nodes[m] = start_ + (base + m) * sourceStep_;
        for (int m = 0; m < 4; ++m) {
            double basis = 1.0;
            for (int k = 0; k < 4; ++k) {
                if (k != m) basis *= (lambda - nodes[k]) / (nodes[m] - nodes[k]);
            }
            weights[std::clamp(base + m, 0, n - 1)] += product[j] * basis;
        }
    }
}

void cColorSpaceSpectral::Resample(const std::vector<double>& from, const std::vector<double>& to,
                                   const double* in, double* out) {
    const int32_t n = static_cast<int32_t>(from.size());
    const int32_t m = static_cast<int32_t>(to.size());
    if (n == 0) return;
    if (n == 1 || PchipDerivatives(from.data(), in, n, derivatives_.data()) != 0) {
        std::fill(out, out + m, in[0]);  // one band: a flat spectrum
        return;
    }
    PchipEvaluate(from.data(), in, derivatives_.data(), n, to.data(), m, out);
}

void cColorSpaceSpectral::ToXYZ(const double* in, double* out) {
    if (workingBandCount_ == 0) return;
    const double* values = in;
    if (mode_ == SpectralIntegration::OneNanometre) {
        Resample(sourceGrid_, workingWavelengths_, in, resampled_.data());
        values = resampled_.data();
    }
    for (int c = 0; c < 3; ++c) {
        const WeightVector& vector = weights_[c];
        double sum = 0.0;
        for (int32_t b = vector.first; b <= vector.last; ++b)
            sum += vector.weights[b - vector.first] * values[b];
        out[c] = scale_[c] * sum;
    }
    if (emissive_) {
        for (int c = 0; c < 3; ++c) out[c] *= kEmissiveFactor;
    }
}

void cColorSpaceSpectral::FromXYZ(const double*, double*) {}

void cColorSpaceSpectral::ToSpectral(const double* in, double* out) {
    if (sameGrid_) {
        std::copy(in, in + std::max(sourceBandCount_, 0), out);
    } else {
        Resample(sourceGrid_, destinationGrid_, in, out);
    }
}

void cColorSpaceSpectral::FromSpectral(const double* in, double* out) {
    if (sameGrid_) {
        std::copy(in, in + std::max(sourceBandCount_, 0), out);
    } else {
        Resample(destinationGrid_, sourceGrid_, in, out);
    }
}
