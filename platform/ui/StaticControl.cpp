// "Static": one line of text per line break in the dialog font, on the dialog's face color.
#include "WindowTree.h"

namespace Pigmo::Platform::Ui {

LRESULT TextControlProcedure(HWND handle, UINT message, WPARAM wParam, LPARAM lParam, TextPainter paint) {
    switch (message) {
        case WM_SETTEXT: {
            const LRESULT result = DefWindowProcA(handle, message, wParam, lParam);
            InvalidateRect(handle, nullptr, TRUE);
            return result;
        }
        case WM_PAINT: {
            PAINTSTRUCT paintStruct;
            const HDC dc = BeginPaint(handle, &paintStruct);
            const Window* window = WindowFromHandle(handle);
            if (dc == nullptr || window == nullptr) return 0;
            paint(dc, *window, ClientRect(*window));
            EndPaint(handle, &paintStruct);
            return 0;
        }
        default:
            return DefWindowProcA(handle, message, wParam, lParam);
    }
}

LRESULT CALLBACK StaticProcedure(HWND handle, UINT message, WPARAM wParam, LPARAM lParam) {
    return TextControlProcedure(handle, message, wParam, lParam,
                                [](HDC dc, const Window& window, RECT client) {
                                    FillRect(dc, &client, SysColorBrush(COLOR_BTNFACE));
                                    SetBkMode(dc, TRANSPARENT);
                                    SetTextColor(dc, GetSysColor(COLOR_WINDOWTEXT));
                                    DrawTextA(dc, window.text.c_str(), -1, &client, DT_LEFT);
                                });
}

}  // namespace Pigmo::Platform::Ui
