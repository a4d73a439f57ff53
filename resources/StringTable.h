#pragma once

#include <cstddef>

#include "Resource.h"

namespace Pigmo {

// Capacity of the shared text buffer, terminator included.
inline constexpr std::size_t kResourceStringCapacity = 256;

// The table's text for id, or null when the table has no such string.
const char* FindResourceText(unsigned int id);

// Loads string id into the one shared buffer and returns it, or null for an unknown id. The text
// stays valid until the next load; longer texts are cut to fit.
const char* LoadResourceString(unsigned int id);

}  // namespace Pigmo
