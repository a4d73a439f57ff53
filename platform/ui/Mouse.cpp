#include "Desktop.h"
#include "WindowTree.h"

namespace Pigmo::Platform::Ui {

namespace {

HWND capture = nullptr;
bool buttonHeld = false;

bool IsWithin(const Window* window, const Window& ancestor) {
    for (; window != nullptr; window = window->parent)
        if (window == &ancestor) return true;
    return false;
}

POINT ClientOriginOnScreen(Window& window) {
    const Window& root = RootOf(window);
    const POINT origin = ClientOriginInRoot(window);
    return {root.rect.left + origin.x, root.rect.top + origin.y};
}

LPARAM PackPoint(LONG x, LONG y) {
    return MAKELPARAM(static_cast<WORD>(static_cast<short>(x)), static_cast<WORD>(static_cast<short>(y)));
}

}  // namespace

// A disabled window takes no mouse input: the point goes to the enabled parent under it.
Window* HitTest(Window& root, POINT point) {
    if ((root.style & WS_DISABLED) != 0 || !Contains(WindowRectInRoot(root), point)) return nullptr;
    Window* current = &root;
    while (Contains(ClientRectInRoot(*current), point)) {
        Window* under = nullptr;
        for (Window* child : current->children) {
            if ((child->style & WS_VISIBLE) != 0 && Contains(WindowRectInRoot(*child), point)) {
                under = child;
                break;
            }
        }
        if (under == nullptr || (under->style & WS_DISABLED) != 0) break;
        current = under;
    }
    return current;
}

void ReleaseCaptureWithin(const Window& window) {
    if (IsWithin(WindowFromHandle(capture), window)) ReleaseCapture();
}

}  // namespace Pigmo::Platform::Ui

using namespace Pigmo::Platform::Ui;

HWND SetCapture(HWND handle) {
    if (WindowFromHandle(handle) == nullptr) return nullptr;
    const HWND previous = GetCapture();
    capture = handle;
    if (previous != nullptr && previous != handle)
        SendMessageA(previous, WM_CAPTURECHANGED, 0, reinterpret_cast<LPARAM>(handle));
    return previous;
}

BOOL ReleaseCapture() {
    const HWND previous = GetCapture();
    capture = nullptr;
    if (previous != nullptr) SendMessageA(previous, WM_CAPTURECHANGED, 0, 0);
    return TRUE;
}

HWND GetCapture() {
    return WindowFromHandle(capture) != nullptr ? capture : nullptr;
}

namespace Pigmo::Platform {

void ForwardMouse(HWND top, UINT message, int x, int y) {
    Ui::Window* root = Ui::WindowFromHandle(top);
    if (root == nullptr || root->parent != nullptr) return;
    if (message != WM_MOUSEMOVE && message != WM_LBUTTONDOWN && message != WM_LBUTTONUP) return;
    if (message != WM_MOUSEMOVE) Ui::buttonHeld = message == WM_LBUTTONDOWN;
    const WPARAM keys = Ui::buttonHeld ? Ui::MK_LBUTTON : 0;
    const POINT point{x, y};
    Ui::Window* target = Ui::WindowFromHandle(GetCapture());
    if (target == nullptr) {
        target = Ui::HitTest(*root, point);
        if (target == nullptr) return;
        // On the frame: only the scroll bar answers, to a press.
        if (!Ui::Contains(Ui::ClientRectInRoot(*target), point)) {
            const RECT area = Ui::WindowRectInRoot(*target);
            if (message == WM_LBUTTONDOWN) Ui::ClickScrollBar(*target, {x - area.left, y - area.top});
            return;
        }
    }
    const POINT origin = Ui::ClientOriginOnScreen(*target);
    SendMessageA(target->handle, message, keys,
                 Ui::PackPoint(root->rect.left + x - origin.x, root->rect.top + y - origin.y));
}

}  // namespace Pigmo::Platform
