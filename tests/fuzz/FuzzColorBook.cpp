// Feeds arbitrary bytes to the color-book reader as a book file.

#include <unistd.h>

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <vector>

#include "ColorBookReader.h"

namespace {

// One file per process, rewritten for every input: the reader takes paths, not buffers.
const std::string& BookPath() {
    static const std::string path = [] {
        char name[] = "/tmp/pigmo-fuzz-book-XXXXXX";
        const int fd = mkstemp(name);
        if (fd < 0) std::abort();
        close(fd);
        return std::string(name);
    }();
    return path;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const std::string& path = BookPath();
    FILE* file = std::fopen(path.c_str(), "wb");
    if (file == nullptr) std::abort();
    if (size > 0 && std::fwrite(data, 1, size, file) != size) std::abort();
    std::fclose(file);

    std::vector<Pigmo::ColorInformation> records;
    const char* error = nullptr;
    if (Pigmo::LoadColorBook(path.c_str(), records, &error)) {
        // Every record must be readable through its interface.
        for (const Pigmo::ColorInformation& record : records) {
            volatile float sink = record.GetLab()[0] + record.GetSRGB()[1] + record.GetLinearRGB()[2];
            for (int i = 0; i < record.GetSpectralReflectanceCount(); ++i)
                sink = sink + record.GetSpectralReflectance()[i];
            for (int i = 0; i < record.GetTagCount(); ++i)
                sink = sink + static_cast<float>(record.GetTag(i)[0]);
            sink = sink + static_cast<float>(record.GetName()[0] + record.GetCategory()[0]);
        }
    } else if (error == nullptr) {
        std::abort();  // a failure always says why
    }
    std::string name;
    Pigmo::ReadPaletteName(path.c_str(), name, &error);
    return 0;
}
