#pragma once

// Inside the window stand-in: the object behind a window handle and what windows, painting, mouse and
// the standard controls share about it. Windows belong to the one thread that runs the interface, as
// in Windows; only class registration is guarded.

#include <cairo.h>

#include <memory>
#include <string>
#include <vector>

#include "Window.h"

namespace Pigmo::Platform::Ui {

// What the stand-in's parts send each other beyond the subset's own messages and styles.
inline constexpr UINT WM_VSCROLL = 0x0115;
inline constexpr WORD SB_LINEUP = 0;
inline constexpr WORD SB_LINEDOWN = 1;
inline constexpr WORD SB_PAGEUP = 2;
inline constexpr WORD SB_PAGEDOWN = 3;
inline constexpr WPARAM MK_LBUTTON = 0x0001;
inline constexpr DWORD WS_EX_CLIENTEDGE = 0x00000200;
inline constexpr int COLOR_SCROLLBAR = 0;
inline constexpr int COLOR_WINDOWFRAME = 6;
inline constexpr int COLOR_3DDKSHADOW = 21;
inline constexpr int COLOR_3DLIGHT = 22;
inline constexpr int kScrollBarWidth = 17;  // SM_CXVSCROLL at 96 dpi

// State a standard control keeps beside its window.
struct ControlData {
    virtual ~ControlData() = default;
};

// The vertical bar of a WS_VSCROLL window; shown while the range is larger than a page.
struct ScrollRange {
    int max = 100;
    int page = 0;
    int pos = 0;
};

struct Window {
    HWND handle = nullptr;
    std::string className;
    WNDPROC procedure = nullptr;
    HBRUSH background = nullptr;
    DWORD style = 0;
    DWORD exStyle = 0;
    Window* parent = nullptr;
    std::vector<Window*> children;  // z-order: the first created lies on top
    RECT rect{};  // in the parent's client coordinates; on the screen for a top-level window
    int id = 0;
    LONG_PTR userData = 0;
    std::string text;
    HFONT font = nullptr;  // the text font of the controls in it: the dialog's
    bool ownsFont = false;
    ScrollRange scroll;
    cairo_region_t* invalid = cairo_region_create();  // client coordinates
    bool erase = false;
    bool frameDirty = false;
    cairo_surface_t* surface = nullptr;  // top-level windows only
    std::unique_ptr<ControlData> control;
    bool destroying = false;

    Window() = default;
    Window(const Window&) = delete;
    Window& operator=(const Window&) = delete;
    ~Window();
};

// Null for a stale or foreign handle.
Window* WindowFromHandle(HWND handle);
template <typename Data>
Data* ControlOf(HWND handle) {
    Window* window = WindowFromHandle(handle);
    return window != nullptr ? dynamic_cast<Data*>(window->control.get()) : nullptr;
}
Window& RootOf(Window& window);
// Visible up to its top-level window, which counts as shown: the host shows it by painting it.
bool IsShown(const Window& window);
std::vector<HWND> ChildHandles(const Window& window);

// Geometry. "In root" is in the pixels of the top-level window's surface.
struct Frame {
    int left, top, right, bottom;
};
Frame FrameOf(const Window& window);
bool HasVerticalBar(const Window& window);
RECT ClientRect(const Window& window);
RECT WindowRectInRoot(const Window& window);
POINT ClientOriginInRoot(const Window& window);
RECT ClientRectInRoot(const Window& window);
// The part of the client area its ancestors leave visible.
RECT VisibleClientInRoot(const Window& window);
RECT Intersect(const RECT& a, const RECT& b);
bool IsEmpty(const RECT& rect);
bool Contains(const RECT& rect, POINT point);
int MulDiv(int number, int numerator, int denominator);

// The procedure shared by controls that show their text: a new text repaints, and `paint` draws
// the client area between BeginPaint and EndPaint.
using TextPainter = void (*)(HDC dc, const Window& window, RECT client);
LRESULT TextControlProcedure(HWND handle, UINT message, WPARAM wParam, LPARAM lParam, TextPainter paint);

// Painting.
// Adds to the invalid area (the whole client when area is null) and to the children under it, marks
// frames for repainting when asked, and tells the host.
void Invalidate(Window& window, const RECT* area, bool erase, bool frame);
void RepaintAllWindows();
void PaintFrame(Window& window);
// Sets the vertical bar; repaints the window when anything changed.
void SetVerticalScroll(Window& window, int max, int page, int pos);
// A press on the vertical bar at a point in window coordinates: WM_VSCROLL to the window.
void ClickScrollBar(Window& window, POINT point);

// The deepest visible, enabled window of root's tree under a point in root's pixels.
Window* HitTest(Window& root, POINT point);
void ReleaseCaptureWithin(const Window& window);

// The standard controls' window procedures.
LRESULT CALLBACK StaticProcedure(HWND window, UINT message, WPARAM wParam, LPARAM lParam);
LRESULT CALLBACK ListBoxProcedure(HWND window, UINT message, WPARAM wParam, LPARAM lParam);
LRESULT CALLBACK EditProcedure(HWND window, UINT message, WPARAM wParam, LPARAM lParam);
LRESULT CALLBACK ToolTipProcedure(HWND window, UINT message, WPARAM wParam, LPARAM lParam);
LRESULT CALLBACK DialogProcedure(HWND window, UINT message, WPARAM wParam, LPARAM lParam);

// A system color as a class or FillRect brush, the Windows way.
inline HBRUSH SysColorBrush(int index) {
    return reinterpret_cast<HBRUSH>(static_cast<std::uintptr_t>(index + 1));
}

}  // namespace Pigmo::Platform::Ui
