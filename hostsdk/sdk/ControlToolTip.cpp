#include "ControlToolTip.h"

namespace Pigmo::Host {

ControlToolTip::ControlToolTip(HWND control)
    : window_(CreateWindowExA(0, TOOLTIPS_CLASSA, nullptr, WS_POPUP | TTS_ALWAYSTIP | TTS_NOPREFIX,
                              CW_USEDEFAULT, CW_USEDEFAULT, CW_USEDEFAULT, CW_USEDEFAULT, nullptr, nullptr,
                              nullptr, nullptr)) {
    if (window_ == nullptr) return;
    TOOLINFOA tool{};
    tool.cbSize = sizeof tool;
    tool.uFlags = TTF_IDISHWND | TTF_SUBCLASS;
    tool.hwnd = control;
    tool.uId = reinterpret_cast<UINT_PTR>(control);
    tool.lpszText = LPSTR_TEXTCALLBACKA;
    SendMessageA(window_, TTM_ADDTOOLA, 0, reinterpret_cast<LPARAM>(&tool));
}

ControlToolTip::~ControlToolTip() {
    if (window_ != nullptr) DestroyWindow(window_);
}

bool ControlToolTip::Answer(LPARAM lParam, const std::string& text) {
    auto* info = reinterpret_cast<NMTTDISPINFOA*>(lParam);
    if (info == nullptr || info->hdr.code != TTN_GETDISPINFOA) return false;
    info->lpszText = const_cast<char*>(text.c_str());
    return true;
}

}  // namespace Pigmo::Host
