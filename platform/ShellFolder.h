#pragma once

#include "WinTypes.h"

inline constexpr int CSIDL_APPDATA = 0x001A;
inline constexpr DWORD SHGFP_TYPE_CURRENT = 0;

// CSIDL_APPDATA is the XDG data folder: $XDG_DATA_HOME when it is an absolute path, else
// ~/.local/share. path receives at most MAX_PATH characters including the terminator.
HRESULT SHGetFolderPathA(HWND owner, int folder, HANDLE token, DWORD flags, LPSTR path);
