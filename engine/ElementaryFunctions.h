#pragma once

#include <algorithm>
#include <array>
#include <bit>
#include <cmath>
#include <cstdint>
#include <numbers>

// The powers, exponential, arc tangent, sine and cosine of the per-color conversions and metrics,
// within one or two units in the last place of the standard library's and several times faster:
// the hot paths spend most of their time in these functions otherwise. Arguments outside the
// ranges they are made for go to the standard library.

namespace Elementary {

// x^N by squaring.
template <int N>
constexpr double IntegerPower(double x) {
    if constexpr (N == 1) {
        return x;
    } else if constexpr (N % 2 == 0) {
        const double half = IntegerPower<N / 2>(x);
        return half * half;
    } else {
        return x * IntegerPower<N - 1>(x);
    }
}

constexpr double IntegerPower(double x, int n) {
    double power = 1.0;
    for (int i = 0; i < n; ++i) power *= x;
    return power;
}

// v^(p/q) for v in [1, 2], for the tables: Newton's method on y^q = v^p from v^3, which lies above.
constexpr double RootOfPower(double v, int p, int q) {
    const double target = IntegerPower(v, p);
    double y = v * v * v;
    for (int i = 0; i < 200; ++i) {
        const double next = y - (IntegerPower(y, q) - target) / (q * IntegerPower(y, q - 1));
        if (!(next < y)) break;
        y = next;
    }
    return y;
}

// Table-driven powers of x for 2^-16 <= x < 2: x = 2^e m, the power of m interpolated linearly
// between entries for m = 1 + k / 512, times the entry of the exponent e.
constexpr int kGuessCellBits = 9;
constexpr int kGuessLowestExponent = -16;
struct GuessTables {
    std::array<double, (1 << kGuessCellBits) + 1> mantissa{};
    std::array<double, 1 - kGuessLowestExponent> exponent{};
};

inline double TableGuess(const GuessTables& tables, double x) {
    constexpr int kFractionBits = 52 - kGuessCellBits;
    const uint64_t bits = std::bit_cast<uint64_t>(x);
    const int exponent = static_cast<int>(bits >> 52) - 1023;
    const uint64_t mantissa = bits & ((uint64_t{1} << 52) - 1);
    const uint64_t cell = mantissa >> kFractionBits;
    const double within = static_cast<double>(mantissa & ((uint64_t{1} << kFractionBits) - 1)) *
                          (1.0 / static_cast<double>(uint64_t{1} << kFractionBits));
    const double low = tables.mantissa[cell];
    return tables.exponent[exponent - kGuessLowestExponent] *
           (low + within * (tables.mantissa[cell + 1] - low));
}

// x^(P/Q) for 2^-16 <= x < 2: a first guess from the tables, then one Halley step on y^Q = x^P.
template <int P, int Q>
class RationalPower {
public:
    static double Of(double x) {
        if (!(x >= 0x1p-16 && x < 2.0)) return std::pow(x, static_cast<double>(P) / Q);
        double y = TableGuess(kTables, x);
        const double xp = IntegerPower<P>(x);
        const double yq = IntegerPower<Q>(y);
        y += y * (2.0 * (xp - yq) / ((Q + 1) * yq + (Q - 1) * xp));
        return y;
    }

private:
    // (1 + k / 512)^(P/Q), and 2^(eP/Q) as 2^whole times the Q-th root of 2 raised to the remainder.
    static constexpr GuessTables MakeTables() {
        GuessTables tables;
        for (int k = 0; k <= (1 << kGuessCellBits); ++k)
            tables.mantissa[k] = RootOfPower(1.0 + k * (1.0 / (1 << kGuessCellBits)), P, Q);
        const double rootOfTwo = RootOfPower(2.0, 1, Q);
        for (int e = kGuessLowestExponent; e <= 0; ++e) {
            int whole = e * P / Q;
            if (whole * Q > e * P) --whole;
            tables.exponent[e - kGuessLowestExponent] =
                IntegerPower(rootOfTwo, e * P - whole * Q) * IntegerPower(0.5, -whole);
        }
        return tables;
    }
    static constexpr GuessTables kTables = MakeTables();
};

// (1 + k / 512)^(-1/3) and 2^(-e/3).
constexpr GuessTables MakeInverseCubeRootTables() {
    GuessTables tables;
    for (int k = 0; k <= (1 << kGuessCellBits); ++k)
        tables.mantissa[k] = 1.0 / RootOfPower(1.0 + k * (1.0 / (1 << kGuessCellBits)), 1, 3);
    const double rootOfTwo = RootOfPower(2.0, 1, 3);
    for (int e = kGuessLowestExponent; e <= 0; ++e)
        tables.exponent[e - kGuessLowestExponent] =
            IntegerPower(rootOfTwo, -e % 3) * IntegerPower(2.0, -e / 3);
    return tables;
}
inline constexpr GuessTables kInverseCubeRootTables = MakeInverseCubeRootTables();

// x^(1/3) for 2^-16 <= x < 2 without a division, which would bound how many colors a batch converts
// per unit of time: z ~ x^(-1/3) from the tables, then x^(1/3) = x z^2 (1 - e)^(-2/3) with
// e = 1 - x z^3, by the binomial series to e^2 (e is below 1e-6).
inline double CubeRoot(double x) {
    if (!(x >= 0x1p-16 && x < 2.0)) return std::cbrt(x);
    const double z = TableGuess(kInverseCubeRootTables, x);
    const double xz2 = x * (z * z);
    const double e = 1.0 - xz2 * z;
    return xz2 + xz2 * (e * (2.0 / 3.0 + e * (5.0 / 9.0)));
}

// a where the condition holds, else b, by bits rather than a branch: hues are random, so branches
// on them would be mispredicted about half the time.
inline double Select(bool condition, double a, double b) {
    const uint64_t mask = uint64_t{0} - condition;
    return std::bit_cast<double>((std::bit_cast<uint64_t>(a) & mask) | (std::bit_cast<uint64_t>(b) & ~mask));
}

// c[0] + c[1] z + ... + c[Count - 1] z^(Count - 1) by Estrin's scheme: the two halves are
// independent, so the chain of dependent multiplications is a logarithm of the count long.
template <int Count>
constexpr double Polynomial(const double* c, double z) {
    if constexpr (Count == 1) {
        return c[0];
    } else if constexpr (Count == 2) {
        return c[0] + c[1] * z;
    } else {
        constexpr int kLow = static_cast<int>(std::bit_floor(static_cast<unsigned>(Count - 1)));
        return Polynomial<kLow>(c, z) + IntegerPower<kLow>(z) * Polynomial<Count - kLow>(c + kLow, z);
    }
}

constexpr double Factorial(int n) {
    return n <= 1 ? 1.0 : n * Factorial(n - 1);
}

// (-1)^(k+1) / (2k + Offset)!, k = 0, 1, ...: the Taylor series in z = x^2 of (sin x - x) / x^3
// with Offset 3 and of (1 - x^2 / 2 - cos x) / x^4 with Offset 4.
template <int Count, int Offset>
struct TaylorTerms {
    double c[Count];
    constexpr TaylorTerms() : c() {
        for (int k = 0; k < Count; ++k) c[k] = (k % 2 == 0 ? -1.0 : 1.0) / Factorial(2 * k + Offset);
    }
};

// sin x for |x| <= pi/2 by the Taylor series to x^21, which is exact to double precision there.
inline double SinNearZero(double x) {
    static constexpr TaylorTerms<10, 3> kTerms;
    const double x2 = x * x;
    return x + x * x2 * Polynomial<10>(kTerms.c, x2);
}

// Sine and cosine together: a reduction to within pi/4 of a multiple of pi/2 and the Taylor series
// to the 18th power.
inline void SinCos(double x, double& sine, double& cosine) {
    if (!(std::fabs(x) < 1024.0)) {
        sine = std::sin(x);
        cosine = std::cos(x);
        return;
    }
    // Adding 1.5 * 2^52 rounds to a whole number, whose low bits are the quadrant.
    constexpr double kRound = 0x1.8p52;
    const double shifted = x * (2.0 / std::numbers::pi) + kRound;
    const double n = shifted - kRound;
    const uint64_t quadrant = std::bit_cast<uint64_t>(shifted) & 3;
    // pi/2 in three parts, the first two of 32 bits so that n times them is exact.
    const double r = ((x - n * 1.5707963267341256) - n * 6.077100506303966e-11) - n * 2.0222662487959506e-21;
    const double r2 = r * r;
    static constexpr TaylorTerms<8, 3> kSineTerms;
    static constexpr TaylorTerms<8, 4> kCosineTerms;
    const double s = r + r * r2 * Polynomial<8>(kSineTerms.c, r2);
    const double c = (1.0 - 0.5 * r2) - r2 * r2 * Polynomial<8>(kCosineTerms.c, r2);
    // Odd quadrants swap sine and cosine; quadrants 2 and 3 negate the sine, 1 and 2 the cosine.
    const bool odd = quadrant & 1;
    sine = std::bit_cast<double>(std::bit_cast<uint64_t>(Select(odd, c, s)) ^ ((quadrant & 2) << 62));
    cosine = std::bit_cast<double>(std::bit_cast<uint64_t>(Select(odd, s, c)) ^ (((quadrant + 1) & 2) << 62));
}

inline double Tan(double x) {
    double s, c;
    SinCos(x, s, c);
    return s / c;
}

// e^x for |x| < 700: x = (32m + j) ln 2 / 32 + r with |r| <= ln 2 / 64, e^x = 2^m 2^(j/32) e^r, e^r
// by its Taylor series to r^6.
inline double Exp(double x) {
    if (!(std::fabs(x) < 700.0)) return std::exp(x);
    struct Tables {
        double twoToTheJ32[32];
        double terms[7];
        constexpr Tables() : twoToTheJ32(), terms() {
            for (int j = 0; j < 32; ++j) twoToTheJ32[j] = j == 0 ? 1.0 : RootOfPower(2.0, j, 32);
            for (int k = 0; k < 7; ++k) terms[k] = 1.0 / Factorial(k);
        }
    };
    static constexpr Tables kTables;
    constexpr double kRound = 0x1.8p52;
    const double n = (x * (32.0 * std::numbers::log2e) + kRound) - kRound;
    // ln 2 / 32 in two parts, the first of 32 bits so that n times it is exact.
    const double r = (x - n * (0.6931471803691238 / 32)) - n * (1.9082149292705877e-10 / 32);
    const int whole = static_cast<int>(n);
    const uint64_t twoToTheM = static_cast<uint64_t>((whole >> 5) + 1023) << 52;
    return Polynomial<7>(kTables.terms, r) * kTables.twoToTheJ32[whole & 31] *
           std::bit_cast<double>(twoToTheM);
}

// Taylor expansions of atan about k/32, k = 0 to 32, to the 9th power, which is exact to double
// precision for |t - k/32| <= 1/64. The constant terms come from expansions about k/8 (to the 13th
// power, exact for |t - k/8| <= 1/16) of the published atan(k/8); every other coefficient from the
// two before it, as (1 + t^2) atan'(t) = 1 gives them.
class AtanExpansions {
public:
    static constexpr int kTerms = 10;
    const double* About(int k) const { return fine_[k]; }

