// The results of the conversions, metrics and image extraction as they were before their code was
// made faster, recorded once for a large fixed set of inputs (random and edge values). Faster code
// must give every one of them again within 1e-9 on the 0..255, L* and a*/b* scales.
// PIGMO_RECORD_RESULTS=FILE writes the results of the code as it is to FILE instead of checking.
#include <gtest/gtest.h>

#include <cmath>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <functional>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "ColorSpaceSRGB.h"
#include "ColorTranslator.h"
#include "pigmo/bp.h"

namespace {

constexpr double kTolerance = 1e-9;

// A generator of its own, so the inputs are the same with every standard library.
class Random {
public:
    explicit Random(uint64_t seed) : state_(seed) {}
    double Uniform(double low, double high) {
        state_ += 0x9E3779B97F4A7C15ull;
        uint64_t z = state_;
        z = (z ^ (z >> 30)) * 0xBF58476D1CE4E5B9ull;
        z = (z ^ (z >> 27)) * 0x94D049BB133111EBull;
        z ^= z >> 31;
        return low + (high - low) * static_cast<double>(z >> 11) * 0x1p-53;
    }

private:
    uint64_t state_;
};

using Compute = std::function<void(const double* in, double* out)>;

struct Path {
    std::string name;
    int inWidth;
    int outWidth;
    double scale;  // onto the scale the tolerance is meant for: 255 for 0..1 RGB, 100 for XYZ
    std::vector<double> inputs;
    Compute compute;
};

struct Range {
    double low, high;
};

// count random colors of the ranges, after the edge colors.
std::vector<double> Inputs(uint64_t seed, const std::vector<Range>& ranges, int count,
                           std::vector<double> edges = {}) {
    Random random(seed);
    for (int i = 0; i < count; ++i) {
        for (const Range& r : ranges) edges.push_back(random.Uniform(r.low, r.high));
    }
    return edges;
}

// Thresholds of the formulas (L* 8 is f = 0.2069, sRGB 10.31475 is c = 0.04045), axes, the ends
// of the ranges and beyond them.
const std::vector<double> kLabEdges = {0,      0,   0,    100,    0,  0,   50, 0,  0,     8.0004, 0,    0,
                                       7.9996, 0,   0,    8.0004, 40, -40, 50, 0,  -10,   50,     -10,  0,
                                       10,     0,   100,  150,    0,  0,   -5, 20, 20,    50,     128,  -128,
                                       100,    300, -300, 1e-300, 0,  0,   0,  0,  1e-12, 60,     -0.0, 0};
const std::vector<double> kRgbEdges = {0,   0,   0,   255, 255, 255, 10.31475, 0,      0,     10.3148, 128,
                                       255, 255, 0,   0,   0,   255, 0,        0,      0,     255,     1,
                                       2,   3,   300, -10, 128, 254, 0.25,     1e-300, 127.5, 127.5,   127.5};
const std::vector<double> kLchEdges = {
    50,          10,         0,  50,  10,         90, 50,  10, 180, 50,   10,    270, 50, 10,
    359.9999999, 50,         10, 360, 50,         10, 405, 50, 10,  -135, 50,    0,   33, 50,
    10,          89.9999999, 50, 10,  90.0000001, 0,  0,   0,  100, 150,  123.4, 50,  10, 269.99999999};
const std::vector<double> kXyzEdges = {0,   0,     0,      0.96422,  1,      0.82521, 0.9505,
                                       1,   1.089, 0.0089, 0.008856, 0.0089, -0.1,    0.5,
                                       0.2, 2,     2,      2,        1e-9,   1e-9,    1e-9};

ColorSpaceStruct Plain(int32_t code) {
    ColorSpaceStruct description;
    description.SetType(code);
    return description;
}

// An engine kept for the path; each path converts on its own.
Compute Engine(ColorSpaceStruct source, ColorSpaceStruct destination, AdaptationMethod adaptation) {
    auto engine = std::make_shared<cColorTranslator>();
    engine->SetAdaptation(adaptation);
    engine->SetSource(source);
    engine->SetDestination(destination);
    return [engine](const double* in, double* out) { EXPECT_EQ(engine->Translate(in, out), 0); };
}

Compute Exported(int (*convert)(const double*, double*)) {
    return [convert](const double* in, double* out) { EXPECT_EQ(convert(in, out), 1); };
}

struct Space {
    int32_t code;
    const char* name;
    std::vector<Range> ranges;
    const std::vector<double>* edges;
    double scale;
};

std::vector<Path> Conversions() {
    const std::vector<Range> lab = {{-5, 105}, {-130, 130}, {-130, 130}};
    const std::vector<Range> rgb = {{-5, 260}, {-5, 260}, {-5, 260}};
    const std::vector<Range> lch = {{-5, 105}, {0, 160}, {-10, 370}};
    const std::vector<Range> xyz = {{-0.05, 1.1}, {-0.05, 1.1}, {-0.05, 1.2}};
    const std::vector<Range> spectrum(36, Range{0, 1});
    std::vector<double> spectrumEdges(36, 1.0);
    for (double v : {0.0, 0.5, 1e-3}) spectrumEdges.insert(spectrumEdges.end(), 36, v);
    for (int band = 0; band < 36; band += 5) {
        for (int i = 0; i < 36; ++i) spectrumEdges.push_back(i == band ? 1.0 : 0.0);
    }

    std::vector<Path> paths = {
        {"BPConvertsRGB2Lab", 3, 3, 1, Inputs(1, rgb, 250, kRgbEdges), Exported(BPConvertsRGB2Lab)},
        {"BPConvertLab2sRGB", 3, 3, 1, Inputs(2, lab, 250, kLabEdges), Exported(BPConvertLab2sRGB)},
        {"BPConvertsLinearRGB2Lab", 3, 3, 1, Inputs(3, rgb, 250, kRgbEdges),
         Exported(BPConvertsLinearRGB2Lab)},
        {"BPConvertLab2LinearsRGB", 3, 3, 255, Inputs(4, lab, 250, kLabEdges),
         Exported(BPConvertLab2LinearsRGB)},
        {"BPConvertLCh2Lab", 3, 3, 1, Inputs(5, lch, 250, kLchEdges), Exported(BPConvertLCh2Lab)},
        {"BPConvertLab2LCh", 3, 3, 1, Inputs(6, lab, 250, kLabEdges), Exported(BPConvertLab2LCh)},
        {"BPConvert36BandSpectral2LabD502", 36, 3, 1, Inputs(7, spectrum, 150, spectrumEdges),
         Exported(BPConvert36BandSpectral2LabD502)},
        {"BPConvert36BandSpectral2LinearsRGB", 36, 3, 255 * 255, Inputs(8, spectrum, 150, spectrumEdges),
         Exported(BPConvert36BandSpectral2LinearsRGB)},
    };

    // The engine between plain descriptions, for the pairs the exported functions do not cover.
    const Space spaces[] = {{3, "lab", lab, &kLabEdges, 1},
                            {4, "lch", lch, &kLchEdges, 1},
                            {6, "xyz", xyz, &kXyzEdges, 100},
                            {24, "srgb", rgb, &kRgbEdges, 1},
                            {25, "linear-srgb", rgb, &kRgbEdges, 255}};
    uint64_t seed = 100;
    for (const Space& from : spaces) {
        for (const Space& to : spaces) {
            ++seed;
            const bool exported = (from.code == 3) != (to.code == 3) && from.code != 6 && to.code != 6;
            if (exported || from.code == to.code) continue;
            paths.push_back({std::string(from.name) + "->" + to.name, 3, 3, to.scale,
                             Inputs(seed, from.ranges, 80, *from.edges),
                             Engine(Plain(from.code), Plain(to.code), AdaptationMethod::None)});
        }
    }

    ColorSpaceStruct srgb = Plain(24);
    cColorSpaceSRGB::White(srgb.whitePoint);
    ColorSpaceStruct linear = Plain(25);
    cColorSpaceSRGB::White(linear.whitePoint);
    ColorSpaceStruct lchD65 = Plain(4);
    lchD65.whitePoint[0] = 0.95047;
    lchD65.whitePoint[2] = 1.08883;
    paths.push_back({"srgb->lab bradford", 3, 3, 1, Inputs(201, rgb, 80, kRgbEdges),
                     Engine(srgb, Plain(3), AdaptationMethod::Bradford)});
    paths.push_back({"lab->srgb cat02", 3, 3, 1, Inputs(202, lab, 80, kLabEdges),
                     Engine(Plain(3), srgb, AdaptationMethod::CAT02)});
    paths.push_back({"lab->linear-srgb xyz-scaling", 3, 3, 255, Inputs(203, lab, 80, kLabEdges),
                     Engine(Plain(3), linear, AdaptationMethod::XYZScaling)});
    paths.push_back({"lch-d65->lab", 3, 3, 1, Inputs(204, lch, 80, kLchEdges),
                     Engine(lchD65, Plain(3), AdaptationMethod::None)});
    return paths;
}

// Each appearance space from XYZ and back, under viewing conditions other than the default.
std::vector<Path> AppearanceSpaces() {
    std::vector<Path> paths;
    ColorSpaceStruct xyz = Plain(6);
    for (int32_t code = 10; code <= 21; ++code) {
        ColorSpaceStruct appearance = Plain(code);
        appearance.ApplyViewingPreset(4);
        const bool brightness = code >= 16;
        const bool cartesian = (code - 10) % 6 >= 3;
        const Range lightness = brightness ? Range{5, 150} : Range{1, 100};
        const std::vector<Range> correlates = cartesian ? std::vector<Range>{lightness, {-60, 60}, {-60, 60}}
                                                        : std::vector<Range>{lightness, {0, 70}, {0, 360}};
        const std::string name = "ciecam02 code " + std::to_string(code);
        paths.push_back({"xyz->" + name, 3, 3, 1,
                         Inputs(300 + code, {{0, 1}, {0, 1}, {0, 1.1}}, 25, kXyzEdges),
                         Engine(xyz, appearance, AdaptationMethod::None)});
        paths.push_back({name + "->xyz", 3, 3, 100, Inputs(400 + code, correlates, 25),
                         Engine(appearance, xyz, AdaptationMethod::None)});
    }
    return paths;
}

// Reference and sample: the published CIEDE2000 pairs' kinds of edge (neutral, opposite hues,
// a hue difference of exactly 180 degrees, one color without chroma), then random pairs, half of
// them close together.
std::vector<double> PairInputs(uint64_t seed, int count) {
    std::vector<double> pairs = {50, 2.6772, -79.7751, 50, 0,     -82.7485, 50, 0,   0,      50, -1,  2,
                                 50, 2.49,   -0.001,   50, -2.49, 0.0009,   50, 2.5, 0,      50, 0,   -2.5,
                                 50, 10,     0,        50, -10,   0,        50, 0,   10,     50, 0,   -10,
                                 50, 0,      0,        50, 0,     0,        60, 20,  -30,    60, 20,  -30,
                                 10, 0,      0,        90, 0,     0,        50, 20,  -30,    55, 18,  -25,
                                 16, 30,     30,       20, 30,    30,       50, -20, -1e-12, 50, -20, 1e-12};
    Random random(seed);
    for (int i = 0; i < count; ++i) {
        const double reference[3] = {random.Uniform(0, 100), random.Uniform(-110, 110),
                                     random.Uniform(-110, 110)};
        pairs.insert(pairs.end(), reference, reference + 3);
        for (int k = 0; k < 3; ++k) {
            const bool near = i % 2 == 1;
            pairs.push_back(near ? reference[k] + random.Uniform(-3, 3)
                                 : random.Uniform(k == 0 ? 0 : -110, k == 0 ? 100 : 110));
        }
    }
    return pairs;
}

std::vector<Path> Metrics() {
    const std::vector<double> pairs = PairInputs(500, 300);
    auto metric = [&](const char* name, std::function<double(const double*, const double*)> f) {
        return Path{name, 6, 1, 1, pairs, [f](const double* in, double* out) { out[0] = f(in, in + 3); }};
    };
    return {
        metric("BPCalculateDeltaE", BPCalculateDeltaE),
        metric("BPCalculateDistanceSquared", BPCalculateDistanceSquared),
        metric("BPCalculateDeltaECMC 2:1", [](auto a, auto b) { return BPCalculateDeltaECMC(a, b, 2, 1); }),
        metric("BPCalculateDeltaECMC 1:1", [](auto a, auto b) { return BPCalculateDeltaECMC(a, b, 1, 1); }),
        metric("BPCalculateDeltaE94", [](auto a, auto b) { return BPCalculateDeltaE94(a, b, 1, 1, 1); }),
        metric("BPCalculateDeltaE94 textiles",
               [](auto a, auto b) { return BPCalculateDeltaE94(a, b, 2, 1, 1); }),
        metric("BPCalculateDeltaE2000", [](auto a, auto b) { return BPCalculateDeltaE2000(a, b, 1, 1, 1); }),
        metric("BPCalculateDeltaE2000 2:1:1",
               [](auto a, auto b) { return BPCalculateDeltaE2000(a, b, 2, 1, 1); }),
    };
}

// Noise (every pixel its own color), smooth shading with grain, and a few flat colors; the input
// is the image's number, the output the count and the ten dominant colors.
std::vector<Path> Images() {
    auto extract = [](const double* in, double* out) {
        const int kind = static_cast<int>(in[0]);
        const int width = 97, height = 61;
        std::vector<unsigned char> pixels(static_cast<size_t>(width) * height * 4);
        Random random(600 + kind);
        for (int y = 0; y < height; ++y) {
            for (int x = 0; x < width; ++x) {
                unsigned char* pixel = &pixels[(static_cast<size_t>(y) * width + x) * 4];
                for (int c = 1; c < 4; ++c) {
                    const double grain = random.Uniform(-6, 6);
                    const double value = kind == 0   ? random.Uniform(0, 256)
                                         : kind == 1 ? 40 + 150.0 * x / width + 50.0 * c * y / height + grain
                                                     : 60.0 * ((x / 20 + y / 15 + c) % 4);
                    pixel[c] = static_cast<unsigned char>(std::fmin(std::fmax(value, 0.0), 255.0));
                }
            }
        }
        int count = -1;
        BPImageExtractLab(pixels.data(), width, height, 10, out + 1, &count);
        out[0] = count;
    };
    return {{"BPImageExtractLab", 1, 31, 1, {0, 1, 2}, extract}};
}

std::vector<Path> AllPaths() {
    std::vector<Path> paths = Conversions();
    for (auto* more : {AppearanceSpaces, Metrics, Images}) {
        for (Path& path : more()) paths.push_back(std::move(path));
    }
    return paths;
}

std::vector<double> Results(const Path& path) {
    const size_t count = path.inputs.size() / path.inWidth;
    std::vector<double> out(count * path.outWidth);
    for (size_t i = 0; i < count; ++i) path.compute(&path.inputs[i * path.inWidth], &out[i * path.outWidth]);
    return out;
}

void Record(const char* file) {
    std::FILE* f = std::fopen(file, "w");
    ASSERT_NE(f, nullptr) << file;
    for (const Path& path : AllPaths()) {
        const std::vector<double> results = Results(path);
        // Decimals enough that rounding the record costs a few thousandths of the tolerance.
        const int decimals = 12 + static_cast<int>(std::ceil(std::log10(path.scale)));
        std::fprintf(f, "%s\n%zu\n", path.name.c_str(), results.size());
        for (size_t i = 0; i < results.size(); ++i)
            std::fprintf(f, "%.*f%c", decimals, results[i], (i + 1) % path.outWidth == 0 ? '\n' : ' ');
    }
    std::fclose(f);
}

// NaN and infinities must stay what they were; finite values within the tolerance.
double Difference(double recorded, double now, double scale) {
    if (std::isnan(recorded) || std::isnan(now))
        return std::isnan(recorded) && std::isnan(now) ? 0.0 : INFINITY;
    if (std::isinf(recorded) || std::isinf(now)) return recorded == now ? 0.0 : INFINITY;
    return std::fabs(recorded - now) * scale;
}

TEST(RecordedResults, HoldToTheLastFewBits) {
    if (const char* file = std::getenv("PIGMO_RECORD_RESULTS")) {
        Record(file);
        GTEST_SKIP() << "recorded to " << file;
    }
    std::ifstream recorded(PIGMO_RECORDED_RESULTS);
    ASSERT_TRUE(recorded) << PIGMO_RECORDED_RESULTS;
    for (const Path& path : AllPaths()) {
        SCOPED_TRACE(path.name);
        std::string name;
        size_t count = 0;
        ASSERT_TRUE(std::getline(recorded, name) && recorded >> count);
        ASSERT_EQ(name, path.name);
        const std::vector<double> results = Results(path);
        ASSERT_EQ(count, results.size());
        double largest = 0.0;
        for (size_t i = 0; i < count; ++i) {
            std::string text;
            recorded >> text;
            const double difference = Difference(std::strtod(text.c_str(), nullptr), results[i], path.scale);
            EXPECT_LE(difference, kTolerance)
                << "input " << i / path.outWidth << ", output " << i % path.outWidth << ": recorded " << text
                << ", now " << results[i];
            largest = std::fmax(largest, difference);
        }
        recorded.ignore(1);  // the end of the last line
        std::printf("%-40s largest difference %.3g\n", path.name.c_str(), largest);
    }
}

}  // namespace
