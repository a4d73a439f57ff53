#pragma once

#include "Window.h"

namespace Pigmo::ColorMap {

// Window procedure of "ColorPallette": seven swatch rows of the owner's book from its scroll
// position, and a strip of every color with markers at the scroll position and the pick. Pressing or
// dragging in the strip scrolls, over the swatches picks. The owner, a Pigmo::IColorPalletteUser, is
// the window's user data.
LRESULT CALLBACK ColorPalletteProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam);

}  // namespace Pigmo::ColorMap
