#include "SpectralChart.h"

#include <cstdio>

#include "ColorInformation.h"
#include "Descriptor.h"
#include "Truncate.h"

namespace Pigmo::ColorMap {

namespace {

enum : ColorId { kText = 1, kFrame = 7, kPlot = 39, kGrid = 59, kCurve = 60 };

constexpr int kGridLines = 10;

void Paint(HWND window, const IColorInformation* color) {
    PAINTSTRUCT paint;
    const HDC dc = BeginPaint(window, &paint);
    IColorManager* colors = GetColorManager();
    RECT client;
    GetClientRect(window, &client);
    const HBRUSH frameBrush = CreateSolidBrush(colors->GetColor(kFrame));
    const HBRUSH plotBrush = CreateSolidBrush(colors->GetColor(kPlot));
    const HPEN textPen = CreatePen(PS_SOLID, 1, colors->GetColor(kText));
    const HPEN gridPen = CreatePen(PS_SOLID, 1, colors->GetColor(kGrid));
    const HPEN curvePen = CreatePen(PS_SOLID, 1, colors->GetColor(kCurve));
    const HBRUSH curveBrush = CreateSolidBrush(colors->GetColor(kCurve));
    const HFONT font = CreateFontA(12, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, "Times New Roman");
    const HGDIOBJ oldBrush = SelectObject(dc, frameBrush);
    const HGDIOBJ oldPen = SelectObject(dc, textPen);
    const HGDIOBJ oldFont = SelectObject(dc, font);
    Rectangle(dc, client.left, client.top, client.right, client.bottom);

    const RECT plot = {client.left + 24, client.top + 1, client.right - 24, client.bottom - 1};
    FillRect(dc, &plot, plotBrush);

    // Ten lines from the top, none at the bottom edge; the labels run from 1 to 0 in ninths.
    SelectObject(dc, gridPen);
    SetTextColor(dc, colors->GetColor(kText));
    SetBkMode(dc, TRANSPARENT);
    const double step = (plot.bottom - plot.top) / static_cast<double>(kGridLines);
    for (int i = 0; i < kGridLines; ++i) {
        const int y = plot.top + static_cast<int>(i * step);
        MoveToEx(dc, plot.left, y, nullptr);
        LineTo(dc, plot.right, y);
        char label[16];
        std::snprintf(label, sizeof label, "%.2g", 1.0 - i / 9.0);
        RECT box = {client.left + 4, y, client.left + 28, y + 12};
        DrawTextA(dc, label, -1, &box, DT_BOTTOM);
    }

    const int count = color != nullptr ? color->GetSpectralReflectanceCount() : 0;
    const float* curve = color != nullptr ? color->GetSpectralReflectance() : nullptr;
    if (count > 0 && curve != nullptr) {
        SelectObject(dc, curvePen);
        SelectObject(dc, curveBrush);
        const int width = plot.right - plot.left, height = plot.bottom - plot.top;
        for (int k = 0; k < count; ++k) {
            const int x = count == 1
                              ? plot.left
                              : plot.left + static_cast<int>(static_cast<double>(width) * k / (count - 1));
            // Reflectance 1 at the top and 0 at the bottom, counted from the client area's top.
            const int y = Truncate(height * (1.0 - curve[k]));
            Rectangle(dc, x - 3, y - 3, x + 3, y + 3);
            if (k > 0)
                LineTo(dc, x, y);
            else
                MoveToEx(dc, x, y, nullptr);
        }
    }

    SelectObject(dc, oldBrush);
    SelectObject(dc, oldPen);
    SelectObject(dc, oldFont);
    for (const HGDIOBJ object : {frameBrush, plotBrush, textPen, gridPen, curvePen, curveBrush, font})
        DeleteObject(object);
    EndPaint(window, &paint);
}

}  // namespace

LRESULT CALLBACK SpectralChartProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    if (message == WM_PAINT) {
        Paint(window, reinterpret_cast<const IColorInformation*>(GetWindowLongPtrA(window, GWLP_USERDATA)));
        return 0;
    }
    return DefWindowProcA(window, message, wParam, lParam);
}

}  // namespace Pigmo::ColorMap
