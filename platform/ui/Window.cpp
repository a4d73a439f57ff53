#include "Window.h"

#include <strings.h>

#include <algorithm>
#include <cstring>
#include <map>
#include <mutex>
#include <string>
#include <utility>

#include "DeviceContext.h"
#include "HandleTable.h"
#include "WindowTree.h"

namespace Pigmo::Platform::Ui {

namespace {

// Class names are case-insensitive, as in Windows ("static" finds "Static").
struct CaseInsensitiveLess {
    bool operator()(const std::string& a, const std::string& b) const {
        return strcasecmp(a.c_str(), b.c_str()) < 0;
    }
};

struct ClassTable {
    std::mutex lock;
    std::map<std::string, WNDCLASSA, CaseInsensitiveLess> classes;
    ATOM lastAtom = 0xC000;

    ClassTable() {
        // The system's own classes; the standard controls paint their backgrounds themselves.
        const struct {
            const char* name;
            WNDPROC procedure;
            HBRUSH background;
        } builtIn[] = {
            {"Static", StaticProcedure, nullptr},
            {"ListBox", ListBoxProcedure, nullptr},
            {"Edit", EditProcedure, nullptr},
            {TOOLTIPS_CLASSA, ToolTipProcedure, nullptr},
            {"#32770", DialogProcedure, SysColorBrush(COLOR_BTNFACE)},
        };
        for (const auto& system : builtIn) {
            WNDCLASSA windowClass{};
            windowClass.lpfnWndProc = system.procedure;
            windowClass.hbrBackground = system.background;
            classes.emplace(system.name, windowClass);
        }
    }
};

ClassTable& Classes() {
    static ClassTable table;
    return table;
}

HandleTable<Window>& Windows() {
    static HandleTable<Window> table;
    return table;
}

// Windows keeps window coordinates within 16 bits; so does the stand-in, so no sum of them overflows.
constexpr int kCoordinateLimit = 32767;

int Coordinate(int value) {
    return std::clamp(value, -kCoordinateLimit, kCoordinateLimit);
}

int Extent(int value) {
    return std::clamp(value, 0, kCoordinateLimit);
}

void MarkDestroying(Window& window) {
    window.destroying = true;
    for (Window* child : window.children) MarkDestroying(*child);
}

// WM_DESTROY reaches a window before its children, which still exist while it handles it.
void SendDestroy(HWND handle) {
    SendMessageA(handle, WM_DESTROY, 0, 0);
    if (const Window* window = WindowFromHandle(handle))
        for (HWND child : ChildHandles(*window)) SendDestroy(child);
}

// Children are freed before their parent.
void Free(Window& window) {
    const std::vector<Window*> children = window.children;
    for (Window* child : children) Free(*child);
    CloseDeviceContextsOf(window.handle);
    if (window.ownsFont) DeleteObject(window.font);
    if (window.parent != nullptr) std::erase(window.parent->children, &window);
    Windows().Remove(window.handle);
}

}  // namespace

Window::~Window() {
    cairo_region_destroy(invalid);
    if (surface != nullptr) cairo_surface_destroy(surface);
}

Window* WindowFromHandle(HWND handle) {
    return Windows().Find(handle);
}

Window& RootOf(Window& window) {
    Window* root = &window;
    while (root->parent != nullptr) root = root->parent;
    return *root;
}

bool IsShown(const Window& window) {
    for (const Window* w = &window; w->parent != nullptr; w = w->parent)
        if ((w->style & WS_VISIBLE) == 0) return false;
    return true;
}

std::vector<HWND> ChildHandles(const Window& window) {
    std::vector<HWND> handles;
    for (const Window* child : window.children) handles.push_back(child->handle);
    return handles;
}

void RepaintAllWindows() {
    for (const std::shared_ptr<Window>& window : Windows().Snapshot())
        if (window->parent == nullptr) Invalidate(*window, nullptr, true, true);
}

Frame FrameOf(const Window& window) {
    const int edge = (window.exStyle & WS_EX_CLIENTEDGE) != 0 ? 2 : (window.style & WS_BORDER) != 0 ? 1 : 0;
    return {edge, edge, edge + (HasVerticalBar(window) ? kScrollBarWidth : 0), edge};
}

bool HasVerticalBar(const Window& window) {
    return (window.style & WS_VSCROLL) != 0 && window.scroll.max + 1 > window.scroll.page;
}

RECT ClientRect(const Window& window) {
    const Frame frame = FrameOf(window);
    return {0, 0, std::max<LONG>(window.rect.right - window.rect.left - frame.left - frame.right, 0),
            std::max<LONG>(window.rect.bottom - window.rect.top - frame.top - frame.bottom, 0)};
}

RECT WindowRectInRoot(const Window& window) {
    const LONG width = window.rect.right - window.rect.left;
    const LONG height = window.rect.bottom - window.rect.top;
    if (window.parent == nullptr) return {0, 0, width, height};
    const POINT origin = ClientOriginInRoot(*window.parent);
    return {origin.x + window.rect.left, origin.y + window.rect.top, origin.x + window.rect.left + width,
            origin.y + window.rect.top + height};
}

POINT ClientOriginInRoot(const Window& window) {
    const RECT area = WindowRectInRoot(window);
    const Frame frame = FrameOf(window);
    return {area.left + frame.left, area.top + frame.top};
}

RECT ClientRectInRoot(const Window& window) {
    const POINT origin = ClientOriginInRoot(window);
    const RECT client = ClientRect(window);
    return {origin.x, origin.y, origin.x + client.right, origin.y + client.bottom};
}

RECT VisibleClientInRoot(const Window& window) {
    if (window.parent != nullptr && (window.style & WS_VISIBLE) == 0) return {0, 0, 0, 0};
    const RECT client = ClientRectInRoot(window);
    return window.parent != nullptr ? Intersect(client, VisibleClientInRoot(*window.parent)) : client;
}

RECT Intersect(const RECT& a, const RECT& b) {
    const RECT both{std::max(a.left, b.left), std::max(a.top, b.top), std::min(a.right, b.right),
                    std::min(a.bottom, b.bottom)};
    return IsEmpty(both) ? RECT{0, 0, 0, 0} : both;
}

bool IsEmpty(const RECT& rect) {
    return rect.right <= rect.left || rect.bottom <= rect.top;
}

bool Contains(const RECT& rect, POINT point) {
    return point.x >= rect.left && point.x < rect.right && point.y >= rect.top && point.y < rect.bottom;
}

// Rounds halves away from zero; -1 for a zero denominator, as Windows' MulDiv.
int MulDiv(int number, int numerator, int denominator) {
    if (denominator == 0) return -1;
    const long long product = static_cast<long long>(number) * numerator;
    const long long magnitude = (std::llabs(product) + std::llabs(denominator) / 2) / std::llabs(denominator);
    return static_cast<int>((product < 0) != (denominator < 0) ? -magnitude : magnitude);
}

}  // namespace Pigmo::Platform::Ui

