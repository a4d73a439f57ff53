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

// The samples that fell to one centroid.
struct Group {
    uint64_t count = 0;
    uint64_t last = 0;  // position of the sample that brought the count to its final value
    double lab[3] = {};
    double distance = 1e20;
};

// BPConvertsRGB2Lab of 8-bit colors, to the last bit: the same sRGB and Lab steps, with each
// channel's share of X, Y and Z looked up for the 256 values it can take. The matrix adds the
// shares in channel order, and a share alone is what it gives for one channel with the others 0.
class ByteSRGBToLab {
public:
    ByteSRGBToLab() : lab_(cColorSpaceTable::DefaultDescription(ColorSpaceCode::Lab)) {
        for (int channel = 0; channel < 3; ++channel) {
            for (int v = 0; v < 256; ++v) {
                double linear[3] = {};
                linear[channel] = cColorSpaceSRGB::DecodeSRGB(v / 255.0);
                cColorSpaceSRGB::LinearToXYZ(linear, shares_[channel][v]);
            }
        }
    }

    void ToXYZ(uint32_t rgb, double* xyz) const {
        const double* r = shares_[0][rgb >> 16];
        const double* g = shares_[1][(rgb >> 8) & 0xFF];
        const double* b = shares_[2][rgb & 0xFF];
        for (int i = 0; i < 3; ++i) xyz[i] = r[i] + g[i] + b[i];
    }

    const cColorSpaceLab& Lab() const { return lab_; }

private:
    double shares_[3][256][3];
    cColorSpaceLab lab_;
};

// Counts of recently sampled colors in a direct-mapped table small enough for the caches. A color
// goes to its group, converted once for all its samples, when another color takes its slot:
// photographs repeat nearby colors many times over, and noise that repeats nothing pays a probe.
class RecentColors {
public:
    explicit RecentColors(std::vector<Group>& groups) : groups_(groups), entries_(size_t{1} << kBits) {}

    // Starts loading a color's slot ahead of its Add; the table outgrows the first-level cache.
    void Prefetch(uint32_t rgb) const { __builtin_prefetch(&entries_[Slot(rgb)]); }

    void Add(uint32_t rgb, uint64_t position) {
        // Runs of one color skip the probe.
        if (rgb != recent_->rgb) {
            recent_ = &entries_[Slot(rgb)];
            if (recent_->rgb != rgb) {
                Retire(*recent_);
                *recent_ = Entry{rgb, 0, 0};
            }
        }
        Entry& entry = *recent_;
        entry.last = std::max(entry.last, position);
        if (++entry.count == UINT32_MAX) {
            Retire(entry);
            entry = Entry{rgb, 0, 0};
        }
    }

    // Hands every color still counted to its group.
    void Finish() {
        for (Entry& entry : entries_) Retire(entry);
        AddRetired();
    }

private:
    struct Entry {
        uint32_t rgb = kEmpty;
        uint32_t count = 0;
        uint64_t last = 0;
    };

    static size_t Slot(uint32_t rgb) { return (rgb * 0x9E3779B1u) >> (32 - kBits); }

    void Retire(const Entry& entry) {
        if (entry.count == 0) return;
        retired_[retiredCount_++] = entry;
        if (retiredCount_ == kBatch) AddRetired();
    }

    // Retired colors go to their groups in batches, one step at a time over the batch: the
    // conversions of different colors then overlap instead of waiting on each other's searches.
    // Kept out of line so that Add, run for every sample, stays small enough to inline.
    [[gnu::noinline]] void AddRetired() {
        static const ByteSRGBToLab toLab;
        const cCentroidLookup& lookup = cCentroidLookup::Instance();
        for (size_t i = 0; i < retiredCount_; ++i) toLab.ToXYZ(retired_[i].rgb, xyzs_[i]);
        toLab.Lab().FromXYZ(xyzs_, labs_, retiredCount_);
        lookup.Nearest(labs_, retiredCount_, centroids_);
        for (size_t i = 0; i < retiredCount_; ++i) {
            if (centroids_[i] < 1) continue;
            Group& group = groups_[centroids_[i] - 1];
            group.count += retired_[i].count;
            group.last = std::max(group.last, retired_[i].last);
            const double weight = static_cast<double>(retired_[i].count);
            for (int c = 0; c < 3; ++c) group.lab[c] += weight * labs_[i][c];
        }
        retiredCount_ = 0;
    }

    static constexpr uint32_t kEmpty = 0xFFFFFFFFu;  // no 24-bit color
    static constexpr int kBits = 15;
    static constexpr size_t kBatch = 64;
    std::vector<Group>& groups_;
    std::vector<Entry> entries_;
    Entry* recent_ = entries_.data();
    Entry retired_[kBatch];
    size_t retiredCount_ = 0;
    double xyzs_[kBatch][3];
    double labs_[kBatch][3];
    int32_t centroids_[kBatch];
};

uint32_t ColorAt(const unsigned char* row, int x) {
    const unsigned char* pixel = row + static_cast<size_t>(x) * 4;
    return (uint32_t{pixel[1]} << 16) | (uint32_t{pixel[2]} << 8) | pixel[3];
}

// Every second pixel from the last one backwards, column by column from the right, each column
// from the bottom. Rows are walked in memory order; each sample's place in that column order is
// computed instead, since only the tie between equally large groups depends on it.
void SampleIntoGroups(const unsigned char* pixels, int width, int height, std::vector<Group>& groups) {
    constexpr int kAhead = 32;  // pixels, 16 samples
    RecentColors recent(groups);
    const uint64_t rowsSampled = (static_cast<uint64_t>(height) + 1) / 2;
    for (int y = height - 1; y >= 0; y -= 2) {
        const unsigned char* row = pixels + static_cast<size_t>(y) * static_cast<size_t>(width) * 4;
        const uint64_t rowPlace = static_cast<uint64_t>(height - 1 - y) / 2;
        uint64_t column = 0;
        for (int x = width - 1; x >= 0; x -= 2, ++column) {
            if (x >= kAhead) recent.Prefetch(ColorAt(row, x - kAhead));
            recent.Add(ColorAt(row, x), column * rowsSampled + rowPlace);
        }
    }
    recent.Finish();
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
