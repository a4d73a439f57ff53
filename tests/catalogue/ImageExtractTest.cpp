#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <climits>
#include <cmath>
#include <functional>
#include <map>
#include <thread>
#include <tuple>
#include <vector>

#include "pigmo/bp.h"

namespace {

using Rgb = std::array<unsigned char, 3>;
using Lab = std::array<double, 3>;

const Rgb kRed = {220, 30, 30};
const Rgb kGreen = {20, 150, 40};
const Rgb kBlue = {30, 40, 210};
const Rgb kDecoy = {250, 240, 0};  // on pixels the sampling must skip

// 4-byte pixels, byte 0 filled with noise that must not matter.
std::vector<unsigned char> MakeImage(int width, int height, const std::function<Rgb(int, int)>& color) {
    std::vector<unsigned char> pixels(static_cast<size_t>(width) * height * 4);
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            unsigned char* pixel = &pixels[(static_cast<size_t>(y) * width + x) * 4];
            const Rgb rgb = color(x, y);
            pixel[0] = static_cast<unsigned char>(x * 37 + y * 11);
            for (int i = 0; i < 3; ++i) pixel[i + 1] = rgb[i];
        }
    }
    return pixels;
}

// One row whose sampled pixels (every second one from the right end) take the given colors
// in sampling order; the pixels in between are decoys.
std::vector<unsigned char> SampledRow(const std::vector<Rgb>& samples, int& width) {
    width = 2 * static_cast<int>(samples.size()) - 1;
    return MakeImage(width, 1, [&](int x, int) { return (x % 2) ? kDecoy : samples[(width - 1 - x) / 2]; });
}

std::vector<Rgb> Repeat(std::initializer_list<std::pair<Rgb, int>> runs) {
    std::vector<Rgb> samples;
    for (const auto& [rgb, count] : runs) samples.insert(samples.end(), count, rgb);
    return samples;
}

Lab LabOf(const Rgb& rgb) {
    const double in[3] = {double(rgb[0]), double(rgb[1]), double(rgb[2])};
    Lab lab{};
    EXPECT_EQ(BPConvertsRGB2Lab(in, lab.data()), 1);
    return lab;
}

std::vector<Lab> Extract(const std::vector<unsigned char>& pixels, int width, int height, int colours) {
    std::vector<double> out(3 * (colours < 1 ? 10 : colours), -1.0);
    int count = -1;
    BPImageExtractLab(pixels.data(), width, height, colours, out.data(), &count);
    std::vector<Lab> result;
    for (int i = 0; i < count; ++i) result.push_back({out[3 * i], out[3 * i + 1], out[3 * i + 2]});
    return result;
}

void ExpectColors(const std::vector<Lab>& actual, const std::vector<Lab>& expected) {
    ASSERT_EQ(actual.size(), expected.size());
    for (size_t i = 0; i < actual.size(); ++i) {
        for (int c = 0; c < 3; ++c) EXPECT_NEAR(actual[i][c], expected[i][c], 1e-9) << "color " << i;
    }
}

double Distance(const Lab& x, const Lab& y) {
    return std::sqrt((x[0] - y[0]) * (x[0] - y[0]) + (x[1] - y[1]) * (x[1] - y[1]) +
                     (x[2] - y[2]) * (x[2] - y[2]));
}

int CentroidOf(const Lab& lab) {
    return BPCentroidGetForLab(lab.data());
}

// The selection done the plain way: every sample converted on its own, columns walked first.
std::vector<Lab> ReferenceExtract(const std::vector<unsigned char>& pixels, int width, int height,
                                  int colours) {
    std::vector<long> count(268, 0);
    std::vector<Lab> mean(268, Lab{});
    int leader = -1;
    for (int x = width - 1; x >= 0; x -= 2) {
        for (int y = height - 1; y >= 0; y -= 2) {
            const unsigned char* pixel = &pixels[(static_cast<size_t>(y) * width + x) * 4];
            const Lab lab = LabOf({pixel[1], pixel[2], pixel[3]});
            const int group = CentroidOf(lab);
            ++count[group];
            for (int c = 0; c < 3; ++c) mean[group][c] += lab[c];
            if (leader < 0 || count[group] > count[leader]) leader = group;
        }
    }
    for (int g = 1; g <= 267; ++g) {
        for (int c = 0; c < 3 && count[g] > 0; ++c) mean[g][c] /= count[g];
    }
    std::vector<double> distance(268, 1e20);
    std::vector<Lab> result = {mean[leader]};
    for (int pick = 1, last = leader; pick < colours; ++pick) {
        double best = 0.0;
        int next = last;
        for (int g = 1; g <= 267; ++g) {
            if (count[g] == 0) continue;
            distance[g] = std::min(distance[g], std::pow(Distance(mean[g], mean[last]), 2));
            if (count[g] * distance[g] * distance[g] > best) {
                best = count[g] * distance[g] * distance[g];
                next = g;
            }
        }
        result.push_back(mean[next]);
        last = next;
    }
    return result;
}

