#pragma once

#include "Window.h"

namespace Pigmo::ColorMap {

// Window procedure of "SpectralChart": the current color's reflectance curve over a labelled grid,
// in the book's band order from left to right. The owner, a Pigmo::IColorInformation, is the
// window's user data; without one only the grid shows.
LRESULT CALLBACK SpectralChartProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam);

}  // namespace Pigmo::ColorMap
