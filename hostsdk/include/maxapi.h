#pragma once

// The host application as a plug-in sees it.

#include "maxtypes.h"

class HostExport Interface {
public:
    virtual ~Interface() = default;
    // The main window, owner of message boxes; null when the host runs without windows.
    virtual HWND GetMAXHWnd() = 0;
};

HostExport Interface* GetCOREInterface();

inline constexpr int APP_IMAGE_DIR = 7;

using ColorId = int;

// The colors of the host's interface, by id; custom controls take every color from here.
class HostExport IColorManager {
public:
    virtual ~IColorManager() = default;
    virtual COLORREF GetColor(ColorId id) = 0;
};

HostExport IColorManager* GetColorManager();

// The folders the host is configured with.
class HostExport IPathConfigMgr {
public:
    virtual ~IPathConfigMgr() = default;
    static IPathConfigMgr* GetPathConfigMgr();
    virtual const MCHAR* GetDir(int which) const = 0;
};
