// "tooltips_class32": tools and their texts. The tip is never drawn into a window's surface; the host
// asks ToolTipTextAt for the text under the pointer and shows it as it likes.
#include <algorithm>
#include <cstring>
#include <string>
#include <vector>

#include "Desktop.h"
#include "WindowTree.h"

namespace Pigmo::Platform::Ui {

namespace {

struct Tool {
    UINT flags;
    HWND window;
    UINT_PTR id;
    RECT rect;
    bool callback;
    std::string text;
    LPARAM lParam;
};

struct ToolTipData : ControlData {
    std::vector<Tool> tools;
};

// Live tooltips, oldest first.
std::vector<HWND>& ToolTips() {
    static std::vector<HWND> tips;
    return tips;
}

BOOL AddTool(ToolTipData& tip, const TOOLINFOA* info) {
    if (info == nullptr || info->cbSize < TTTOOLINFOA_V2_SIZE) return FALSE;
    Tool tool{info->uFlags, info->hwnd,  info->uId, info->rect, info->lpszText == LPSTR_TEXTCALLBACKA,
              {},           info->lParam};
    // A text below 64 K would be a resource id; there are no string resources here.
    if (!tool.callback && reinterpret_cast<std::uintptr_t>(info->lpszText) >= 0x10000)
        tool.text = info->lpszText;
    tip.tools.push_back(std::move(tool));
    return TRUE;
}

bool Covers(const Tool& tool, const Window& target, POINT point) {
    if ((tool.flags & TTF_IDISHWND) != 0) return reinterpret_cast<HWND>(tool.id) == target.handle;
    if (tool.window != target.handle) return false;
    const POINT origin = ClientOriginInRoot(target);
    return Contains(tool.rect, {point.x - origin.x, point.y - origin.y});
}

// By value: the tool's window may add tools while it answers.
std::string TextOf(HWND tip, Tool tool) {
    if (!tool.callback) return tool.text;
    NMTTDISPINFOA request{};
    request.hdr = {tip, tool.id, TTN_GETDISPINFOA};
    request.lpszText = request.szText;
    request.uFlags = tool.flags;
    request.lParam = tool.lParam;
    SendMessageA(tool.window, WM_NOTIFY, tool.id, reinterpret_cast<LPARAM>(&request));
    if (request.lpszText == request.szText)
        return std::string(request.szText, strnlen(request.szText, sizeof request.szText));
    if (request.lpszText == nullptr || request.lpszText == LPSTR_TEXTCALLBACKA) return {};
    return request.lpszText;
}

}  // namespace

LRESULT CALLBACK ToolTipProcedure(HWND handle, UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
        case WM_CREATE:
            WindowFromHandle(handle)->control = std::make_unique<ToolTipData>();
            ToolTips().push_back(handle);
            return 0;
        case WM_DESTROY:
            std::erase(ToolTips(), handle);
            return 0;
        case TTM_ADDTOOLA: {
            auto* tip = ControlOf<ToolTipData>(handle);
            return tip != nullptr ? AddTool(*tip, reinterpret_cast<const TOOLINFOA*>(lParam)) : FALSE;
        }
        default:
            return DefWindowProcA(handle, message, wParam, lParam);
    }
}

}  // namespace Pigmo::Platform::Ui

namespace Pigmo::Platform {

std::string ToolTipTextAt(HWND top, int x, int y) {
    Ui::Window* root = Ui::WindowFromHandle(top);
    if (root == nullptr || root->parent != nullptr) return {};
    // The tool's window is the one the mouse would reach there.
    const Ui::Window* target = Ui::HitTest(*root, {x, y});
    if (target == nullptr) return {};
    const HWND targetHandle = target->handle;
    for (HWND tip : std::vector<HWND>(Ui::ToolTips())) {
        const auto* data = Ui::ControlOf<Ui::ToolTipData>(tip);
        target = Ui::WindowFromHandle(targetHandle);
        if (data == nullptr || target == nullptr) continue;
        for (const Ui::Tool& tool : data->tools)
            if (Ui::WindowFromHandle(tool.window) != nullptr && Ui::Covers(tool, *target, {x, y}))
                return Ui::TextOf(tip, tool);
    }
    return {};
}

}  // namespace Pigmo::Platform
