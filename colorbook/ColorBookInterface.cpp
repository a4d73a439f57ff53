// The color-book part of the C interface: a book read whole into a handle that never changes after.
#include <pigmo/bp.h>

#include <algorithm>
#include <cstdio>
#include <cstring>
#include <limits>
#include <memory>
#include <string>
#include <vector>

#include "ColorBookReader.h"

struct BPColorBook {
    std::string name;
    std::vector<Pigmo::ColorInformation> colors;
};

namespace {

class BookFiller final : public Pigmo::ColorBookVisitor {
public:
    explicit BookFiller(BPColorBook& book) : book_(book) {}

    void Begin(const std::string& paletteName, std::size_t colorCount) override {
        book_.name = paletteName;
        book_.colors.reserve(colorCount);
    }
    void Color(const Pigmo::ColorInformation& color, const std::vector<double>&) override {
        book_.colors.push_back(color);
    }

private:
    BPColorBook& book_;
};

void CopyText(const std::string& text, char* buffer, size_t size) {
    if (buffer == nullptr || size == 0) return;
    const size_t length = std::min(text.size(), size - 1);
    std::memcpy(buffer, text.data(), length);
    buffer[length] = 0;
}

const Pigmo::ColorInformation* ColorAt(const BPColorBook* book, int index) {
    if (book == nullptr || index < 0 || static_cast<size_t>(index) >= book->colors.size()) return nullptr;
    return &book->colors[static_cast<size_t>(index)];
}

int CopyTriple(const float* values, double* out) {
    if (out == nullptr) return 0;
    for (int i = 0; i < 3; ++i) out[i] = values[i];
    return 1;
}

}  // namespace

extern "C" {

int BPGetHtmlColorCode(const double* sRGB, char* code, size_t codeSize) {
    if (sRGB == nullptr || code == nullptr || codeSize == 0) return 0;
    try {
        CopyText(Pigmo::HtmlColorCode(sRGB[0], sRGB[1], sRGB[2]), code, codeSize);
        return 1;
    } catch (...) {
        code[0] = 0;
        return 0;
    }
}

BPColorBook* BPColorBookOpen(const char* path, char* errorText, size_t errorTextSize) {
    CopyText("", errorText, errorTextSize);
    try {
        auto book = std::make_unique<BPColorBook>();
        BookFiller filler(*book);
        const char* error = nullptr;
        Pigmo::ColorBookFailure failure;
        std::lock_guard guard(Pigmo::ColorBookReaderLock());
        if (Pigmo::ReadColorBook(path, filler, &error, &failure)) return book.release();
        CopyText(Pigmo::ColorBookFailureText(path, error, failure), errorText, errorTextSize);
    } catch (...) {
        // Only allocation throws here; the text is formatted without allocating.
        if (errorText != nullptr && errorTextSize > 0)
            std::snprintf(errorText, errorTextSize, "%s: out of memory", path != nullptr ? path : "");
    }
    return nullptr;
}

void BPColorBookClose(BPColorBook* book) {
    delete book;
}

const char* BPColorBookGetName(const BPColorBook* book) {
    return book != nullptr ? book->name.c_str() : nullptr;
}

int BPColorBookGetColorCount(const BPColorBook* book) {
    return book != nullptr
               ? static_cast<int>(std::min<size_t>(book->colors.size(), std::numeric_limits<int>::max()))
               : 0;
}

const char* BPColorBookGetColorName(const BPColorBook* book, int index) {
    const Pigmo::ColorInformation* color = ColorAt(book, index);
    return color != nullptr ? color->GetName() : nullptr;
}

const char* BPColorBookGetColorCategory(const BPColorBook* book, int index) {
    const Pigmo::ColorInformation* color = ColorAt(book, index);
    return color != nullptr ? color->GetCategory() : nullptr;
}

int BPColorBookGetColorLab(const BPColorBook* book, int index, double* lab) {
    const Pigmo::ColorInformation* color = ColorAt(book, index);
    return color != nullptr ? CopyTriple(color->GetLab(), lab) : 0;
}

int BPColorBookGetColorSRGB(const BPColorBook* book, int index, double* sRGB) {
    const Pigmo::ColorInformation* color = ColorAt(book, index);
    return color != nullptr ? CopyTriple(color->GetSRGB(), sRGB) : 0;
}

int BPColorBookGetColorLinearRGB(const BPColorBook* book, int index, double* linearRGB) {
    const Pigmo::ColorInformation* color = ColorAt(book, index);
    return color != nullptr ? CopyTriple(color->GetLinearRGB(), linearRGB) : 0;
}

int BPColorBookGetColorTagCount(const BPColorBook* book, int index) {
    const Pigmo::ColorInformation* color = ColorAt(book, index);
    return color != nullptr ? color->GetTagCount() : 0;
}

const char* BPColorBookGetColorTag(const BPColorBook* book, int index, int tag) {
    const Pigmo::ColorInformation* color = ColorAt(book, index);
    return color != nullptr && tag >= 0 ? color->GetTag(static_cast<unsigned>(tag)) : nullptr;
}

int BPColorBookGetColorReflectanceCount(const BPColorBook* book, int index) {
    const Pigmo::ColorInformation* color = ColorAt(book, index);
    return color != nullptr ? color->GetSpectralReflectanceCount() : 0;
}

int BPColorBookGetColorReflectance(const BPColorBook* book, int index, double* values, int capacity) {
    const Pigmo::ColorInformation* color = ColorAt(book, index);
    if (color == nullptr || values == nullptr || capacity <= 0) return 0;
    const int count = std::min(capacity, color->GetSpectralReflectanceCount());
    const float* curve = color->GetSpectralReflectance();
    for (int i = 0; i < count; ++i) values[i] = curve[i];
    return count;
}

}  // extern "C"
