#include "GdiObjects.h"

#include <cairo-ft.h>
#include <fontconfig/fontconfig.h>
#include <ft2build.h>
#include FT_FREETYPE_H
#include <strings.h>

#include <cmath>
#include <map>
#include <utility>

#include "HandleTable.h"
#include "Window.h"

namespace Pigmo::Platform::Ui {

namespace {

HandleTable<GdiObject>& Objects() {
    static HandleTable<GdiObject> table;
    return table;
}

HGDIOBJ AddObject(GdiObject object) {
    return Objects().Add<HGDIOBJ>(std::make_shared<GdiObject>(std::move(object)));
}

// Windows' faces and the installed, metric-compatible ones that stand in for them.
struct FaceSubstitute {
    const char* asked;
    const char* installed;
};
constexpr FaceSubstitute kFaceSubstitutes[] = {
    {"Times New Roman", "Liberation Serif"},
    {"MS Shell Dlg", "Liberation Sans"},
    {"MS Sans Serif", "Liberation Sans"},
    {"Arial", "Liberation Sans"},
};

const char* InstalledFace(const std::string& asked) {
    if (asked.empty()) return "Liberation Sans";
    for (const FaceSubstitute& substitute : kFaceSubstitutes)
        if (strcasecmp(asked.c_str(), substitute.asked) == 0) return substitute.installed;
    return asked.c_str();
}

// Faces are looked up with a fontconfig configuration of our own, which leaves the process's shared
// fontconfig state alone and goes with us, and opened with FreeType; once per family and weight.
class FaceCache {
public:
    FaceCache() = default;
    FaceCache(const FaceCache&) = delete;
    FaceCache& operator=(const FaceCache&) = delete;
    ~FaceCache() {
        for (const auto& [key, face] : faces_) cairo_font_face_destroy(face);
        if (config_ != nullptr) FcConfigDestroy(config_);
    }

    cairo_font_face_t* Find(const std::string& family, bool bold) {
        const auto key = std::make_pair(family, bold);
        if (const auto found = faces_.find(key); found != faces_.end()) return found->second;
        cairo_font_face_t* face = Open(family, bold);
        // Without any font file Cairo's own built-in face still draws.
        if (face == nullptr)
            face = cairo_toy_font_face_create(family.c_str(), CAIRO_FONT_SLANT_NORMAL,
                                              bold ? CAIRO_FONT_WEIGHT_BOLD : CAIRO_FONT_WEIGHT_NORMAL);
        faces_.emplace(key, face);
        return face;
    }

private:
    // Null when no font file is found for the family.
    cairo_font_face_t* Open(const std::string& family, bool bold) {
        if (library_ == nullptr && FT_Init_FreeType(&library_) != 0) library_ = nullptr;
        if (config_ == nullptr) config_ = FcInitLoadConfigAndFonts();
        if (library_ == nullptr || config_ == nullptr) return nullptr;
        FcPattern* asked = FcPatternCreate();
        FcPatternAddString(asked, FC_FAMILY, reinterpret_cast<const FcChar8*>(family.c_str()));
        FcPatternAddInteger(asked, FC_WEIGHT, bold ? FC_WEIGHT_BOLD : FC_WEIGHT_REGULAR);
        FcPatternAddInteger(asked, FC_SLANT, FC_SLANT_ROMAN);
        FcConfigSubstitute(config_, asked, FcMatchPattern);
        FcDefaultSubstitute(asked);
        FcResult result;
        FcPattern* match = FcFontMatch(config_, asked, &result);
        FcPatternDestroy(asked);
        if (match == nullptr) return nullptr;
        FcChar8* file = nullptr;
        int index = 0;
        FT_Face freeType = nullptr;
        if (FcPatternGetString(match, FC_FILE, 0, &file) == FcResultMatch) {
            FcPatternGetInteger(match, FC_INDEX, 0, &index);
            if (FT_New_Face(library_, reinterpret_cast<const char*>(file), index, &freeType) != 0)
                freeType = nullptr;
        }
        FcPatternDestroy(match);
        if (freeType == nullptr) return nullptr;
        cairo_font_face_t* face = cairo_ft_font_face_create_for_ft_face(freeType, 0);
        // The FreeType face goes when Cairo lets go of its face.
        static const cairo_user_data_key_t kFreeTypeFace{};
        if (cairo_font_face_set_user_data(face, &kFreeTypeFace, freeType, [](void* data) {
                FT_Done_Face(static_cast<FT_Face>(data));
            }) != CAIRO_STATUS_SUCCESS) {
            cairo_font_face_destroy(face);
            FT_Done_Face(freeType);
            return nullptr;
        }
        return face;
    }

