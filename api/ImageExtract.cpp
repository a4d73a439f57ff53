#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <vector>

#include "CentroidLookup.h"
#include "ColorSpaceLab.h"
#include "ColorSpaceSRGB.h"
#include "ColorSpaceTable.h"
#include "IsccNbsCatalogue.h"
#include "pigmo/bp.h"

namespace {

// The distinct sampled colors, how often each occurs and the latest position at which it occurs
// in sampling order. Converting each distinct color once instead of every sample is what makes
// large images affordable: photographs repeat their colors many times over.
class ColorTally {
public:
    struct Entry {
        uint32_t rgb = kEmpty;
        uint32_t count = 0;
        uint64_t last = 0;
    };

    ColorTally() : slots_(size_t{1} << kInitialBits) {}

    // False when the table has reached its size limit or a count its maximum; Clear it before
    // adding more.
    bool Add(uint32_t rgb, uint64_t position) {
        if (rgb != recent_) {
            const size_t slot = Find(rgb);
            if (slot == kFull) return false;
            recent_ = rgb;
            recentSlot_ = slot;
        }
        Entry& entry = slots_[recentSlot_];
        if (entry.count == UINT32_MAX) return false;
        ++entry.count;
        entry.last = std::max(entry.last, position);
        return true;
    }

    // Starts loading the slot a color will probe first; the table outgrows the caches.
    void Prefetch(uint32_t rgb) const { __builtin_prefetch(&slots_[Home(rgb)]); }

    const std::vector<Entry>& Slots() const { return slots_; }

    void Clear() {
        std::fill(slots_.begin(), slots_.end(), Entry{});
        used_ = 0;
        recent_ = kEmpty;
    }

private:
    static constexpr uint32_t kEmpty = 0xFFFFFFFFu;
    static constexpr size_t kFull = ~size_t{0};
    static constexpr int kInitialBits = 10;
    // 8 MB of slots: noise-like images are converted in several rounds instead of growing further.
    static constexpr int kMaximumBits = 19;

    // Fibonacci hashing: the high bits of the product mix all three channels.
    size_t Home(uint32_t rgb) const { return (rgb * 0x9E3779B97F4A7C15ull) >> (64 - bits_); }

    size_t Find(uint32_t rgb) {
        const size_t mask = slots_.size() - 1;
        size_t slot = Home(rgb);
        while (slots_[slot].rgb != rgb) {
            if (slots_[slot].rgb == kEmpty) {
                // Kept at most half full so probe runs stay short.
                if (2 * (used_ + 1) > slots_.size()) {
                    if (bits_ == kMaximumBits) return kFull;
                    Grow();
                    return Find(rgb);
                }
                slots_[slot].rgb = rgb;
                ++used_;
                return slot;
            }
            slot = (slot + 1) & mask;
        }
        return slot;
    }

    void Grow() {
        std::vector<Entry> old(slots_.size() * 2);
        old.swap(slots_);
        ++bits_;
        const size_t mask = slots_.size() - 1;
        for (const Entry& entry : old) {
            if (entry.rgb == kEmpty) continue;
            size_t slot = Home(entry.rgb);
            while (slots_[slot].rgb != kEmpty) slot = (slot + 1) & mask;
            slots_[slot] = entry;
        }
    }

    std::vector<Entry> slots_;
    int bits_ = kInitialBits;
    size_t used_ = 0;
    uint32_t recent_ = kEmpty;
    size_t recentSlot_ = 0;
};

// The samples that fell to one centroid.
struct Group {
    uint64_t count = 0;
    uint64_t last = 0;  // position of the sample that brought the count to its final value
    double lab[3] = {};
    double distance = 1e20;
};

// BPConvertsRGB2Lab of 8-bit colors, to the last bit: the same sRGB and Lab steps, with the
// transfer function looked up for the 256 values a channel can take.
class ByteSRGBToLab {
public:
    ByteSRGBToLab() : lab_(cColorSpaceTable::DefaultDescription(ColorSpaceCode::Lab)) {
        for (int v = 0; v < 256; ++v) linear_[v] = cColorSpaceSRGB::DecodeSRGB(v / 255.0);
    }

