#include <gtest/gtest.h>

#include <climits>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <limits>
#include <random>
#include <set>
#include <string>
#include <thread>
#include <vector>

#include "pigmo/bp.h"

namespace {

// FNV-1a over "index|name|category|L|a|b\n" rows of one category, values with six decimals:
// computed from the published table separately from the library's copy.
struct CategoryDigest {
    int category;
    int first;
    int count;
    uint64_t digest;
    const char* name;
};

const CategoryDigest kCategories[] = {
    {1, 1, 24, 0x4727dabd5efdb12aull, "Red/Pink"},
    {2, 25, 8, 0xea074a01d70fc6a5ull, "Yellowish Pink"},
    {3, 33, 15, 0xf7216870832fed18ull, "Reddish Orange/Reddish Brown"},
    {4, 48, 18, 0x44c9c6e7109d385bull, "Orange Brown"},
    {5, 66, 16, 0x2d52e32aa4662971ull, "Orange Yellow/Yellowish Brown"},
    {6, 82, 15, 0x6b2a3cdd11fe25fcull, "Yellow/Olive Brown"},
    {7, 97, 18, 0x5cae81a6db8aa18bull, "Greenish Yellow/Olive"},
    {8, 115, 15, 0xc135552634302a3aull, "Yellow Green/Olive Green"},
    {9, 130, 9, 0x9044faa301a30234ull, "Yellowish Green"},
    {10, 139, 19, 0xd8cb2c85d756d1ddull, "Green"},
    {11, 158, 10, 0x359a1a03936e9b1bull, "Bluish Green"},
    {12, 168, 8, 0xeed6d02c12e9b751ull, "Greenish Blue"},
    {13, 176, 18, 0xe5892bcb1bbdf3b2ull, "Blue"},
    {14, 194, 11, 0x325467c4f3679d34ull, "Purplish Blue"},
    {15, 205, 11, 0x33192b82f9eccffcull, "Violet"},
    {16, 216, 20, 0xff7ac45498c8dc3full, "Purple"},
    {17, 236, 10, 0x3406529db4d03c09ull, "Reddish Purple"},
    {18, 246, 17, 0x178697fdbc48ddcfull, "Purplish Pink/Purplish Red"},
    {19, 263, 5, 0x6f40824a5c4adf26ull, "White/Gray/Black"},
};

uint64_t Fnv1a(const std::string& text) {
    uint64_t hash = 0xcbf29ce484222325ull;
    for (unsigned char c : text) hash = (hash ^ c) * 0x100000001b3ull;
    return hash;
}

std::string Row(int index) {
    const double* lab = BPCentroidGetLab(index);
    char values[96];
    std::snprintf(values, sizeof values, "|%.6f|%.6f|%.6f\n", lab[0], lab[1], lab[2]);
    return std::to_string(index) + "|" + BPCentroidGetName(index) + "|" +
           std::to_string(BPCentroidGetCategory(index)) + values;
}

TEST(CentroidCatalogue, EveryCategoryMatchesThePublishedRows) {
    ASSERT_EQ(BPCentroidGetCount(), 267);
    ASSERT_EQ(BPCentroidGetCategoryCount(), 19);
    int next = 1;
    for (const CategoryDigest& expected : kCategories) {
        SCOPED_TRACE(expected.name);
        EXPECT_STREQ(BPCentroidGetCategoryName(expected.category), expected.name);
        ASSERT_EQ(expected.first, next);
        std::string rows;
        for (int index = expected.first; index < expected.first + expected.count; ++index) {
            rows += Row(index);
        }
        EXPECT_EQ(Fnv1a(rows), expected.digest) << rows;
        next += expected.count;
    }
    EXPECT_EQ(next, 268);
}

TEST(CentroidCatalogue, IndicesAreClampedIntoRange) {
    struct Case {
        int index;
        const char* name;
        int category;
    };
    const Case cases[] = {
        {1, "Vivid Pink", 1},       {0, "Vivid Pink", 1},   {-5, "Vivid Pink", 1},
        {INT_MIN, "Vivid Pink", 1}, {263, "White", 19},     {267, "Black", 19},
        {268, "Black", 19},         {INT_MAX, "Black", 19}, {115, "Vivid Yellowish Green", 8},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.index);
        EXPECT_STREQ(BPCentroidGetName(c.index), c.name);
        EXPECT_EQ(BPCentroidGetCategory(c.index), c.category);
    }
    EXPECT_EQ(BPCentroidGetLab(0), BPCentroidGetLab(1));
    EXPECT_EQ(BPCentroidGetLab(1000), BPCentroidGetLab(267));
    EXPECT_DOUBLE_EQ(BPCentroidGetLab(267)[0], 13.227911);
    EXPECT_STREQ(BPCentroidGetCategoryName(0), "Red/Pink");
    EXPECT_STREQ(BPCentroidGetCategoryName(-1), "Red/Pink");
    EXPECT_STREQ(BPCentroidGetCategoryName(20), "White/Gray/Black");
}

