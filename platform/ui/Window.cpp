#include "Window.h"

#include <map>
#include <mutex>
#include <string>

namespace {

struct ClassTable {
    std::mutex lock;
    std::map<std::string, WNDCLASSA> classes;
    ATOM lastAtom = 0xC000;
};

ClassTable& Classes() {
    static ClassTable table;
    return table;
}

// Stock objects are fixed handles that no one deletes.
HGDIOBJ const kStockObjects[] = {reinterpret_cast<HGDIOBJ>(std::uintptr_t{0x10})};

}  // namespace

ATOM RegisterClassA(const WNDCLASSA* windowClass) {
    if (windowClass == nullptr || windowClass->lpszClassName == nullptr ||
        windowClass->lpfnWndProc == nullptr)
        return 0;
    ClassTable& table = Classes();
    std::lock_guard guard(table.lock);
    if (!table.classes.emplace(windowClass->lpszClassName, *windowClass).second) return 0;
    return ++table.lastAtom;
}

BOOL GetClassInfoA(HINSTANCE, LPCSTR name, WNDCLASSA* windowClass) {
    if (name == nullptr || windowClass == nullptr) return FALSE;
    ClassTable& table = Classes();
    std::lock_guard guard(table.lock);
    const auto found = table.classes.find(name);
    if (found == table.classes.end()) return FALSE;
    *windowClass = found->second;
    windowClass->lpszClassName = found->first.c_str();
    return TRUE;
}

LRESULT CALLBACK DefWindowProcA(HWND, UINT, WPARAM, LPARAM) {
    return 0;
}

HCURSOR LoadCursorA(HINSTANCE, LPCSTR name) {
    // System cursors only; the value is enough to tell them apart.
    return reinterpret_cast<HCURSOR>(const_cast<char*>(name));
}

HGDIOBJ GetStockObject(int object) {
    return object == WHITE_BRUSH ? kStockObjects[0] : nullptr;
}

BOOL DisableThreadLibraryCalls(HINSTANCE module) {
    return module != nullptr ? TRUE : FALSE;
}
