#include "IlluminantSetup.h"

#include <algorithm>
#include <cmath>

#include "CieIlluminants.h"
#include "ColorSpaceSpectral.h"
#include "ColorSpaceStruct.h"
#include "RelativeWhites.h"
#include "RobertsonLines.h"

namespace {

constexpr double kGeneratedStart = 300.0, kGeneratedEnd = 830.0, kGeneratedStep = 1.0;
constexpr double kIlluminantATemperature = 2856.0;
constexpr double kD50Temperature = 5003.0, kD65Temperature = 6504.0;
constexpr double kDaylightSplit = 5750.0;  // below: tilt D50, from here on: tilt D65
constexpr double kWhiteTemperatureTolerance = 1e-4;

// Planck's law with the second radiation constant 1.4388e7 nm K; lambda in nm.
double Planck(double lambda, double temperature) {
    return 3.7418e19 / (std::pow(lambda, 5.0) * (std::exp(14388000.0 / (lambda * temperature)) - 1.0));
}

void SetTable(IlluminantStruct& r, double start, double step, const double* values, int32_t count) {
    r.tableStart = start;
    r.tableStep = step;
    r.tableEnd = start + (count - 1) * step;
    r.valueCount = ColorSpaceStruct::BandCount(r.tableStart, r.tableEnd, r.tableStep);
    r.values.assign(values, values + count);
}

void SetPlanckian(IlluminantStruct& r, double temperature) {
    const int32_t count = ColorSpaceStruct::BandCount(kGeneratedStart, kGeneratedEnd, kGeneratedStep);
    std::vector<double> values(count);
    double peak = 0.0;
    for (int32_t i = 0; i < count; ++i) {
        values[i] = Planck(kGeneratedStart + i * kGeneratedStep, temperature);
        peak = std::max(peak, values[i]);
    }
    for (double& v : values) v = 100.0 * v / peak;
    SetTable(r, kGeneratedStart, kGeneratedStep, values.data(), count);
}

// Daylight: the nearer of the D50 and D65 tables, at any other temperature tilted by the ratio of
// the peak-normalised Planck curves of the wanted and the table's temperature.
void SetDaylight(IlluminantStruct& r, double temperature) {
    const bool fromD65 = temperature >= kDaylightSplit;
    const double base = fromD65 ? kD65Temperature : kD50Temperature;
    if (fromD65) {
        SetTable(r, kIlluminantD65Start, kIlluminantD65Step, kIlluminantD65, kIlluminantD65Count);
    } else {
        SetTable(r, kIlluminantD50Start, kIlluminantD50Step, kIlluminantD50, kIlluminantD50Count);
    }
    if (temperature == base) return;
    const int32_t n = static_cast<int32_t>(r.values.size());
    std::vector<double> wanted(n), table(n);
    double wantedPeak = 0.0, tablePeak = 0.0;
    for (int32_t i = 0; i < n; ++i) {
        const double lambda = r.tableStart + i * r.tableStep;
        wanted[i] = Planck(lambda, temperature);
        table[i] = Planck(lambda, base);
        wantedPeak = std::max(wantedPeak, wanted[i]);
        tablePeak = std::max(tablePeak, table[i]);
    }
    for (int32_t i = 0; i < n; ++i) r.values[i] *= (wanted[i] / wantedPeak) / (table[i] / tablePeak);
}

bool TabulatedWhite(const IlluminantStruct& r, double white[3]) {
    if (r.observer != 0 && r.observer != 1) return false;
    for (const RelativeWhiteRow& row : kRelativeWhites) {
        if (row.kind != r.kind) continue;
        if (row.kind == 1 &&
            std::fabs(row.colorTemperature - r.colorTemperature) > kWhiteTemperatureTolerance) {
            continue;
        }
        const double* xz = r.observer == 0 ? row.white2 : row.white10;
        if (std::isnan(xz[0])) return false;
        white[0] = xz[0];
        white[1] = 1.0;
        white[2] = xz[1];
        return true;
    }
    return false;
}

// The illuminant's own power table taken as a reflectance under no illuminant.
void ComputeWhite(IlluminantStruct& r) {
    ColorSpaceStruct grid;
    grid.SetType(2);
    grid.wavelengthStart = r.tableStart;
    grid.wavelengthEnd = r.tableEnd;
    grid.wavelengthStep = r.tableStep;
    grid.observer = r.observer;
    grid.observerAge = r.observerAge;
    grid.fieldSize = r.fieldSize;
    cColorSpaceSpectral node(grid, grid);
    double xyz[3] = {0.0, 0.0, 0.0};
    if (static_cast<int32_t>(r.values.size()) ==
        ColorSpaceStruct::BandCount(r.tableStart, r.tableEnd, r.tableStep)) {
        node.ToXYZ(r.values.data(), xyz);
    }
    // Undo the per-channel normalisation (each channel scaled to its own equal-energy white),
    // which would tilt the white by the ratio of the colour-matching functions' areas.
    double raw[3];
    for (int c = 0; c < 3; ++c) raw[c] = node.Scale(c) != 0.0 ? xyz[c] / node.Scale(c) : 0.0;
    if (raw[1] > 0.0) {
        r.relativeWhite[0] = raw[0] / raw[1];
        r.relativeWhite[1] = 1.0;
        r.relativeWhite[2] = raw[2] / raw[1];
    }
    r.colorTemperature = RobertsonTemperature(r.relativeWhite, r.colorTemperature);
}

}  // namespace

