#pragma once

// Message boxes. Nothing here waits for a click: each box is recorded, handed to the host's handler
// when one is installed, and answered with OK.

#include <functional>
#include <string>
#include <vector>

#include "Window.h"

inline constexpr UINT MB_OK = 0x00000000;
inline constexpr int IDOK = 1;

WINAPI_EXPORT int MessageBoxA(HWND owner, LPCSTR text, LPCSTR caption, UINT type);

namespace Pigmo::Platform {

struct ShownMessageBox {
    HWND owner;
    std::string caption;
    std::string text;
    UINT type;
};

// The boxes shown since the last call, oldest first; the record is emptied.
WINAPI_EXPORT std::vector<ShownMessageBox> TakeMessageBoxes();

// Called with each box as it is shown (a tool prints it, a window shows it); empty to stop.
WINAPI_EXPORT void SetMessageBoxHandler(std::function<void(const ShownMessageBox&)> handler);

}  // namespace Pigmo::Platform
