#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "ChromaticAdaptation.h"
#include "ColorSpace.h"
#include "ColorSpaceStruct.h"
#include "DataCollection.h"
#include "Export.h"

// Build() result when validation refuses the pair.
inline constexpr int32_t kTranslatorRefused = 83;

// Converts colors from a source description to a destination description through a short
// chain of nodes that meet in CIE XYZ (white Y = 1). Translate allocates nothing.
class PIGMO_API cColorTranslator {
public:
    // Which node operation a chain step calls.
    enum Operation : int32_t {
        kConvert = 0,
        kToXYZ = 1,
        kFromXYZ = 2,
        kToSpectral = 3,
        kFromSpectral = 4,
        kToComponents = 5,
        kFromComponents = 6
    };

    cColorTranslator();
    ~cColorTranslator();
    cColorTranslator(const cColorTranslator&) = delete;
    cColorTranslator& operator=(const cColorTranslator&) = delete;

    // Each setter keeps a clone and rebuilds when the other side is set; returns Build()'s result or 0.
    int32_t SetSource(const ColorSpaceStruct& description);
    int32_t SetDestination(const ColorSpaceStruct& description);
    void SetAdaptation(AdaptationMethod method);
    void SetClampLabSource(bool clamp) { clampLabSource_ = clamp; }
    // 0, or kTranslatorRefused. A refused pair is also marked failed, so Translate reports it.
    int32_t Build();

    // 0 on success, 1 when the pair cannot be converted (out untouched). in holds the source's
    // channel count of values, out the destination's.
    int32_t Translate(const double* in, double* out);
    // count colors one after the other, each exactly as Translate converts it.
    int32_t TranslateArray(const double* in, double* out, size_t count);
    // Rows of in into rows of out (resized); the collections' descriptions replace the engine's
    // when they differ. Stops at the first failing row and returns its status.
    int32_t TranslateCollection(const cDataCollection& in, cDataCollection& out);

    const ColorSpaceStruct* Source() const { return source_.get(); }
    const ColorSpaceStruct* Destination() const { return destination_.get(); }
    bool IsIdentity() const { return identity_; }
    bool IsFailed() const { return failed_; }
    // Why the pair is refused or cannot be converted; empty when it can.
    const std::string& FailureReason() const { return reason_; }
    int32_t NodeCount() const { return static_cast<int32_t>(nodes_.size()); }
    const cColorSpace* Node(int32_t index) const { return nodes_[index].get(); }
    int32_t NodeOperation(int32_t index) const { return operations_[index]; }
    const ChromaticAdaptation* Adaptation() const { return adaptation_ ? &*adaptation_ : nullptr; }

private:
    // One color through the whole chain, for chains whose node types are known when built: one call
    // instead of the step loop's calls through operation codes and virtual functions.
    using Kernel = void (*)(cColorTranslator& translator, const double* in, double* out, size_t count);
    template <class... Nodes>
    struct NodeTypes {};
    template <class From, class To>
    static void ThroughXYZ(cColorTranslator& translator, const double* in, double* out, size_t count);
    template <class Node>
    static void Direct(cColorTranslator& translator, const double* in, double* out, size_t count);
    template <class From, class... To>
    static Kernel KernelFrom(const cColorSpace& first, const cColorSpace& last, NodeTypes<To...>);
    template <class... From, class... To>
    static Kernel KernelFor(const cColorSpace& first, const cColorSpace& last, NodeTypes<From...>,
                            NodeTypes<To...> ends);
    Kernel ChooseKernel() const;
    void RunSteps(const double* in, double* out);
    void MapOutput(double* out) const;
    void Adapt(double* xyz) const;

    bool BothSidesSet() const;
    // Why validation refuses the pair; empty when it does not.
    std::string Refusal() const;
    void MapRanges();
    void SelectNodes();
    void Invalidate();

    std::unique_ptr<ColorSpaceStruct> source_;
    std::unique_ptr<ColorSpaceStruct> destination_;
    bool identity_ = false;
    bool failed_ = true;  // nothing to convert until a pair is built
    std::string reason_ = "no source or destination";
    std::vector<std::unique_ptr<cColorSpace>> nodes_;
    std::vector<int32_t> operations_;
    Kernel kernel_ = nullptr;
    AdaptationMethod adaptationMethod_ = AdaptationMethod::None;
    int32_t adaptationStep_ = 0;  // node after which the adaptation applies; -1 for none
    std::optional<ChromaticAdaptation> adaptation_;
    std::vector<double> inputBuffer_;
    size_t outputWidth_ = 0;  // the destination's channel count
    std::vector<double> intermediate_[2];
    std::vector<double> inputScale_, outputScale_, inputOffset_, outputOffset_;
    bool clampLabSource_ = true;
};
