#include <cstring>
#include <utility>
#include <vector>

#include "Desktop.h"
#include "DeviceContext.h"

namespace Pigmo::Platform::Ui {

namespace {

std::function<void(const Pigmo::Platform::DrawnText&)>& TextHook() {
    static std::function<void(const Pigmo::Platform::DrawnText&)> hook;
    return hook;
}

// Lines end at CR LF, LF or CR, as DrawText breaks them.
std::vector<std::string_view> SplitLines(std::string_view text) {
    std::vector<std::string_view> lines;
    std::size_t start = 0;
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (text[i] != '\n' && text[i] != '\r') continue;
        lines.push_back(text.substr(start, i - start));
        if (text[i] == '\r' && i + 1 < text.size() && text[i + 1] == '\n') ++i;
        start = i + 1;
    }
    lines.push_back(text.substr(start));
    return lines;
}

}  // namespace

}  // namespace Pigmo::Platform::Ui

using namespace Pigmo::Platform::Ui;

int DrawTextA(HDC dc, LPCSTR text, int length, RECT* rect, UINT format) {
    DeviceContext* context = ContextFromHandle(dc);
    if (context == nullptr || text == nullptr || rect == nullptr) return 0;
    const std::string_view drawn(text, length < 0 ? std::strlen(text) : strnlen(text, length));
    const Font& font = std::get<Font>(context->font->value);
    if (const auto hook = TextHook())
        hook({context->window, std::string(drawn), *rect, format, font.face, font.height, font.weight,
              context->textColor});

    const bool singleLine = (format & DT_SINGLELINE) != 0;
    const std::vector<std::string_view> lines =
        singleLine ? std::vector<std::string_view>{drawn} : SplitLines(drawn);
    // Wide arithmetic: the rectangle may be anything.
    const long long lineHeight = font.CellHeight();
    const long long height = static_cast<long long>(rect->bottom) - rect->top;
    long long top = rect->top;
    if (singleLine && (format & DT_VCENTER) != 0)
        top = rect->top + (height - lineHeight) / 2;
    else if (singleLine && (format & DT_BOTTOM) != 0)
        top = rect->bottom - lineHeight;

    cairo_t* cairo = context->cairo;
    cairo_save(cairo);
    if ((format & DT_NOCLIP) == 0) {
        cairo_new_path(cairo);
        cairo_rectangle(cairo, rect->left, rect->top, static_cast<double>(rect->right) - rect->left,
                        static_cast<double>(height));
        cairo_clip(cairo);
    }
    cairo_set_scaled_font(cairo, font.scaled.get());
    long long y = top;
    for (const std::string_view line : lines) {
        const long long width = font.TextWidth(line);
        long long x = rect->left;
        if ((format & DT_CENTER) != 0)
            x = rect->left + (static_cast<long long>(rect->right) - rect->left - width) / 2;
        else if ((format & DT_RIGHT) != 0)
            x = rect->right - width;
        if (context->backgroundMode == OPAQUE) {
            cairo_new_path(cairo);
            cairo_rectangle(cairo, static_cast<double>(x), static_cast<double>(y), static_cast<double>(width),
                            static_cast<double>(lineHeight));
            SetSourceColor(cairo, context->backgroundColor);
            cairo_fill(cairo);
        }
        SetSourceColor(cairo, context->textColor);
        cairo_move_to(cairo, static_cast<double>(x), static_cast<double>(y + font.ascent));
        cairo_show_text(cairo, ToUtf8(line).c_str());
        y += lineHeight;
    }
    cairo_new_path(cairo);
    cairo_restore(cairo);
    // With vertical placement GDI answers the offset from the top to the text's bottom.
    return static_cast<int>(y - rect->top);
}

namespace Pigmo::Platform {

void SetTextHook(std::function<void(const DrawnText&)> hook) {
    Ui::TextHook() = std::move(hook);
}

}  // namespace Pigmo::Platform
