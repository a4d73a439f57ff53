// "ListBox": a single-selection list of text items with item data, in the dialog font. The vertical
// bar appears while the items do not fit.
#include <algorithm>
#include <cstring>
#include <string>
#include <vector>

#include "GdiObjects.h"
#include "WindowTree.h"

namespace Pigmo::Platform::Ui {

namespace {

struct ListItem {
    std::string text;
    LPARAM data = 0;
};

struct ListBoxData : ControlData {
    std::vector<ListItem> items;
    int selected = -1;
    int top = 0;
};

int ItemHeight(const Window& window) {
    return std::max(FontOf(window.font).CellHeight(), 1);
}

int RowsShown(const Window& window) {
    return std::max<int>(ClientRect(window).bottom / ItemHeight(window), 1);
}

int Count(const ListBoxData& list) {
    return static_cast<int>(list.items.size());
}

// Keeps the first row in range and the scroll bar in step with it.
void Scroll(Window& window, ListBoxData& list, int top) {
    const int rows = RowsShown(window);
    list.top = std::clamp(top, 0, std::max(Count(list) - rows, 0));
    SetVerticalScroll(window, Count(list) - 1, rows, list.top);
    InvalidateRect(window.handle, nullptr, TRUE);
}

void ScrollIntoView(Window& window, ListBoxData& list, int index) {
    if (index < list.top)
        Scroll(window, list, index);
    else if (index >= list.top + RowsShown(window))
        Scroll(window, list, index - RowsShown(window) + 1);
    else
        InvalidateRect(window.handle, nullptr, TRUE);
}

void Paint(HWND handle, const Window& window, const ListBoxData& list) {
    PAINTSTRUCT paint;
    const HDC dc = BeginPaint(handle, &paint);
    if (dc == nullptr) return;
    const RECT client = ClientRect(window);
    FillRect(dc, &client, SysColorBrush(COLOR_WINDOW));
    SetBkMode(dc, TRANSPARENT);
    const int height = ItemHeight(window);
    constexpr LONG kTextIndent = 1;
    for (int i = list.top, y = 0; i < Count(list) && y < client.bottom; ++i, y += height) {
        const RECT row{0, y, client.right, y + height};
        const bool selected = i == list.selected;
        if (selected) FillRect(dc, &row, SysColorBrush(COLOR_HIGHLIGHT));
        SetTextColor(dc, GetSysColor(selected ? COLOR_HIGHLIGHTTEXT : COLOR_WINDOWTEXT));
        RECT text{row.left + kTextIndent, row.top, row.right, row.bottom};
        DrawTextA(dc, list.items[i].text.c_str(), -1, &text, DT_LEFT | DT_SINGLELINE);
    }
    EndPaint(handle, &paint);
}

}  // namespace

LRESULT CALLBACK ListBoxProcedure(HWND handle, UINT message, WPARAM wParam, LPARAM lParam) {
    Window* window = WindowFromHandle(handle);
    if (message == WM_CREATE) {
        window->control = std::make_unique<ListBoxData>();
        Scroll(*window, static_cast<ListBoxData&>(*window->control), 0);
        return 0;
    }
    auto* list = window != nullptr ? dynamic_cast<ListBoxData*>(window->control.get()) : nullptr;
    if (list == nullptr) return DefWindowProcA(handle, message, wParam, lParam);
    const int index = static_cast<int>(wParam);
    const bool valid = index >= 0 && index < Count(*list);
    switch (message) {
        case LB_ADDSTRING:
            if (lParam == 0) return LB_ERR;
            list->items.push_back({reinterpret_cast<LPCSTR>(lParam), 0});
            Scroll(*window, *list, list->top);
            return Count(*list) - 1;
        case LB_RESETCONTENT:
            list->items.clear();
            list->selected = -1;
            Scroll(*window, *list, 0);
            return 0;
        case LB_SETCURSEL:
            // -1 clears the selection and still answers LB_ERR, as Windows does.
            if (!valid && index != -1) return LB_ERR;
            list->selected = index;
            if (valid)
                ScrollIntoView(*window, *list, index);
            else
                InvalidateRect(handle, nullptr, TRUE);
            return valid ? index : LB_ERR;
        case LB_GETCURSEL:
            return list->selected >= 0 ? list->selected : LB_ERR;
        case LB_GETTEXT:
            if (!valid || lParam == 0) return LB_ERR;
            std::memcpy(reinterpret_cast<char*>(lParam), list->items[index].text.c_str(),
                        list->items[index].text.size() + 1);
            return static_cast<LRESULT>(list->items[index].text.size());
        case LB_GETTEXTLEN:
            return valid ? static_cast<LRESULT>(list->items[index].text.size()) : LB_ERR;
        case LB_GETCOUNT:
            return Count(*list);
        case LB_GETITEMDATA:
            return valid ? list->items[index].data : LB_ERR;
        case LB_SETITEMDATA:
            if (!valid) return LB_ERR;
            list->items[index].data = lParam;
            return TRUE;
        case WM_VSCROLL: {
            const int rows = RowsShown(*window);
            const int steps[] = {-1, 1, -rows, rows};  // SB_LINEUP, SB_LINEDOWN, SB_PAGEUP, SB_PAGEDOWN
            if (LOWORD(wParam) <= SB_PAGEDOWN) Scroll(*window, *list, list->top + steps[LOWORD(wParam)]);
            return 0;
        }
        case WM_LBUTTONDOWN: {
            const int y = GET_Y_LPARAM(lParam);
            const int item = list->top + y / ItemHeight(*window);
            if (y < 0 || item >= Count(*list)) return 0;
            list->selected = item;
            InvalidateRect(handle, nullptr, TRUE);
            // A click notifies even on the item already selected, as Windows does.
            if ((window->style & LBS_NOTIFY) != 0 && window->parent != nullptr)
                SendMessageA(window->parent->handle, WM_COMMAND,
                             MAKEWPARAM(static_cast<WORD>(window->id), LBN_SELCHANGE),
                             reinterpret_cast<LPARAM>(handle));
            return 0;
        }
        case WM_PAINT:
            Paint(handle, *window, *list);
            return 0;
        default:
            return DefWindowProcA(handle, message, wParam, lParam);
    }
}

}  // namespace Pigmo::Platform::Ui
