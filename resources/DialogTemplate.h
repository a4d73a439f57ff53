#pragma once

#include "Window.h"

namespace Pigmo {

// The dialog template resource with that id, or null when the library has none.
const DialogTemplate* FindResourceDialog(int id);

}  // namespace Pigmo