const std::set<int> kNearL50 = {
    11,  12,  15,  19,  22,  27,  34,  35,  37,  39,  42,  45,  48,  51,  54,  57,  63,  66,  69,  74,  77,
    80,  82,  85,  91,  94,  95,  97,  100, 103, 106, 109, 112, 115, 116, 118, 119, 121, 123, 131, 136, 139,
    141, 145, 150, 155, 158, 159, 160, 164, 167, 169, 170, 173, 176, 177, 178, 182, 186, 191, 195, 196, 199,
    203, 205, 206, 210, 214, 216, 218, 223, 228, 233, 236, 237, 241, 245, 248, 254, 255, 258, 262, 265};
const std::set<int> kNearA0 = {
    7,   9,   31,  33,  62,  63,  65,  70,  73,  75,  77,  79,  80,  81,  82,  83,  84,  85,  86,  87,  88,
    89,  90,  91,  92,  93,  94,  95,  96,  100, 106, 107, 108, 109, 110, 111, 112, 113, 114, 122, 124, 125,
    149, 150, 151, 177, 178, 179, 180, 181, 182, 183, 184, 185, 186, 187, 188, 189, 190, 191, 192, 193, 194,
    197, 198, 199, 201, 202, 203, 204, 209, 230, 231, 232, 233, 235, 263, 264, 265, 266, 267};
const std::set<int> kNearB0 = {1,   7,   8,   10,  11,  14,  17,  20,  21,  22,  23,  24,  29,  44,  46,  47,
                               62,  64,  129, 132, 133, 139, 140, 141, 142, 143, 146, 147, 148, 149, 150, 151,
                               152, 153, 154, 155, 156, 157, 158, 159, 160, 161, 162, 163, 164, 166, 189, 190,
                               191, 227, 228, 231, 232, 233, 234, 235, 236, 245, 246, 247, 248, 249, 250, 251,
                               252, 253, 254, 255, 256, 257, 258, 259, 261, 262, 263, 264, 265, 266, 267};

int OctantOf(const double* lab) {
    return 4 * (lab[0] > 50.0) + 2 * (lab[1] > 0.0) + (lab[2] > 0.0);
}

// A centroid serves its own octant and, across each border it is listed near, the other side.
bool Serves(int index, int octant) {
    const int own = OctantOf(BPCentroidGetLab(index));
    const int free = 4 * kNearL50.count(index) + 2 * kNearA0.count(index) + kNearB0.count(index);
    return ((octant ^ own) & ~free) == 0;
}

double DistanceSquared(const double* x, const double* y) {
    return (x[0] - y[0]) * (x[0] - y[0]) + (x[1] - y[1]) * (x[1] - y[1]) + (x[2] - y[2]) * (x[2] - y[2]);
}

// Scan in index order, keeping the first strictly smaller distance; octant -1 scans everything.
int ReferenceNearest(const double* lab, int octant) {
    double best = std::numeric_limits<double>::infinity();
    int result = -1;
    for (int index = 1; index <= 267; ++index) {
        if (octant >= 0 && !Serves(index, octant)) continue;
        const double distance = DistanceSquared(lab, BPCentroidGetLab(index));
        if (distance < best) {
            best = distance;
            result = index;
        }
    }
    return result;
}

TEST(CentroidLookup, EachCentroidFindsItself) {
    for (int index = 1; index <= 267; ++index) {
        EXPECT_EQ(BPCentroidGetForLab(BPCentroidGetLab(index)), index) << BPCentroidGetName(index);
    }
}

TEST(CentroidLookup, NamedCases) {
    struct Case {
        double lab[3];
        int expected;
        int nearestOverall;
    };
    const Case cases[] = {
        {{80.656948, 27.535981, 8.233154}, 1, 1},
        {{50.0, 0.0, 0.0}, 265, 265},  // every test fails at the border: octant 0
        {{30.0, 5.0, 0.0}, 64, 64},
        {{70.0, -20.0, 0.01}, 163, 163},
        // The nearest centroid overall lies outside the octant and is not listed near its borders.
        {{48.0, -117.0, -0.25}, 139, 115},
        {{10.0, -0.5, 122.0}, 100, 69},
        // Exactly on a border, which belongs to the side of the failed test.
        {{29.0, 0.0, 114.0}, 100, 69},
        {{94.0, -127.0, 0.0}, 140, 115},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(testing::Message() << c.lab[0] << ", " << c.lab[1] << ", " << c.lab[2]);
        EXPECT_EQ(BPCentroidGetForLab(c.lab), c.expected);
        EXPECT_EQ(ReferenceNearest(c.lab, -1), c.nearestOverall);
    }
}

