#pragma once

// What a host does with the window stand-in that Windows itself would do: paint the windows, show
// their pixels, route the mouse, ask for tooltips. Tests also watch the text drawn.

#include <cairo.h>

#include <functional>
#include <string>

#include "Window.h"

namespace Pigmo::Platform {

// Sends WM_PAINT to every window of top's tree with an invalid area, parents before children.
WINAPI_EXPORT void PaintWindows(HWND top);

// The pixels of a top-level window: an ARGB32 image surface of its size, valid while it lives.
WINAPI_EXPORT cairo_surface_t* WindowSurface(HWND top);

// Mouse input in top's pixels (WM_LBUTTONDOWN, WM_MOUSEMOVE, WM_LBUTTONUP): to the window that has
// the capture, else to the deepest visible, enabled window under the point, in its own coordinates.
WINAPI_EXPORT void ForwardMouse(HWND top, UINT message, int x, int y);

// Called when a window of top's tree is invalidated, so an on-screen host can schedule a paint.
WINAPI_EXPORT void SetInvalidationHandler(std::function<void(HWND top)> handler);

// The text a tooltip shows for the point, asked of the tool's window with TTN_GETDISPINFOA; empty
// when no tool covers the point.
WINAPI_EXPORT std::string ToolTipTextAt(HWND top, int x, int y);

// One DrawTextA call as the device context drew it.
struct DrawnText {
    HWND window;
    std::string text;
    RECT rect;  // in the window's client coordinates, as given
    UINT format;
    std::string face;  // the face asked for
    int height;
    int weight;
    COLORREF color;
};
// Called for every DrawTextA; empty to stop.
WINAPI_EXPORT void SetTextHook(std::function<void(const DrawnText&)> hook);

}  // namespace Pigmo::Platform
