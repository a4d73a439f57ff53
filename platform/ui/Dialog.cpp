// "#32770" and dialogs from templates in dialog units.
#include "GdiObjects.h"
#include "WindowTree.h"

namespace Pigmo::Platform::Ui {

namespace {

struct DialogData : ControlData {
    DLGPROC procedure;
    int baseX;
    int baseY;

    DialogData(DLGPROC dialogProcedure, int x, int y) : procedure(dialogProcedure), baseX(x), baseY(y) {}
};

// Windows' dialog base units: the font's cell height, and the average width of the Latin letters.
POINT BaseUnits(const Font& font) {
    const int width = font.TextWidth("ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz");
    return {(width / 26 + 1) / 2, font.CellHeight()};
}

}  // namespace

LRESULT CALLBACK DialogProcedure(HWND handle, UINT message, WPARAM wParam, LPARAM lParam) {
    if (const auto* dialog = ControlOf<DialogData>(handle); dialog != nullptr && dialog->procedure != nullptr)
        if (const INT_PTR result = dialog->procedure(handle, message, wParam, lParam); result != 0)
            return result;
    return DefWindowProcA(handle, message, wParam, lParam);
}

}  // namespace Pigmo::Platform::Ui

using namespace Pigmo::Platform::Ui;

HWND CreateDialogIndirectParamA(HINSTANCE instance, const DialogTemplate* dialogTemplate, HWND parent,
                                DLGPROC dialogProc, LPARAM param) {
    if (dialogTemplate == nullptr || (dialogTemplate->items == nullptr && dialogTemplate->itemCount != 0))
        return nullptr;
    // Without DS_SETFONT the dialog takes the default GUI font.
    const bool ownFont = (dialogTemplate->style & DS_SETFONT) != 0 && dialogTemplate->fontFace != nullptr;
    const HFONT font = ownFont ? CreateFontA(-MulDiv(dialogTemplate->pointSize, 96, 72), 0, 0, 0, FW_NORMAL,
                                             0, 0, 0, 0, 0, 0, 0, 0, dialogTemplate->fontFace)
                               : GetStockObject(DEFAULT_GUI_FONT);
    const POINT base = BaseUnits(FontOf(font));
    const HWND dialog =
        CreateWindowExA(dialogTemplate->exStyle, "#32770", "", dialogTemplate->style, 0, 0,
                        MulDiv(dialogTemplate->cx, base.x, 4), MulDiv(dialogTemplate->cy, base.y, 8), parent,
                        nullptr, instance, nullptr);
    Window* window = WindowFromHandle(dialog);
    if (window == nullptr) {
        if (ownFont) DeleteObject(font);
        return nullptr;
    }
    window->font = font;
    window->ownsFont = ownFont;
    window->control = std::make_unique<DialogData>(dialogProc, base.x, base.y);

    HWND focus = nullptr;
    for (std::size_t i = 0; i < dialogTemplate->itemCount; ++i) {
        const DialogItemTemplate& item = dialogTemplate->items[i];
        const HWND control =
            CreateWindowExA(0, item.className, item.text != nullptr ? item.text : "", item.style | WS_CHILD,
                            MulDiv(item.x, base.x, 4), MulDiv(item.y, base.y, 8), MulDiv(item.cx, base.x, 4),
                            MulDiv(item.cy, base.y, 8), dialog,
                            reinterpret_cast<HMENU>(static_cast<std::intptr_t>(item.id)), instance, nullptr);
        if (control == nullptr) {
            DestroyWindow(dialog);
            return nullptr;
        }
        if (focus == nullptr && (item.style & WS_TABSTOP) != 0) focus = control;
    }
    SendMessageA(dialog, WM_INITDIALOG, reinterpret_cast<WPARAM>(focus), param);
    return IsWindow(dialog) != FALSE ? dialog : nullptr;
}

BOOL MapDialogRect(HWND dialog, RECT* rect) {
    const auto* data = ControlOf<DialogData>(dialog);
    if (data == nullptr || rect == nullptr) return FALSE;
    *rect = {MulDiv(rect->left, data->baseX, 4), MulDiv(rect->top, data->baseY, 8),
             MulDiv(rect->right, data->baseX, 4), MulDiv(rect->bottom, data->baseY, 8)};
    return TRUE;
}
