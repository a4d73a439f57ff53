// The host's way in: the process-attach work and the five entry points it looks up by name.
#include <dlfcn.h>

#include "Descriptor.h"
#include "Export.h"
#include "InformationControl.h"
#include "PaletteControl.h"
#include "SpectralChart.h"
#include "StringTable.h"
#include "Window.h"

namespace Pigmo::ColorMap {

namespace {

HINSTANCE moduleInstance = nullptr;

constexpr ULONG DLL_PROCESS_ATTACH = 1;

// The rollout's own controls.
struct ControlClass {
    const char* name;
    WNDPROC procedure;
};
const ControlClass kControlClasses[] = {
    {"ColorPallette", ColorPalletteProc},
    {"ColorInformation", ColorInformationProc},
    {"SpectralChart", SpectralChartProc},
};

BOOL DllMain(HINSTANCE instance, ULONG reason, void*) {
    if (reason != DLL_PROCESS_ATTACH) return TRUE;
    moduleInstance = instance;
    DisableThreadLibraryCalls(instance);
    WNDCLASSA windowClass{};
    windowClass.style = CS_HREDRAW | CS_VREDRAW;
    windowClass.hInstance = instance;
    windowClass.hCursor = LoadCursorA(nullptr, IDC_ARROW);
    windowClass.hbrBackground = static_cast<HBRUSH>(GetStockObject(WHITE_BRUSH));
    for (const ControlClass& control : kControlClasses) {
        windowClass.lpfnWndProc = control.procedure;
        windowClass.lpszClassName = control.name;
        if (RegisterClassA(&windowClass) == 0) break;
    }
    return TRUE;
}

// The loader has no DllMain; the library's base address is its instance handle.
__attribute__((constructor)) void AttachProcess() {
    Dl_info info{};
    if (dladdr(reinterpret_cast<void*>(&AttachProcess), &info) != 0)
        DllMain(static_cast<HINSTANCE>(info.dli_fbase), DLL_PROCESS_ATTACH, nullptr);
}

}  // namespace

HINSTANCE ModuleInstance() {
    return moduleInstance;
}

const MCHAR* GetString(int id) {
    return moduleInstance != nullptr ? LoadResourceString(static_cast<unsigned int>(id)) : nullptr;
}

}  // namespace Pigmo::ColorMap

extern "C" {

PIGMO_API const MCHAR* LibDescription() {
    return "Pigmo Color Map";
}

PIGMO_API int LibNumberClasses() {
    return 1;
}

PIGMO_API ClassDesc* LibClassDesc(int i) {
    // Built on the first call, whatever i is; destroyed when the library unloads.
    static Pigmo::ColorMap::Descriptor descriptor;
    return i == 0 ? &descriptor : nullptr;
}

// Host release 13000, interface 35, SDK revision 0.
PIGMO_API ULONG LibVersion() {
    return 0x32C82300;
}

PIGMO_API ULONG CanAutoDefer() {
    return 1;
}

}  // extern "C"
