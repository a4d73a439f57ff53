#include <cmath>

#include "pigmo/bp.h"

namespace {

// One piece of a hue map: x in [start, end) maps to base + c1 (x - start) + ... + c9 (x - start)^9.
struct HueSegment {
    double start;
    double end;
    double base;
    double c[9];
};

// clang-format off
// CIELAB hue to the angle of the twelve-sector painter's wheel; each range becomes a 30-degree sector.
constexpr HueSegment kWheelMap[] = {
    {0, 25, 330, {0.93976, 0.0075427, 0.00011468, -7.6996e-14, 7.8091e-15, -4.8103e-16, 1.765e-17, -3.5433e-19, 2.9927e-21}},
    {25, 40, 0, {1.5319, 0.033583, -0.00015846, -5.2253e-14, 8.2323e-15, -7.9888e-16, 4.666e-17, -1.504e-18, 2.0549e-20}},
    {40, 50, 30, {2.4324, 0.20582, -0.014906, -4.3729e-12, 9.251e-13, -1.2386e-13, 1.019e-14, -4.6992e-16, 9.296e-18}},
    {50, 70, 60, {2.0769, -0.057692, 0.0014423, -6.4904e-14, 9.2375e-15, -7.8612e-16, 3.9452e-17, -1.076e-18, 1.2291e-20}},
    {70, 90, 90, {1.5, 0.014189, -0.00070946, 1.5745e-14, -2.5227e-15, 2.3078e-16, -1.2055e-17, 3.3454e-19, -3.8255e-21}},
    {90, 120, 120, {1.2162, -0.014414, 0.00024024, -3.5791e-15, 4.5454e-16, -2.9941e-17, 1.0898e-18, -2.0826e-20, 1.6339e-22}},
    {120, 150, 150, {1, 0.0045662, -0.00015221, -2.6609e-15, 3.9026e-16, -2.7184e-17, 1.0151e-18, -1.9611e-20, 1.5423e-22}},
    {150, 190, 180, {0.86301, -0.0028225, -7.1746e-08, -7.7562e-15, 5.0726e-16, -2.0175e-17, 4.7761e-19, -6.179e-21, 3.3598e-23}},
    {190, 245, 210, {0.63687, -0.0049864, 6.0441e-05, 2.1721e-15, -1.0894e-16, 3.2598e-18, -5.7408e-20, 5.4842e-22, -2.1901e-24}},
    {245, 285, 240, {0.63687, 0.0043768, -3.8713e-05, -9.384e-15, 5.7061e-16, -2.127e-17, 4.7504e-19, -5.8295e-21, 3.0205e-23}},
    {285, 320, 270, {0.80119, 0.0047962, -9.1357e-05, -2.169e-14, 1.5229e-15, -6.4669e-17, 1.6304e-18, -2.2431e-20, 1.2958e-22}},
    {320, 360, 300, {0.80119, -0.0073033, 0.00015059, -1.0393e-14, 6.8368e-16, -2.7248e-17, 6.4281e-19, -8.2439e-21, 4.4247e-23}},
};

// Wheel angle back to CIELAB hue; undoes the wheel map to about 0.1 degree.
constexpr HueSegment kHueMap[] = {
    {0, 30, 25, {0.625, -0.005, 2.7778e-05, -9.239e-16, 1.0682e-16, -6.6509e-18, 2.3165e-19, -4.2572e-21, 3.2198e-23}},
    {30, 60, 40, {0.4, -0.0081481, 0.00019753, -9.0556e-16, 1.141e-16, -7.3575e-18, 2.6304e-19, -4.9613e-21, 3.8572e-23}},
    {60, 90, 50, {0.44444, 0.014815, -0.00024691, -8.8596e-16, 1.3387e-16, -9.3424e-18, 3.4908e-19, -6.7687e-21, 5.3632e-23}},
    {90, 120, 70, {0.66667, -0.0044444, 0.00014815, -3.244e-15, 3.2544e-16, -1.8798e-17, 6.2529e-19, -1.1141e-20, 8.2427e-23}},
    {120, 150, 90, {0.8, 0.013333, -0.00022222, -2.9897e-15, 2.974e-16, -1.7087e-17, 5.689e-19, -1.0203e-20, 7.6313e-23}},
    {150, 180, 120, {1, -0.0047619, 0.00015873, -5.012e-15, 5.8457e-16, -3.6877e-17, 1.3048e-18, -2.4391e-20, 1.8777e-22}},
    {180, 210, 150, {1.1429, 0.0056809, 2.2278e-05, -5.0697e-15, 5.9596e-16, -3.8284e-17, 1.3854e-18, -2.6545e-20, 2.0963e-22}},
    {210, 240, 190, {1.5439, 0.028947, -0.00064327, -9.3527e-15, 9.7663e-16, -5.7875e-17, 1.9671e-18, -3.5762e-20, 2.6976e-22}},
    {240, 270, 245, {1.5439, -0.011072, 0.00013515, -1.4432e-15, 3.379e-16, -2.714e-17, 1.0942e-18, -2.224e-20, 1.8158e-22}},
    {270, 300, 285, {1.2444, -0.0077778, 0.00017284, 1.0586e-15, 1.4999e-16, -1.8169e-17, 8.284e-19, -1.7801e-20, 1.4979e-22}},
    {300, 330, 320, {1.2444, 0.016182, -0.00044065, -2.6106e-15, 6.1441e-16, -4.9415e-17, 1.9941e-18, -4.0571e-20, 3.3159e-22}},
    {330, 360, 0, {1.0481, -0.0083333, 3.9113e-05, -1.3238e-15, 1.1235e-16, -5.7575e-18, 1.7549e-19, -2.9294e-21, 2.0617e-23}},
};
// clang-format on

// Into [0, 360): whole degrees by remainder, the fraction added back.
double NormaliseAngle(double angle) {
    const double whole = std::floor(angle);
    double r = std::fmod(whole, 360.0) + (angle - whole);
    if (r < 0.0) r += 360.0;
    return r;
}

template <std::size_t N>
double MapAngle(const HueSegment (&map)[N], double x) {
    for (const HueSegment& s : map) {
        if (x >= s.start && x < s.end) {
            const double t = x - s.start;
            double sum = 0.0;
            for (int k = 8; k >= 0; --k) sum = (sum + s.c[k]) * t;
            return s.base + sum;
        }
    }
    return x;  // only NaN falls through, and stays NaN
}

double RotateHue(double hue, double wheelOffset) {
    const double wheel = MapAngle(kWheelMap, NormaliseAngle(hue));
    return MapAngle(kHueMap, NormaliseAngle(wheel + wheelOffset));
}

// Two companions at wheel offsets -offset and +offset; the status of the last conversion.
int RotatedPair(const double* lab, double* lab1, double* lab2, double offset) {
    double lch[3];
    if (BPConvertLab2LCh(lab, lch) == 0) return 0;
    const double lch1[3] = {lch[0], lch[1], RotateHue(lch[2], -offset)};
    const double lch2[3] = {lch[0], lch[1], RotateHue(lch[2], offset)};
    BPConvertLCh2Lab(lch1, lab1);
    return BPConvertLCh2Lab(lch2, lab2);
}

}  // namespace

