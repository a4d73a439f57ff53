#include <utility>

#include "Desktop.h"
#include "DeviceContext.h"
#include "WindowTree.h"

namespace Pigmo::Platform::Ui {

namespace {

std::function<void(HWND)>& InvalidationHandler() {
    static std::function<void(HWND)> handler;
    return handler;
}

cairo_rectangle_int_t ToCairo(const RECT& rect) {
    return {rect.left, rect.top, rect.right - rect.left, rect.bottom - rect.top};
}

// Without WS_CLIPCHILDREN a parent paints over its children, so they are invalidated with it.
void InvalidateTree(Window& window, const RECT& area, bool erase) {
    const RECT inClient = Intersect(area, ClientRect(window));
    if (IsEmpty(inClient)) return;
    const cairo_rectangle_int_t part = ToCairo(inClient);
    cairo_region_union_rectangle(window.invalid, &part);
    window.erase = window.erase || erase;
    for (Window* child : window.children) {
        const RECT covered = Intersect(inClient, child->rect);
        if ((child->style & WS_VISIBLE) == 0 || IsEmpty(covered)) continue;
        child->frameDirty = true;
        const Frame childFrame = FrameOf(*child);
        const LONG dx = child->rect.left + childFrame.left;
        const LONG dy = child->rect.top + childFrame.top;
        InvalidateTree(*child, {covered.left - dx, covered.top - dy, covered.right - dx, covered.bottom - dy},
                       erase);
    }
}

// Sends WM_PAINT to the windows of the tree that have something to paint, parents first.
void PaintTree(HWND handle) {
    Window* window = WindowFromHandle(handle);
    if (window->frameDirty) {
        window->frameDirty = false;
        PaintFrame(*window);
    }
    if (!cairo_region_is_empty(window->invalid)) SendMessageA(handle, WM_PAINT, 0, 0);
    window = WindowFromHandle(handle);
    if (window == nullptr) return;
    for (HWND child : ChildHandles(*window)) {
        const Window* found = WindowFromHandle(child);
        if (found != nullptr && found->parent == window && (found->style & WS_VISIBLE) != 0) PaintTree(child);
    }
}

}  // namespace

void Invalidate(Window& window, const RECT* area, bool erase, bool frame) {
    window.frameDirty = window.frameDirty || frame;
    InvalidateTree(window, area != nullptr ? *area : ClientRect(window), erase);
    if (const auto handler = InvalidationHandler()) handler(RootOf(window).handle);
}

}  // namespace Pigmo::Platform::Ui

using namespace Pigmo::Platform::Ui;

BOOL InvalidateRect(HWND handle, const RECT* rect, BOOL erase) {
    Window* window = WindowFromHandle(handle);
    if (window == nullptr) return FALSE;
    Invalidate(*window, rect, erase != FALSE, false);
    return TRUE;
}

BOOL UpdateWindow(HWND handle) {
    Window* window = WindowFromHandle(handle);
    if (window == nullptr) return FALSE;
    if (IsShown(*window)) PaintTree(handle);
    return TRUE;
}

HDC BeginPaint(HWND handle, PAINTSTRUCT* paint) {
    Window* window = WindowFromHandle(handle);
    if (window == nullptr || paint == nullptr) return nullptr;
    // The context may paint what is invalid of the client area its ancestors leave visible.
    cairo_region_t* clip = std::exchange(window->invalid, cairo_region_create());
    const bool erase = std::exchange(window->erase, false);
    cairo_rectangle_int_t extents;
    cairo_region_get_extents(clip, &extents);
    paint->rcPaint = {extents.x, extents.y, extents.x + extents.width, extents.y + extents.height};
    const POINT origin = ClientOriginInRoot(*window);
    cairo_region_translate(clip, origin.x, origin.y);
    const RECT visible = VisibleClientInRoot(*window);
    const cairo_rectangle_int_t visiblePart{visible.left, visible.top, visible.right - visible.left,
                                            visible.bottom - visible.top};
    cairo_region_intersect_rectangle(clip, &visiblePart);
    paint->hdc = OpenDeviceContext(*window, origin, clip);
    cairo_region_destroy(clip);
    paint->fErase = erase && window->background == nullptr ? TRUE : FALSE;
    if (erase && window->background != nullptr) {
        const RECT client = ClientRect(*window);
        FillRect(paint->hdc, &client, window->background);
    }
    return paint->hdc;
}

BOOL EndPaint(HWND, const PAINTSTRUCT* paint) {
    if (paint == nullptr || ContextFromHandle(paint->hdc) == nullptr) return FALSE;
    CloseDeviceContext(paint->hdc);
    return TRUE;
}

namespace Pigmo::Platform {

void PaintWindows(HWND top) {
    const Ui::Window* window = Ui::WindowFromHandle(top);
    if (window != nullptr && window->parent == nullptr) Ui::PaintTree(top);
}

cairo_surface_t* WindowSurface(HWND top) {
    const Ui::Window* window = Ui::WindowFromHandle(top);
    return window != nullptr ? window->surface : nullptr;
}

void SetInvalidationHandler(std::function<void(HWND top)> handler) {
    Ui::InvalidationHandler() = std::move(handler);
}

}  // namespace Pigmo::Platform
