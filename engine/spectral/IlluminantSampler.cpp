#include "IlluminantSampler.h"

#include <algorithm>
#include <cmath>

#include "Interpolation.h"
#include "SpragueCoefficients.h"

namespace {

bool IsCoarseTableStep(double step) {
    return step == 10.0 || step == 5.0;
}

// Table value at index i, with two Sprague end-extrapolated values beyond each end.
double ExtendedValue(const std::vector<double>& v, int32_t i) {
    const int32_t n = static_cast<int32_t>(v.size());
    if (i >= 0 && i < n) return v[i];
    const bool low = i < 0;
    const int32_t beyond = low ? -i : i - n + 1;  // 1 inner, 2 outer
    const double* coefficients = kSpragueEnd[beyond == 2 ? 0 : 1];
    double sum = 0.0;
    for (int k = 0; k < 6; ++k) sum += coefficients[k] * v[low ? k : n - 1 - k];
    return sum / kSpragueEndDivisor;
}

double SpragueAt(const IlluminantStruct& il, int32_t wavelength) {
    const int32_t tableStart = static_cast<int32_t>(il.tableStart);
    const int32_t step = static_cast<int32_t>(il.tableStep);
    const int32_t n = static_cast<int32_t>(il.values.size());
    if (wavelength < tableStart) return il.values.front();
    if (wavelength >= tableStart + (n - 1) * step) return il.values.back();
    const int32_t q = (wavelength - tableStart) / step;
    const int32_t o = (wavelength - tableStart) % step;
    const double* row = kSpragueCoefficients[o * (10 / step)];
    double sum = 0.0;
    for (int k = 0; k < 6; ++k) sum += row[k] * ExtendedValue(il.values, q - 2 + k);
    return sum / kSpragueDivisor;
}

double LagrangeAt(const IlluminantStruct& il, double wavelength) {
    const int32_t n = static_cast<int32_t>(il.values.size());
    const double last = il.tableStart + (n - 1) * il.tableStep;
    if (wavelength < il.tableStart) return il.values.front();
    if (wavelength > last) return il.values.back();
    const int32_t index = static_cast<int32_t>((wavelength - il.tableStart) / il.tableStep);
    const int32_t window = std::min(std::max(index, 1), n - 3) - 1;
    double sum = 0.0;
    for (int m = 0; m < 4; ++m) {
        const double pm = il.tableStart + (window + m) * il.tableStep;
        double basis = 1.0;
        for (int j = 0; j < 4; ++j) {
            if (j == m) continue;
            const double pj = il.tableStart + (window + j) * il.tableStep;
            basis *= (wavelength - pj) / (pm - pj);
        }
        sum += basis * il.values[window + m];
    }
    return sum;
}

std::vector<double> SampleGeneral(const IlluminantStruct& il, double start, double step, int32_t count) {
    std::vector<double> out(count, 0.0);
    const int32_t n = static_cast<int32_t>(il.values.size());
    std::vector<double> tableWavelengths(n), derivatives(n);
    for (int32_t k = 0; k < n; ++k) tableWavelengths[k] = il.tableStart + k * il.tableStep;
    std::vector<double> targets(count);
    for (int32_t i = 0; i < count; ++i) targets[i] = start + i * step;
    if (PchipDerivatives(tableWavelengths.data(), il.values.data(), n, derivatives.data()) != 0) return out;
    const double tableEnd = tableWavelengths[n - 1];
    for (int32_t i = 0; i < count; ++i) {
        if (targets[i] >= il.tableStart && targets[i] <= tableEnd) {
            PchipEvaluate(tableWavelengths.data(), il.values.data(), derivatives.data(), n, &targets[i], 1,
                          &out[i]);
        }
    }
    if (il.tableStep >= step || count < 2) return out;

    // A coarser target grid would miss the table's lines between its samples (emission lines of
    // the fluorescent lamps): each line's excess over the interpolation goes to the two nearest
    // samples in proportion to its nearness, so that no power is lost or moved away.
    const std::vector<double> uncorrected = out;
    for (int32_t k = 0; k < n; ++k) {
        const double lambda = tableWavelengths[k];
        const double excess =
            il.values[k] - LinearInterpolate(targets.data(), uncorrected.data(), count, lambda);
        for (int32_t i = 0; i < count; ++i) {
            const double distance = std::fabs(lambda - targets[i]);
            if (distance < step) out[i] += excess * (il.tableStep / step) * (1.0 - distance / step);
        }
    }
    return out;
}

}  // namespace

std::vector<double> SampleIlluminant(const IlluminantStruct& il, SpectralIntegration mode, double start,
                                     double step, int32_t count) {
    if (count <= 0) return {};
    if (il.kind == 0 || il.values.empty()) return std::vector<double>(count, 100.0);

    const bool kernelMode = mode == SpectralIntegration::Sprague || mode == SpectralIntegration::Lagrange;
    const int32_t n = static_cast<int32_t>(il.values.size());
    // The kernels need the grid on whole nanometres of the table's own grid; otherwise (or with
    // too short a table) the general sampler takes over rather than leaving values unset.
    const double offset = start - il.tableStart;
    const bool onTableGrid = start == std::floor(start) && il.tableStart == std::floor(il.tableStart) &&
                             std::fmod(offset, il.tableStep) == 0.0;
    const int32_t minimum = mode == SpectralIntegration::Sprague ? 6 : 4;
    if (kernelMode && step == 1.0 && IsCoarseTableStep(il.tableStep) && onTableGrid && n >= minimum) {
        std::vector<double> out(count);
        for (int32_t i = 0; i < count; ++i) {
            const double wavelength = start + i;
            out[i] = mode == SpectralIntegration::Sprague ? SpragueAt(il, static_cast<int32_t>(wavelength))
                                                          : LagrangeAt(il, wavelength);
        }
        return out;
    }
    return SampleGeneral(il, start, step, count);
}
