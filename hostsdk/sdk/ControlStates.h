#pragma once

#include <map>
#include <memory>

#include "ControlToolTip.h"

namespace Pigmo::Host {

// The state of each window of a custom control class, with its tooltip, from WM_CREATE to
// WM_DESTROY; windows live on the main thread only.
template <class State>
class ControlStates {
public:
    static State* Find(HWND window) {
        const auto found = States().find(window);
        return found != States().end() ? &found->second : nullptr;
    }

    // Creates or drops the state; true when the message was one of the two.
    static bool Track(HWND window, UINT message) {
        if (message == WM_CREATE) {
            States()[window].toolTip = std::make_unique<ControlToolTip>(window);
            return true;
        }
        if (message == WM_DESTROY) {
            States().erase(window);
            return true;
        }
        return false;
    }

    static void RegisterClass(const char* name, WNDPROC procedure) {
        WNDCLASSA windowClass{};
        windowClass.style = CS_HREDRAW | CS_VREDRAW;
        windowClass.lpfnWndProc = procedure;
        windowClass.hCursor = LoadCursorA(nullptr, IDC_ARROW);
        windowClass.lpszClassName = name;
        RegisterClassA(&windowClass);
    }

private:
    static std::map<HWND, State>& States() {
        static std::map<HWND, State> states;
        return states;
    }
};

}  // namespace Pigmo::Host
