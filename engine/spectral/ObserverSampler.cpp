#include "ObserverSampler.h"

#include <algorithm>

#include "Cie2006Observer.h"
#include "CieObservers.h"
#include "Interpolation.h"

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

ObserverFunctions SampleObserver(int32_t observer, double age, double fieldSize, double start, double step,
                                 int32_t count, bool trim) {
    ObserverFunctions functions;
    if (observer == 2) {
        const std::vector<double> xyz = Cie2006ColorMatchingFunctions(age, fieldSize);
        std::vector<double> wavelengths(kCie2006TableCount), table(kCie2006TableCount);
        for (int32_t i = 0; i < kCie2006TableCount; ++i) wavelengths[i] = kCie2006TableStart + i;
        for (int c = 0; c < 3; ++c) {
            for (int32_t i = 0; i < kCie2006TableCount; ++i) table[i] = xyz[i * 3 + c];
            functions[c] =
                SampleTable(wavelengths.data(), table.data(), kCie2006TableCount, start, step, count, trim);
        }
        return functions;
    }
    static const double* const kTables[2][3] = {{kCie1931X, kCie1931Y, kCie1931Z},
                                                {kCie1964X, kCie1964Y, kCie1964Z}};
    static const int32_t kCounts[2][3] = {{kCie1931XYCount, kCie1931XYCount, kCie1931ZCount},
                                          {kCie1964XYCount, kCie1964XYCount, kCie1964ZCount}};
    const int o = observer == 1 ? 1 : 0;
    for (int c = 0; c < 3; ++c)
        functions[c] = SampleStandard(kTables[o][c], kCounts[o][c], start, step, count, trim);
    return functions;
}
