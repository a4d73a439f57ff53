#include "ColorTranslator.h"

#include <algorithm>

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
#include "ColorSpaceXYZ.h"
#include "ColorSpaceYxy.h"

namespace {

bool InRange(int32_t code, int32_t low, int32_t high) {
    return code >= low && code <= high;
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
    switch (d.type) {
        case 3:
            return std::make_unique<cColorSpaceLab>(d);
        case 4:
            return std::make_unique<cColorSpaceLch>(d);
        case 6:
            return std::make_unique<cColorSpaceXYZ>();
        case 8:
            return std::make_unique<cColorSpaceYxy>(d);
        case 24:
            return std::make_unique<cColorSpaceSRGB>();
        case 25:
            return std::make_unique<cColorSpaceLinearSRGB>();
        case 26:
            return std::make_unique<cColorSpaceLinearRIMM>();
        default:
            return cColorSpaceCIECAM02::Create(d);  // codes 10 to 21; null for the rest
    }
}

// First node of a chain through XYZ: source values to XYZ.
std::unique_ptr<cColorSpace> SourceNode(const ColorSpaceStruct& source, const ColorSpaceStruct& destination) {
    if (source.type == 2) return std::make_unique<cColorSpaceSpectral>(source, destination);
    return ColorimetricNode(source);
}

// Last node of a chain through XYZ: XYZ to destination values.
std::unique_ptr<cColorSpace> DestinationNode(const ColorSpaceStruct& destination) {
    // Illuminance keeps only Y, so it is a destination and never a source.
    if (destination.type == 27) return std::make_unique<cColorSpaceLux>();
    return ColorimetricNode(destination);
}

// One node that converts without passing through XYZ; null when the pair takes the XYZ chain.
std::unique_ptr<cColorSpace> DirectNode(const ColorSpaceStruct& source, const ColorSpaceStruct& destination) {
    if (!ColorSpaceStruct::SameWhite(source, destination)) return nullptr;
    if (source.type == 3 && destination.type == 4) return std::make_unique<cColorSpaceLabtoLch>();
    if (source.type == 4 && destination.type == 3) return std::make_unique<cColorSpaceLchtoLab>();
    return nullptr;
}

}  // namespace

cColorTranslator::cColorTranslator() = default;
cColorTranslator::~cColorTranslator() = default;

bool cColorTranslator::BothSidesSet() const {
    return source_ && destination_ && source_->type != 0 && destination_->type != 0;
}

int32_t cColorTranslator::SetSource(const ColorSpaceStruct& description) {
    source_ = description.Clone();
    if (destination_ && destination_->type != 0) return Build();
    Invalidate();
    return 0;
}

int32_t cColorTranslator::SetDestination(const ColorSpaceStruct& description) {
    destination_ = description.Clone();
    if (source_ && source_->type != 0) return Build();
    Invalidate();
    return 0;
}

void cColorTranslator::SetAdaptation(int32_t method) {
    adaptationMethod_ = method;
    if (BothSidesSet()) Build();
}

int32_t cColorTranslator::Validate() const {
    const int32_t s = source_->type;
    const int32_t d = destination_->type;
    // Spectral sources bring their own observer; every other pair must share one.
    if (s != 2 && s != 46 &&
        (source_->observer != destination_->observer || source_->observerAge != destination_->observerAge ||
         source_->fieldSize != destination_->fieldSize)) {
        return kTranslatorRefused;
    }
    if (d == 2 && s != 2 && s != 46 && !InRange(s, 28, 45)) return kTranslatorRefused;
    if (s == 1 && !identity_) return kTranslatorRefused;
    if (d == 1 && s != 1 && s != 2) return kTranslatorRefused;
    return 0;
}

// Until the next build there is nothing to convert with: the chain belongs to the old pair.
void cColorTranslator::Invalidate() {
    nodes_.clear();
    operations_.clear();
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
}

int32_t cColorTranslator::Build() {
    Invalidate();
    if (!source_ || !destination_) return 0;

    inputBuffer_.assign(std::max(source_->GetChannelCount(), 0), 0.0);
    for (ColorSpaceStruct* description : {source_.get(), destination_.get()}) {
        if (description->hasIlluminant)
            std::copy_n(description->illuminant.relativeWhite, 3, description->whitePoint);
    }
    identity_ = ColorSpaceStruct::SameSpace(*source_, *destination_);
    // A refused pair stays failed with no chain: keeping the chain of the previous pair would
    // convert with nodes that no longer match the descriptions.
    if (Validate() == kTranslatorRefused) {
        identity_ = false;
        return kTranslatorRefused;
    }
    failed_ = false;
    MapRanges();
    if (identity_) return 0;

    SelectNodes();
    if (failed_) return 0;
    if (InRange(adaptationMethod_, ChromaticAdaptation::kXYZScaling, ChromaticAdaptation::kCAT02)) {
        adaptation_.emplace(adaptationMethod_, source_->whitePoint, destination_->whitePoint);
    }
    return 0;
}

void cColorTranslator::SelectNodes() {
    // A spectrum goes to densities or to another wavelength grid in one step, without XYZ.
    if (source_->type == 2 && destination_->type == 1) {
        nodes_.push_back(std::make_unique<cColorSpaceDensity>(*destination_, *source_));
        operations_ = {kConvert};
        adaptationStep_ = -1;
        return;
    }
    if (source_->type == 2 && destination_->type == 2) {
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

    if (identity_) {
        if (cur != out) std::copy_n(cur, inputBuffer_.size(), out);
    } else {
        const size_t count = nodes_.size();
        double* target = count == 1 ? out : intermediate_[0].data();
        for (size_t k = 0; k < count; ++k) {
            (nodes_[k].get()->*kOperations[operations_[k]])(cur, target);
            if (static_cast<int32_t>(k) == adaptationStep_) {
                // Lab beyond the gamut of real colors gives negative XYZ; cut it before adapting.
                if (clampLabSource_ && source_->type == 3) {
                    for (int i = 0; i < 3; ++i) {
                        if (target[i] < 0.0) target[i] = 0.0;
                    }
                }
                if (adaptation_) adaptation_->Apply(target);
            }
            cur = target;
            target = k + 2 == count ? out : intermediate_[(k + 1) % 2].data();
        }
    }

    for (size_t i = 0; i < outputScale_.size(); ++i) out[i] = outputOffset_[i] + outputScale_[i] * out[i];
    return 0;
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
    if (!source_ || source_->type == 0 || !destination_ || destination_->type == 0) return 1;
    // Rows narrower than the source would be read past their end.
    if (in.Columns() < source_->GetChannelCount()) return 1;
    out.Resize(in.Rows(), destination_->GetChannelCount());
    for (int32_t row = 0; row < in.Rows(); ++row) {
        if (const int32_t status = Translate(in.Row(row), out.Row(row)); status != 0) return status;
    }
    return 0;
}