using namespace Pigmo::Platform::Ui;

ATOM RegisterClassA(const WNDCLASSA* windowClass) {
    if (windowClass == nullptr || windowClass->lpszClassName == nullptr ||
        windowClass->lpfnWndProc == nullptr)
        return 0;
    ClassTable& table = Classes();
    std::lock_guard guard(table.lock);
    if (!table.classes.emplace(windowClass->lpszClassName, *windowClass).second) return 0;
    return ++table.lastAtom;
}

BOOL GetClassInfoA(HINSTANCE, LPCSTR name, WNDCLASSA* windowClass) {
    if (name == nullptr || windowClass == nullptr) return FALSE;
    ClassTable& table = Classes();
    std::lock_guard guard(table.lock);
    const auto found = table.classes.find(name);
    if (found == table.classes.end()) return FALSE;
    *windowClass = found->second;
    windowClass->lpszClassName = found->first.c_str();
    return TRUE;
}

HCURSOR LoadCursorA(HINSTANCE, LPCSTR name) {
    // System cursors only; the value is enough to tell them apart.
    return reinterpret_cast<HCURSOR>(const_cast<char*>(name));
}

BOOL DisableThreadLibraryCalls(HINSTANCE module) {
    return module != nullptr ? TRUE : FALSE;
}

