#pragma once

#include <mutex>
#include <pugixml.hpp>
#include <string>
#include <vector>

#include "ColorInformation.h"

namespace Pigmo {

// Root attribute value of every CxF version-2 book.
inline constexpr const char* kCxF2Namespace = "http://colorexchangeformat.com/v2";

// Capacity of the "doesn't exist" message, terminator included; longer paths are cut.
inline constexpr std::size_t kColorBookMessageCapacity = 512;

// What a tool can say beyond the string-table text when a book does not open. The texts stay as the
// map shows them; the cause is for tools that have room to say more.
struct ColorBookFailure {
    std::string cause;  // "permission denied", "is a directory", "XML error at byte 12: ...", or empty
    bool outOfMemory = false;
};

// Receives a book read in one pass: its palette name and color count, then each color in order.
class ColorBookVisitor {
public:
    // paletteName is the first palette's "PaletteName", empty when the book has no palette.
    virtual void Begin(const std::string& paletteName, std::size_t colorCount) = 0;
    // wavelengths holds the "Wavelength" attribute of each reflectance point, in the order the
    // record keeps their values; NaN where a point has none. The values are read in document order
    // whatever these say.
    virtual void Color(const ColorInformation& color, const std::vector<double>& wavelengths) = 0;

protected:
    ~ColorBookVisitor() = default;
};

// The reader reports through shared buffers; callers on several threads hold this lock from the call
// until they have copied its text.
std::mutex& ColorBookReaderLock();

// One line for a book that did not open: the reader's text, led by the path unless the text names it
// already, then the cause where the failure gives one.
std::string ColorBookFailureText(const char* path, const char* errorMessage, const ColorBookFailure& failure);

// Loads path into document and checks it is a CxF 2.1 book. On failure returns false and points
// *errorMessage (when not null) at a string-table text valid until the next error or string load.
bool OpenColorBook(const char* path, pugi::xml_document& document, const char** errorMessage,
                   ColorBookFailure* failure = nullptr);

// Opens the book once and hands its colors to visitor one at a time, so a caller can use each record
// and let it go. False, with nothing visited, as OpenColorBook fails.
bool ReadColorBook(const char* path, ColorBookVisitor& visitor, const char** errorMessage,
                   ColorBookFailure* failure = nullptr);

// Appends one record per color of the book to records (which is not cleared first). True when the
// book opened, also when it holds no color; false with *errorMessage as OpenColorBook sets it.
bool LoadColorBook(const char* path, std::vector<ColorInformation>& records, const char** errorMessage);

// The book's display name: "PaletteName" of its first palette. name is left as it is when the book
// has no palette or does not open. Only the start of the book is read, in bounded memory, up to the
// first palette's tag; damage further on is found when the book is loaded.
bool ReadPaletteName(const char* path, std::string& name, const char** errorMessage);

}  // namespace Pigmo
