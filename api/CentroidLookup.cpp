#include "CentroidLookup.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "IsccNbsCatalogue.h"
#include "pigmo/bp.h"

namespace {

// Centroids close enough to a border that they also serve the octant on its other side.
constexpr int32_t kNearLightness50[] = {
    11,  12,  15,  19,  22,  27,  34,  35,  37,  39,  42,  45,  48,  51,  54,  57,  63,  66,  69,  74,  77,
    80,  82,  85,  91,  94,  95,  97,  100, 103, 106, 109, 112, 115, 116, 118, 119, 121, 123, 131, 136, 139,
    141, 145, 150, 155, 158, 159, 160, 164, 167, 169, 170, 173, 176, 177, 178, 182, 186, 191, 195, 196, 199,
    203, 205, 206, 210, 214, 216, 218, 223, 228, 233, 236, 237, 241, 245, 248, 254, 255, 258, 262, 265};
constexpr int32_t kNearAZero[] = {
    7,   9,   31,  33,  62,  63,  65,  70,  73,  75,  77,  79,  80,  81,  82,  83,  84,  85,  86,  87,  88,
    89,  90,  91,  92,  93,  94,  95,  96,  100, 106, 107, 108, 109, 110, 111, 112, 113, 114, 122, 124, 125,
    149, 150, 151, 177, 178, 179, 180, 181, 182, 183, 184, 185, 186, 187, 188, 189, 190, 191, 192, 193, 194,
    197, 198, 199, 201, 202, 203, 204, 209, 230, 231, 232, 233, 235, 263, 264, 265, 266, 267};
constexpr int32_t kNearBZero[] = {
    1,   7,   8,   10,  11,  14,  17,  20,  21,  22,  23,  24,  29,  44,  46,  47,  62,  64,  129, 132,
    133, 139, 140, 141, 142, 143, 146, 147, 148, 149, 150, 151, 152, 153, 154, 155, 156, 157, 158, 159,
    160, 161, 162, 163, 164, 166, 189, 190, 191, 227, 228, 231, 232, 233, 234, 235, 236, 245, 246, 247,
    248, 249, 250, 251, 252, 253, 254, 255, 256, 257, 258, 259, 261, 262, 263, 264, 265, 266, 267};

// Grid boxes: L* from 0 to 100, a* and b* from -128 to 128, each halved at its border.
constexpr double kGridLow[3] = {0.0, -128.0, -128.0};
constexpr double kGridHalf[3] = {50.0, 128.0, 128.0};
constexpr int32_t kGridCells[3] = {16, 24, 24};  // per half
// Kept candidates may exceed the bound by this much, so rounding at box edges loses none.
constexpr double kSlack = 1e-6;

template <size_t N>
bool Contains(const int32_t (&list)[N], int32_t index) {
    return std::binary_search(std::begin(list), std::end(list), index);
}

}  // namespace

const cCentroidLookup& cCentroidLookup::Instance() {
    static const cCentroidLookup instance;
    return instance;
}

int32_t cCentroidLookup::BucketOf(const double* lab) {
    return 4 * (lab[0] > 50.0) + 2 * (lab[1] > 0.0) + (lab[2] > 0.0);
}

double cCentroidLookup::DistanceSquared(const double* x, const double* y) {
    const double dl = x[0] - y[0];
    const double da = x[1] - y[1];
    const double db = x[2] - y[2];
    return dl * dl + da * da + db * db;
}

cCentroidLookup::cCentroidLookup() {
    for (int32_t index = 1; index <= kIsccNbsCentroidCount; ++index) {
        const int32_t own = BucketOf(kIsccNbsCentroids[index - 1].lab);
        // Bits a centroid may differ in from its own octant: those of the borders it is near.
        const int32_t free = 4 * Contains(kNearLightness50, index) + 2 * Contains(kNearAZero, index) +
                             Contains(kNearBZero, index);
        for (int32_t bucket = 0; bucket < 8; ++bucket) {
            if (((bucket ^ own) & ~free) == 0) members_[bucket].push_back(static_cast<int16_t>(index));
        }
    }
    for (int32_t bucket = 0; bucket < 8; ++bucket) BuildGrid(bucket);
}