    void Convert(uint32_t rgb, double* lab) const {
        const double linear[3] = {linear_[rgb >> 16], linear_[(rgb >> 8) & 0xFF], linear_[rgb & 0xFF]};
        double xyz[3];
        cColorSpaceSRGB::LinearToXYZ(linear, xyz);
        lab_.FromXYZ(xyz, lab);
    }

private:
    double linear_[256];
    // FromXYZ changes nothing, so threads share it; the node interface just is not const.
    mutable cColorSpaceLab lab_;
};

// Adds the tallied colors to the groups of their nearest centroids, as Lab sums until averaged.
void AddToGroups(const ColorTally& tally, std::vector<Group>& groups) {
    static const ByteSRGBToLab toLab;
    const cCentroidLookup& lookup = cCentroidLookup::Instance();
    for (const ColorTally::Entry& entry : tally.Slots()) {
        if (entry.count == 0) continue;
        double lab[3];
        toLab.Convert(entry.rgb, lab);
        const int32_t index = lookup.Nearest(lab);
        if (index < 1) continue;
        Group& group = groups[index - 1];
        group.count += entry.count;
        group.last = std::max(group.last, entry.last);
        const double weight = static_cast<double>(entry.count);
        for (int i = 0; i < 3; ++i) group.lab[i] += weight * lab[i];
    }
}

uint32_t ColorAt(const unsigned char* row, int x) {
    const unsigned char* pixel = row + static_cast<size_t>(x) * 4;
    return (uint32_t{pixel[1]} << 16) | (uint32_t{pixel[2]} << 8) | pixel[3];
}

// Every second pixel from the last one backwards, column by column from the right, each column
// from the bottom. Rows are walked in memory order; each sample's place in that column order is
// computed instead, since only the tie between equally large groups depends on it.
void SampleIntoGroups(const unsigned char* pixels, int width, int height, std::vector<Group>& groups) {
    constexpr int kAhead = 32;  // pixels, 16 samples
    ColorTally tally;
    const uint64_t rowsSampled = (static_cast<uint64_t>(height) + 1) / 2;
    for (int y = height - 1; y >= 0; y -= 2) {
        const unsigned char* row = pixels + static_cast<size_t>(y) * static_cast<size_t>(width) * 4;
        const uint64_t rowPlace = static_cast<uint64_t>(height - 1 - y) / 2;
        uint64_t column = 0;
        for (int x = width - 1; x >= 0; x -= 2, ++column) {
            if (x >= kAhead) tally.Prefetch(ColorAt(row, x - kAhead));
            const uint32_t rgb = ColorAt(row, x);
            const uint64_t position = column * rowsSampled + rowPlace;
            if (!tally.Add(rgb, position)) {
                AddToGroups(tally, groups);
                tally.Clear();
                tally.Add(rgb, position);
            }
        }
    }
    AddToGroups(tally, groups);
}

// Averages the groups and writes the means of `wanted` of them, largest group first, then
// farthest first weighted by size: each pick maximises count x (squared distance)^2 to the
// nearest pick so far. Once every score is 0 the last pick repeats to the end. Returns the
// number written.
int SelectDominant(std::vector<Group>& groups, int wanted, double* labOut) {
    // The leader is the largest group, and of equal ones the first to reach that size.
    const Group* selected = nullptr;
    for (Group& group : groups) {
        if (group.count == 0) continue;
        for (double& value : group.lab) value /= static_cast<double>(group.count);
        if (!selected || group.count > selected->count ||
            (group.count == selected->count && group.last < selected->last)) {
            selected = &group;
        }
    }
    int written = 0;
    bool exhausted = false;
    while (selected && written < wanted) {
        std::copy_n(selected->lab, 3, labOut + 3 * written);
        ++written;
        if (exhausted || written == wanted) continue;
        const Group* next = selected;
        double bestScore = 0.0;
        for (Group& group : groups) {
            if (group.count == 0) continue;
            group.distance =
                std::min(group.distance, cCentroidLookup::DistanceSquared(group.lab, selected->lab));
            const double score = static_cast<double>(group.count) * group.distance * group.distance;
            if (score > bestScore) {
                bestScore = score;
                next = &group;
            }
        }
        exhausted = next == selected;
        selected = next;
    }
    return written;
}

}  // namespace

extern "C" void BPImageExtractLab(const unsigned char* pixels, int width, int height, int colourCount,
                                  double* labOut, int* countOut) {
    int written = 0;
    if (pixels != nullptr && labOut != nullptr && width > 0 && height > 0) {
        std::vector<Group> groups(kIsccNbsCentroidCount);
        SampleIntoGroups(pixels, width, height, groups);
        written = SelectDominant(groups, colourCount < 1 ? 10 : colourCount, labOut);
    }
    if (countOut) *countOut = written;
}