TEST(ImageExtract, OneColorImageRepeatsItsColor) {
    for (const Rgb& rgb : {Rgb{255, 255, 255}, Rgb{0, 0, 0}, Rgb{12, 200, 90}}) {
        SCOPED_TRACE(testing::Message() << int(rgb[0]) << "," << int(rgb[1]) << "," << int(rgb[2]));
        for (const auto& [width, height] : {std::pair{1, 1}, std::pair{6, 5}, std::pair{37, 2}}) {
            const auto pixels = MakeImage(width, height, [&](int, int) { return rgb; });
            ExpectColors(Extract(pixels, width, height, 3), {LabOf(rgb), LabOf(rgb), LabOf(rgb)});
        }
    }
}

TEST(ImageExtract, ColourCountBelowOneMeansTen) {
    const auto pixels = MakeImage(4, 4, [](int x, int) { return x < 2 ? kRed : kBlue; });
    for (int colours : {0, -1, INT_MIN}) EXPECT_EQ(Extract(pixels, 4, 4, colours).size(), 10u) << colours;
}

TEST(ImageExtract, NothingToSampleGivesCountZero) {
    const auto pixels = MakeImage(2, 2, [](int, int) { return kRed; });
    for (const auto& [image, width, height] : {std::tuple{pixels.data(), 0, 2},
                                               {pixels.data(), 2, 0},
                                               {pixels.data(), -3, 2},
                                               {pixels.data(), 2, -1},
                                               {nullptr, 2, 2}}) {
        double lab[3] = {-7.0, -7.0, -7.0};
        int count = 99;
        BPImageExtractLab(image, width, height, 1, lab, &count);
        EXPECT_EQ(count, 0) << width << "x" << height;
        EXPECT_EQ(lab[0], -7.0);
    }
    int count = 99;
    BPImageExtractLab(pixels.data(), 2, 2, 1, nullptr, &count);
    EXPECT_EQ(count, 0);
    double lab[3] = {};
    BPImageExtractLab(pixels.data(), 2, 2, 1, lab, nullptr);  // no count wanted
    EXPECT_NEAR(lab[0], LabOf(kRed)[0], 1e-9);
}

TEST(ImageExtract, OnlyEverySecondPixelFromTheLastCounts) {
    // Sampled columns and rows count down from the last by two; everything else is a decoy.
    for (const auto& [width, height] : {std::pair{5, 5}, std::pair{4, 4}, std::pair{6, 3}, std::pair{1, 7}}) {
        const auto pixels = MakeImage(width, height, [&](int x, int y) {
            return (width - 1 - x) % 2 == 0 && (height - 1 - y) % 2 == 0 ? kGreen : kDecoy;
        });
        ExpectColors(Extract(pixels, width, height, 2), {LabOf(kGreen), LabOf(kGreen)});
    }
}

TEST(ImageExtract, LargestGroupLeadsThenTheOthers) {
    struct Case {
        std::vector<Rgb> samples;
        std::vector<Rgb> expected;
    };
    const Case cases[] = {
        {Repeat({{kBlue, 1}, {kRed, 3}}), {kRed, kBlue}},
        {Repeat({{kRed, 1}, {kBlue, 3}}), {kBlue, kRed}},
        // With no further group apart, the last pick repeats.
        {Repeat({{kRed, 3}, {kBlue, 1}}), {kRed, kBlue, kBlue, kBlue}},
        {Repeat({{kBlue, 3}, {kRed, 1}}), {kBlue, kRed, kRed, kRed}},
        {Repeat({{kRed, 2}}), {kRed}},
    };
    for (const Case& c : cases) {
        int width = 0;
        const auto pixels = SampledRow(c.samples, width);
        std::vector<Lab> expected;
        for (const Rgb& rgb : c.expected) expected.push_back(LabOf(rgb));
        ExpectColors(Extract(pixels, width, 1, static_cast<int>(c.expected.size())), expected);
    }
}

