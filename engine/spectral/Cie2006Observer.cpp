#include "Cie2006Observer.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "Cie2006Inputs.h"
#include "CieObservers.h"
#include "Interpolation.h"
#include "Matrix3.h"

namespace {

constexpr double kStandardAge = 32.0;
constexpr int32_t kTenthsPerNm = 10;           // peaks are taken on a 0.1-nm grid
constexpr double kQuantalLWeight = 1.89;       // L weight of the quantal V(lambda), 2 degrees, age 32
constexpr double kFirstPinnedMinimum = 502.0;  // where the 2-degree fit puts x-bar's chromaticity minimum
constexpr int kMaxPinMoves = 10;
constexpr double kFitTolerance = 1e-10;

// The published functions take the peak optical densities to three decimals (2 degrees: 0.5 for L
// and M, 0.4 for S, 0.35 for the macula), rounded half away from zero.
double RoundDensity(double density) {
    return std::copysign(std::floor(std::fabs(density) * 1000.0 + 0.5) / 1000.0, density);
}

double LimitField(double fieldSize) {
    return std::clamp(fieldSize, 1.0, 10.0);
}

// Largest value on the 0.1-nm grid from 390 to 830 nm of a smooth function with one peak, given
// its values at 1 nm (table) and the function itself (f): the largest 1-nm value, refined within
// a nanometre of it.
template <class F>
double FinePeak(const std::vector<double>& table, F f) {
    const auto best = std::max_element(table.begin(), table.end()) - table.begin();
    double peak = table[best];
    const double last = kCie2006TableStart + (kCie2006TableCount - 1);
    for (int32_t tenth = -kTenthsPerNm; tenth <= kTenthsPerNm; ++tenth) {
        const double w =
            kCie2006TableStart + static_cast<double>(best) + static_cast<double>(tenth) / kTenthsPerNm;
        if (w >= kCie2006TableStart && w <= last) peak = std::max(peak, f(w));
    }
    return peak;
}

// The quantal cone fundamentals of CIE 170-1 for one age and field size, not normalised. Exact at
// the 5-nm inputs; between them their logarithms follow a not-a-knot spline, beyond the last
// input the last 5-nm step of the logarithm continues. The S cone has no absorbance past 615 nm.
class ConeModel {
public:
    ConeModel(double age, double fieldSize) {
        const double lmDensity = RoundDensity(0.38 + 0.54 * std::exp(-fieldSize / 1.333));
        const double sDensity = RoundDensity(0.30 + 0.45 * std::exp(-fieldSize / 1.333));
        const double macularPeak = RoundDensity(0.485 * std::exp(-fieldSize / 6.132));
        const double lensScale = age <= 60.0 ? 1.0 + 0.02 * (age - 32.0) : 1.56 + 0.0667 * (age - 60.0);
        for (const Cie2006Row& row : kCie2006Inputs) {
            const double prereceptoral =
                macularPeak * row.macular + row.lensAgeing * lensScale + row.lensFixed;
            for (int c = 0; c < 3; ++c) {
                if (row.logAbsorbance[c] == kNotTabulated) continue;
                const double density = (c < 2 ? lmDensity : sDensity) * std::pow(10.0, row.logAbsorbance[c]);
                log_[c].push_back(std::log10(1.0 - std::pow(10.0, -density)) - prereceptoral);
            }
        }
        for (int c = 0; c < 3; ++c) {
            curvature_[c] = EvenSplineCurvatures(log_[c].data(), static_cast<int32_t>(log_[c].size()));
            table_[c].resize(kCie2006TableCount);
            std::vector<double> energy(kCie2006TableCount);
            for (int32_t i = 0; i < kCie2006TableCount; ++i) {
                table_[c][i] = Quantal(c, kCie2006TableStart + i);
                energy[i] = (kCie2006TableStart + i) * table_[c][i];
            }
            quantalPeak_[c] = FinePeak(table_[c], [&](double w) { return Quantal(c, w); });
            energyPeak_[c] = FinePeak(energy, [&](double w) { return w * Quantal(c, w); });
        }
    }

    double Quantal(int cone, double wavelength) const {
        const std::vector<double>& y = log_[cone];
        const int32_t n = static_cast<int32_t>(y.size());
        const double position = (wavelength - kCie2006Start) / kCie2006Step;
        if (position <= n - 1)
            return std::pow(10.0, EvenSplineValue(y.data(), curvature_[cone].data(), n, position));
        if (n < kCie2006Count) return 0.0;
        return std::pow(10.0, y[n - 1] + (position - (n - 1)) * (y[n - 1] - y[n - 2]));
    }
    // Quantal at 1 nm from 390 to 830 nm.
    const std::vector<double>& QuantalTable(int cone) const { return table_[cone]; }
    double QuantalPeak(int cone) const { return quantalPeak_[cone]; }
    double EnergyPeak(int cone) const { return energyPeak_[cone]; }

