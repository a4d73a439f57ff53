#include "CustButton.h"

#include <memory>
#include <string>

#include "ControlStates.h"
#include "custcont.h"

namespace Pigmo::Host {

namespace {

// -MulDiv(8, 96, 72): 8 points at 96 pixels an inch.
constexpr int kDialogFontHeight = -11;

struct Button {
    std::unique_ptr<ControlToolTip> toolTip;
    bool toolTipOn = false;
    std::string toolTipText;
    bool pressed = false;  // the left button went down here and is held
    bool inside = false;   // ... and the pointer is over the button
};

using ButtonStates = ControlStates<Button>;

bool Inside(HWND window, LPARAM position) {
    RECT client{};
    GetClientRect(window, &client);
    const int x = GET_X_LPARAM(position), y = GET_Y_LPARAM(position);
    return x >= client.left && x < client.right && y >= client.top && y < client.bottom;
}

void Paint(HWND window, const Button& button) {
    PAINTSTRUCT paint;
    HDC dc = BeginPaint(window, &paint);
    RECT client{};
    GetClientRect(window, &client);
    HBRUSH face =
        CreateSolidBrush(GetSysColor(button.pressed && button.inside ? COLOR_HIGHLIGHT : COLOR_BTNFACE));
    HPEN frame = CreatePen(PS_SOLID, 1, GetSysColor(COLOR_BTNSHADOW));
    HFONT font = CreateFontA(kDialogFontHeight, 0, 0, 0, FW_NORMAL, 0, 0, 0, 0, 0, 0, 0, 0, "MS Shell Dlg");
    HGDIOBJ oldBrush = SelectObject(dc, face);
    HGDIOBJ oldPen = SelectObject(dc, frame);
    HGDIOBJ oldFont = SelectObject(dc, font);
    Rectangle(dc, client.left, client.top, client.right, client.bottom);
    char text[MAX_PATH] = "";
    GetWindowTextA(window, text, sizeof text);
    SetBkMode(dc, TRANSPARENT);
    SetTextColor(dc, GetSysColor(COLOR_BTNTEXT));
    RECT label{client.left + 2, client.top + 1, client.right - 2, client.bottom - 1};
    DrawTextA(dc, text, -1, &label, DT_CENTER | DT_VCENTER | DT_SINGLELINE);
    SelectObject(dc, oldFont);
    SelectObject(dc, oldPen);
    SelectObject(dc, oldBrush);
    DeleteObject(font);
    DeleteObject(frame);
    DeleteObject(face);
    EndPaint(window, &paint);
}

LRESULT CALLBACK ButtonProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    if (ButtonStates::Track(window, message)) return 0;
    Button* button = ButtonStates::Find(window);
    if (button == nullptr) return DefWindowProcA(window, message, wParam, lParam);
    switch (message) {
        case WM_PAINT:
            Paint(window, *button);
            return 0;
        case WM_NOTIFY: {
            // The answer points at the text, so it must outlive this call.
            static const std::string none;
            if (ControlToolTip::Answer(lParam, button->toolTipOn ? button->toolTipText : none)) return 0;
            break;
        }
        case WM_LBUTTONDOWN:
            SetCapture(window);
            button->pressed = button->inside = true;
            InvalidateRect(window, nullptr, FALSE);
            return 0;
        case WM_MOUSEMOVE:
            if (button->pressed && button->inside != Inside(window, lParam)) {
                button->inside = !button->inside;
                InvalidateRect(window, nullptr, FALSE);
            }
            return 0;
        case WM_LBUTTONUP: {
            if (!button->pressed) return 0;
            const bool clicked = Inside(window, lParam);
            button->pressed = false;
            InvalidateRect(window, nullptr, FALSE);
            ReleaseCapture();
            // Last: the parent may open a dialog, or close the rollout, before this returns.
            if (clicked)
                SendMessageA(GetParent(window), WM_COMMAND,
                             MAKEWPARAM(static_cast<WORD>(GetDlgCtrlID(window)), BN_CLICKED),
                             reinterpret_cast<LPARAM>(window));
            return 0;
        }
        case WM_CAPTURECHANGED:
            if (button->pressed) {
                button->pressed = false;
                InvalidateRect(window, nullptr, FALSE);
            }
            return 0;
    }
    return DefWindowProcA(window, message, wParam, lParam);
}

class ButtonInterface final : public ICustButton {
public:
    explicit ButtonInterface(HWND window) : window_(window) {}

    void SetText(const MCHAR* text) override {
        SetWindowTextA(window_, text != nullptr ? text : "");
        InvalidateRect(window_, nullptr, FALSE);
    }
    void GetText(MCHAR* text, int capacity) override { GetWindowTextA(window_, text, capacity); }
    void SetTooltip(BOOL on, const MCHAR* text) override {
        if (Button* button = ButtonStates::Find(window_)) {
            button->toolTipOn = on != FALSE;
            button->toolTipText = text != nullptr ? text : "";
        }
    }

private:
    HWND window_;
};

}  // namespace

void RegisterCustButtonClass() {
    ButtonStates::RegisterClass("CustButton", ButtonProc);
}

}  // namespace Pigmo::Host

ICustButton* GetICustButton(HWND control) {
    return Pigmo::Host::ButtonStates::Find(control) != nullptr ? new Pigmo::Host::ButtonInterface(control)
                                                               : nullptr;
}

void ReleaseICustButton(ICustButton* button) {
    delete button;
}