extern "C" {

int BPHarmonyGetMonochromatic(const double* lab, double* lab1, double* lab2) {
    double lch[3];
    if (BPConvertLab2LCh(lab, lch) == 0) return 0;
    const double L = lch[0];
    double darker = L < 33.0 ? L + 33.0 : (L < 67.0 ? L - 33.0 : L - 66.0);
    double lighter = L < 33.0 ? L + 66.0 : (L < 67.0 ? L + 33.0 : L - 33.0);
    if (darker < 10.0) darker = 10.0;
    if (lighter > 90.0) lighter = 90.0;
    const double lch1[3] = {darker, lch[1], lch[2]};
    const double lch2[3] = {lighter, lch[1], lch[2]};
    BPConvertLCh2Lab(lch1, lab1);
    return BPConvertLCh2Lab(lch2, lab2);
}

int BPHarmonyGetNearNeighbor(const double* lab, double* lab1, double* lab2) {
    return RotatedPair(lab, lab1, lab2, 30.0);
}

int BPHarmonyGetFarNeighbor(const double* lab, double* lab1, double* lab2) {
    return RotatedPair(lab, lab1, lab2, 150.0);
}

int BPHarmonyGetTriadic(const double* lab, double* lab1, double* lab2) {
    return RotatedPair(lab, lab1, lab2, 120.0);
}

int BPHarmonyGetComplement(const double* lab, double* labOut) {
    double lch[3];
    if (BPConvertLab2LCh(lab, lch) == 0) return 0;
    const double rotated[3] = {lch[0], lch[1], RotateHue(lch[2], 180.0)};
    return BPConvertLCh2Lab(rotated, labOut);
}

}  // extern "C"