    // l-bar, m-bar, s-bar on the table grid: energy based, each with peak 1.
    std::vector<double> EnergyTable() const {
        std::vector<double> lms(static_cast<size_t>(kCie2006TableCount) * 3);
        for (int32_t i = 0; i < kCie2006TableCount; ++i) {
            for (int c = 0; c < 3; ++c)
                lms[3 * i + c] = (kCie2006TableStart + i) * table_[c][i] / energyPeak_[c];
        }
        return lms;
    }

private:
    std::vector<double> log_[3];
    std::vector<double> curvature_[3];
    std::vector<double> table_[3];
    double quantalPeak_[3] = {};
    double energyPeak_[3] = {};
};

// Spectral chromaticities x, y of a standard observer's 1-nm table from 360 nm (z-bar 0 past
// its table), with the wavelengths that shape them: 360, x minimum, y maximum, 700, 830 nm.
struct StandardChromaticities {
    std::vector<double> x, y, xCurvature, yCurvature;
    double knots[5];
};

StandardChromaticities Chromaticities(const double* xBar, const double* yBar, int32_t count,
                                      const double* zBar, int32_t zCount) {
    StandardChromaticities s;
    for (int32_t i = 0; i < count; ++i) {
        const double sum = xBar[i] + yBar[i] + (i < zCount ? zBar[i] : 0.0);
        s.x.push_back(xBar[i] / sum);
        s.y.push_back(yBar[i] / sum);
    }
    s.xCurvature = EvenSplineCurvatures(s.x.data(), count);
    s.yCurvature = EvenSplineCurvatures(s.y.data(), count);
    const auto xMin = std::min_element(s.x.begin(), s.x.end()) - s.x.begin();
    const auto yMax = std::max_element(s.y.begin(), s.y.end()) - s.y.begin();
    const double knots[5] = {kCmfStart, kCmfStart + xMin, kCmfStart + yMax, 700.0, 830.0};
    std::copy_n(knots, 5, s.knots);
    return s;
}

// The CIE 1931 and 1964 spectral chromaticities blended for the field size (2 degrees gives the
// first, 10 the second) on the table grid. Each standard's wavelengths are first stretched
// piecewise linearly so that their x minimum and y maximum fall on the blended wavelengths.
void ReferenceChromaticities(double field, std::vector<double>& x, std::vector<double>& y) {
    const StandardChromaticities standards[2] = {
        Chromaticities(kCie1931X, kCie1931Y, kCie1931XYCount, kCie1931Z, kCie1931ZCount),
        Chromaticities(kCie1964X, kCie1964Y, kCie1964XYCount, kCie1964Z, kCie1964ZCount)};
    const double weights[2] = {(10.0 - field) / 8.0, (field - 2.0) / 8.0};
    double knots[5];
    for (int k = 0; k < 5; ++k)
        knots[k] = weights[0] * standards[0].knots[k] + weights[1] * standards[1].knots[k];
    x.assign(kCie2006TableCount, 0.0);
    y.assign(kCie2006TableCount, 0.0);
    for (int32_t i = 0; i < kCie2006TableCount; ++i) {
        for (int s = 0; s < 2; ++s) {
            const StandardChromaticities& c = standards[s];
            const int32_t n = static_cast<int32_t>(c.x.size());
            const double position = LinearInterpolate(knots, c.knots, 5, kCie2006TableStart + i) - kCmfStart;
            x[i] += weights[s] * EvenSplineValue(c.x.data(), c.xCurvature.data(), n, position);
            y[i] += weights[s] * EvenSplineValue(c.y.data(), c.yCurvature.data(), n, position);
        }
    }
}

template <class F>
double GoldenSectionMinimum(F f, double lo, double hi) {
    const double ratio = (std::sqrt(5.0) - 1.0) / 2.0;
    double c = hi - ratio * (hi - lo), d = lo + ratio * (hi - lo);
    double fc = f(c), fd = f(d);
    while (hi - lo > kFitTolerance) {
        if (fc < fd) {
            hi = d;
            d = c;
            fd = fc;
            c = hi - ratio * (hi - lo);
            fc = f(c);
        } else {
            lo = c;
            c = d;
            fc = fd;
            d = lo + ratio * (hi - lo);
            fd = f(d);
        }
    }
    return (lo + hi) / 2.0;
}

void Derive(const ConeModel& cones, const std::vector<double>& lms, double age, double field, double m[9]) {
    // y-bar, the luminous efficiency: on the quantal scale (l and m with peak 1) 1.89 l + m at age
    // 32, the L weight following at other ages the change in the ratio of the L and M peaks at
    // 2 degrees; then on the energy scale with peak 1.
    const ConeModel twoDegrees(age, 2.0), standard(kStandardAge, 2.0);
    const double lWeight = kQuantalLWeight * (twoDegrees.QuantalPeak(0) / twoDegrees.QuantalPeak(1)) /
                           (standard.QuantalPeak(0) / standard.QuantalPeak(1));
    const double lScale = lWeight / cones.QuantalPeak(0), mScale = 1.0 / cones.QuantalPeak(1);
    std::vector<double> v(kCie2006TableCount);
    for (int32_t i = 0; i < kCie2006TableCount; ++i) {
        v[i] = (kCie2006TableStart + i) *
               (lScale * cones.QuantalTable(0)[i] + mScale * cones.QuantalTable(1)[i]);
    }
    const double vPeak = FinePeak(
        v, [&](double w) { return w * (lScale * cones.Quantal(0, w) + mScale * cones.Quantal(1, w)); });
    const double a21 = lScale * cones.EnergyPeak(0) / vPeak;
    const double a22 = mScale * cones.EnergyPeak(1) / vPeak;

    double sums[3] = {0.0, 0.0, 0.0};
    for (size_t i = 0; i < lms.size(); ++i) sums[i % 3] += lms[i];
    const double sumV = a21 * sums[0] + a22 * sums[1];
    // z-bar: s-bar with y-bar's area.
    const double a33 = sumV / sums[2];

    std::vector<double> xRef, yRef;
    ReferenceChromaticities(field, xRef, yRef);
    const double xRefMin = *std::min_element(xRef.begin(), xRef.end());
    // x-bar = a11 l + a12 m + a13 s. Given a13, x-bar's area equal to y-bar's and its chromaticity
    // at the pinned wavelength equal to the reference minimum fix a11 and a12.
    auto solve = [&](double a13, int32_t pin, double& a11, double& a12) {
        const double* c = &lms[3 * static_cast<size_t>(pin)];
        const double r1 = sumV - a13 * sums[2];
        const double r2 = xRefMin / (1.0 - xRefMin) * (a21 * c[0] + a22 * c[1] + a33 * c[2]) - a13 * c[2];
        const double det = sums[0] * c[1] - sums[1] * c[0];
        a11 = (r1 * c[1] - sums[1] * r2) / det;
        a12 = (sums[0] * r2 - c[0] * r1) / det;
    };
    // Squared chromaticity distance to the reference over the table; lowest takes x's minimum.
    auto distance = [&](double a13, int32_t pin, int32_t* lowest) {
        double a11, a12;
        solve(a13, pin, a11, a12);
        double sum = 0.0, xLowest = std::numeric_limits<double>::infinity();
        for (int32_t i = 0; i < kCie2006TableCount; ++i) {
            const double* c = &lms[3 * static_cast<size_t>(i)];
            const double xyz[3] = {a11 * c[0] + a12 * c[1] + a13 * c[2], a21 * c[0] + a22 * c[1], a33 * c[2]};
            const double total = xyz[0] + xyz[1] + xyz[2];
            const double x = xyz[0] / total, y = xyz[1] / total;
            sum += (x - xRef[i]) * (x - xRef[i]) + (y - yRef[i]) * (y - yRef[i]) +
                   (x + y - xRef[i] - yRef[i]) * (x + y - xRef[i] - yRef[i]);  // z's distance
            if (lowest != nullptr && x < xLowest) {
                xLowest = x;
                *lowest = i;
            }
        }
        return sum;
    };
    // The minimum is pinned where the fitted x-bar has it; move the pin until they agree.
    int32_t pin = static_cast<int32_t>(kFirstPinnedMinimum - kCie2006TableStart);
    double a13 = 0.0;
    for (int move = 0; move <= kMaxPinMoves; ++move) {
        a13 = GoldenSectionMinimum([&](double a) { return distance(a, pin, nullptr); }, -1.0, 2.0);
        int32_t lowest = pin;
        distance(a13, pin, &lowest);
        if (lowest == pin || move == kMaxPinMoves) break;
        pin = lowest;
    }
    double a11, a12;
    solve(a13, pin, a11, a12);
    const double matrix[9] = {a11, a12, a13, a21, a22, 0.0, 0.0, 0.0, a33};
    std::copy_n(matrix, 9, m);
}

}  // namespace

void DeriveCie2006Transformation(double age, double fieldSize, double matrix[9]) {
    const double field = LimitField(fieldSize);
    const ConeModel cones(age, field);
    Derive(cones, cones.EnergyTable(), age, field, matrix);
}

std::vector<double> Cie2006ColorMatchingFunctions(double age, double fieldSize) {
    const double field = LimitField(fieldSize);
    const ConeModel cones(age, field);
    const std::vector<double> lms = cones.EnergyTable();
    double matrix[9];
    if (age == kStandardAge && (field == 2.0 || field == 10.0)) {
        std::copy_n(field == 2.0 ? kCie2015Matrix2 : kCie2015Matrix10, 9, matrix);
    } else {
        Derive(cones, lms, age, field, matrix);
    }
    std::vector<double> xyz(lms.size());
    for (size_t i = 0; i < lms.size(); i += 3) Multiply3(matrix, &lms[i], &xyz[i]);
    return xyz;
}