HWND CreateWindowExA(DWORD exStyle, LPCSTR className, LPCSTR windowName, DWORD style, int x, int y, int width,
                     int height, HWND parentHandle, HMENU menu, HINSTANCE, void*) {
    WNDCLASSA windowClass{};
    if (GetClassInfoA(nullptr, className, &windowClass) == FALSE) return nullptr;
    Window* parent = nullptr;
    if (parentHandle != nullptr) {
        parent = WindowFromHandle(parentHandle);
        if (parent == nullptr || parent->destroying) return nullptr;
    }
    if (x == CW_USEDEFAULT) x = y = 0;
    if (width == CW_USEDEFAULT) width = height = 0;
    x = Coordinate(x), y = Coordinate(y), width = Extent(width), height = Extent(height);

    auto window = std::make_shared<Window>();
    window->className = windowClass.lpszClassName;
    window->procedure = windowClass.lpfnWndProc;
    window->background = windowClass.hbrBackground;
    window->style = style;
    window->exStyle = exStyle;
    window->parent = parent;
    window->rect = {x, y, x + width, y + height};
    window->id = parent != nullptr ? static_cast<int>(reinterpret_cast<std::intptr_t>(menu)) : 0;
    window->text = windowName != nullptr ? windowName : "";
    window->font = parent != nullptr ? parent->font : nullptr;
    if (parent == nullptr) window->surface = cairo_image_surface_create(CAIRO_FORMAT_ARGB32, width, height);
    Window* created = window.get();
    const HWND handle = Windows().Add<HWND>(std::move(window));
    created->handle = handle;
    if (parent != nullptr) parent->children.push_back(created);

    const LRESULT result = SendMessageA(handle, WM_CREATE, 0, 0);
    if (WindowFromHandle(handle) == nullptr) return nullptr;
    if (result == -1) {
        DestroyWindow(handle);
        return nullptr;
    }
    Invalidate(*created, nullptr, true, true);
    return handle;
}

BOOL DestroyWindow(HWND handle) {
    Window* window = WindowFromHandle(handle);
    if (window == nullptr || window->destroying) return FALSE;
    ReleaseCaptureWithin(*window);
    window = WindowFromHandle(handle);
    if (window == nullptr || window->destroying) return TRUE;
    MarkDestroying(*window);
    SendDestroy(handle);
    window = WindowFromHandle(handle);
    Window* parent = window->parent;
    const RECT area = window->rect;
    Free(*window);
    // What the window covered shows its parent again.
    if (parent != nullptr && !parent->destroying) Invalidate(*parent, &area, true, false);
    return TRUE;
}

BOOL IsWindow(HWND handle) {
    return WindowFromHandle(handle) != nullptr ? TRUE : FALSE;
}

HWND GetParent(HWND handle) {
    const Window* window = WindowFromHandle(handle);
    return window != nullptr && window->parent != nullptr ? window->parent->handle : nullptr;
}

HWND GetDlgItem(HWND dialog, int id) {
    const Window* window = WindowFromHandle(dialog);
    if (window == nullptr) return nullptr;
    for (const Window* child : window->children)
        if (child->id == id) return child->handle;
    return nullptr;
}

int GetDlgCtrlID(HWND handle) {
    const Window* window = WindowFromHandle(handle);
    return window != nullptr ? window->id : 0;
}

LONG_PTR SetWindowLongPtrA(HWND handle, int index, LONG_PTR value) {
    Window* window = WindowFromHandle(handle);
    if (window == nullptr || index != GWLP_USERDATA) return 0;
    return std::exchange(window->userData, value);
}

LONG_PTR GetWindowLongPtrA(HWND handle, int index) {
    const Window* window = WindowFromHandle(handle);
    return window != nullptr && index == GWLP_USERDATA ? window->userData : 0;
}

BOOL GetClientRect(HWND handle, RECT* rect) {
    const Window* window = WindowFromHandle(handle);
    if (window == nullptr || rect == nullptr) return FALSE;
    *rect = ClientRect(*window);
    return TRUE;
}

