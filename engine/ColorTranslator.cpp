#include "ColorTranslator.h"

#include <algorithm>
#include <string>
#include <typeinfo>

#include "ColorSpaceCIECAM02.h"
#include "ColorSpaceDensity.h"
#include "ColorSpaceLab.h"
#include "ColorSpaceLabtoLch.h"
#include "ColorSpaceLch.h"
#include "ColorSpaceLchtoLab.h"
#include "ColorSpaceLinearRIMM.h"
#include "ColorSpaceLinearSRGB.h"
#include "ColorSpaceLux.h"
#include "ColorSpaceSRGB.h"
#include "ColorSpaceSpectral.h"
#include "ColorSpaceTable.h"
#include "ColorSpaceXYZ.h"
#include "ColorSpaceYxy.h"

namespace {

using enum ColorSpaceCode;

bool InRange(int32_t code, int32_t low, int32_t high) {
    return code >= low && code <= high;
}

std::string Named(int32_t code) {
    const ColorSpaceEntry* entry = cColorSpaceTable::Find(code);
    return entry ? std::string(entry->name) + " (" + std::to_string(code) + ")"
                 : "code " + std::to_string(code);
}

using NodeOperation = void (cColorSpace::*)(const double*, double*);

// Indexed by cColorTranslator::Operation.
constexpr NodeOperation kOperations[] = {
    &cColorSpace::Convert,        &cColorSpace::ToXYZ,        &cColorSpace::FromXYZ,
    &cColorSpace::ToSpectral,     &cColorSpace::FromSpectral, &cColorSpace::ToComponents,
    &cColorSpace::FromComponents,
};

// Per channel, value' = offset + value * scale from the declared range onto the code's default one
// (toDefault) or back.
void MapChannels(const ColorSpaceStruct& d, bool toDefault, std::vector<double>& scale,
                 std::vector<double>& offset) {
    const int32_t count = d.GetChannelCount();
    scale.resize(count);
    offset.resize(count);
    for (int32_t i = 0; i < count; ++i) {
        const double defaultMin = ColorSpaceStruct::DefaultMinimum(d.type, i);
        const double defaultMax = ColorSpaceStruct::DefaultMaximum(d.type, i);
        const double fromMin = toDefault ? d.GetMinimum(i) : defaultMin;
        const double fromMax = toDefault ? d.GetMaximum(i) : defaultMax;
        const double toMin = toDefault ? defaultMin : d.GetMinimum(i);
        const double toMax = toDefault ? defaultMax : d.GetMaximum(i);
        scale[i] = (toMax - toMin) / (fromMax - fromMin);
        offset[i] = toMin - fromMin * scale[i];
    }
}

// --- Node selection: the one place that maps codes to nodes. ---

// Node of a space that can stand at either end of a chain through XYZ; null when none is built.
std::unique_ptr<cColorSpace> ColorimetricNode(const ColorSpaceStruct& d) {
    switch (d.Code()) {
        case Lab:
            return std::make_unique<cColorSpaceLab>(d);
        case Lch:
            return std::make_unique<cColorSpaceLch>(d);
        case XYZ:
            return std::make_unique<cColorSpaceXYZ>();
        case Yxy:
            return std::make_unique<cColorSpaceYxy>(d);
        case SRGB:
            return std::make_unique<cColorSpaceSRGB>();
        case LinearSRGB:
            return std::make_unique<cColorSpaceLinearSRGB>();
        case LinearRIMM:
            return std::make_unique<cColorSpaceLinearRIMM>();
        default:
            return cColorSpaceCIECAM02::Create(d);  // the CIECAM02 spaces; null for the rest
    }
}

// First node of a chain through XYZ: source values to XYZ.
std::unique_ptr<cColorSpace> SourceNode(const ColorSpaceStruct& source, const ColorSpaceStruct& destination) {
    if (source.Is(Spectral)) return std::make_unique<cColorSpaceSpectral>(source, destination);
    return ColorimetricNode(source);
}

// Last node of a chain through XYZ: XYZ to destination values.
std::unique_ptr<cColorSpace> DestinationNode(const ColorSpaceStruct& destination) {
    // Illuminance keeps only Y, so it is a destination and never a source.
    if (destination.Is(Lux)) return std::make_unique<cColorSpaceLux>();
    return ColorimetricNode(destination);
}

// One node that converts without passing through XYZ; null when the pair takes the XYZ chain.
std::unique_ptr<cColorSpace> DirectNode(const ColorSpaceStruct& source, const ColorSpaceStruct& destination) {
    if (!ColorSpaceStruct::SameWhite(source, destination)) return nullptr;
    if (source.Is(Lab) && destination.Is(Lch)) return std::make_unique<cColorSpaceLabtoLch>();
    if (source.Is(Lch) && destination.Is(Lab)) return std::make_unique<cColorSpaceLchtoLab>();
    return nullptr;
}

}  // namespace

