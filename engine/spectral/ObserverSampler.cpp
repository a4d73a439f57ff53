#include "ObserverSampler.h"

#include <algorithm>
#include <cmath>

#include "Cie2006Inputs.h"
#include "CieObservers.h"
#include "Interpolation.h"
#include "Matrix3.h"

namespace {

// Samples a table at the target grid by linear interpolation; negatives become 0.
SampledFunction SampleTable(const double* wavelengths, const double* table, int32_t n, double start,
                            double step, int32_t count, bool trim) {
    std::vector<double> all(static_cast<size_t>(std::max(count, 0)));
    for (int32_t i = 0; i < count; ++i) {
        all[i] = std::max(LinearInterpolate(wavelengths, table, n, start + i * step), 0.0);
    }
    SampledFunction result;
    if (!trim) {
        result.values = std::move(all);
        result.last = count - 1;
        return result;
    }
    int32_t first = 0;
    while (first < count && !(all[first] > 0.0)) ++first;
    int32_t last = count - 1;
    while (last >= first && !(all[last] > 0.0)) --last;
    result.first = first;
    result.last = last;
    if (last >= first) result.values.assign(all.begin() + first, all.begin() + last + 1);
    return result;
}

SampledFunction SampleStandard(const double* table, int32_t n, double start, double step, int32_t count,
                               bool trim) {
    std::vector<double> wavelengths(n);
    for (int32_t i = 0; i < n; ++i) wavelengths[i] = kCmfStart + i;
    return SampleTable(wavelengths.data(), table, n, start, step, count, trim);
}

}  // namespace

std::vector<double> Cie2006ColorMatchingFunctions(double age, double fieldSize) {
    const double field = std::clamp(fieldSize, 1.0, 10.0);
    const double peakLM = 0.38 + 0.54 * std::exp(-field / 1.333);
    const double peakS = 0.30 + 0.45 * std::exp(-field / 1.333);
    const double macularPeak = 0.485 * std::exp(-field / 6.132);
    const double lensScale = age <= 60.0 ? 1.0 + 0.02 * (age - 32.0) : 1.56 + 0.0667 * (age - 60.0);

    // Energy-based cone fundamentals: absorptance behind the macula and the lens, times wavelength.
    std::vector<double> lms(static_cast<size_t>(kCie2006Count) * 3);
    double area[3] = {0.0, 0.0, 0.0};
    for (int32_t i = 0; i < kCie2006Count; ++i) {
        const Cie2006Row& row = kCie2006Inputs[i];
        const double wavelength = kCie2006Start + i * kCie2006Step;
        const double prereceptoral = macularPeak * row.macular + row.lensAgeing * lensScale + row.lensFixed;
        for (int c = 0; c < 3; ++c) {
            const double absorbance = std::pow(10.0, row.logAbsorbance[c]);  // 0 where not tabulated
            const double absorptance = 1.0 - std::pow(10.0, -(c < 2 ? peakLM : peakS) * absorbance);
            lms[i * 3 + c] = absorptance * std::pow(10.0, -prereceptoral) * wavelength;
            area[c] += lms[i * 3 + c];
        }
    }
    // Equal areas make the equal-energy white come out equal in X, Y and Z through the matrix.
    double xyzFromLms[9];
    Invert3(kCie2006LmsFromXyz, xyzFromLms);
    std::vector<double> xyz(lms.size());
    double yPeak = 0.0;
    for (int32_t i = 0; i < kCie2006Count; ++i) {
        for (int k = 0; k < 3; ++k) {
            double sum = 0.0;
            for (int c = 0; c < 3; ++c) sum += xyzFromLms[3 * k + c] * lms[i * 3 + c] / area[c];
            xyz[i * 3 + k] = sum;
        }
        yPeak = std::max(yPeak, xyz[i * 3 + 1]);
    }
    for (double& v : xyz) v /= yPeak;
    return xyz;
}

SampledFunction SampleObserver(int32_t observer, double age, double fieldSize, int32_t channel, double start,
                               double step, int32_t count, bool trim) {
    if (observer == 2) {
        const std::vector<double> xyz = Cie2006ColorMatchingFunctions(age, fieldSize);
        std::vector<double> wavelengths(kCie2006Count), table(kCie2006Count);
        for (int32_t i = 0; i < kCie2006Count; ++i) {
            wavelengths[i] = kCie2006Start + i * kCie2006Step;
            table[i] = xyz[i * 3 + channel];
        }
        return SampleTable(wavelengths.data(), table.data(), kCie2006Count, start, step, count, trim);
    }
    static const double* const kTables[2][3] = {{kCie1931X, kCie1931Y, kCie1931Z},
                                                {kCie1964X, kCie1964Y, kCie1964Z}};
    static const int32_t kCounts[2][3] = {{kCie1931XYCount, kCie1931XYCount, kCie1931ZCount},
                                          {kCie1964XYCount, kCie1964XYCount, kCie1964ZCount}};
    const int o = observer == 1 ? 1 : 0;
    return SampleStandard(kTables[o][channel], kCounts[o][channel], start, step, count, trim);
}
