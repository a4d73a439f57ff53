// "Edit": one line of text in a sunken edge; a read-only edit shows the dialog's face color.
#include "WindowTree.h"

namespace Pigmo::Platform::Ui {

LRESULT CALLBACK EditProcedure(HWND handle, UINT message, WPARAM wParam, LPARAM lParam) {
    if (message == WM_CREATE) {
        // As the dialog manager gives edits in a three-dimensional dialog.
        WindowFromHandle(handle)->exStyle |= WS_EX_CLIENTEDGE;
        return 0;
    }
    return TextControlProcedure(
        handle, message, wParam, lParam, [](HDC dc, const Window& window, RECT client) {
            const bool grey = (window.style & (ES_READONLY | WS_DISABLED)) != 0;
            FillRect(dc, &client, SysColorBrush(grey ? COLOR_BTNFACE : COLOR_WINDOW));
            SetBkMode(dc, TRANSPARENT);
            SetTextColor(dc,
                         GetSysColor((window.style & WS_DISABLED) != 0 ? COLOR_GRAYTEXT : COLOR_WINDOWTEXT));
            constexpr LONG kMargin = 1;
            RECT text{client.left + kMargin, client.top, client.right - kMargin, client.bottom};
            DrawTextA(dc, window.text.c_str(), -1, &text, DT_LEFT | DT_SINGLELINE | DT_VCENTER);
        });
}

}  // namespace Pigmo::Platform::Ui