cColorTranslator::cColorTranslator() = default;
cColorTranslator::~cColorTranslator() = default;

bool cColorTranslator::BothSidesSet() const {
    return source_ && destination_ && !source_->Is(None) && !destination_->Is(None);
}

int32_t cColorTranslator::SetSource(const ColorSpaceStruct& description) {
    source_ = description.Clone();
    if (destination_ && !destination_->Is(None)) return Build();
    Invalidate();
    return 0;
}

int32_t cColorTranslator::SetDestination(const ColorSpaceStruct& description) {
    destination_ = description.Clone();
    if (source_ && !source_->Is(None)) return Build();
    Invalidate();
    return 0;
}

void cColorTranslator::SetAdaptation(AdaptationMethod method) {
    adaptationMethod_ = method;
    if (BothSidesSet()) Build();
}

std::string cColorTranslator::Refusal() const {
    const bool spectralSource = source_->Is(Spectral) || source_->Is(UVOnOff);
    // Spectral sources bring their own observer; every other pair must share one.
    if (!spectralSource &&
        (source_->observer != destination_->observer || source_->observerAge != destination_->observerAge ||
         source_->fieldSize != destination_->fieldSize)) {
        return "the source and the destination have different observers";
    }
    if (destination_->Is(Spectral) && !spectralSource && !InRange(source_->type, 28, 45))
        return "spectral values come only from spectral values";
    if (source_->Is(Density) && !identity_) return "densities convert only to the same density description";
    if (destination_->Is(Density) && !source_->Is(Density) && !source_->Is(Spectral))
        return "densities come only from spectral values";
    return {};
}

// Until the next build there is nothing to convert with: the chain belongs to the old pair.
void cColorTranslator::Invalidate() {
    nodes_.clear();
    operations_.clear();
    kernel_ = nullptr;
    adaptation_.reset();
    adaptationStep_ = -1;
    intermediate_[0].clear();
    intermediate_[1].clear();
    inputScale_.clear();
    outputScale_.clear();
    inputOffset_.clear();
    outputOffset_.clear();
    identity_ = false;
    failed_ = true;
    reason_ = "no source or destination";
}

int32_t cColorTranslator::Build() {
    Invalidate();
    if (!source_ || !destination_) return 0;

    inputBuffer_.assign(std::max(source_->GetChannelCount(), 0), 0.0);
    outputWidth_ = static_cast<size_t>(std::max(destination_->GetChannelCount(), 0));
    for (ColorSpaceStruct* description : {source_.get(), destination_.get()}) {
        if (description->hasIlluminant)
            std::copy_n(description->illuminant.relativeWhite, 3, description->whitePoint);
    }
    identity_ = ColorSpaceStruct::SameSpace(*source_, *destination_);
    // A refused pair stays failed with no chain: keeping the chain of the previous pair would
    // convert with nodes that no longer match the descriptions.
    if (std::string refusal = Refusal(); !refusal.empty()) {
        identity_ = false;
        reason_ = std::move(refusal);
        return kTranslatorRefused;
    }
    failed_ = false;
    reason_.clear();
    MapRanges();
    if (identity_) return 0;

    SelectNodes();
    if (failed_) return 0;
    if (adaptationMethod_ >= AdaptationMethod::XYZScaling && adaptationMethod_ <= AdaptationMethod::CAT02) {
        adaptation_.emplace(adaptationMethod_, source_->whitePoint, destination_->whitePoint);
    }
    kernel_ = ChooseKernel();
    return 0;
}

namespace {
// Colors of three channels, one after the other, as rows of three.
const double (*Triples(const double* values))[3] {
    return reinterpret_cast<const double(*)[3]>(values);
}
double (*Triples(double* values))[3] {
    return reinterpret_cast<double(*)[3]>(values);
}
}  // namespace