TEST(ImageExtract, EqualGroupsGoToTheFirstToReachTheirSize) {
    // In sampling order A B B A: B reaches two first although A came first.
    int width = 0;
    auto pixels = SampledRow({kRed, kBlue, kBlue, kRed}, width);
    ExpectColors(Extract(pixels, width, 1, 1), {LabOf(kBlue)});
    // Down columns first: column x = 4 holds A A, x = 2 holds B C, x = 0 holds B C, so A
    // reaches two first; walking rows first would make B or C the leader.
    const std::map<std::pair<int, int>, Rgb> grid = {{{4, 2}, kRed},   {{4, 0}, kRed},  {{2, 2}, kBlue},
                                                     {{2, 0}, kGreen}, {{0, 2}, kBlue}, {{0, 0}, kGreen}};
    pixels = MakeImage(5, 3, [&](int x, int y) {
        const auto found = grid.find({x, y});
        return found == grid.end() ? kDecoy : found->second;
    });
    ExpectColors(Extract(pixels, 5, 3, 1), {LabOf(kRed)});
}

TEST(ImageExtract, GroupMeanWeighsItsColors) {
    const Rgb light = {128, 128, 128}, dark = {124, 124, 124};
    const Lab l = LabOf(light), d = LabOf(dark);
    ASSERT_EQ(CentroidOf(l), CentroidOf(d));
    int width = 0;
    const auto pixels = SampledRow(Repeat({{dark, 1}, {light, 3}}), width);
    ExpectColors(Extract(pixels, width, 1, 1),
                 {{(3 * l[0] + d[0]) / 4, (3 * l[1] + d[1]) / 4, (3 * l[2] + d[2]) / 4}});
}

TEST(ImageExtract, FarSmallGroupBeatsNearLargeOne) {
    // Score = count x (squared distance)^2: one sample 50 units away outweighs a hundred 10 away.
    const Rgb base = {128, 128, 128}, near = {150, 120, 128}, far = kBlue;
    const Lab b = LabOf(base), n = LabOf(near), f = LabOf(far);
    ASSERT_NE(CentroidOf(b), CentroidOf(n));
    ASSERT_LT(Distance(b, n), 15.0);
    ASSERT_GT(Distance(b, f), 45.0);
    ASSERT_GT(std::pow(Distance(b, f), 4), 100 * std::pow(Distance(b, n), 4));
    ASSERT_LT(std::pow(Distance(b, f), 2), 100 * std::pow(Distance(b, n), 2));
    int width = 0;
    const auto pixels = SampledRow(Repeat({{near, 100}, {base, 200}, {far, 1}}), width);
    const auto colors = Extract(pixels, width, 1, 3);
    ASSERT_EQ(colors.size(), 3u);
    EXPECT_EQ(CentroidOf(colors[0]), CentroidOf(b));
    EXPECT_EQ(CentroidOf(colors[1]), CentroidOf(f));
    EXPECT_EQ(CentroidOf(colors[2]), CentroidOf(n));
}

TEST(ImageExtract, ManyColorsAndThreadsAgreeWithThePlainWay) {
    // Every sample a color of its own, more than one pass of the color table holds, from several
    // threads at once; asking for every group compares all their means.
    const int width = 1201, height = 1200;
    const auto pixels = MakeImage(width, height, [](int x, int y) {
        const unsigned rgb = ((x / 2 * 600u + y / 2) * 2654435761u) & 0xFFFFFFu;  // odd factor: one to one
        return Rgb{static_cast<unsigned char>(rgb >> 16), static_cast<unsigned char>(rgb >> 8),
                   static_cast<unsigned char>(rgb)};
    });
    const auto expected = ReferenceExtract(pixels, width, height, 267);
    std::vector<std::vector<Lab>> results(4);
    std::vector<std::thread> threads;
    for (auto& result : results) {
        threads.emplace_back([&] { result = Extract(pixels, width, height, 267); });
    }
    for (auto& thread : threads) thread.join();
    for (const auto& result : results) ExpectColors(result, expected);
}

TEST(ImageExtract, PhotoLikeImagesAgreeWithThePlainWay) {
    // Smooth shading with a few levels of grain, in odd and even sizes.
    for (const auto& [width, height] : {std::pair{301, 200}, std::pair{200, 301}, std::pair{2, 999}}) {
        unsigned seed = 1;
        const auto pixels = MakeImage(width, height, [&](int x, int y) {
            seed = seed * 1103515245u + 12345u;
            const int grain = static_cast<int>((seed >> 16) % 7) - 3;
            auto level = [&](double v) {
                return static_cast<unsigned char>(std::clamp(v + grain, 0.0, 255.0));
            };
            return Rgb{level(40 + 200.0 * x / width), level(90 + 100.0 * y / height),
                       level(x < width / 3 ? 200 : 60)};
        });
        ExpectColors(Extract(pixels, width, height, 8), ReferenceExtract(pixels, width, height, 8));
    }
}

}  // namespace