    FT_Library library_ = nullptr;
    FcConfig* config_ = nullptr;
    std::map<std::pair<std::string, bool>, cairo_font_face_t*> faces_;
};

// The cell GDI gives a font created with height 0.
constexpr int kDefaultCellHeight = 16;

cairo_scaled_font_t* ScaleFont(cairo_font_face_t* face, double em, bool hintMetrics) {
    cairo_matrix_t size;
    cairo_matrix_init_scale(&size, em, em);
    cairo_matrix_t identity;
    cairo_matrix_init_identity(&identity);
    cairo_font_options_t* options = cairo_font_options_create();
    cairo_font_options_set_antialias(options, CAIRO_ANTIALIAS_GRAY);
    cairo_font_options_set_hint_style(options, CAIRO_HINT_STYLE_SLIGHT);
    cairo_font_options_set_hint_metrics(options,
                                        hintMetrics ? CAIRO_HINT_METRICS_ON : CAIRO_HINT_METRICS_OFF);
    cairo_scaled_font_t* scaled = cairo_scaled_font_create(face, &size, &identity, options);
    cairo_font_options_destroy(options);
    return scaled;
}

std::optional<Font> MakeFont(int height, int weight, const char* asked) {
    Font font{asked != nullptr ? asked : "", height, weight, nullptr, 0, 0};
    static FaceCache faces;
    cairo_font_face_t* face = faces.Find(InstalledFace(font.face), weight >= 600);
    // The face's own ascent and descent per em, unhinted, decide the size for a given cell.
    constexpr double kProbeEm = 100.0;
    cairo_scaled_font_t* probe = ScaleFont(face, kProbeEm, false);
    cairo_font_extents_t extents{};
    cairo_scaled_font_extents(probe, &extents);
    const bool measured = cairo_scaled_font_status(probe) == CAIRO_STATUS_SUCCESS && extents.ascent > 0;
    cairo_scaled_font_destroy(probe);
    if (!measured) return std::nullopt;
    const double ascentPerEm = extents.ascent / kProbeEm;
    const double descentPerEm = extents.descent / kProbeEm;
    double em;
    if (height < 0) {
        em = -static_cast<double>(height);
        font.ascent = static_cast<int>(std::lround(em * ascentPerEm));
        font.descent = static_cast<int>(std::lround(em * descentPerEm));
    } else {
        const int cell = height > 0 ? height : kDefaultCellHeight;
        em = cell / (ascentPerEm + descentPerEm);
        font.ascent = static_cast<int>(std::lround(em * ascentPerEm));
        font.descent = cell - font.ascent;
    }
    font.scaled.reset(ScaleFont(face, em, true));
    if (cairo_scaled_font_status(font.scaled.get()) != CAIRO_STATUS_SUCCESS) return std::nullopt;
    return font;
}

HGDIOBJ AddStock(std::variant<Brush, Pen, Font> value) {
    return AddObject(GdiObject{std::move(value), true});
}

// Strict, as Cairo checks it: no overlong forms, surrogates or code points past U+10FFFF.
bool IsUtf8(std::string_view text) {
    std::size_t i = 0;
    while (i < text.size()) {
        const auto lead = static_cast<unsigned char>(text[i]);
        int trail;
        char32_t code;
        if (lead < 0x80) {
            trail = 0, code = lead;
        } else if ((lead & 0xE0) == 0xC0) {
            trail = 1, code = lead & 0x1F;
        } else if ((lead & 0xF0) == 0xE0) {
            trail = 2, code = lead & 0x0F;
        } else if ((lead & 0xF8) == 0xF0) {
            trail = 3, code = lead & 0x07;
        } else {
            return false;
        }
        if (i + trail >= text.size()) return false;
        for (int k = 1; k <= trail; ++k) {
            const auto next = static_cast<unsigned char>(text[i + k]);
            if ((next & 0xC0) != 0x80) return false;
            code = (code << 6) | (next & 0x3F);
        }
        constexpr char32_t kSmallest[] = {0, 0x80, 0x800, 0x10000};
        if (code < kSmallest[trail] || code > 0x10FFFF || (code >= 0xD800 && code <= 0xDFFF)) return false;
        i += trail + 1;
    }
    return true;
}

}  // namespace

int Font::TextWidth(std::string_view text) const {
    const std::string utf8 = ToUtf8(text);
    cairo_text_extents_t extents{};
    cairo_scaled_font_text_extents(scaled.get(), utf8.c_str(), &extents);
    return static_cast<int>(std::lround(extents.x_advance));
}

std::shared_ptr<GdiObject> ShareGdiObject(HGDIOBJ object) {
    return Objects().Share(object);
}

const Font& FontOf(HFONT font) {
    if (const GdiObject* object = Objects().Find(font))
        if (const Font* found = std::get_if<Font>(&object->value)) return *found;
    return std::get<Font>(Objects().Find(GetStockObject(DEFAULT_GUI_FONT))->value);
}

std::optional<Brush> BrushOf(HBRUSH brush) {
    const auto value = reinterpret_cast<std::uintptr_t>(brush);
    if (value >= 1 && value <= 31) return Brush{GetSysColor(static_cast<int>(value) - 1), false};
    if (const GdiObject* object = Objects().Find(brush))
        if (const Brush* found = std::get_if<Brush>(&object->value)) return *found;
    return std::nullopt;
}

std::string ToUtf8(std::string_view text) {
    if (IsUtf8(text)) return std::string(text);
    std::string utf8;
    for (const char c : text) {
        const auto byte = static_cast<unsigned char>(c);
        if (byte < 0x80) {
            utf8 += c;
        } else {
            utf8 += static_cast<char>(0xC0 | (byte >> 6));
            utf8 += static_cast<char>(0x80 | (byte & 0x3F));
        }
    }
    return utf8;
}

}  // namespace Pigmo::Platform::Ui

