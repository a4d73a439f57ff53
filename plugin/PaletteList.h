#pragma once

namespace Pigmo::ColorMap {

class Map;

// Gives a new map the first system palette as its book and picks the book's first color; a map
// without a system palette keeps an empty book.
void LoadDefaultPalette(Map& map);

}  // namespace Pigmo::ColorMap
