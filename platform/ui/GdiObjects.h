#pragma once

// Inside the GDI stand-in: brushes, pens and fonts behind their handles.

#include <cairo.h>

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <variant>

#include "Gdi.h"

namespace Pigmo::Platform::Ui {

struct Brush {
    COLORREF color;
    bool hollow;
};

struct Pen {
    int width;
    COLORREF color;
    bool hollow;
};

struct ScaledFontRelease {
    void operator()(cairo_scaled_font_t* font) const { cairo_scaled_font_destroy(font); }
};

// A font as asked for (face, height, weight) and as found: a Liberation face scaled so that its cell
// (ascent + descent) is what GDI's height asks for.
struct Font {
    std::string face;
    int height;
    int weight;
    std::unique_ptr<cairo_scaled_font_t, ScaledFontRelease> scaled;
    int ascent;
    int descent;

    int CellHeight() const { return ascent + descent; }
    int TextWidth(std::string_view text) const;
};

struct GdiObject {
    std::variant<Brush, Pen, Font> value;
    bool stock = false;
};

// Null for a stale or foreign handle.
std::shared_ptr<GdiObject> ShareGdiObject(HGDIOBJ object);
// A live font, else the default GUI font.
const Font& FontOf(HFONT font);
// A brush handle or a system color index + 1, as FillRect and window classes take them.
std::optional<Brush> BrushOf(HBRUSH brush);
// The stand-in's text is UTF-8 when it is valid UTF-8, otherwise Latin-1.
std::string ToUtf8(std::string_view text);

}  // namespace Pigmo::Platform::Ui