void cCentroidLookup::BuildGrid(int32_t bucket) {
    Grid& grid = grids_[bucket];
    double size[3];
    for (int32_t axis = 0; axis < 3; ++axis) {
        const bool upper = (bucket >> (2 - axis)) & 1;
        grid.low[axis] = upper ? kGridLow[axis] + kGridHalf[axis] : kGridLow[axis];
        size[axis] = kGridHalf[axis] / kGridCells[axis];
    }
    const std::vector<int16_t>& members = members_[bucket];
    std::vector<double> nearest(members.size());
    for (int32_t l = 0; l < kGridCells[0]; ++l) {
        for (int32_t a = 0; a < kGridCells[1]; ++a) {
            for (int32_t b = 0; b < kGridCells[2]; ++b) {
                const int32_t cell[3] = {l, a, b};
                double low[3], high[3];
                for (int32_t axis = 0; axis < 3; ++axis) {
                    low[axis] = grid.low[axis] + cell[axis] * size[axis];
                    high[axis] = low[axis] + size[axis];
                }
                // Every color of the box is within `bound` of some member, so a member farther than
                // that from the whole box is never the nearest.
                double bound = std::numeric_limits<double>::infinity();
                for (size_t m = 0; m < members.size(); ++m) {
                    const double* c = kIsccNbsCentroids[members[m] - 1].lab;
                    double inside[3], farthest[3];
                    for (int32_t axis = 0; axis < 3; ++axis) {
                        inside[axis] = std::clamp(c[axis], low[axis], high[axis]);
                        farthest[axis] = c[axis] - low[axis] > high[axis] - c[axis] ? low[axis] : high[axis];
                    }
                    nearest[m] = DistanceSquared(c, inside);
                    bound = std::min(bound, DistanceSquared(c, farthest));
                }
                grid.start.push_back(static_cast<uint32_t>(grid.candidates.size()));
                for (size_t m = 0; m < members.size(); ++m) {
                    if (nearest[m] <= bound + kSlack) grid.candidates.push_back(members[m]);
                }
            }
        }
    }
    grid.start.push_back(static_cast<uint32_t>(grid.candidates.size()));
}

int32_t cCentroidLookup::BoxOf(const Grid& grid, const double* lab) {
    int32_t box = 0;
    for (int32_t axis = 0; axis < 3; ++axis) {
        // A product may put a color on a box border into the next box, whose candidates still
        // serve it: boxes are closed and the candidates kept with slack.
        const double cellsPerUnit = kGridCells[axis] / kGridHalf[axis];
        const double offset = lab[axis] - grid.low[axis];
        if (!(offset >= 0.0 && offset <= kGridHalf[axis])) return -1;
        box = box * kGridCells[axis] +
              std::min(static_cast<int32_t>(offset * cellsPerUnit), kGridCells[axis] - 1);
    }
    return box;
}

cCentroidLookup::Place cCentroidLookup::PlaceOf(const double* lab) const {
    if (!std::isfinite(lab[0]) || !std::isfinite(lab[1]) || !std::isfinite(lab[2])) return {-1, -1};
    const int32_t bucket = BucketOf(lab);
    return {bucket, BoxOf(grids_[bucket], lab)};
}

cCentroidLookup::Candidates cCentroidLookup::CandidatesAt(Place place) const {
    if (place.bucket < 0) return {};
    const std::vector<int16_t>& members = members_[place.bucket];
    if (place.box < 0) return {members.data(), members.data() + members.size()};
    const Grid& grid = grids_[place.bucket];
    return {grid.candidates.data() + grid.start[place.box],
            grid.candidates.data() + grid.start[place.box + 1]};
}

int32_t cCentroidLookup::NearestOf(const double* lab, Candidates candidates) {
    if (candidates.first == candidates.last) return -1;
    // In index order, only a strictly smaller distance replaces the best, so ties keep the lower
    // index; the first candidate is taken even when a far color's distance overflows. Selected
    // without branches: which candidate wins is as good as random.
    double best = DistanceSquared(lab, kIsccNbsCentroids[*candidates.first - 1].lab);
    int32_t result = *candidates.first;
    for (const int16_t* index = candidates.first + 1; index != candidates.last; ++index) {
        const double distance = DistanceSquared(lab, kIsccNbsCentroids[*index - 1].lab);
        const int32_t closer = distance < best;
        best = std::min(best, distance);
        result += (*index - result) & -closer;
    }
    return result;
}

int32_t cCentroidLookup::Nearest(const double* lab) const {
    return NearestOf(lab, CandidatesAt(PlaceOf(lab)));
}

void cCentroidLookup::Nearest(const double (*labs)[3], size_t count, int32_t* nearest) const {
    // Each level of table reads for the whole step before the next: independent of each other,
    // their cache misses overlap.
    constexpr size_t kStep = 64;
    Place places[kStep];
    Candidates candidates[kStep];
    for (size_t done = 0; done < count; done += kStep) {
        const size_t step = std::min(kStep, count - done);
        for (size_t i = 0; i < step; ++i) {
            places[i] = PlaceOf(labs[done + i]);
            if (places[i].box >= 0) __builtin_prefetch(&grids_[places[i].bucket].start[places[i].box]);
        }
        for (size_t i = 0; i < step; ++i) {
            candidates[i] = CandidatesAt(places[i]);
            __builtin_prefetch(candidates[i].first);
        }
        for (size_t i = 0; i < step; ++i) nearest[done + i] = NearestOf(labs[done + i], candidates[i]);
    }
}

extern "C" int BPCentroidGetForLab(const double* lab) {
    return lab ? cCentroidLookup::Instance().Nearest(lab) : -1;
}
