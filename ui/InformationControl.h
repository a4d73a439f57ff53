#pragma once

#include "Window.h"

namespace Pigmo::ColorMap {

// Window procedure of "ColorInformation": the current color's name, category, L*a*b*, sRGB and HTML
// code as text, or placeholders without a color. The owner, a Pigmo::IColorInformation, is the
// window's user data.
LRESULT CALLBACK ColorInformationProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam);

}  // namespace Pigmo::ColorMap
