// Feeds arbitrary bytes to the color-book reader as a book file, and checks that the bounded read of
// a book's start agrees with the whole-document parse.

#include <fcntl.h>
#include <unistd.h>

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <pugixml.hpp>
#include <string>
#include <vector>

#include "BookHead.h"
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

    // Whenever the whole book parses, its head says the same of the root and the first palette.
    constexpr unsigned int kOptions = pugi::parse_default | pugi::parse_comments | pugi::parse_trim_pcdata;
    char* copy = static_cast<char*>(pugi::get_memory_allocation_function()(size + 1));
    if (size > 0) std::memcpy(copy, data, size);
    pugi::xml_document whole;  // parsed in place, as the reader does
    if (whole.load_buffer_inplace_own(copy, size, kOptions, pugi::encoding_auto)) {
        const int fd = open(path.c_str(), O_RDONLY | O_CLOEXEC);
        std::string head;
        if (fd < 0 || !Pigmo::ReadBookHead(fd, head, 1 + size % 7)) std::abort();
        close(fd);
        pugi::xml_document part;
        if (!part.load_buffer(head.data(), head.size(), kOptions, pugi::encoding_auto)) std::abort();
        const pugi::xml_node a = whole.document_element(), b = part.document_element();
        const pugi::xml_node pa = a.child("CxF:Palette"), pb = b.child("CxF:Palette");
        if (std::strcmp(a.name(), b.name()) != 0 ||
            std::strcmp(a.attribute("xmlns:CxF").value(), b.attribute("xmlns:CxF").value()) != 0 ||
            !pa != !pb ||
            std::strcmp(pa.attribute("PaletteName").value(), pb.attribute("PaletteName").value()) != 0)
            std::abort();
    }
    return 0;
}
