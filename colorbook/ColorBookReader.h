#pragma once

#include <pugixml.hpp>
#include <string>
#include <vector>

#include "ColorInformation.h"

namespace Pigmo {

// Root attribute value of every CxF version-2 book.
inline constexpr const char* kCxF2Namespace = "http://colorexchangeformat.com/v2";

// Capacity of the "doesn't exist" message, terminator included; longer paths are cut.
inline constexpr std::size_t kColorBookMessageCapacity = 512;

// Loads path into document and checks it is a CxF 2.1 book. On failure returns false and points
// *errorMessage (when not null) at a string-table text valid until the next error or string load.
bool OpenColorBook(const char* path, pugi::xml_document& document, const char** errorMessage);

// Appends one record per color of the book to records (which is not cleared first). True when the
// book opened, also when it holds no color; false with *errorMessage as OpenColorBook sets it.
bool LoadColorBook(const char* path, std::vector<ColorInformation>& records, const char** errorMessage);

// The book's display name: "PaletteName" of its first palette (empty when it has none). name is
// left as it is when the book has no palette or does not open.
bool ReadPaletteName(const char* path, std::string& name, const char** errorMessage);

}  // namespace Pigmo
