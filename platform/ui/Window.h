#pragma once

// Windows user-interface subset: window classes. One instance of it serves host and plug-in alike.

#include "WinTypes.h"

#define WINAPI_EXPORT __attribute__((visibility("default")))
#define CALLBACK

using HGDIOBJ = struct HGDIOBJ__*;
using HBRUSH = HGDIOBJ;
using HCURSOR = struct HCURSOR__*;
using HICON = struct HICON__*;
using HMENU = struct HMENU__*;
using ATOM = WORD;
using WNDPROC = LRESULT(CALLBACK*)(HWND, UINT, WPARAM, LPARAM);

inline constexpr UINT CS_VREDRAW = 0x0001;
inline constexpr UINT CS_HREDRAW = 0x0002;
inline constexpr int WHITE_BRUSH = 0;
inline const LPCSTR IDC_ARROW = reinterpret_cast<LPCSTR>(std::uintptr_t{32512});

struct WNDCLASSA {
    UINT style;
    WNDPROC lpfnWndProc;
    int cbClsExtra;
    int cbWndExtra;
    HINSTANCE hInstance;
    HICON hIcon;
    HCURSOR hCursor;
    HBRUSH hbrBackground;
    LPCSTR lpszMenuName;
    LPCSTR lpszClassName;
};

// Registers a class by name; 0 when the name is taken or the record is incomplete.
WINAPI_EXPORT ATOM RegisterClassA(const WNDCLASSA* windowClass);
// The class registered under name; FALSE when there is none.
WINAPI_EXPORT BOOL GetClassInfoA(HINSTANCE instance, LPCSTR name, WNDCLASSA* windowClass);
WINAPI_EXPORT LRESULT CALLBACK DefWindowProcA(HWND window, UINT message, WPARAM wParam, LPARAM lParam);
WINAPI_EXPORT HCURSOR LoadCursorA(HINSTANCE instance, LPCSTR name);
WINAPI_EXPORT HGDIOBJ GetStockObject(int object);
// Threads start and end without telling the library; nothing to switch off here.
WINAPI_EXPORT BOOL DisableThreadLibraryCalls(HINSTANCE module);