double RobertsonTemperature(const double white[3], double previous) {
    const double sum = white[0] + white[1] + white[2];
    if (sum == 0.0) return 5004.0;
    const double x = white[0] / sum, y = white[1] / sum;
    const double denominator = 6.0 * y - x + 1.5;
    const double u = 2.0 * x / denominator, v = 3.0 * y / denominator;
    double previousDistance = 0.0;
    for (int i = 0; i < kRobertsonLineCount; ++i) {
        const RobertsonLine& line = kRobertsonLines[i];
        const double distance =
            ((v - line.v) - line.slope * (u - line.u)) / std::sqrt(1.0 + line.slope * line.slope);
        if (i > 0 && previousDistance / distance < 0.0) {
            const double lowMired = kRobertsonLines[i - 1].mired;
            const double mired =
                lowMired + (line.mired - lowMired) * previousDistance / (previousDistance - distance);
            return 1000000.0 / mired;
        }
        previousDistance = distance;
    }
    return previous;
}

void ApplyIlluminant(IlluminantStruct& r, int32_t kind, double temperature) {
    r.values.clear();
    r.valueCount = 0;
    r.tableStart = r.tableEnd = r.tableStep = 0.0;
    r.kind = kind;
    r.colorTemperature = temperature;
    std::fill(std::begin(r.relativeWhite), std::end(r.relativeWhite), 0.0);

    switch (kind) {
        case 1:
            SetDaylight(r, temperature);
            break;
        case 3:
            r.colorTemperature = kIlluminantATemperature;
            [[fallthrough]];
        case 2:
            SetPlanckian(r, r.colorTemperature);
            break;
        case 5:
            SetTable(r, kIlluminantCStart, kIlluminantCStep, kIlluminantC, kIlluminantCCount);
            break;
        case 6: {
            const std::vector<double> flat(
                ColorSpaceStruct::BandCount(kGeneratedStart, kGeneratedEnd, kGeneratedStep), 100.0);
            SetTable(r, kGeneratedStart, kGeneratedStep, flat.data(), static_cast<int32_t>(flat.size()));
            break;
        }
        case 7:
        case 8:
        case 9:
            SetTable(r, kFluorescentStart, kFluorescentStep, kIlluminantF[kind - 7], kFluorescentCount);
            break;
        case 13:
        case 14:
        case 15:
        case 16:
        case 17:
        case 18:
            SetTable(r, kFluorescentStart, kFluorescentStep, kIlluminantF[kind - 10], kFluorescentCount);
            break;
        default:
            r.kind = 0;
            break;
    }

    // A temperature without a finite spectrum (0 K, negative, far too low) gives no illuminant.
    if (!std::all_of(r.values.begin(), r.values.end(), [](double v) { return std::isfinite(v); })) {
        r.values.clear();
        r.valueCount = 0;
        r.tableStart = r.tableEnd = r.tableStep = 0.0;
        r.kind = 0;
    }
    if (r.kind == 0) {
        std::fill(std::begin(r.relativeWhite), std::end(r.relativeWhite), 1.0);
        return;
    }
    if (!TabulatedWhite(r, r.relativeWhite)) ComputeWhite(r);
}
