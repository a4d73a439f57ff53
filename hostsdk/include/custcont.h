#pragma once

// The host's custom controls the rollout uses: the push button and the color swatch. Their window
// classes ("CustButton", "ColorSwatch") are the host's; a plug-in reaches one through its interface.

#include "Window.h"
#include "maxtypes.h"

// The notification code of a click, in the high word of the WM_COMMAND a button sends its parent.
inline constexpr WORD BN_CLICKED = 0;

class HostExport ICustButton {
public:
    virtual ~ICustButton() = default;
    virtual void SetText(const MCHAR* text) = 0;
    virtual void GetText(MCHAR* text, int capacity) = 0;
    // Shows text as the button's tooltip, or none when switched off.
    virtual void SetTooltip(BOOL on, const MCHAR* text) = 0;
};

class HostExport IColorSwatch {
public:
    virtual ~IColorSwatch() = default;
    virtual COLORREF SetColor(COLORREF color, int notify = FALSE) = 0;
    virtual COLORREF GetColor() = 0;
};

// Null when the window is not a custom button.
HostExport ICustButton* GetICustButton(HWND control);
HostExport void ReleaseICustButton(ICustButton* button);
// Sets the swatch's color and title; null when the window is not a color swatch.
HostExport IColorSwatch* GetIColorSwatch(HWND control, COLORREF color, const MCHAR* title);
HostExport void ReleaseIColorSwatch(IColorSwatch* swatch);
