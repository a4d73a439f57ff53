#pragma once

// Inside the GDI stand-in: a device context draws into the surface of a top-level window, moved to a
// window's origin and clipped to what that window may paint.

#include <cairo.h>

#include <memory>

#include "GdiObjects.h"
#include "WindowTree.h"

namespace Pigmo::Platform::Ui {

struct DeviceContext {
    HWND window = nullptr;
    cairo_t* cairo = nullptr;
    std::shared_ptr<GdiObject> brush;
    std::shared_ptr<GdiObject> pen;
    std::shared_ptr<GdiObject> font;
    COLORREF textColor = RGB(0, 0, 0);
    COLORREF backgroundColor = RGB(255, 255, 255);
    int backgroundMode = OPAQUE;
    POINT position{};

    DeviceContext() = default;
    DeviceContext(const DeviceContext&) = delete;
    DeviceContext& operator=(const DeviceContext&) = delete;
    ~DeviceContext() { cairo_destroy(cairo); }
};

// origin and clip are in root pixels; the context starts with the window's font.
HDC OpenDeviceContext(Window& window, POINT origin, const cairo_region_t* clip);
void CloseDeviceContext(HDC context);
void CloseDeviceContextsOf(HWND window);
DeviceContext* ContextFromHandle(HDC context);

inline void SetSourceColor(cairo_t* cairo, COLORREF color) {
    cairo_set_source_rgb(cairo, GetRValue(color) / 255.0, GetGValue(color) / 255.0, GetBValue(color) / 255.0);
}

}  // namespace Pigmo::Platform::Ui