using namespace Pigmo::Platform::Ui;

HGDIOBJ GetStockObject(int object) {
    switch (object) {
        case WHITE_BRUSH: {
            static const HGDIOBJ stock = AddStock(Brush{RGB(255, 255, 255), false});
            return stock;
        }
        case NULL_BRUSH: {
            static const HGDIOBJ stock = AddStock(Brush{0, true});
            return stock;
        }
        case BLACK_PEN: {
            static const HGDIOBJ stock = AddStock(Pen{1, RGB(0, 0, 0), false});
            return stock;
        }
        case NULL_PEN: {
            static const HGDIOBJ stock = AddStock(Pen{1, 0, true});
            return stock;
        }
        case DEFAULT_GUI_FONT: {
            // MS Shell Dlg at 8 points, 96 dpi.
            static const HGDIOBJ stock = AddStock(*MakeFont(-11, FW_NORMAL, "MS Shell Dlg"));
            return stock;
        }
        default:
            return nullptr;
    }
}

HBRUSH CreateSolidBrush(COLORREF color) {
    return AddObject(GdiObject{Brush{color, false}});
}

HPEN CreatePen(int style, int width, COLORREF color) {
    constexpr int PS_NULL = 5;
    return AddObject(GdiObject{Pen{width > 1 ? width : 1, color, style == PS_NULL}});
}

HFONT CreateFontA(int height, int, int, int, int weight, DWORD, DWORD, DWORD, DWORD, DWORD, DWORD, DWORD,
                  DWORD, LPCSTR face) {
    std::optional<Font> font = MakeFont(height, weight, face);
    return font ? AddObject(GdiObject{std::move(*font)}) : nullptr;
}

BOOL DeleteObject(HGDIOBJ object) {
    const GdiObject* found = Objects().Find(object);
    if (found == nullptr) return FALSE;
    // Stock objects stay; a context that still holds a deleted object keeps it until it lets go.
    if (!found->stock) Objects().Remove(object);
    return TRUE;
}
