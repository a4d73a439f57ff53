#include "CoreInterface.h"

namespace {

class CoreInterface final : public Interface {
public:
    HWND GetMAXHWnd() override { return window; }
    HWND window = nullptr;
};

CoreInterface& Core() {
    static CoreInterface core;
    return core;
}

}  // namespace

Interface* GetCOREInterface() {
    return &Core();
}

namespace Pigmo::Host {

void SetMainWindow(HWND window) {
    Core().window = window;
}

}  // namespace Pigmo::Host
