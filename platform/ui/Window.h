#pragma once

// Windows user-interface subset: window classes and windows, messages, mouse capture, invalidation
// and painting, and the standard controls the rollout uses (static text, list box, read-only edit,
// tooltip). One instance of it serves host and plug-in alike. Names, values and behaviour are
// Windows' own; what the Parts do not call is left out.

#include <cstddef>

#include "Gdi.h"
#include "WinTypes.h"

#define CALLBACK

using HMENU = struct HMENU__*;
using HCURSOR = struct HCURSOR__*;
using HICON = struct HICON__*;
using ATOM = WORD;
using UINT_PTR = std::uintptr_t;
using LONG_PTR = std::intptr_t;
using WNDPROC = LRESULT(CALLBACK*)(HWND, UINT, WPARAM, LPARAM);
using DLGPROC = INT_PTR(CALLBACK*)(HWND, UINT, WPARAM, LPARAM);

struct PAINTSTRUCT {
    HDC hdc;
    BOOL fErase;
    RECT rcPaint;
};

// Class styles.
inline constexpr UINT CS_VREDRAW = 0x0001;
inline constexpr UINT CS_HREDRAW = 0x0002;

// Window styles.
inline constexpr DWORD WS_POPUP = 0x80000000;
inline constexpr DWORD WS_CHILD = 0x40000000;
inline constexpr DWORD WS_VISIBLE = 0x10000000;
inline constexpr DWORD WS_DISABLED = 0x08000000;
inline constexpr DWORD WS_BORDER = 0x00800000;
inline constexpr DWORD WS_VSCROLL = 0x00200000;
inline constexpr DWORD WS_SYSMENU = 0x00080000;
inline constexpr DWORD WS_GROUP = 0x00020000;
inline constexpr DWORD WS_TABSTOP = 0x00010000;
inline constexpr DWORD SS_LEFT = 0x0000;
inline constexpr DWORD ES_AUTOHSCROLL = 0x0080;
inline constexpr DWORD ES_READONLY = 0x0800;
inline constexpr DWORD LBS_NOTIFY = 0x0001;
inline constexpr DWORD LBS_NOINTEGRALHEIGHT = 0x0100;
inline constexpr DWORD TTS_ALWAYSTIP = 0x01;
inline constexpr DWORD TTS_NOPREFIX = 0x02;
inline constexpr DWORD DS_FIXEDSYS = 0x0008;
inline constexpr DWORD DS_SETFONT = 0x0040;

inline constexpr int CW_USEDEFAULT = static_cast<int>(0x80000000);
inline constexpr int GWLP_USERDATA = -21;

// Messages.
inline constexpr UINT WM_CREATE = 0x0001;
inline constexpr UINT WM_DESTROY = 0x0002;
inline constexpr UINT WM_SETTEXT = 0x000C;
inline constexpr UINT WM_GETTEXT = 0x000D;
inline constexpr UINT WM_GETTEXTLENGTH = 0x000E;
inline constexpr UINT WM_PAINT = 0x000F;
inline constexpr UINT WM_NOTIFY = 0x004E;
inline constexpr UINT WM_INITDIALOG = 0x0110;
inline constexpr UINT WM_COMMAND = 0x0111;
inline constexpr UINT WM_MOUSEMOVE = 0x0200;
inline constexpr UINT WM_LBUTTONDOWN = 0x0201;
inline constexpr UINT WM_LBUTTONUP = 0x0202;
inline constexpr UINT WM_CAPTURECHANGED = 0x0215;

// List box messages and notification.
inline constexpr UINT LB_ADDSTRING = 0x0180;
inline constexpr UINT LB_RESETCONTENT = 0x0184;
inline constexpr UINT LB_SETCURSEL = 0x0186;
inline constexpr UINT LB_GETCURSEL = 0x0188;
inline constexpr UINT LB_GETTEXT = 0x0189;
inline constexpr UINT LB_GETTEXTLEN = 0x018A;
inline constexpr UINT LB_GETCOUNT = 0x018B;
inline constexpr UINT LB_GETITEMDATA = 0x0199;
inline constexpr UINT LB_SETITEMDATA = 0x019A;
inline constexpr LRESULT LB_ERR = -1;
inline constexpr WORD LBN_SELCHANGE = 1;

