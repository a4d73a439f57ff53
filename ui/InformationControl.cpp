#include "InformationControl.h"

#include <cstdio>
#include <string>

#include "ColorInformation.h"
#include "Descriptor.h"

namespace Pigmo::ColorMap {

namespace {

enum : ColorId { kBackground = 0, kText = 1, kSecondaryText = 20 };

template <typename... Values>
std::string Format(const char* format, Values... values) {
    char text[96];
    std::snprintf(text, sizeof text, format, values...);
    return text;
}

HFONT Font(int height, int weight) {
    return CreateFontA(height, 0, 0, 0, weight, 0, 0, 0, 0, 0, 0, 0, 0, "Times New Roman");
}

void Paint(HWND window, const IColorInformation* color) {
    PAINTSTRUCT paint;
    const HDC dc = BeginPaint(window, &paint);
    IColorManager* colors = GetColorManager();
    RECT client;
    GetClientRect(window, &client);
    const HBRUSH background = CreateSolidBrush(colors->GetColor(kBackground));
    const HPEN pen = CreatePen(PS_SOLID, 1, colors->GetColor(kText));
    const HFONT title = Font(20, FW_BOLD), category = Font(16, FW_BOLD), label = Font(14, 0),
                value = Font(14, FW_BOLD);
    const HGDIOBJ oldBrush = SelectObject(dc, background);
    const HGDIOBJ oldPen = SelectObject(dc, pen);
    const HGDIOBJ oldFont = SelectObject(dc, label);
    FillRect(dc, &client, background);
    SetBkMode(dc, TRANSPARENT);

    RECT box = {client.left, client.top, client.right - 10, client.bottom};
    const auto draw = [&](HFONT font, ColorId textColor, const std::string& text) {
        SelectObject(dc, font);
        SetTextColor(dc, colors->GetColor(textColor));
        DrawTextA(dc, text.c_str(), -1, &box, 0);
    };
    // A label, then its value 50 pixels to the right.
    const auto line = [&](const char* name, const std::string& text) {
        draw(label, kSecondaryText, name);
        box.left += 50;
        draw(value, kText, text);
        box.left -= 50;
    };
    draw(title, kText, color != nullptr ? color->GetName() : "N/A");
    box.top += 24;
    draw(category, kSecondaryText, color != nullptr ? color->GetCategory() : "N/A");
    box.top += 20;
    const float* lab = color != nullptr ? color->GetLab() : nullptr;
    line("L*a*b*", lab != nullptr ? Format("%.1f, %.1f, %.1f", lab[0], lab[1], lab[2]) : "*, *, *");
    box.top += 17;
    const float* sRGB = color != nullptr ? color->GetSRGB() : nullptr;
    line("sRGB", sRGB != nullptr ? Format("%.0f, %.0f, %.0f", sRGB[0], sRGB[1], sRGB[2]) : "*, *, *");
    box.top += 17;
    line("HTML", sRGB != nullptr ? HtmlColorCode(sRGB[0], sRGB[1], sRGB[2]) : "#*");

    SelectObject(dc, oldFont);
    SelectObject(dc, oldBrush);
    SelectObject(dc, oldPen);
    for (const HGDIOBJ object : {background, pen, title, category, label, value}) DeleteObject(object);
    EndPaint(window, &paint);
}

}  // namespace

LRESULT CALLBACK ColorInformationProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
        case WM_PAINT:
            Paint(window,
                  reinterpret_cast<const IColorInformation*>(GetWindowLongPtrA(window, GWLP_USERDATA)));
            return 0;
        case WM_MOUSEMOVE:
            return 0;
        default:
            return DefWindowProcA(window, message, wParam, lParam);
    }
}

}  // namespace Pigmo::ColorMap
