#pragma once

#include "maxapi.h"

namespace Pigmo::Host {

// Makes window the host's main window, the owner of the message boxes plug-ins show; null (the
// start) when the host runs without windows.
HostExport void SetMainWindow(HWND window);

}  // namespace Pigmo::Host