// Tooltips.
inline constexpr const char* TOOLTIPS_CLASSA = "tooltips_class32";
inline constexpr UINT TTM_ADDTOOLA = 0x0404;
inline constexpr UINT TTN_GETDISPINFOA = static_cast<UINT>(-520);
inline constexpr UINT TTF_IDISHWND = 0x0001;
inline constexpr UINT TTF_SUBCLASS = 0x0010;
inline const LPSTR LPSTR_TEXTCALLBACKA = reinterpret_cast<LPSTR>(~std::uintptr_t{0});
// The size of the tool record as 32-bit Windows counts it; any size from this on is accepted.
inline constexpr UINT TTTOOLINFOA_V2_SIZE = 48;

struct NMHDR {
    HWND hwndFrom;
    UINT_PTR idFrom;
    UINT code;
};

struct NMTTDISPINFOA {
    NMHDR hdr;
    LPSTR lpszText;
    char szText[80];
    HINSTANCE hinst;
    UINT uFlags;
    LPARAM lParam;
};

struct TOOLINFOA {
    UINT cbSize;
    UINT uFlags;
    HWND hwnd;
    UINT_PTR uId;
    RECT rect;
    HINSTANCE hinst;
    LPSTR lpszText;
    LPARAM lParam;
};

// SetWindowPos.
inline const HWND HWND_TOPMOST = reinterpret_cast<HWND>(std::intptr_t{-1});
inline constexpr UINT SWP_NOSIZE = 0x0001;
inline constexpr UINT SWP_NOMOVE = 0x0002;
inline constexpr UINT SWP_NOACTIVATE = 0x0010;

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

constexpr WORD LOWORD(std::uintptr_t v) {
    return static_cast<WORD>(v & 0xFFFF);
}
constexpr WORD HIWORD(std::uintptr_t v) {
    return static_cast<WORD>((v >> 16) & 0xFFFF);
}
constexpr WPARAM MAKEWPARAM(WORD low, WORD high) {
    return static_cast<WPARAM>(low) | (static_cast<WPARAM>(high) << 16);
}
constexpr LPARAM MAKELPARAM(WORD low, WORD high) {
    return static_cast<LPARAM>(static_cast<DWORD>(low) | (static_cast<DWORD>(high) << 16));
}
// Signed halves of a mouse message's position word.
constexpr int GET_X_LPARAM(LPARAM v) {
    return static_cast<short>(LOWORD(static_cast<std::uintptr_t>(v)));
}
constexpr int GET_Y_LPARAM(LPARAM v) {
    return static_cast<short>(HIWORD(static_cast<std::uintptr_t>(v)));
}

// System colors, which the standard controls paint with; a host sets them to its own scheme.
inline constexpr int COLOR_WINDOW = 5;
inline constexpr int COLOR_WINDOWTEXT = 8;
inline constexpr int COLOR_HIGHLIGHT = 13;
inline constexpr int COLOR_HIGHLIGHTTEXT = 14;
inline constexpr int COLOR_BTNFACE = 15;
inline constexpr int COLOR_BTNSHADOW = 16;
inline constexpr int COLOR_GRAYTEXT = 17;
inline constexpr int COLOR_BTNTEXT = 18;
inline constexpr int COLOR_BTNHIGHLIGHT = 20;
inline constexpr int COLOR_INFOTEXT = 23;
inline constexpr int COLOR_INFOBK = 24;
WINAPI_EXPORT COLORREF GetSysColor(int index);
WINAPI_EXPORT BOOL SetSysColors(int count, const int* indexes, const COLORREF* colors);

