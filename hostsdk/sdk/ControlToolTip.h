#pragma once

#include <string>

#include "Window.h"

namespace Pigmo::Host {

// The tooltip of one host control: a tooltip window whose one tool is the control, which gives the
// text when asked (WM_NOTIFY with TTN_GETDISPINFOA).
class ControlToolTip {
public:
    explicit ControlToolTip(HWND control);
    ~ControlToolTip();
    ControlToolTip(const ControlToolTip&) = delete;
    ControlToolTip& operator=(const ControlToolTip&) = delete;

    // Points the tooltip's request at text, which must outlive the request; false when lParam is
    // another notification.
    static bool Answer(LPARAM lParam, const std::string& text);

private:
    HWND window_;
};

}  // namespace Pigmo::Host
