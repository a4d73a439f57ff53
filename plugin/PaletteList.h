#pragma once

#include "Window.h"

namespace Pigmo::ColorMap {

class Map;

// Gives a new map the first system palette as its book and picks the book's first color; a map
// without a system palette keeps an empty book.
void LoadDefaultPalette(Map& map);

// Adds the palette at path to the dialog's palette list: its display name (empty when the file is
// not a readable book), with path as the entry's data; path must outlive the entry.
void AddPaletteToList(const char* path, HWND dialog);

// Rebuilds the map's palette paths and the dialog's list from the system and user folders, system
// palettes first, and selects entry 0 without loading it.
void PopulatePaletteList(Map& map, HWND dialog);

}  // namespace Pigmo::ColorMap
