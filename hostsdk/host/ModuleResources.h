#pragma once

// The resources a module carries (dialog templates, string-table texts), which Windows finds in the
// module's file by instance handle. Here a module makes them known while it is loaded.

#include "Window.h"
#include "maxtypes.h"

namespace Pigmo::Host {

struct ModuleResources {
    const DialogTemplate* (*dialog)(int id);  // null for an id the module lacks
    const char* (*text)(unsigned int id);     // null for an id the module lacks
};

// Called by a module as it loads, and with Unregister... as it unloads; a second registration of
// the same module replaces the first.
HostExport void RegisterModuleResources(HINSTANCE module, ModuleResources resources);
HostExport void UnregisterModuleResources(HINSTANCE module);

// Null when the module is not registered or lacks the resource.
HostExport const DialogTemplate* FindDialogTemplate(HINSTANCE module, int id);
HostExport const char* FindModuleText(HINSTANCE module, int id);

}  // namespace Pigmo::Host
