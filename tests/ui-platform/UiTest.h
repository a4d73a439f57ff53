#pragma once

// Shared by the window stand-in's tests: windows that record what they are sent, and top-level
// windows read back pixel by pixel.

#include <cairo.h>
#include <gtest/gtest.h>

#include <functional>
#include <map>
#include <string>
#include <vector>

#include "Desktop.h"
#include "Window.h"

namespace UiTest {

struct Message {
    HWND window;
    UINT message;
    WPARAM wParam;
    LPARAM lParam;
};

inline std::vector<Message> received;
// Run for each recorded message as it arrives.
inline std::function<void(const Message&)> onMessage;

// The "Recorder" class: records every message, then leaves it to DefWindowProcA.
inline LRESULT CALLBACK RecordingProcedure(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    received.push_back({window, message, wParam, lParam});
    if (onMessage) onMessage(received.back());
    return DefWindowProcA(window, message, wParam, lParam);
}

inline std::vector<Message> Sent(UINT message) {
    std::vector<Message> found;
    for (const Message& m : received)
        if (m.message == message) found.push_back(m);
    return found;
}

inline std::vector<HWND> WindowsSent(UINT message) {
    std::vector<HWND> windows;
    for (const Message& m : Sent(message)) windows.push_back(m.window);
    return windows;
}

inline const char* Register(const char* name, WNDPROC procedure, HBRUSH background = nullptr) {
    WNDCLASSA windowClass{};
    windowClass.lpfnWndProc = procedure;
    windowClass.hbrBackground = background;
    windowClass.lpszClassName = name;
    RegisterClassA(&windowClass);  // a second registration is refused, harmlessly
    return name;
}

inline HWND Child(HWND parent, int id, int x, int y, int width, int height, DWORD style = WS_VISIBLE,
                  const char* className = "Recorder") {
    Register("Recorder", RecordingProcedure);
    return CreateWindowExA(0, className, "", WS_CHILD | style, x, y, width, height, parent,
                           reinterpret_cast<HMENU>(static_cast<std::intptr_t>(id)), nullptr, nullptr);
}

inline HWND TopLevel(int width, int height, const char* className = "Recorder") {
    Register("Recorder", RecordingProcedure);
    return CreateWindowExA(0, className, "", WS_POPUP | WS_VISIBLE, 0, 0, width, height, nullptr, nullptr,
                           nullptr, nullptr);
}

inline HFONT Font(const char* face, int height, int weight = 0) {
    return CreateFontA(height, 0, 0, 0, weight, 0, 0, 0, 0, 0, 0, 0, 0, face);
}

inline COLORREF Pixel(HWND top, int x, int y) {
    cairo_surface_t* surface = Pigmo::Platform::WindowSurface(top);
    cairo_surface_flush(surface);
    const unsigned char* row =
        cairo_image_surface_get_data(surface) + y * cairo_image_surface_get_stride(surface);
    const std::uint32_t argb = reinterpret_cast<const std::uint32_t*>(row)[x];
    return RGB((argb >> 16) & 0xFF, (argb >> 8) & 0xFF, argb & 0xFF);
}

// The surface as rows of letters, one per color of the legend; '?' for any other.
inline std::vector<std::string> Picture(HWND top, const std::map<COLORREF, char>& legend) {
    cairo_surface_t* surface = Pigmo::Platform::WindowSurface(top);
    std::vector<std::string> rows(cairo_image_surface_get_height(surface));
    for (int y = 0; y < static_cast<int>(rows.size()); ++y)
        for (int x = 0; x < cairo_image_surface_get_width(surface); ++x) {
            const auto found = legend.find(Pixel(top, x, y));
            rows[y] += found != legend.end() ? found->second : '?';
        }
    return rows;
}

// The smallest rectangle holding every pixel that is not white; all zero when there is none.
inline RECT InkBounds(HWND top) {
    const std::vector<std::string> rows = Picture(top, {{RGB(255, 255, 255), '.'}});
    RECT ink{1 << 20, 1 << 20, -1, -1};
    for (LONG y = 0; y < static_cast<LONG>(rows.size()); ++y)
        for (LONG x = 0; x < static_cast<LONG>(rows[y].size()); ++x)
            if (rows[y][x] != '.')
                ink = {std::min(ink.left, x), std::min(ink.top, y), std::max(ink.right, x + 1),
                       std::max(ink.bottom, y + 1)};
    return ink.right < 0 ? RECT{} : ink;
}

// A top-level window drawn on straight from the test: invalidated, so BeginPaint gives a context
// for the whole of it, cleared to white.
class Canvas {
public:
    Canvas(int width, int height) : window_(TopLevel(width, height)), area_{0, 0, width, height} {}
    ~Canvas() { DestroyWindow(window_); }

    template <typename Draw>
    void Paint(Draw draw) {
        InvalidateRect(window_, nullptr, FALSE);
        PAINTSTRUCT paint;
        const HDC dc = BeginPaint(window_, &paint);
        FillRect(dc, &area_, static_cast<HBRUSH>(GetStockObject(WHITE_BRUSH)));
        draw(dc);
        EndPaint(window_, &paint);
    }

    HWND Window() const { return window_; }

private:
    HWND window_;
    RECT area_;
};

}  // namespace UiTest
