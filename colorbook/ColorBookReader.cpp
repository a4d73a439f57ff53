#include "ColorBookReader.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <limits>
#include <memory>

#include "BookHead.h"
#include "Paths.h"
#include "RegularFile.h"
#include "StringTable.h"

namespace Pigmo {

namespace {

char messageBuffer[kColorBookMessageCapacity];

void Report(const char** errorMessage, const char* text) {
    if (errorMessage != nullptr) *errorMessage = text;
}

void Explain(ColorBookFailure* failure, std::string cause, bool outOfMemory = false) {
    if (failure == nullptr) return;
    failure->cause = std::move(cause);
    failure->outOfMemory = outOfMemory;
}

struct PugiFree {
    void operator()(char* buffer) const { pugi::get_memory_deallocation_function()(buffer); }
};
using PugiBuffer = std::unique_ptr<char, PugiFree>;

// The path as the file system takes it, or false with the "doesn't exist" text when it has no status.
bool Locate(const char* path, std::string& native, const char** errorMessage, ColorBookFailure* failure) {
    native = Platform::NativePath(path != nullptr ? path : "");
    struct stat status {};
    if (path != nullptr && stat(native.c_str(), &status) == 0) return true;
    const int error = path != nullptr ? errno : ENOENT;
    // "Doesn't exist" says it all only when nothing is there.
    Explain(failure, error == ENOENT ? "" : Platform::SystemErrorText(error));
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

bool Invalid(const char** errorMessage, ColorBookFailure* failure, std::string cause,
             bool outOfMemory = false) {
    Explain(failure, std::move(cause), outOfMemory);
    Report(errorMessage, LoadResourceString(IDS_COLORBOOK_INVALID));
    return false;
}

// Reads a regular file whole, into a buffer the document can take over. Anything else (a
// directory, a device, a pipe) would block or never end, so it counts as unreadable.
bool ReadRegularFile(const std::string& path, PugiBuffer& content, std::size_t& size,
                     const char** errorMessage, ColorBookFailure* failure) {
    std::string problem;
    const int fd = Platform::OpenRegularFile(path, problem);
    if (fd < 0) return Invalid(errorMessage, failure, problem);
    struct stat status {};
    bool ok = fstat(fd, &status) == 0;
    // What the file holds at this moment; a file that shrinks meanwhile gives what is left.
    const std::size_t capacity = ok ? static_cast<std::size_t>(status.st_size) : 0;
    if (ok && capacity > 0) {
        content.reset(static_cast<char*>(pugi::get_memory_allocation_function()(capacity)));
        if (!content) {
            close(fd);
            return Invalid(errorMessage, failure, "out of memory", true);
        }
    }
    size = 0;
    while (ok && size < capacity) {
        const ssize_t count = read(fd, content.get() + size, capacity - size);
        if (count == 0) break;
        if (count < 0)
            ok = errno == EINTR;
        else
            size += static_cast<std::size_t>(count);
    }
    const int error = errno;
    close(fd);
    if (!ok) return Invalid(errorMessage, failure, Platform::SystemErrorText(error));
    if (size == 0) return Invalid(errorMessage, failure, "the file is empty");
    return true;
}

constexpr unsigned int kParseOptions = pugi::parse_default | pugi::parse_comments | pugi::parse_trim_pcdata;

bool Parsed(const pugi::xml_parse_result& result, const char** errorMessage, ColorBookFailure* failure) {
    if (result) return true;
    if (result.status == pugi::status_out_of_memory)
        return Invalid(errorMessage, failure, "out of memory", true);
    return Invalid(errorMessage, failure,
                   "XML error at byte " + std::to_string(result.offset) + ": " + result.description());
}

// The root must be "CxF:CxF" of the version-2 namespace.
bool CheckRoot(const pugi::xml_document& document, const char** errorMessage, ColorBookFailure* failure) {
    const pugi::xml_node root = document.document_element();
    if (!root) return Invalid(errorMessage, failure, "no root element");
    if (std::strcmp(root.name(), "CxF:CxF") != 0)
        return Invalid(errorMessage, failure,
                       "the root element is '" + std::string(root.name()) + "', not 'CxF:CxF'");
    const pugi::xml_attribute version = root.attribute("xmlns:CxF");
    if (!version || std::strcmp(version.value(), kCxF2Namespace) != 0) {
        Explain(failure, version ? "xmlns:CxF is '" + std::string(version.value()) + "'"
                                 : "the root has no xmlns:CxF");
        Report(errorMessage, LoadResourceString(IDS_COLORBOOK_VERSION));
        return false;
    }
    return true;
}

// "PaletteName" of the first palette; name is left as it is when the book has no palette.
void FindPaletteName(const pugi::xml_document& document, std::string& name) {
    static const pugi::xpath_query palettes("/CxF:CxF/CxF:Palette");
    const pugi::xpath_node_set nodes = palettes.evaluate_node_set(document.document_element());
    if (!nodes.empty()) name = nodes.first().node().attribute("PaletteName").value();
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
    std::vector<double> wavelengths;  // one per curve value
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
        for (const pugi::xml_node point : child.children("CxF:ReflectancePoint")) {
            fields.curve.push_back(NumberOf(point));
            const pugi::xml_attribute wavelength = point.attribute("Wavelength");
            fields.wavelengths.push_back(wavelength ? std::strtod(wavelength.value(), nullptr)
                                                    : std::numeric_limits<double>::quiet_NaN());
        }
    }
}

// The record of one color element; wavelengths receives its points' wavelength attributes.
ColorInformation ReadColor(const pugi::xml_node& color, std::vector<double>& wavelengths) {
    ColorFields fields;
    for (const pugi::xml_node child : color.children())
        if (child.type() == pugi::node_element) ReadColorChild(child, fields);
    const pugi::xml_attribute name = color.attribute("ColorName");
    const int count = static_cast<int>(fields.curve.size());
    wavelengths = std::move(fields.wavelengths);
    return ColorInformation(name ? name.value() : "Unnamed", fields.category ? fields.category : "Default",
                            fields.hasLab ? fields.lab : nullptr, fields.hasRGB ? fields.rgb : nullptr,
                            count >= 2 ? fields.curve.data() : nullptr, count, &fields.tags);
}

// Collects the records of a book in a list.
class RecordAppender final : public ColorBookVisitor {
public:
    explicit RecordAppender(std::vector<ColorInformation>& records) : records_(records) {}
    void Begin(const std::string&, std::size_t colorCount) override {
        records_.reserve(records_.size() + colorCount);
    }
    void Color(const ColorInformation& color, const std::vector<double>&) override {
        records_.push_back(color);
    }

private:
    std::vector<ColorInformation>& records_;
};

}  // namespace

bool OpenColorBook(const char* path, pugi::xml_document& document, const char** errorMessage,
                   ColorBookFailure* failure) {
    Explain(failure, "");
    std::string native;
    if (!Locate(path, native, errorMessage, failure)) return false;
    PugiBuffer content;
    std::size_t size = 0;
    if (!ReadRegularFile(native, content, size, errorMessage, failure)) return false;
    return Parsed(
               document.load_buffer_inplace_own(content.release(), size, kParseOptions, pugi::encoding_auto),
               errorMessage, failure) &&
           CheckRoot(document, errorMessage, failure);
}

bool ReadColorBook(const char* path, ColorBookVisitor& visitor, const char** errorMessage,
                   ColorBookFailure* failure) {
    pugi::xml_document document;
    if (!OpenColorBook(path, document, errorMessage, failure)) return false;
    static const pugi::xpath_query colors("/CxF:CxF/CxF:Palette//CxF:ColorSet/CxF:Color");
    const pugi::xpath_node_set nodes = colors.evaluate_node_set(document.document_element());
    std::string palette;
    FindPaletteName(document, palette);
    visitor.Begin(palette, nodes.size());
    std::vector<double> wavelengths;
    for (const pugi::xpath_node& node : nodes) {
        if (!node.node()) continue;
        const ColorInformation color = ReadColor(node.node(), wavelengths);
        visitor.Color(color, wavelengths);
    }
    return true;
}

std::mutex& ColorBookReaderLock() {
    static std::mutex lock;
    return lock;
}

std::string ColorBookFailureText(const char* path, const char* errorMessage,
                                 const ColorBookFailure& failure) {
    const std::string where = path != nullptr ? path : "";
    std::string text = errorMessage != nullptr ? errorMessage : "cannot read the book";
    if (text.find(where) == std::string::npos) text = where + ": " + text;
    if (!failure.cause.empty()) text += " (" + failure.cause + ")";
    return text;
}

bool LoadColorBook(const char* path, std::vector<ColorInformation>& records, const char** errorMessage) {
    RecordAppender appender(records);
    return ReadColorBook(path, appender, errorMessage);
}

bool ReadPaletteName(const char* path, std::string& name, const char** errorMessage) {
    std::string native;
    if (!Locate(path, native, errorMessage, nullptr)) return false;
    std::string problem;
    const int fd = Platform::OpenRegularFile(native, problem);
    if (fd < 0) return Invalid(errorMessage, nullptr, problem);
    std::string head;
    const bool read = ReadBookHead(fd, head);
    close(fd);
    if (!read) return Invalid(errorMessage, nullptr, "");
    pugi::xml_document document;
    if (!Parsed(document.load_buffer(head.data(), head.size(), kParseOptions, pugi::encoding_auto),
                errorMessage, nullptr) ||
        !CheckRoot(document, errorMessage, nullptr))
        return false;
    FindPaletteName(document, name);
    return true;
}

}  // namespace Pigmo
