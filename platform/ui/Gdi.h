#pragma once

// GDI subset, drawn with Cairo: device contexts of windows, solid brushes, pens of any width, fonts
// by face, height and weight, and the drawing calls the Parts use. Shapes are drawn without
// antialiasing, pixel for pixel as GDI draws them; text is antialiased.

#include "WinTypes.h"

#define WINAPI_EXPORT __attribute__((visibility("default")))

using HDC = struct HDC__*;
using HGDIOBJ = struct HGDIOBJ__*;
using HBRUSH = HGDIOBJ;
using HPEN = HGDIOBJ;
using HFONT = HGDIOBJ;

struct RECT {
    LONG left, top, right, bottom;
};
struct POINT {
    LONG x, y;
};

constexpr COLORREF RGB(int r, int g, int b) {
    return static_cast<COLORREF>((r & 0xFF) | ((g & 0xFF) << 8) | ((b & 0xFF) << 16));
}
constexpr BYTE GetRValue(COLORREF c) {
    return static_cast<BYTE>(c & 0xFF);
}
constexpr BYTE GetGValue(COLORREF c) {
    return static_cast<BYTE>((c >> 8) & 0xFF);
}
constexpr BYTE GetBValue(COLORREF c) {
    return static_cast<BYTE>((c >> 16) & 0xFF);
}

// Stock objects.
inline constexpr int WHITE_BRUSH = 0;
inline constexpr int NULL_BRUSH = 5;
inline constexpr int BLACK_PEN = 7;
inline constexpr int NULL_PEN = 8;
inline constexpr int DEFAULT_GUI_FONT = 17;

inline constexpr int PS_SOLID = 0;
inline constexpr int FW_NORMAL = 400;
inline constexpr int FW_BOLD = 700;
inline constexpr int TRANSPARENT = 1;
inline constexpr int OPAQUE = 2;

// DrawTextA formats. As in Windows, DT_VCENTER and DT_BOTTOM act only with DT_SINGLELINE.
inline constexpr UINT DT_LEFT = 0x0000;
inline constexpr UINT DT_CENTER = 0x0001;
inline constexpr UINT DT_RIGHT = 0x0002;
inline constexpr UINT DT_VCENTER = 0x0004;
inline constexpr UINT DT_BOTTOM = 0x0008;
inline constexpr UINT DT_SINGLELINE = 0x0020;
inline constexpr UINT DT_NOCLIP = 0x0100;

WINAPI_EXPORT HGDIOBJ GetStockObject(int object);
WINAPI_EXPORT HBRUSH CreateSolidBrush(COLORREF color);
WINAPI_EXPORT HPEN CreatePen(int style, int width, COLORREF color);
// Height above 0 is the cell height, below 0 the character height, 0 the default (as Windows).
// "Times New Roman" and "MS Shell Dlg" map to the metric-compatible Liberation Serif and Sans.
WINAPI_EXPORT HFONT CreateFontA(int height, int width, int escapement, int orientation, int weight,
                                DWORD italic, DWORD underline, DWORD strikeOut, DWORD charSet,
                                DWORD outPrecision, DWORD clipPrecision, DWORD quality, DWORD pitchAndFamily,
                                LPCSTR face);
WINAPI_EXPORT HGDIOBJ SelectObject(HDC dc, HGDIOBJ object);
WINAPI_EXPORT BOOL DeleteObject(HGDIOBJ object);

WINAPI_EXPORT int FillRect(HDC dc, const RECT* rect, HBRUSH brush);
// Outlined with the selected pen and filled with the selected brush; right and bottom excluded.
WINAPI_EXPORT BOOL Rectangle(HDC dc, int left, int top, int right, int bottom);
WINAPI_EXPORT BOOL MoveToEx(HDC dc, int x, int y, POINT* previous);
// From the current point to (x, y), the end point excluded; (x, y) becomes the current point.
WINAPI_EXPORT BOOL LineTo(HDC dc, int x, int y);
// counts[i] points for polygon i, filled with the brush (alternate rule) and outlined with the pen.
WINAPI_EXPORT BOOL PolyPolygon(HDC dc, const POINT* points, const int* counts, int polygonCount);
WINAPI_EXPORT int DrawTextA(HDC dc, LPCSTR text, int length, RECT* rect, UINT format);
WINAPI_EXPORT COLORREF SetTextColor(HDC dc, COLORREF color);
WINAPI_EXPORT int SetBkMode(HDC dc, int mode);
WINAPI_EXPORT COLORREF SetBkColor(HDC dc, COLORREF color);