// Classes.
WINAPI_EXPORT ATOM RegisterClassA(const WNDCLASSA* windowClass);
WINAPI_EXPORT BOOL GetClassInfoA(HINSTANCE instance, LPCSTR name, WNDCLASSA* windowClass);
WINAPI_EXPORT HCURSOR LoadCursorA(HINSTANCE instance, LPCSTR name);
WINAPI_EXPORT BOOL DisableThreadLibraryCalls(HINSTANCE module);

// Windows. x, y are relative to the parent's client area (pixels); hMenu is a child's id.
WINAPI_EXPORT HWND CreateWindowExA(DWORD exStyle, LPCSTR className, LPCSTR windowName, DWORD style, int x,
                                   int y, int width, int height, HWND parent, HMENU menu, HINSTANCE instance,
                                   void* param);
WINAPI_EXPORT BOOL DestroyWindow(HWND window);
WINAPI_EXPORT BOOL IsWindow(HWND window);
WINAPI_EXPORT HWND GetParent(HWND window);
WINAPI_EXPORT HWND GetDlgItem(HWND dialog, int id);
WINAPI_EXPORT int GetDlgCtrlID(HWND window);
WINAPI_EXPORT LONG_PTR SetWindowLongPtrA(HWND window, int index, LONG_PTR value);
WINAPI_EXPORT LONG_PTR GetWindowLongPtrA(HWND window, int index);
WINAPI_EXPORT BOOL GetClientRect(HWND window, RECT* rect);
WINAPI_EXPORT BOOL SetWindowPos(HWND window, HWND insertAfter, int x, int y, int width, int height,
                                UINT flags);
WINAPI_EXPORT BOOL EnableWindow(HWND window, BOOL enable);
WINAPI_EXPORT BOOL IsWindowEnabled(HWND window);
WINAPI_EXPORT BOOL SetWindowTextA(HWND window, LPCSTR text);
WINAPI_EXPORT int GetWindowTextA(HWND window, LPSTR text, int capacity);
WINAPI_EXPORT LRESULT SendMessageA(HWND window, UINT message, WPARAM wParam, LPARAM lParam);
WINAPI_EXPORT LRESULT CALLBACK DefWindowProcA(HWND window, UINT message, WPARAM wParam, LPARAM lParam);

// Mouse capture.
WINAPI_EXPORT HWND SetCapture(HWND window);
WINAPI_EXPORT BOOL ReleaseCapture();
WINAPI_EXPORT HWND GetCapture();

// Painting. Invalid areas are painted when the host paints its windows (Pigmo::Platform::PaintWindows).
WINAPI_EXPORT BOOL InvalidateRect(HWND window, const RECT* rect, BOOL erase);
WINAPI_EXPORT BOOL UpdateWindow(HWND window);
WINAPI_EXPORT HDC BeginPaint(HWND window, PAINTSTRUCT* paint);
WINAPI_EXPORT BOOL EndPaint(HWND window, const PAINTSTRUCT* paint);

// Dialogs. A template in dialog units, for a font; its controls are made in order with their ids.
struct DialogItemTemplate {
    const char* className;
    int id;
    const char* text;
    short x, y, cx, cy;
    DWORD style;
};
struct DialogTemplate {
    DWORD style;
    DWORD exStyle;
    short cx, cy;
    const char* fontFace;
    int pointSize;
    const DialogItemTemplate* items;
    std::size_t itemCount;
};
// Creates the dialog and its controls (dialog units converted for the template's font, as Windows
// converts them), then sends WM_INITDIALOG with param to dialogProc. Null when a class is unknown.
WINAPI_EXPORT HWND CreateDialogIndirectParamA(HINSTANCE instance, const DialogTemplate* dialogTemplate,
                                              HWND parent, DLGPROC dialogProc, LPARAM param);
// Dialog units of the dialog's font to pixels.
WINAPI_EXPORT BOOL MapDialogRect(HWND dialog, RECT* rect);
