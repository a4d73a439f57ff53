// Loading a large color book: 5,000 colors, each with CIELAB and a 36-band curve, so every record
// converts its CIELAB to sRGB and its curve to linear RGB. Reports time and the peak heap in use
// during one load (document, records and file buffer together).

#include <benchmark/benchmark.h>
#include <malloc.h>
#include <unistd.h>

#include <atomic>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <new>
#include <string>
#include <vector>

#include "ColorBookReader.h"
#include "RatioReporter.h"

namespace {

std::atomic<std::size_t> heapInUse{0};
std::atomic<std::size_t> heapPeak{0};

void* CountedAllocate(std::size_t size) {
    void* block = std::malloc(size);
    if (block != nullptr) {
        const std::size_t now = heapInUse += malloc_usable_size(block);
        std::size_t peak = heapPeak.load();
        while (now > peak && !heapPeak.compare_exchange_weak(peak, now)) {
        }
    }
    return block;
}

// Out of line: GCC otherwise pairs the free below with operator new and warns.
[[gnu::noinline]] void CountedFree(void* block) {
    if (block == nullptr) return;
    heapInUse -= malloc_usable_size(block);
    std::free(block);
}

constexpr int kColors = 5000;

std::string WriteBook() {
    char name[] = "/tmp/pigmo-bench-book-XXXXXX";
    const int fd = mkstemp(name);
    if (fd < 0) std::abort();
    close(fd);
    std::ofstream out(name);
    out << "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
           "<CxF:CxF xmlns:CxF=\"http://colorexchangeformat.com/v2\">\n"
           "  <CxF:Palette PaletteName=\"Benchmark\">\n    <CxF:ColorSet>\n";
    char number[32];
    for (int i = 0; i < kColors; ++i) {
        out << "      <CxF:Color ColorName=\"Color " << i << "\">\n"
            << "        <CxF:CustomAttribute><CxF:Name>category</CxF:Name><CxF:ValueChoice>"
               "<CxF:StringValue>Group "
            << i % 19 << "</CxF:StringValue></CxF:ValueChoice></CxF:CustomAttribute>\n"
            << "        <CxF:ColorSpaceCIELab><CxF:L>" << 20 + i % 70 << "</CxF:L><CxF:A>" << i % 41 - 20
            << "</CxF:A><CxF:B>" << i % 37 - 18 << "</CxF:B></CxF:ColorSpaceCIELab>\n"
            << "        <CxF:ColorSpaceSpectral>\n";
        for (int band = 0; band < 36; ++band) {
            std::snprintf(number, sizeof number, "%.4f", 0.05 + 0.9 * ((i * 7 + band * 13) % 100) / 100.0);
            out << "          <CxF:ReflectancePoint Wavelength=\"" << 380 + 10 * band << "\">" << number
                << "</CxF:ReflectancePoint>\n";
        }
        out << "        </CxF:ColorSpaceSpectral>\n      </CxF:Color>\n";
    }
    out << "    </CxF:ColorSet>\n  </CxF:Palette>\n</CxF:CxF>\n";
    return name;
}

void BM_LoadColorBook5000(benchmark::State& state) {
    static const std::string path = WriteBook();
    std::size_t peak = 0;
    for (auto _ : state) {
        const std::size_t before = heapInUse.load();
        heapPeak = before;
        std::vector<Pigmo::ColorInformation> records;
        const char* error = nullptr;
        if (!Pigmo::LoadColorBook(path.c_str(), records, &error) || records.size() != kColors) {
            state.SkipWithError(error != nullptr ? error : "wrong color count");
            break;
        }
        benchmark::DoNotOptimize(records.data());
        peak = std::max(peak, heapPeak.load() - before);
    }
    state.counters["colors"] = kColors;
    state.counters["peak_MiB"] = static_cast<double>(peak) / (1024.0 * 1024.0);
    std::ifstream file(path, std::ios::binary | std::ios::ate);
    state.counters["file_MiB"] = static_cast<double>(file.tellg()) / (1024.0 * 1024.0);
    state.SetItemsProcessed(state.iterations() * kColors);
}
BENCHMARK(BM_LoadColorBook5000)->Unit(benchmark::kMillisecond);

}  // namespace

void* operator new(std::size_t size) {
    if (void* block = CountedAllocate(size)) return block;
    throw std::bad_alloc();
}
void* operator new[](std::size_t size) {
    return operator new(size);
}
void operator delete(void* block) noexcept {
    CountedFree(block);
}
void operator delete[](void* block) noexcept {
    CountedFree(block);
}
void operator delete(void* block, std::size_t) noexcept {
    CountedFree(block);
}
void operator delete[](void* block, std::size_t) noexcept {
    CountedFree(block);
}

int main(int argc, char** argv) {
    // The document's own allocations count too.
    pugi::set_memory_management_functions(CountedAllocate, CountedFree);
    return Pigmo::Bench::RunBenchmarks(argc, argv);
}
