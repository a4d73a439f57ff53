#pragma once

#include <memory>

#include "ColorSpace.h"
#include "ColorSpaceStruct.h"
#include "Export.h"

// CIECAM02 appearance correlates (CIE 159:2004) of connection-space colors. The viewing model is
// computed once from the description; the derived classes only choose which three correlates
// they write and read.
class PIGMO_API cColorSpaceCIECAM02 : public cColorSpace {
public:
    explicit cColorSpaceCIECAM02(const ColorSpaceStruct& description);

    // The node of codes 10 to 21; null for any other code.
    static std::unique_ptr<cColorSpaceCIECAM02> Create(const ColorSpaceStruct& description);

    double FL() const { return fl_; }
    double D() const { return d_; }

protected:
    // A layout names its channels: lightness 'J' or 'Q', colorfulness 'C', 'M' or 's', then the
    // hue in degrees, or with cartesian the colorfulness times cos h and sin h.
    struct Layout {
        char lightness;
        char colorfulness;
        bool cartesian;
    };
    void Appearance(Layout layout, const double* xyz, double* out) const;
    void Stimulus(Layout layout, const double* in, double* xyz) const;

private:
    struct Correlates {
        double J, C, h, M, Q, s;
    };
    Correlates Forward(const double* xyz) const;
    void Inverse(double J, double C, double h, double* xyz) const;
    // Post-adaptation cone responses of CAT02 responses.
    void CompressedResponses(const double* rgb, double* compressed) const;
    double AchromaticResponse(const double* compressed) const;
    double BrightnessScale() const { return (4.0 / c_) * (aw_ + 4.0) * fl4_; }

    double c_;
    double z_;
    double fl_;
    double d_;
    double nbb_;       // equal to Ncb
    double adapt_[3];  // (Yw / Rw)·D + 1 − D for each cone
    double aw_;
    bool absolute_;
    // Constant factors of every color's correlates.
    double fl4_;          // FL^0.25
    double chromaScale_;  // (1.64 − 0.29^n)^0.73
    double hueScale_;     // Nc · 12500/13 · Ncb
};

// Binds a channel layout to the model; the twelve spaces below are its instances.
template <char L, char K, bool Cartesian>
class PIGMO_API cColorSpaceCIECAM02Layout : public cColorSpaceCIECAM02 {
    static_assert(L == 'J' || L == 'Q');
    static_assert(K == 'C' || K == 'M' || K == 's');

public:
    using cColorSpaceCIECAM02::cColorSpaceCIECAM02;
    void ToXYZ(const double* in, double* xyz) override { Stimulus({L, K, Cartesian}, in, xyz); }
    void FromXYZ(const double* xyz, double* out) override { Appearance({L, K, Cartesian}, xyz, out); }
};

// clang-format off
class PIGMO_API cColorSpaceCIECAM02_JCh final : public cColorSpaceCIECAM02Layout<'J', 'C', false> { public: using cColorSpaceCIECAM02Layout::cColorSpaceCIECAM02Layout; };
class PIGMO_API cColorSpaceCIECAM02_JMh final : public cColorSpaceCIECAM02Layout<'J', 'M', false> { public: using cColorSpaceCIECAM02Layout::cColorSpaceCIECAM02Layout; };
class PIGMO_API cColorSpaceCIECAM02_Jsh final : public cColorSpaceCIECAM02Layout<'J', 's', false> { public: using cColorSpaceCIECAM02Layout::cColorSpaceCIECAM02Layout; };
class PIGMO_API cColorSpaceCIECAM02_JChab final : public cColorSpaceCIECAM02Layout<'J', 'C', true> { public: using cColorSpaceCIECAM02Layout::cColorSpaceCIECAM02Layout; };
class PIGMO_API cColorSpaceCIECAM02_JMhab final : public cColorSpaceCIECAM02Layout<'J', 'M', true> { public: using cColorSpaceCIECAM02Layout::cColorSpaceCIECAM02Layout; };
class PIGMO_API cColorSpaceCIECAM02_Jshab final : public cColorSpaceCIECAM02Layout<'J', 's', true> { public: using cColorSpaceCIECAM02Layout::cColorSpaceCIECAM02Layout; };
class PIGMO_API cColorSpaceCIECAM02_QCh final : public cColorSpaceCIECAM02Layout<'Q', 'C', false> { public: using cColorSpaceCIECAM02Layout::cColorSpaceCIECAM02Layout; };
class PIGMO_API cColorSpaceCIECAM02_QMh final : public cColorSpaceCIECAM02Layout<'Q', 'M', false> { public: using cColorSpaceCIECAM02Layout::cColorSpaceCIECAM02Layout; };
class PIGMO_API cColorSpaceCIECAM02_Qsh final : public cColorSpaceCIECAM02Layout<'Q', 's', false> { public: using cColorSpaceCIECAM02Layout::cColorSpaceCIECAM02Layout; };
class PIGMO_API cColorSpaceCIECAM02_QChab final : public cColorSpaceCIECAM02Layout<'Q', 'C', true> { public: using cColorSpaceCIECAM02Layout::cColorSpaceCIECAM02Layout; };
class PIGMO_API cColorSpaceCIECAM02_QMhab final : public cColorSpaceCIECAM02Layout<'Q', 'M', true> { public: using cColorSpaceCIECAM02Layout::cColorSpaceCIECAM02Layout; };
class PIGMO_API cColorSpaceCIECAM02_Qshab final : public cColorSpaceCIECAM02Layout<'Q', 's', true> { public: using cColorSpaceCIECAM02Layout::cColorSpaceCIECAM02Layout; };
// clang-format on
