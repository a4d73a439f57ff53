#include "ColorSwatch.h"

#include <memory>
#include <string>

#include "ControlStates.h"
#include "custcont.h"

namespace Pigmo::Host {

namespace {

struct Swatch {
    std::unique_ptr<ControlToolTip> toolTip;
    COLORREF color = RGB(0, 0, 0);
    std::string title;
};

using SwatchStates = ControlStates<Swatch>;

void Paint(HWND window, const Swatch& swatch) {
    PAINTSTRUCT paint;
    HDC dc = BeginPaint(window, &paint);
    RECT client{};
    GetClientRect(window, &client);
    HBRUSH fill = CreateSolidBrush(swatch.color);
    HPEN frame = CreatePen(PS_SOLID, 1, GetSysColor(COLOR_BTNSHADOW));
    HGDIOBJ oldBrush = SelectObject(dc, fill);
    HGDIOBJ oldPen = SelectObject(dc, frame);
    Rectangle(dc, client.left, client.top, client.right, client.bottom);
    SelectObject(dc, oldPen);
    SelectObject(dc, oldBrush);
    DeleteObject(frame);
    DeleteObject(fill);
    EndPaint(window, &paint);
}

LRESULT CALLBACK SwatchProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    if (SwatchStates::Track(window, message)) return 0;
    Swatch* swatch = SwatchStates::Find(window);
    if (swatch == nullptr) return DefWindowProcA(window, message, wParam, lParam);
    if (message == WM_PAINT) {
        Paint(window, *swatch);
        return 0;
    }
    if (message == WM_NOTIFY && ControlToolTip::Answer(lParam, swatch->title)) return 0;
    return DefWindowProcA(window, message, wParam, lParam);
}

class SwatchInterface final : public IColorSwatch {
public:
    explicit SwatchInterface(HWND window) : window_(window) {}

    // No one here listens for a change, so there is nothing to notify.
    COLORREF SetColor(COLORREF color, int) override {
        Swatch* swatch = SwatchStates::Find(window_);
        if (swatch == nullptr) return 0;
        const COLORREF previous = swatch->color;
        swatch->color = color;
        InvalidateRect(window_, nullptr, FALSE);
        return previous;
    }
    COLORREF GetColor() override {
        const Swatch* swatch = SwatchStates::Find(window_);
        return swatch != nullptr ? swatch->color : 0;
    }

private:
    HWND window_;
};

}  // namespace

void RegisterColorSwatchClass() {
    SwatchStates::RegisterClass("ColorSwatch", SwatchProc);
}

}  // namespace Pigmo::Host

IColorSwatch* GetIColorSwatch(HWND control, COLORREF color, const MCHAR* title) {
    Pigmo::Host::Swatch* swatch = Pigmo::Host::SwatchStates::Find(control);
    if (swatch == nullptr) return nullptr;
    swatch->title = title != nullptr ? title : "";
    auto* colorSwatch = new Pigmo::Host::SwatchInterface(control);
    colorSwatch->SetColor(color, FALSE);
    return colorSwatch;
}

void ReleaseIColorSwatch(IColorSwatch* swatch) {
    delete swatch;
}
