#pragma once

#include <cstdint>
#include <memory>
#include <vector>

#include "Export.h"
#include "IlluminantStruct.h"

class ColorSpaceStruct;
enum class ColorSpaceCode : int32_t;

// How the spectral node builds its tristimulus weights, with their stored values.
enum class WeightingMethod : int32_t {
    Direct = 0,        // the colour-matching functions at the band wavelengths
    OneNanometre = 1,  // spectra resampled to 1 nm
    FixedTableA = 2,   // the precomputed 10-nm sets of the first kind
    FixedTableB = 3,   // the precomputed 10-nm set of the second kind
    Sprague = 4,
    Lagrange = 5,
};

// Abstract description of a color space; ColorSpaceStruct is the one concrete kind.
class PIGMO_API DescriptionStruct {
public:
    virtual std::unique_ptr<ColorSpaceStruct> Clone() const = 0;
    virtual int32_t GetChannelCount() const = 0;
    virtual bool Equals(const ColorSpaceStruct* other) const = 0;
    virtual double GetMinimum(int32_t channel) const = 0;
    virtual double GetMaximum(int32_t channel) const = 0;
    virtual ~DescriptionStruct() = default;
};

// In which color space values are given and under which circumstances.
class PIGMO_API ColorSpaceStruct : public DescriptionStruct {
public:
    int32_t type = 0;  // color-space code; 0 = none
    int32_t observer = 0;
    double observerAge = 32.0;
    double fieldSize = 2.0;
    double whitePoint[3] = {0.96422, 1.0, 0.82521};
    bool hasIlluminant = false;
    IlluminantStruct illuminant;
    double wavelengthStart = 0.0;
    double wavelengthEnd = 0.0;
    double wavelengthStep = 0.0;
    int32_t weighting = static_cast<int32_t>(WeightingMethod::Sprague);
    double viewingConditions[6] = {};
    bool emissive = false;
    std::vector<double> minimum;  // empty: default range
    std::vector<double> maximum;  // empty: default range

    ColorSpaceStruct();
    ColorSpaceStruct(const ColorSpaceStruct&) = default;
    ColorSpaceStruct& operator=(const ColorSpaceStruct&) = default;
    ~ColorSpaceStruct() override = default;

    std::unique_ptr<ColorSpaceStruct> Clone() const override;
    int32_t GetChannelCount() const override;
    bool Equals(const ColorSpaceStruct* other) const override;
    double GetMinimum(int32_t channel) const override;
    double GetMaximum(int32_t channel) const override;

    // Refuses codes 28 to 36; otherwise stores the code and drops both range arrays.
    virtual bool SetType(int32_t code);
    virtual int32_t GetType() const { return type; }
    bool SetType(ColorSpaceCode code) { return SetType(static_cast<int32_t>(code)); }
    ColorSpaceCode Code() const { return static_cast<ColorSpaceCode>(type); }
    bool Is(ColorSpaceCode code) const { return type == static_cast<int32_t>(code); }
    virtual bool IsCompatible(const ColorSpaceStruct* other) const;

    bool SetMaximum(int32_t channel, double value);
    bool SetMinimum(int32_t channel, double value);
    void ApplyViewingPreset(int32_t preset);  // 0..6
    bool HasDefaultRanges() const;
    // The white the nodes use: the illuminant's relative white when hasIlluminant is set.
    const double* EffectiveWhite() const;

    static int32_t ChannelCountOf(int32_t code);  // for codes whose count does not depend on the grid
    static double DefaultMinimum(int32_t code, int32_t channel);
    static double DefaultMaximum(int32_t code, int32_t channel);
    static bool SameSpace(const ColorSpaceStruct& a, const ColorSpaceStruct& b);
    static bool SameWhite(const ColorSpaceStruct& a, const ColorSpaceStruct& b);
    // Band count of an evenly spaced grid: trunc((end - start) / step + 0.5) + 1.
    static int32_t BandCount(double start, double end, double step);
    // The color books' spectra: 36 bands, 380 to 730 nm by 10 nm, under the given illuminant.
    static ColorSpaceStruct BookSpectrum(IlluminantKind illuminantKind, double temperature);
};
