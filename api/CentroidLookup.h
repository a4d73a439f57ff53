#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <vector>

// Nearest ISCC-NBS centroid of a color, searched only among the centroids of the color's
// octant (L* > 50, a* > 0, b* > 0) and those listed as lying near one of its borders.
// Immutable once built, so one instance serves every thread.
class cCentroidLookup {
public:
    static const cCentroidLookup& Instance();

    // Bucket 0 to 7 of a color: 4 x [L* > 50] + 2 x [a* > 0] + [b* > 0].
    static int32_t BucketOf(const double* lab);
    // Squared CIE76 difference of two L*, a*, b* triples.
    static double DistanceSquared(const double* x, const double* y);

    // 1-based centroid index with the smallest squared CIE76 distance, the lower index on
    // ties; -1 when a component is not finite.
    int32_t Nearest(const double* lab) const;
    // Nearest of each of `count` colors, faster than one at a time.
    void Nearest(const double (*labs)[3], size_t count, int32_t* nearest) const;

private:
    cCentroidLookup();

    // A bucket's octant, within the range real colors reach, cut into boxes. Each box lists, in
    // index order, the members that can be nearest for some color in it, which is what lets a
    // query compare a handful of centroids instead of the whole bucket.
    struct Grid {
        double low[3];
        std::vector<uint32_t> start;  // per box, into candidates; one extra at the end
        std::vector<int16_t> candidates;
    };

    // The centroids that can be nearest to a color, in index order; none when it is not finite.
    struct Candidates {
        const int16_t* first = nullptr;
        const int16_t* last = nullptr;
    };
    // A color's bucket and box; bucket -1 when a component is not finite, box -1 beyond the grid.
    struct Place {
        int32_t bucket;
        int32_t box;
    };
    Place PlaceOf(const double* lab) const;
    Candidates CandidatesAt(Place place) const;
    static int32_t NearestOf(const double* lab, Candidates candidates);

    void BuildGrid(int32_t bucket);
    // Box of a color inside the grid, or -1 when it lies beyond.
    static int32_t BoxOf(const Grid& grid, const double* lab);

    std::array<std::vector<int16_t>, 8> members_;  // ascending
    std::array<Grid, 8> grids_;
};
