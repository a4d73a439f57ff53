#include "ColorBookReader.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <memory>

#include "Paths.h"
#include "StringTable.h"

namespace Pigmo {

namespace {

char messageBuffer[kColorBookMessageCapacity];

void Report(const char** errorMessage, const char* text) {
    if (errorMessage != nullptr) *errorMessage = text;
}

struct PugiFree {
    void operator()(char* buffer) const { pugi::get_memory_deallocation_function()(buffer); }
};
using PugiBuffer = std::unique_ptr<char, PugiFree>;

// Reads a regular file whole, into a buffer the document can take over. Anything else (a
// directory, a device, a pipe) would block or never end, so it counts as unreadable.
bool ReadRegularFile(const std::string& path, PugiBuffer& content, std::size_t& size) {
    const int fd = open(path.c_str(), O_RDONLY | O_NONBLOCK | O_NOCTTY | O_CLOEXEC);
    if (fd < 0) return false;
    struct stat status {};
    bool ok = fstat(fd, &status) == 0 && S_ISREG(status.st_mode) && status.st_size > 0;
    if (ok) {
        // What the file holds at this moment; a file that shrinks meanwhile gives what is left.
        const std::size_t capacity = static_cast<std::size_t>(status.st_size);
        content.reset(static_cast<char*>(pugi::get_memory_allocation_function()(capacity)));
        ok = content != nullptr;
        size = 0;
        while (ok && size < capacity) {
            const ssize_t count = read(fd, content.get() + size, capacity - size);
            if (count == 0) break;
            if (count < 0)
                ok = errno == EINTR;
            else
                size += static_cast<std::size_t>(count);
        }
    }
    close(fd);
    return ok;
}

// The value of an element's first child node when that node is text; null otherwise.
const char* TextOf(const pugi::xml_node& element) {
    const pugi::xml_node first = element.first_child();
    const pugi::xml_node_type type = first.type();
    return type == pugi::node_pcdata || type == pugi::node_cdata ? first.value() : nullptr;
}

// A value no float can hold (inf, nan, 1e39) reads 0: it would poison every value derived from it.
float FiniteFloat(double value) {
    const float narrowed = static_cast<float>(value);
    return std::isfinite(narrowed) ? narrowed : 0.0f;
}

// As atof reads it; no text reads 0.
float NumberOf(const pugi::xml_node& element) {
    const char* text = TextOf(element);
    return text != nullptr ? FiniteFloat(std::strtod(text, nullptr)) : 0.0f;
}

bool ReadTriple(const pugi::xml_node& space, const char* const (&names)[3], float (&values)[3]) {
    pugi::xml_node parts[3];
    for (int i = 0; i < 3; ++i) {
        parts[i] = space.child(names[i]);
        if (!parts[i]) return false;
    }
    for (int i = 0; i < 3; ++i) values[i] = NumberOf(parts[i]);
    return true;
}

struct ColorFields {
    const char* category = nullptr;
    float lab[3] = {0, 0, 0};
    float rgb[3] = {0, 0, 0};
    bool hasLab = false;
    bool hasRGB = false;
    std::vector<float> curve;
    std::vector<std::string> tags;
};

void ReadCustomAttribute(const pugi::xml_node& attribute, ColorFields& fields) {
    const char* name = TextOf(attribute.child("CxF:Name"));
    if (name == nullptr) return;
    const pugi::xml_node choice = attribute.child("CxF:ValueChoice");
    if (std::strcmp(name, "category") == 0) {
        if (const char* category = TextOf(choice.child("CxF:StringValue"))) fields.category = category;
    } else if (std::strcmp(name, "tags") == 0) {
        for (const pugi::xml_node value : choice.children("CxF:StringValue"))
            if (const char* tag = TextOf(value)) fields.tags.emplace_back(tag);
    }
}

void ReadColorChild(const pugi::xml_node& child, ColorFields& fields) {
    static const char* const kLabNames[3] = {"CxF:L", "CxF:A", "CxF:B"};
    static const char* const kRGBNames[3] = {"CxF:Red", "CxF:Green", "CxF:Blue"};
    const char* name = child.name();
    if (std::strcmp(name, "CxF:CustomAttribute") == 0) {
        ReadCustomAttribute(child, fields);
    } else if (std::strcmp(name, "CxF:ColorSpaceCIELab") == 0) {
        float lab[3];
        if (ReadTriple(child, kLabNames, lab)) {
            std::copy(lab, lab + 3, fields.lab);
            fields.hasLab = true;
        }
    } else if (std::strcmp(name, "CxF:ColorSpaceSRGB") == 0) {
        float rgb[3];
        if (ReadTriple(child, kRGBNames, rgb)) {
            // Books hold sRGB on 0..1; records take it on 0..255.
            for (int i = 0; i < 3; ++i) fields.rgb[i] = FiniteFloat(rgb[i] * 255.0);
            fields.hasRGB = true;
        }
    } else if (std::strcmp(name, "CxF:ColorSpaceSpectral") == 0) {
        for (const pugi::xml_node point : child.children("CxF:ReflectancePoint"))
            fields.curve.push_back(NumberOf(point));
    }
}

ColorInformation ReadColor(const pugi::xml_node& color) {
    ColorFields fields;
    for (const pugi::xml_node child : color.children())
        if (child.type() == pugi::node_element) ReadColorChild(child, fields);
    const pugi::xml_attribute name = color.attribute("ColorName");
    const int count = static_cast<int>(fields.curve.size());
    return ColorInformation(name ? name.value() : "Unnamed", fields.category ? fields.category : "Default",
                            fields.hasLab ? fields.lab : nullptr, fields.hasRGB ? fields.rgb : nullptr,
                            count >= 2 ? fields.curve.data() : nullptr, count, &fields.tags);
}

}  // namespace

bool OpenColorBook(const char* path, pugi::xml_document& document, const char** errorMessage) {
    const std::string native = Platform::NativePath(path != nullptr ? path : "");
    struct stat status {};
    if (path == nullptr || stat(native.c_str(), &status) != 0) {
        const char* format = LoadResourceString(IDS_COLORBOOK_MISSING);
        if (format == nullptr) {
            Report(errorMessage, nullptr);
            return false;
        }
        // The format is our own table's text with one %s.
        std::snprintf(messageBuffer, sizeof messageBuffer, format, path != nullptr ? path : "");
        Report(errorMessage, messageBuffer);
        return false;
    }

    PugiBuffer content;
    std::size_t size = 0;
    constexpr unsigned int kParseOptions =
        pugi::parse_default | pugi::parse_comments | pugi::parse_trim_pcdata;
    if (!ReadRegularFile(native, content, size) ||
        !document.load_buffer_inplace_own(content.release(), size, kParseOptions, pugi::encoding_auto)) {
        Report(errorMessage, LoadResourceString(IDS_COLORBOOK_INVALID));
        return false;
    }

    const pugi::xml_node root = document.document_element();
    if (!root || std::strcmp(root.name(), "CxF:CxF") != 0) {
        Report(errorMessage, LoadResourceString(IDS_COLORBOOK_INVALID));
        return false;
    }
    const pugi::xml_attribute version = root.attribute("xmlns:CxF");
    if (!version || std::strcmp(version.value(), kCxF2Namespace) != 0) {
        Report(errorMessage, LoadResourceString(IDS_COLORBOOK_VERSION));
        return false;
    }
    return true;
}

bool LoadColorBook(const char* path, std::vector<ColorInformation>& records, const char** errorMessage) {
    pugi::xml_document document;
    if (!OpenColorBook(path, document, errorMessage)) return false;
    static const pugi::xpath_query colors("/CxF:CxF/CxF:Palette//CxF:ColorSet/CxF:Color");
    const pugi::xpath_node_set nodes = colors.evaluate_node_set(document.document_element());
    records.reserve(records.size() + nodes.size());
    for (const pugi::xpath_node& node : nodes)
        if (node.node()) records.push_back(ReadColor(node.node()));
    return true;
}

bool ReadPaletteName(const char* path, std::string& name, const char** errorMessage) {
    pugi::xml_document document;
    if (!OpenColorBook(path, document, errorMessage)) return false;
    static const pugi::xpath_query palettes("/CxF:CxF/CxF:Palette");
    const pugi::xpath_node_set nodes = palettes.evaluate_node_set(document.document_element());
    if (!nodes.empty()) name = nodes.first().node().attribute("PaletteName").value();
    return true;
}

}  // namespace Pigmo
