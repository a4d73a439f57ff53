#pragma once

#include <string>
#include <vector>

#include "FileSearch.h"

namespace Pigmo {

// Starts the search for "*.cxf" in the suite's "Resources\System Palettes\" folder, found through
// its uninstall entry. True when the entry was read and a file found; folder and search are written
// only when the entry was read (the search may then be INVALID_HANDLE_VALUE).
bool FindFirstSystemPalette(std::string& folder, WIN32_FIND_DATAA& found, HANDLE& search);

// Starts the search for "*.cxf" in the user's "\Pigmo\Tintora\User\" application-data folder.
// True when that folder's parent is known; the caller must still test search.
bool FindFirstUserPalette(std::string& folder, WIN32_FIND_DATAA& found, HANDLE& search);

// The text after the last '/' or '\', or the whole path when it has neither.
const char* FileNameOf(const char* path);

// Full paths of every palette file: the system ones, then the user's, each in search order.
// systemCount, when given, receives how many of them are system palettes.
std::vector<std::string> CollectPalettePaths(std::size_t* systemCount = nullptr);

// The first system palette, the book a new map starts with; false when there is none.
bool FindDefaultPalettePath(std::string& path);

// The name a palette list shows: its "PaletteName", empty when the file cannot be read as a book.
std::string PaletteDisplayName(const char* path);

}  // namespace Pigmo
