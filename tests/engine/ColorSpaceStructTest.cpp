#include <gtest/gtest.h>

#include <cmath>

#include "ColorSpaceStruct.h"

namespace {

ColorSpaceStruct OfType(int32_t code) {
    ColorSpaceStruct d;
    d.SetType(code);
    return d;
}

TEST(ColorSpaceStruct, ChannelCounts) {
    const std::pair<int32_t, int32_t> cases[] = {
        {-1, 0}, {1, 4},  {3, 3},   {11, 3}, {12, 3}, {15, 3}, {21, 3}, {27, 1},  {37, 0}, {47, 3}, {48, 1},
        {52, 4}, {53, 5}, {64, 16}, {69, 4}, {70, 4}, {71, 5}, {73, 6}, {83, 16}, {84, 0}, {85, 0}};
    for (auto [code, channels] : cases)
        EXPECT_EQ(OfType(code).GetChannelCount(), channels) << "code " << code;

    struct Grid {
        double start, end, step;
        int32_t bands;
    };
    // Degenerate grids have no bands rather than an undefined count.
    for (const Grid& g : {Grid{380, 730, 10, 36}, Grid{400, 700, 10, 31}, Grid{380, 780, 5, 81},
                          Grid{0, 0, 0, 0}, Grid{700, 400, 10, 0}}) {
        for (int32_t code : {2, 46}) {
            ColorSpaceStruct d = OfType(code);
            d.wavelengthStart = g.start;
            d.wavelengthEnd = g.end;
            d.wavelengthStep = g.step;
            EXPECT_EQ(d.GetChannelCount(), g.bands) << g.start << ".." << g.end << " step " << g.step;
        }
    }
}

TEST(ColorSpaceStruct, DefaultRanges) {
    struct Case {
        int32_t code, channel;
        double minimum, maximum;
    };
    const Case cases[] = {{3, 0, 0.0, 100.0},     {3, 2, -128.0, 128.0},
                          {3, 3, 0.0, 255.0},     {4, 1, 0.0, 181.01933598376},
                          {4, 2, 0.0, 360.0},     {9, 1, 0.0, 181.01933598376},
                          {14, 1, -128.0, 128.0}, {47, 2, -128.0, 128.0},
                          {22, 0, 0.0, 100.0},    {24, 0, 0.0, 255.0},
                          {25, 2, 0.0, 255.0},    {6, 0, 0.0, 1.0},
                          {60, 5, 0.0, 1.0}};
    for (const Case& c : cases) {
        const ColorSpaceStruct d = OfType(c.code);
        EXPECT_EQ(d.GetMinimum(c.channel), c.minimum) << c.code << "/" << c.channel;
        EXPECT_EQ(d.GetMaximum(c.channel), c.maximum) << c.code << "/" << c.channel;
    }
}

TEST(ColorSpaceStruct, SetMaximumAndSetType) {
    ColorSpaceStruct d = OfType(25);
    EXPECT_TRUE(d.SetMaximum(0, 1.0));
    EXPECT_EQ(d.maximum, (std::vector<double>{1.0, 255.0, 255.0}));
    EXPECT_FALSE(d.HasDefaultRanges());
    EXPECT_EQ(d.GetMaximum(3), 0.0);  // outside the channels once an array exists
    EXPECT_FALSE(d.SetMaximum(3, 1.0));
    for (int32_t code = 28; code <= 36; ++code) EXPECT_FALSE(d.SetType(code)) << code;
    EXPECT_EQ(d.type, 25);
    EXPECT_FALSE(d.maximum.empty());
    EXPECT_TRUE(d.SetType(25));
    EXPECT_TRUE(d.maximum.empty());
    EXPECT_TRUE(d.SetType(40));
    EXPECT_EQ(d.type, 40);
}

TEST(ColorSpaceStruct, RangesStaySafeWhenTheGridGrows) {
    ColorSpaceStruct d = OfType(2);
    d.wavelengthStart = 400;
    d.wavelengthEnd = 420;
    d.wavelengthStep = 10;
    d.SetMaximum(0, 0.5);
    d.SetMinimum(1, 0.25);
    d.wavelengthEnd = 700;  // 31 channels now, arrays of 3
    EXPECT_EQ(d.GetMaximum(0), 0.5);
    EXPECT_EQ(d.GetMaximum(30), 1.0);
    EXPECT_EQ(d.GetMinimum(30), 0.0);
    EXPECT_EQ(d.GetMaximum(31), 0.0);
    EXPECT_TRUE(d.SetMaximum(30, 0.75));
    EXPECT_EQ(d.GetMaximum(30), 0.75);
    EXPECT_TRUE(d.Clone()->Equals(&d));
}

TEST(ColorSpaceStruct, EqualsSameSpaceAndSameWhite) {
    ColorSpaceStruct a = OfType(3);
    ColorSpaceStruct b = OfType(3);
    EXPECT_TRUE(a.Equals(&b));
    EXPECT_FALSE(a.Equals(nullptr));
    b.SetMaximum(0, 50.0);
    EXPECT_FALSE(a.Equals(&b));
    EXPECT_FALSE(b.Equals(&a));
    EXPECT_TRUE(ColorSpaceStruct::SameSpace(a, b));
    a.SetMaximum(0, 50.0);
    EXPECT_TRUE(a.Equals(&b));
    a.emissive = true;  // not compared
    EXPECT_TRUE(a.Equals(&b));
    a.viewingConditions[5] = 0.5;
    EXPECT_FALSE(ColorSpaceStruct::SameSpace(a, b));
    EXPECT_TRUE(ColorSpaceStruct::SameWhite(a, b));
    a.whitePoint[2] = 1.08883;
    EXPECT_FALSE(ColorSpaceStruct::SameWhite(a, b));
    // With an illuminant, its record decides and the white point is not looked at.
    a.hasIlluminant = true;
    EXPECT_TRUE(ColorSpaceStruct::SameWhite(a, b));
    b.illuminant.kind = 1;
    EXPECT_FALSE(ColorSpaceStruct::SameWhite(a, b));
    b.whitePoint[0] = std::nan("");
    EXPECT_FALSE(b.Equals(&b));
}

TEST(IlluminantStruct, EqualityIgnoresTheWhiteAndMissingValues) {
    IlluminantStruct a;
    IlluminantStruct b;
    a.kind = b.kind = 1;
    a.valueCount = b.valueCount = 2;
    a.values = {1.0, 2.0};
    a.relativeWhite[0] = 0.96422;
    EXPECT_TRUE(a == b);
    b.values = {1.0, 2.5};
    EXPECT_FALSE(a == b);
    b.values = {1.0, 2.0};
    b.observerAge = 40.0;
    EXPECT_FALSE(a == b);
}

}  // namespace
