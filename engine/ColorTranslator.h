#pragma once

#include <cstdint>
#include <memory>
#include <vector>

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
    cColorTranslator();
    ~cColorTranslator();
    cColorTranslator(const cColorTranslator&) = delete;
    cColorTranslator& operator=(const cColorTranslator&) = delete;

    int32_t SetSource(const ColorSpaceStruct& description);
    int32_t SetDestination(const ColorSpaceStruct& description);
    void SetAdaptation(int32_t method);  // 0 none, 1 XYZ scaling, 2 Bradford, 3 Sharp, 4 CMCCAT2000, 5 CAT02
    void SetClampLabSource(bool clamp) { clampLabSource_ = clamp; }
    int32_t Build();  // 0, or kTranslatorRefused

    // 0 on success, 1 when the pair cannot be converted (out untouched).
    int32_t Translate(const double* in, double* out);
    int32_t TranslateCollection(const cDataCollection& in, cDataCollection& out);

    const ColorSpaceStruct* Source() const { return source_.get(); }
    const ColorSpaceStruct* Destination() const { return destination_.get(); }
    bool IsIdentity() const { return identity_; }
    bool IsFailed() const { return failed_; }
    int32_t NodeCount() const { return static_cast<int32_t>(nodes_.size()); }
    const cColorSpace* Node(int32_t index) const { return nodes_[index].get(); }

private:
    // (implementation detail: fields follow)
    std::unique_ptr<ColorSpaceStruct> source_;
    std::unique_ptr<ColorSpaceStruct> destination_;
    bool identity_ = false;
    bool failed_ = false;
    std::vector<std::unique_ptr<cColorSpace>> nodes_;
    std::vector<int32_t> operations_;
    int32_t adaptationMethod_ = 0;
    int32_t adaptationStep_ = 0;
    bool hasAdaptation_ = false;
    double adaptation_[9] = {};
    std::vector<double> inputBuffer_;
    std::vector<double> intermediate_[2];
    std::vector<double> inputScale_, outputScale_, inputOffset_, outputOffset_;
    bool clampLabSource_ = true;
};