template <class From, class To>
void cColorTranslator::ThroughXYZ(cColorTranslator& translator, const double* in, double* out, size_t count) {
    From& first = static_cast<From&>(*translator.nodes_[0]);
    To& last = static_cast<To&>(*translator.nodes_[1]);
    const size_t inWidth = translator.inputBuffer_.size();
    const size_t outWidth = translator.outputWidth_;
    // A block at a time, each step over the whole block: one color's step no longer waits for the
    // step before it, so the processor overlaps the steps of neighbouring colors. Nodes with a
    // step for many colors of three channels run it over the block at once.
    constexpr size_t kBlock = 16;
    double xyz[kBlock][3];
    for (size_t done = 0; done < count; done += kBlock) {
        const size_t block = std::min(kBlock, count - done);
        const double* blockIn = in + done * inWidth;
        double* blockOut = out + done * outWidth;
        if constexpr (requires { first.ToXYZ(Triples(blockIn), xyz, block); }) {
            first.ToXYZ(Triples(blockIn), xyz, block);
        } else {
            for (size_t i = 0; i < block; ++i) {
                xyz[i][0] = xyz[i][1] = xyz[i][2] = 0.0;  // an inert spectral node writes nothing
                first.From::ToXYZ(blockIn + i * inWidth, xyz[i]);
            }
        }
        for (size_t i = 0; i < block; ++i) translator.Adapt(xyz[i]);
        if constexpr (requires { last.FromXYZ(xyz, Triples(blockOut), block); }) {
            last.FromXYZ(xyz, Triples(blockOut), block);
        } else {
            for (size_t i = 0; i < block; ++i) last.To::FromXYZ(xyz[i], blockOut + i * outWidth);
        }
    }
}

template <class Node>
void cColorTranslator::Direct(cColorTranslator& translator, const double* in, double* out, size_t count) {
    Node& node = static_cast<Node&>(*translator.nodes_[0]);
    for (size_t i = 0; i < count; ++i, in += 3, out += 3) node.Node::Convert(in, out);
}

template <class From, class... To>
cColorTranslator::Kernel cColorTranslator::KernelFrom(const cColorSpace& first, const cColorSpace& last,
                                                      NodeTypes<To...>) {
    Kernel kernel = nullptr;
    if (typeid(first) == typeid(From))
        ((typeid(last) == typeid(To) && (kernel = &ThroughXYZ<From, To>)) || ...);
    return kernel;
}

template <class... From, class... To>
cColorTranslator::Kernel cColorTranslator::KernelFor(const cColorSpace& first, const cColorSpace& last,
                                                     NodeTypes<From...>, NodeTypes<To...> ends) {
    Kernel kernel = nullptr;
    ((kernel = KernelFrom<From>(first, last, ends)) || ...);
    return kernel;
}

// The conversions among Lab, LCh, XYZ, sRGB and linear sRGB, and from spectra to them.
cColorTranslator::Kernel cColorTranslator::ChooseKernel() const {
    if (nodes_.size() == 1 && operations_[0] == kConvert) {
        if (typeid(*nodes_[0]) == typeid(cColorSpaceLabtoLch)) return &Direct<cColorSpaceLabtoLch>;
        if (typeid(*nodes_[0]) == typeid(cColorSpaceLchtoLab)) return &Direct<cColorSpaceLchtoLab>;
        return nullptr;
    }
    if (nodes_.size() != 2 || operations_[0] != kToXYZ) return nullptr;
    using Ends =
        NodeTypes<cColorSpaceLab, cColorSpaceLch, cColorSpaceXYZ, cColorSpaceSRGB, cColorSpaceLinearSRGB>;
    return KernelFor(*nodes_[0], *nodes_[1],
                     NodeTypes<cColorSpaceLab, cColorSpaceLch, cColorSpaceXYZ, cColorSpaceSRGB,
                               cColorSpaceLinearSRGB, cColorSpaceSpectral>{},
                     Ends{});
}

