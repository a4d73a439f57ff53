#pragma once

#include <cstddef>
#include <string>

namespace Pigmo {

// Capacity for one start tag the head keeps; a longer tag makes the head unreadable.
inline constexpr std::size_t kBookHeadTagLimit = std::size_t{1} << 20;

// Bytes ReadBookHead asks the file for at a time.
inline constexpr std::size_t kBookHeadChunkSize = std::size_t{64} << 10;

// Reads a book from fd (an open regular file, from its current offset to its end) chunkSize bytes at a
// time and sets head to a small document, in the file's own encoding and byte order (BOM kept), holding
// what the start of the book says of itself: the XML declaration when the file starts with one, the
// root element's start tag, and the start tag of the root's first child element named exactly
// "CxF:Palette" when one comes before the root closes, each closed again. Parsed as OpenColorBook parses a
// book, head gives the same root name, root attributes and first palette's attributes as the whole file
// does, for every file that parses whole. Memory stays at one chunk plus the kept tags.
//
// Reading stops at the end of the palette's start tag, or of the root when it has no palette, so nothing
// after that is checked: a book damaged further on still gets its name here, and loading it reports the
// damage. What comes before is only tokenised, as far as it takes to find where each construct ends; end
// tags are matched by depth, not by name.
//
// Returns false, with head unspecified, when the start of the file cannot be tokenised that far: an
// unclosed comment, PI, CDATA section or DOCTYPE, a broken tag, an end tag before any root, no root
// element, a NUL where the document has to go on, a kept tag longer than kBookHeadTagLimit, or a read
// error. The whole-file parse fails on each of these but the long tag.
bool ReadBookHead(int fd, std::string& head, std::size_t chunkSize = kBookHeadChunkSize);

}  // namespace Pigmo
