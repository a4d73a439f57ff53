// The frame around a client area: the one-pixel border, the sunken client edge and the vertical
// scroll bar, painted by the system and not by the window's procedure.
#include <algorithm>

#include "DeviceContext.h"
#include "WindowTree.h"

namespace Pigmo::Platform::Ui {

namespace {

struct ScrollBarLayout {
    RECT bar, up, down, thumb;
};

// In window coordinates. The thumb is empty when the track is too short for it.
ScrollBarLayout LayoutOf(const Window& window) {
    const int edge = FrameOf(window).top;
    const LONG width = window.rect.right - window.rect.left;
    const LONG height = window.rect.bottom - window.rect.top;
    ScrollBarLayout layout{};
    layout.bar = {width - edge - kScrollBarWidth, edge, width - edge, height - edge};
    const LONG arrow = std::min<LONG>(kScrollBarWidth, (layout.bar.bottom - layout.bar.top) / 2);
    layout.up = {layout.bar.left, layout.bar.top, layout.bar.right, layout.bar.top + arrow};
    layout.down = {layout.bar.left, layout.bar.bottom - arrow, layout.bar.right, layout.bar.bottom};
    const LONG track = layout.down.top - layout.up.bottom;
    const int range = window.scroll.max + 1;
    constexpr LONG kSmallestThumb = 8;
    const LONG thumb = std::max<LONG>(
        kSmallestThumb, static_cast<LONG>(static_cast<long long>(track) * window.scroll.page / range));
    if (thumb < track) {
        const int span = std::max(range - window.scroll.page, 1);
        const LONG top = layout.up.bottom + static_cast<LONG>(static_cast<long long>(track - thumb) *
                                                              std::clamp(window.scroll.pos, 0, span) / span);
        layout.thumb = {layout.bar.left, top, layout.bar.right, top + thumb};
    }
    return layout;
}

void Fill(HDC dc, LONG left, LONG top, LONG right, LONG bottom, int color) {
    const RECT rect{left, top, right, bottom};
    FillRect(dc, &rect, SysColorBrush(color));
}

void RaisedBox(HDC dc, const RECT& box) {
    Fill(dc, box.left, box.top, box.right, box.bottom, COLOR_BTNFACE);
    Fill(dc, box.left, box.top, box.right - 1, box.top + 1, COLOR_BTNHIGHLIGHT);
    Fill(dc, box.left, box.top, box.left + 1, box.bottom - 1, COLOR_BTNHIGHLIGHT);
    Fill(dc, box.left, box.bottom - 1, box.right, box.bottom, COLOR_BTNSHADOW);
    Fill(dc, box.right - 1, box.top, box.right, box.bottom, COLOR_BTNSHADOW);
}

// A small triangle in the button's middle, pointing up or down.
void Arrow(HDC dc, const RECT& button, bool up) {
    constexpr int kRows = 4;
    const LONG middleX = (button.left + button.right) / 2;
    const LONG firstRow = (button.top + button.bottom) / 2 - kRows / 2;
    for (int row = 0; row < kRows; ++row) {
        const int halfWidth = up ? row : kRows - 1 - row;
        Fill(dc, middleX - halfWidth, firstRow + row, middleX + halfWidth + 1, firstRow + row + 1,
             COLOR_BTNTEXT);
    }
}

void PaintScrollBar(HDC dc, const Window& window) {
    const ScrollBarLayout layout = LayoutOf(window);
    Fill(dc, layout.bar.left, layout.bar.top, layout.bar.right, layout.bar.bottom, COLOR_SCROLLBAR);
    RaisedBox(dc, layout.up);
    Arrow(dc, layout.up, true);
    RaisedBox(dc, layout.down);
    Arrow(dc, layout.down, false);
    if (!IsEmpty(layout.thumb)) RaisedBox(dc, layout.thumb);
}

}  // namespace

void PaintFrame(Window& window) {
    const Frame frame = FrameOf(window);
    if (frame.left == 0 && frame.right == 0) return;
    const RECT area = WindowRectInRoot(window);
    const RECT visible =
        window.parent != nullptr ? Intersect(area, VisibleClientInRoot(*window.parent)) : area;
    const cairo_rectangle_int_t visiblePart{visible.left, visible.top, visible.right - visible.left,
                                            visible.bottom - visible.top};
    cairo_region_t* clip = cairo_region_create_rectangle(&visiblePart);
    const HDC dc = OpenDeviceContext(window, {area.left, area.top}, clip);
    cairo_region_destroy(clip);
    const LONG width = area.right - area.left;
    const LONG height = area.bottom - area.top;
    if (frame.top == 1) {
        Fill(dc, 0, 0, width, 1, COLOR_WINDOWFRAME);
        Fill(dc, 0, height - 1, width, height, COLOR_WINDOWFRAME);
        Fill(dc, 0, 0, 1, height, COLOR_WINDOWFRAME);
        Fill(dc, width - 1, 0, width, height, COLOR_WINDOWFRAME);
    } else if (frame.top == 2) {
        // Sunken: shadow above and left, light below and right, two pixels deep.
        Fill(dc, 0, 0, width - 1, 1, COLOR_BTNSHADOW);
        Fill(dc, 0, 0, 1, height - 1, COLOR_BTNSHADOW);
        Fill(dc, 0, height - 1, width, height, COLOR_BTNHIGHLIGHT);
        Fill(dc, width - 1, 0, width, height, COLOR_BTNHIGHLIGHT);
        Fill(dc, 1, 1, width - 2, 2, COLOR_3DDKSHADOW);
        Fill(dc, 1, 1, 2, height - 2, COLOR_3DDKSHADOW);
        Fill(dc, 1, height - 2, width - 1, height - 1, COLOR_3DLIGHT);
        Fill(dc, width - 2, 1, width - 1, height - 1, COLOR_3DLIGHT);
    }
    if (HasVerticalBar(window)) PaintScrollBar(dc, window);
    CloseDeviceContext(dc);
}

void SetVerticalScroll(Window& window, int max, int page, int pos) {
    ScrollRange& scroll = window.scroll;
    if (scroll.max == max && scroll.page == page && scroll.pos == pos) return;
    scroll = {max, page, pos};
    // Showing or hiding the bar changes the client area: everything is painted again.
    Invalidate(window, nullptr, true, true);
}

void ClickScrollBar(Window& window, POINT point) {
    if (!HasVerticalBar(window)) return;
    const ScrollBarLayout layout = LayoutOf(window);
    if (!Contains(layout.bar, point)) return;
    WORD code;
    if (point.y < layout.up.bottom)
        code = SB_LINEUP;
    else if (point.y >= layout.down.top)
        code = SB_LINEDOWN;
    else if (!IsEmpty(layout.thumb) && point.y < layout.thumb.top)
        code = SB_PAGEUP;
    else if (!IsEmpty(layout.thumb) && point.y >= layout.thumb.bottom)
        code = SB_PAGEDOWN;
    else
        return;
    SendMessageA(window.handle, WM_VSCROLL, MAKEWPARAM(code, 0), 0);
}

}  // namespace Pigmo::Platform::Ui
