#include <array>

#include "WindowTree.h"

namespace Pigmo::Platform::Ui {

namespace {

// Windows 10's default scheme, COLOR_SCROLLBAR (0) to COLOR_MENUBAR (30).
std::array<COLORREF, 31>& Colors() {
    static std::array<COLORREF, 31> colors{
        RGB(200, 200, 200), RGB(0, 0, 0),       RGB(153, 180, 209), RGB(191, 205, 219), RGB(240, 240, 240),
        RGB(255, 255, 255), RGB(100, 100, 100), RGB(0, 0, 0),       RGB(0, 0, 0),       RGB(0, 0, 0),
        RGB(180, 180, 180), RGB(244, 247, 252), RGB(171, 171, 171), RGB(0, 120, 215),   RGB(255, 255, 255),
        RGB(240, 240, 240), RGB(160, 160, 160), RGB(109, 109, 109), RGB(0, 0, 0),       RGB(0, 0, 0),
        RGB(255, 255, 255), RGB(105, 105, 105), RGB(227, 227, 227), RGB(0, 0, 0),       RGB(255, 255, 225),
        RGB(0, 0, 0),       RGB(0, 102, 204),   RGB(185, 209, 234), RGB(215, 228, 242), RGB(0, 120, 215),
        RGB(240, 240, 240),
    };
    return colors;
}

}  // namespace

}  // namespace Pigmo::Platform::Ui

using namespace Pigmo::Platform::Ui;

COLORREF GetSysColor(int index) {
    return index >= 0 && static_cast<std::size_t>(index) < Colors().size() ? Colors()[index] : 0;
}

// All or nothing: an unknown index changes no color. Every window paints again in the new scheme.
BOOL SetSysColors(int count, const int* indexes, const COLORREF* colors) {
    if (count < 0 || (count > 0 && (indexes == nullptr || colors == nullptr))) return FALSE;
    for (int i = 0; i < count; ++i)
        if (indexes[i] < 0 || static_cast<std::size_t>(indexes[i]) >= Colors().size()) return FALSE;
    for (int i = 0; i < count; ++i) Colors()[indexes[i]] = colors[i];
    RepaintAllWindows();
    return TRUE;
}
