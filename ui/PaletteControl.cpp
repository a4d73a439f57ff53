#include "PaletteControl.h"

#include <algorithm>
#include <cmath>
#include <string>

#include "Descriptor.h"
#include "IColorPalletteUser.h"
#include "Resource.h"
#include "Truncate.h"

namespace Pigmo::ColorMap {

namespace {

constexpr int kRows = 7;

// Host interface colors by id.
enum : ColorId { kBackground = 0, kText = 1, kLabelBackground = 7, kSelection = 61 };

// Shared by every palette window, as a press in one and a move in another would share them.
bool stripDragging = false;
bool swatchPicking = false;

struct Areas {
    RECT client;
    RECT stripDrawn, stripHit, swatchesDrawn, swatchesHit;
};

Areas AreasOf(HWND window) {
    Areas a{};
    GetClientRect(window, &a.client);
    const RECT& c = a.client;
    a.stripDrawn = {c.right - 50, c.top, c.right - 10, c.bottom - 3};
    a.stripHit = {c.right - 50, c.top, c.right - 10, c.bottom};
    a.swatchesDrawn = {c.left, c.top, c.right - 70, c.bottom - 3};
    a.swatchesHit = {c.left, c.top, c.right - 70, c.bottom};
    return a;
}

// Edges included.
bool Inside(const RECT& r, int x, int y) {
    return x >= r.left && x <= r.right && y >= r.top && y <= r.bottom;
}

IColorPalletteUser* OwnerOf(HWND window) {
    return reinterpret_cast<IColorPalletteUser*>(GetWindowLongPtrA(window, GWLP_USERDATA));
}

// Each sRGB channel truncated, its low byte kept.
COLORREF ColorOf(const IColorInformation& color) {
    const float* sRGB = color.GetSRGB();
    return RGB(Truncate(sRGB[0]) & 0xFF, Truncate(sRGB[1]) & 0xFF, Truncate(sRGB[2]) & 0xFF);
}

void Marker(HDC dc, const RECT& band) {
    const LONG middle = static_cast<LONG>(band.top + 3.5);
    const POINT points[6] = {{band.left - 10, band.top},      {band.left - 10, band.top + 7},
                             {band.left - 1, middle},         {band.right + 10, band.top},
                             {band.right + 10, band.top + 7}, {band.right + 1, middle}};
    const int counts[2] = {3, 3};
    PolyPolygon(dc, points, counts, 2);
}

void Paint(HWND window, IColorPalletteUser& owner) {
    PAINTSTRUCT paint;
    const HDC dc = BeginPaint(window, &paint);
    IColorManager* colors = GetColorManager();
    const Areas a = AreasOf(window);
    const RECT& c = a.client;
    const HBRUSH background = CreateSolidBrush(colors->GetColor(kBackground));
    const HFONT font = CreateFontA(12, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, "Times New Roman");
    const HGDIOBJ oldFont = SelectObject(dc, font);
    const HGDIOBJ oldBrush = SelectObject(dc, background);
    const HGDIOBJ oldPen = SelectObject(dc, GetStockObject(BLACK_PEN));
    FillRect(dc, &c, background);

    const unsigned int count = owner.GetColorCount();
    HBRUSH labelBrush = nullptr, textBrush = nullptr, selectionBrush = nullptr;
    HPEN textPen = nullptr, framePen = nullptr, selectionPen = nullptr;
    if (count == 0) {
        SetTextColor(dc, colors->GetColor(kText));
        SetBkMode(dc, TRANSPARENT);
        RECT message = c;
        message.top = c.top + (c.bottom - c.top) / 2;
        const MCHAR* none = GetString(IDS_NO_COLORS_PRESENT);
        const std::string text = "- " + std::string(none != nullptr ? none : "") + " -";
        DrawTextA(dc, text.c_str(), -1, &message, DT_CENTER);
    } else {
        labelBrush = CreateSolidBrush(colors->GetColor(kLabelBackground));
        textBrush = CreateSolidBrush(colors->GetColor(kText));
        selectionBrush = CreateSolidBrush(colors->GetColor(kSelection));
        textPen = CreatePen(PS_SOLID, 1, colors->GetColor(kText));
        framePen = CreatePen(PS_SOLID, 3, colors->GetColor(kSelection));
        selectionPen = CreatePen(PS_SOLID, 1, colors->GetColor(kSelection));
        const int scroll = owner.GetScrollPosition();
        const int selected = owner.GetSelectedIndex();

        SelectObject(dc, background);
        SelectObject(dc, textPen);
        const RECT& strip = a.stripDrawn;
        Rectangle(dc, strip.left, strip.top, strip.right, strip.bottom);
        // Every color as a band; with more colors than pixels the bands overlap, later ones on top.
        const float step = static_cast<float>(strip.bottom - c.top - 3) / static_cast<float>(count);
        float y = 1.0f;
        for (unsigned int i = 0; i < count; ++i) {
            RECT band;
            band.top = static_cast<LONG>(std::floor(y)) + 1;
            band.bottom = static_cast<LONG>(static_cast<float>(band.top) + step + 1.0f);
            band.left = strip.left + 1;
            band.right = strip.right - 1;
            const HBRUSH brush = CreateSolidBrush(ColorOf(*owner.GetColor(i)));
            FillRect(dc, &band, brush);
            DeleteObject(brush);
            y += step;
            if (static_cast<int>(i) == scroll) {
                SelectObject(dc, textPen);
                SelectObject(dc, textBrush);
                Marker(dc, band);
            }
            if (static_cast<int>(i) == selected) {
                SelectObject(dc, selectionPen);
                SelectObject(dc, selectionBrush);
                Marker(dc, band);
            }
        }

        SelectObject(dc, background);
        SelectObject(dc, textPen);
        const RECT& swatches = a.swatchesDrawn;
        Rectangle(dc, swatches.left, swatches.top, swatches.right, c.bottom - 2);
        const int first = std::max(scroll, 0);
        const int last = std::min(first + kRows, static_cast<int>(count));
        const double rowHeight = (swatches.bottom - c.top - 3) / static_cast<double>(kRows);
        for (int i = first; i < last; ++i) {
            const IColorInformation& color = *owner.GetColor(static_cast<unsigned int>(i));
            const int t = static_cast<int>((i - first) * rowHeight);
            RECT swatch;
            swatch.top = c.top + t + 1;
            swatch.bottom = std::min(swatches.bottom - 1, static_cast<LONG>(swatch.top + rowHeight - 12.0));
            swatch.left = c.left + 1;
            swatch.right = swatches.right - 1;
            const HBRUSH brush = CreateSolidBrush(ColorOf(color));
            FillRect(dc, &swatch, brush);
            RECT label = {swatch.left, swatch.bottom, swatch.right, swatch.bottom + 12};
            FillRect(dc, &label, labelBrush);
            SetBkMode(dc, TRANSPARENT);
            SetTextColor(dc, colors->GetColor(kText));
            DrawTextA(dc, color.GetName(), -1, &label, DT_CENTER);
            if (i == selected) {
                SelectObject(dc, GetStockObject(NULL_BRUSH));
                SelectObject(dc, framePen);
                Rectangle(dc, c.left + 1, c.top + t, swatches.right - 1,
                          static_cast<int>(c.top + t + rowHeight + 1.0));
            }
            DeleteObject(brush);
        }
    }

    SelectObject(dc, oldFont);
    SelectObject(dc, oldBrush);
    SelectObject(dc, oldPen);
    for (const HGDIOBJ object :
         {background, labelBrush, textBrush, selectionBrush, textPen, framePen, selectionPen, font})
        if (object != nullptr) DeleteObject(object);
    EndPaint(window, &paint);
}

void ScrollTo(HWND window, IColorPalletteUser& owner, int x, int y) {
    const Areas a = AreasOf(window);
    if (!Inside(a.stripHit, x, y)) return;
    const int count = static_cast<int>(owner.GetColorCount());
    const double height = a.client.bottom - a.client.top;
    const int position = static_cast<int>(count * (y - a.client.top) / height);
    owner.SetScrollPosition(std::clamp(position, 0, count - 1));
    InvalidateRect(window, nullptr, FALSE);
}

void PickAt(HWND window, IColorPalletteUser& owner, int x, int y) {
    const Areas a = AreasOf(window);
    if (!Inside(a.swatchesHit, x, y)) return;
    const int count = static_cast<int>(owner.GetColorCount());
    const double height = a.client.bottom - a.client.top;
    const int index = owner.GetScrollPosition() + static_cast<int>(kRows * (y - a.client.top) / height);
    owner.SelectColor(std::clamp(index, 0, count - 1));
    InvalidateRect(window, nullptr, FALSE);
}

}  // namespace

LRESULT CALLBACK ColorPalletteProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    IColorPalletteUser* owner = OwnerOf(window);
    // The owner is asked only for what a message needs: it may be gone by the time the window is.
    const auto active = [owner] { return owner != nullptr && owner->GetColorCount() > 0; };
    const int x = GET_X_LPARAM(lParam), y = GET_Y_LPARAM(lParam);
    switch (message) {
        case WM_PAINT:
            if (owner != nullptr) {
                Paint(window, *owner);
            } else {
                PAINTSTRUCT paint;
                BeginPaint(window, &paint);
                EndPaint(window, &paint);
            }
            return 0;
        case WM_LBUTTONDOWN:
            if (!active()) return 0;
            SetCapture(window);
            if (Inside(AreasOf(window).stripHit, x, y)) {
                stripDragging = true;
                ScrollTo(window, *owner, x, y);
            } else if (Inside(AreasOf(window).swatchesHit, x, y)) {
                swatchPicking = true;
                PickAt(window, *owner, x, y);
            }
            return 0;
        case WM_MOUSEMOVE:
            if (!active()) return 0;
            if (stripDragging)
                ScrollTo(window, *owner, x, y);
            else if (swatchPicking)
                PickAt(window, *owner, x, y);
            return 0;
        case WM_LBUTTONUP:
            // Released whatever the book holds now, so a book emptied during a drag keeps no capture.
            if (GetCapture() == window) ReleaseCapture();
            stripDragging = swatchPicking = false;
            return 0;
        default:
            return DefWindowProcA(window, message, wParam, lParam);
    }
}

}  // namespace Pigmo::ColorMap
