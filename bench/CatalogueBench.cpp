#include <benchmark/benchmark.h>

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <random>
#include <vector>

#include "RatioReporter.h"
#include "pigmo/bp.h"

namespace {

constexpr int kWidth = 4000;
constexpr int kHeight = 3000;

// Colors an image can hold: random sRGB values converted to Lab.
std::vector<double> RandomLabs(size_t count) {
    std::mt19937 random(11);
    std::uniform_int_distribution<int> channel(0, 255);
    std::vector<double> labs(3 * count);
    for (size_t i = 0; i < count; ++i) {
        const double rgb[3] = {double(channel(random)), double(channel(random)), double(channel(random))};
        BPConvertsRGB2Lab(rgb, &labs[3 * i]);
    }
    return labs;
}

void BM_CentroidGetForLab(benchmark::State& state) {
    const std::vector<double> labs = RandomLabs(4096);
    size_t i = 0;
    for (auto _ : state) {
        benchmark::DoNotOptimize(BPCentroidGetForLab(&labs[3 * i]));
        i = (i + 1) & 4095;
    }
    state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_CentroidGetForLab);

enum class Content { Flat, Photo, Noise };

// Photo: smooth shading over a few large shapes plus sensor-like noise of a few levels, so
// neighbouring pixels share most but not all of their colors. Noise: every pixel independent.
std::vector<unsigned char> MakeImage(Content content) {
    std::vector<unsigned char> pixels(static_cast<size_t>(kWidth) * kHeight * 4);
    std::mt19937 random(5);
    std::normal_distribution<double> grain(0.0, 1.5);
    std::uniform_int_distribution<int> any(0, 255);
    for (int y = 0; y < kHeight; ++y) {
        for (int x = 0; x < kWidth; ++x) {
            unsigned char* pixel = &pixels[(static_cast<size_t>(y) * kWidth + x) * 4];
            double rgb[3] = {200.0, 120.0, 60.0};
            if (content == Content::Photo) {
                const double u = x / double(kWidth), v = y / double(kHeight);
                const bool sky = v < 0.35 + 0.1 * std::sin(6.0 * u);
                const bool disc = (u - 0.6) * (u - 0.6) + (v - 0.6) * (v - 0.6) < 0.04;
                if (sky) {
                    rgb[0] = 90 + 60 * v, rgb[1] = 140 + 60 * v, rgb[2] = 230 - 30 * u;
                } else if (disc) {
                    rgb[0] = 180 + 50 * u, rgb[1] = 40 + 40 * v, rgb[2] = 50;
                } else {
                    rgb[0] = 70 + 60 * u * v, rgb[1] = 110 + 50 * std::sin(9 * u) * v, rgb[2] = 40 + 30 * u;
                }
                for (double& c : rgb) c += grain(random);
            } else if (content == Content::Noise) {
                for (double& c : rgb) c = any(random);
            }
            pixel[0] = 255;
            for (int i = 0; i < 3; ++i)
                pixel[i + 1] = static_cast<unsigned char>(std::clamp(rgb[i], 0.0, 255.0));
        }
    }
    return pixels;
}

// Distinct colors among the pixels the extraction samples: what its cost grows with.
size_t DistinctSampled(const std::vector<unsigned char>& pixels) {
    std::vector<bool> seen(size_t{1} << 24);
    size_t distinct = 0;
    for (int y = kHeight - 1; y >= 0; y -= 2) {
        for (int x = kWidth - 1; x >= 0; x -= 2) {
            const unsigned char* pixel = &pixels[(static_cast<size_t>(y) * kWidth + x) * 4];
            const size_t rgb = (size_t{pixel[1]} << 16) | (size_t{pixel[2]} << 8) | pixel[3];
            distinct += !seen[rgb];
            seen[rgb] = true;
        }
    }
    return distinct;
}

void BM_ImageExtractLab(benchmark::State& state) {
    const std::vector<unsigned char> pixels = MakeImage(static_cast<Content>(state.range(0)));
    state.counters["distinct"] = static_cast<double>(DistinctSampled(pixels));
    double lab[10 * 3];
    int count = 0;
    for (auto _ : state) {
        BPImageExtractLab(pixels.data(), kWidth, kHeight, 10, lab, &count);
        benchmark::DoNotOptimize(lab);
    }
    state.counters["Mpx/s"] = benchmark::Counter(
        static_cast<double>(state.iterations()) * kWidth * kHeight / 1e6, benchmark::Counter::kIsRate);
}
BENCHMARK(BM_ImageExtractLab)
    ->ArgName("flat0_photo1_noise2")
    ->Arg(static_cast<int>(Content::Flat))
    ->Arg(static_cast<int>(Content::Photo))
    ->Arg(static_cast<int>(Content::Noise))
    ->Unit(benchmark::kMillisecond);

}  // namespace

int main(int argc, char** argv) {
    return Pigmo::Bench::RunBenchmarks(argc, argv);
}