void cColorTranslator::SelectNodes() {
    // A spectrum goes to densities or to another wavelength grid in one step, without XYZ.
    if (source_->Is(Spectral) && destination_->Is(Density)) {
        nodes_.push_back(std::make_unique<cColorSpaceDensity>(*destination_, *source_));
        operations_ = {kConvert};
        adaptationStep_ = -1;
        return;
    }
    if (source_->Is(Spectral) && destination_->Is(Spectral)) {
        nodes_.push_back(std::make_unique<cColorSpaceSpectral>(*source_, *destination_));
        operations_ = {kToSpectral};
        adaptationStep_ = -1;
        return;
    }
    if (auto direct = DirectNode(*source_, *destination_)) {
        nodes_.push_back(std::move(direct));
        operations_ = {kConvert};
        adaptationStep_ = -1;
        return;
    }
    auto first = SourceNode(*source_, *destination_);
    auto last = DestinationNode(*destination_);
    // Spaces whose nodes are not built here (and the codes without any node) cannot be converted.
    if (!first || !last) {
        failed_ = true;
        reason_ = "no conversion " + std::string(first ? "to " : "from ") +
                  Named(first ? destination_->type : source_->type) + " is built";
        return;
    }
    nodes_.push_back(std::move(first));
    nodes_.push_back(std::move(last));
    operations_ = {kToXYZ, kFromXYZ};
    adaptationStep_ = 0;
    intermediate_[0].assign(3, 0.0);
}

void cColorTranslator::MapRanges() {
    // Values in a declared range are mapped onto the default range of the code, the nodes' scale.
    if (!source_->HasDefaultRanges()) MapChannels(*source_, true, inputScale_, inputOffset_);
    if (!destination_->HasDefaultRanges()) MapChannels(*destination_, false, outputScale_, outputOffset_);
}

int32_t cColorTranslator::Translate(const double* in, double* out) {
    if (failed_) return 1;
    const double* cur = in;
    if (!inputScale_.empty()) {
        for (size_t i = 0; i < inputScale_.size(); ++i)
            inputBuffer_[i] = inputOffset_[i] + in[i] * inputScale_[i];
        cur = inputBuffer_.data();
    }
    if (kernel_) {
        kernel_(*this, cur, out, 1);
    } else if (identity_) {
        if (cur != out) std::copy_n(cur, inputBuffer_.size(), out);
    } else {
        RunSteps(cur, out);
    }
    MapOutput(out);
    return 0;
}

int32_t cColorTranslator::TranslateArray(const double* in, double* out, size_t count) {
    if (failed_) return 1;
    if (!kernel_ || !inputScale_.empty()) {
        for (size_t i = 0; i < count; ++i) Translate(in + i * inputBuffer_.size(), out + i * outputWidth_);
        return 0;
    }
    kernel_(*this, in, out, count);
    if (!outputScale_.empty()) {
        for (size_t i = 0; i < count; ++i) MapOutput(out + i * outputWidth_);
    }
    return 0;
}

void cColorTranslator::MapOutput(double* out) const {
    for (size_t i = 0; i < outputScale_.size(); ++i) out[i] = outputOffset_[i] + outputScale_[i] * out[i];
}

void cColorTranslator::RunSteps(const double* in, double* out) {
    const double* cur = in;
    const size_t count = nodes_.size();
    double* target = count == 1 ? out : intermediate_[0].data();
    for (size_t k = 0; k < count; ++k) {
        (nodes_[k].get()->*kOperations[operations_[k]])(cur, target);
        if (static_cast<int32_t>(k) == adaptationStep_) Adapt(target);
        cur = target;
        target = k + 2 == count ? out : intermediate_[(k + 1) % 2].data();
    }
}

// The step between the two nodes of a chain through XYZ.
void cColorTranslator::Adapt(double* xyz) const {
    // Lab beyond the gamut of real colors gives negative XYZ; cut it before adapting.
    if (clampLabSource_ && source_->Is(Lab)) {
        for (int i = 0; i < 3; ++i) {
            if (xyz[i] < 0.0) xyz[i] = 0.0;
        }
    }
    if (adaptation_) adaptation_->Apply(xyz);
}

int32_t cColorTranslator::TranslateCollection(const cDataCollection& in, cDataCollection& out) {
    if (const ColorSpaceStruct* description = in.Description();
        description && !description->Equals(source_.get())) {
        SetSource(*description);
    }
    if (const ColorSpaceStruct* description = out.Description();
        description && !description->Equals(destination_.get())) {
        SetDestination(*description);
    }
    if (!BothSidesSet()) return 1;
    // Rows narrower than the source would be read past their end.
    if (in.Columns() < source_->GetChannelCount()) return 1;
    out.Resize(in.Rows(), destination_->GetChannelCount());
    for (int32_t row = 0; row < in.Rows(); ++row) {
        if (const int32_t status = Translate(in.Row(row), out.Row(row)); status != 0) return status;
    }
    return 0;
}