// Colors on, just beside and away from the three borders, each octant equally.
std::vector<std::vector<double>> Queries() {
    std::mt19937 random(7);
    std::uniform_real_distribution<double> l(-10.0, 110.0), ab(-130.0, 130.0), near(-2.0, 2.0);
    const double borders[] = {50.0, 0.0, 0.0};
    std::vector<std::vector<double>> queries;
    for (int i = 0; i < 6000; ++i) {
        std::vector<double> lab = {l(random), ab(random), ab(random)};
        const int axis = i % 4;
        if (axis < 3) {
            const int kind = (i / 4) % 4;
            const double offset = kind == 0 ? 0.0 : kind == 1 ? 1e-9 : kind == 2 ? -1e-9 : near(random);
            lab[axis] = borders[axis] + offset;
        }
        queries.push_back(lab);
    }
    return queries;
}

// Eight threads make the first lookups together, so they also race to build the search tables.
TEST(CentroidLookup, AgreesWithAScanOfTheOctantFromConcurrentFirstUse) {
    const auto queries = Queries();
    std::vector<int> expected;
    int agreeOverall = 0;
    for (const auto& lab : queries) {
        expected.push_back(ReferenceNearest(lab.data(), OctantOf(lab.data())));
        agreeOverall += expected.back() == ReferenceNearest(lab.data(), -1);
    }
    std::vector<int> mismatches(8, 0);
    std::vector<std::thread> threads;
    for (int t = 0; t < 8; ++t) {
        threads.emplace_back([&, t] {
            for (size_t i = 0; i < queries.size(); ++i) {
                mismatches[t] += BPCentroidGetForLab(queries[i].data()) != expected[i];
            }
        });
    }
    for (auto& thread : threads) thread.join();
    for (int count : mismatches) EXPECT_EQ(count, 0);
    // The border lists make the octant search the true nearest for nearly every color.
    EXPECT_GT(agreeOverall, static_cast<int>(queries.size()) * 99 / 100);
}

TEST(CentroidLookup, ListedCentroidsServeTheFarSideOfTheirBorder) {
    const std::set<int>* lists[] = {&kNearL50, &kNearA0, &kNearB0};
    const double borders[] = {50.0, 0.0, 0.0};
    int foundItself = 0, checked = 0;
    for (int axis = 0; axis < 3; ++axis) {
        for (int index : *lists[axis]) {
            // The centroid moved just across the border: on it for the lower side, beyond it for the upper.
            double lab[3] = {BPCentroidGetLab(index)[0], BPCentroidGetLab(index)[1],
                             BPCentroidGetLab(index)[2]};
            lab[axis] = lab[axis] > borders[axis] ? borders[axis] : borders[axis] + 1e-6;
            const int expected = ReferenceNearest(lab, OctantOf(lab));
            EXPECT_EQ(BPCentroidGetForLab(lab), expected) << "centroid " << index << " axis " << axis;
            foundItself += expected == index;
            ++checked;
        }
    }
    EXPECT_GT(foundItself, checked / 2);
}

TEST(CentroidLookup, ExactTiesKeepTheLowerIndex) {
    // Midpoints of centroid pairs that come out exactly equidistant in double arithmetic.
    int ties = 0;
    for (int first = 1; first <= 267; ++first) {
        for (int second = first + 1; second <= 267; ++second) {
            const double* x = BPCentroidGetLab(first);
            const double* y = BPCentroidGetLab(second);
            const double mid[3] = {(x[0] + y[0]) / 2, (x[1] + y[1]) / 2, (x[2] + y[2]) / 2};
            if (DistanceSquared(mid, x) != DistanceSquared(mid, y)) continue;
            const int expected = ReferenceNearest(mid, OctantOf(mid));
            if (expected != first) continue;
            ++ties;
            EXPECT_EQ(BPCentroidGetForLab(mid), first) << first << " or " << second;
        }
    }
    EXPECT_GT(ties, 50);
}

TEST(CentroidLookup, UnusableInputGivesMinusOne) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    const double inf = std::numeric_limits<double>::infinity();
    const double cases[][3] = {{nan, 0, 0}, {50, nan, 0}, {50, 0, nan}, {inf, 0, 0}, {50, -inf, 0}};
    for (const auto& lab : cases) EXPECT_EQ(BPCentroidGetForLab(lab), -1);
    EXPECT_EQ(BPCentroidGetForLab(nullptr), -1);
    // Far away but finite still has a nearest centroid.
    const double far[3] = {1e6, 0, 0};
    EXPECT_EQ(BPCentroidGetForLab(far), ReferenceNearest(far, OctantOf(far)));
    EXPECT_NE(BPCentroidGetForLab(far), -1);
}

}  // namespace