    constexpr AtanExpansions() : coarse_(), fine_() {
        constexpr double kAtanOfEighths[9] = {0.0,
                                              0.12435499454676144,
                                              0.24497866312686414,
                                              0.35877067027057225,
                                              0.4636476090008061,
                                              0.5585993153435624,
                                              0.6435011087932844,
                                              0.7188299996216245,
                                              0.7853981633974483};
        for (int k = 0; k <= 8; ++k) Expand(coarse_[k], 14, k / 8.0, kAtanOfEighths[k]);
        for (int k = 0; k <= 32; ++k) {
            const int nearest = (k + 2) / 4;
            const double value = Polynomial<14>(coarse_[nearest], k / 32.0 - nearest / 8.0);
            Expand(fine_[k], kTerms, k / 32.0, value);
        }
    }

private:
    static constexpr void Expand(double* c, int terms, double centre, double atanOfCentre) {
        const double scale = 1.0 + centre * centre;
        c[0] = atanOfCentre;
        c[1] = 1.0 / scale;
        for (int m = 1; m + 1 < terms; ++m)
            c[m + 1] = (-2.0 * centre * m * c[m] - (m - 1) * c[m - 1]) / (scale * (m + 1));
    }

    double coarse_[9][14];
    double fine_[33][kTerms];
};

// atan2 with one division and no branch on the octant. Zeros, infinities, NaN and the smallest
// magnitudes keep the standard library's conventions and precision.
inline double Atan2(double y, double x) {
    const double ax = std::fabs(x);
    const double ay = std::fabs(y);
    const double low = std::min(ax, ay);
    const double high = std::max(ax, ay);
    if (!(ax < 0x1p1000 && ay < 0x1p1000 && high > 0x1p-1000)) return std::atan2(y, x);
    static constexpr AtanExpansions kExpansions;
    const double t = low / high;
    const int k = static_cast<int>(t * 32.0 + 0.5);
    const double angle = Polynomial<AtanExpansions::kTerms>(kExpansions.About(k), t - k * (1.0 / 32));
    // Reflections by |offset - angle|, with offsets of 0 or pi/2 and then 0 or pi, looked up rather
    // than branched on; the part of pi below double precision is added back, so that a hue and its
    // opposite lie pi apart as closely as the standard library puts them.
    constexpr double kPi = std::numbers::pi;
    constexpr double kPiLow = 1.2246467991473532e-16;  // pi - (double) pi
    static constexpr double kQuarter[2] = {0.0, kPi / 2}, kQuarterLow[2] = {0.0, kPiLow / 2};
    static constexpr double kHalf[2] = {0.0, kPi}, kHalfLow[2] = {0.0, kPiLow};
    const bool steep = ay > ax;
    const bool left = x < 0.0;
    const double reflected = std::fabs(kQuarter[steep] - angle) + kQuarterLow[steep];
    return std::copysign(std::fabs(kHalf[left] - reflected) + kHalfLow[left], y);
}

}  // namespace Elementary