// The order among siblings stays as created; HWND_TOPMOST and the like are taken and have no effect.
BOOL SetWindowPos(HWND handle, HWND, int x, int y, int width, int height, UINT flags) {
    Window* window = WindowFromHandle(handle);
    if (window == nullptr) return FALSE;
    const RECT before = window->rect;
    RECT& area = window->rect;
    if ((flags & SWP_NOMOVE) == 0) {
        area = {Coordinate(x), Coordinate(y), 0, 0};
        area.right = area.left + before.right - before.left;
        area.bottom = area.top + before.bottom - before.top;
    }
    if ((flags & SWP_NOSIZE) == 0) {
        area.right = area.left + Extent(width);
        area.bottom = area.top + Extent(height);
    }
    if (std::memcmp(&area, &before, sizeof area) == 0) return TRUE;
    const bool resized = area.right - area.left != before.right - before.left ||
                         area.bottom - area.top != before.bottom - before.top;
    if (window->parent == nullptr && resized) {
        cairo_surface_destroy(window->surface);
        window->surface =
            cairo_image_surface_create(CAIRO_FORMAT_ARGB32, area.right - area.left, area.bottom - area.top);
    }
    if (window->parent != nullptr) Invalidate(*window->parent, &before, true, false);
    Invalidate(*window, nullptr, true, true);
    return TRUE;
}

BOOL EnableWindow(HWND handle, BOOL enable) {
    Window* window = WindowFromHandle(handle);
    if (window == nullptr) return FALSE;
    const bool wasDisabled = (window->style & WS_DISABLED) != 0;
    if (wasDisabled == (enable == FALSE)) return wasDisabled ? TRUE : FALSE;
    window->style ^= WS_DISABLED;
    Invalidate(*window, nullptr, true, false);
    if (enable == FALSE) ReleaseCaptureWithin(*window);
    return wasDisabled ? TRUE : FALSE;
}

BOOL IsWindowEnabled(HWND handle) {
    const Window* window = WindowFromHandle(handle);
    return window != nullptr && (window->style & WS_DISABLED) == 0 ? TRUE : FALSE;
}

BOOL SetWindowTextA(HWND handle, LPCSTR text) {
    if (WindowFromHandle(handle) == nullptr) return FALSE;
    return SendMessageA(handle, WM_SETTEXT, 0, reinterpret_cast<LPARAM>(text)) != 0 ? TRUE : FALSE;
}

int GetWindowTextA(HWND handle, LPSTR text, int capacity) {
    if (text == nullptr || capacity <= 0) return 0;
    text[0] = '\0';
    if (WindowFromHandle(handle) == nullptr) return 0;
    return static_cast<int>(
        SendMessageA(handle, WM_GETTEXT, static_cast<WPARAM>(capacity), reinterpret_cast<LPARAM>(text)));
}

LRESULT SendMessageA(HWND handle, UINT message, WPARAM wParam, LPARAM lParam) {
    const Window* window = WindowFromHandle(handle);
    if (window == nullptr) return 0;
    return window->procedure(handle, message, wParam, lParam);
}

LRESULT CALLBACK DefWindowProcA(HWND handle, UINT message, WPARAM wParam, LPARAM lParam) {
    Window* window = WindowFromHandle(handle);
    if (window == nullptr) return 0;
    switch (message) {
        case WM_SETTEXT:
            window->text = lParam != 0 ? reinterpret_cast<LPCSTR>(lParam) : "";
            return TRUE;
        case WM_GETTEXT: {
            if (lParam == 0 || wParam == 0) return 0;
            const std::size_t count = std::min<std::size_t>(window->text.size(), wParam - 1);
            std::memcpy(reinterpret_cast<char*>(lParam), window->text.data(), count);
            reinterpret_cast<char*>(lParam)[count] = '\0';
            return static_cast<LRESULT>(count);
        }
        case WM_GETTEXTLENGTH:
            return static_cast<LRESULT>(window->text.size());
        case WM_PAINT: {
            // Validates; BeginPaint erases with the class background where that was asked for.
            PAINTSTRUCT paint;
            if (BeginPaint(handle, &paint) != nullptr) EndPaint(handle, &paint);
            return 0;
        }
        default:
            return 0;
    }
}
