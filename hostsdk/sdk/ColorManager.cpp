#include "ColorManager.h"

#include <iterator>

#include "Window.h"
#include "maxapi.h"

namespace Pigmo::Host {

namespace {

// The host's light scheme: grey panels, black text, an orange selection.
enum SchemeColor : ColorId {
    kBackground = 0,
    kText = 1,
    kLabelBackground = 7,
    kSecondaryText = 20,
    kPlotBackground = 39,
    kGridLine = 59,
    kCurve = 60,
    kSelection = 61,
};

COLORREF Scheme(ColorId id) {
    switch (id) {
        case kText:
            return RGB(0, 0, 0);
        case kLabelBackground:
            return RGB(230, 230, 230);
        case kSecondaryText:
            return RGB(72, 72, 72);
        case kPlotBackground:
            return RGB(250, 250, 250);
        case kGridLine:
            return RGB(204, 204, 204);
        case kCurve:
            return RGB(28, 96, 208);
        case kSelection:
            return RGB(255, 140, 0);
        // The panels' grey, also for the ids the host's own panels would use.
        default:
            return RGB(197, 197, 197);
    }
}

class ColorManager final : public IColorManager {
public:
    COLORREF GetColor(ColorId id) override { return Scheme(id); }
};

}  // namespace

void ApplySchemeToSystemColors() {
    struct Entry {
        int index;
        COLORREF color;
    };
    const Entry entries[] = {
        {COLOR_BTNFACE, Scheme(kBackground)},      {COLOR_BTNTEXT, Scheme(kText)},
        {COLOR_WINDOW, Scheme(kLabelBackground)},  {COLOR_WINDOWTEXT, Scheme(kText)},
        {COLOR_HIGHLIGHT, Scheme(kSelection)},     {COLOR_HIGHLIGHTTEXT, Scheme(kText)},
        {COLOR_BTNSHADOW, Scheme(kSecondaryText)}, {COLOR_BTNHIGHLIGHT, Scheme(kPlotBackground)},
        {COLOR_GRAYTEXT, RGB(120, 120, 120)},      {COLOR_INFOBK, Scheme(kLabelBackground)},
        {COLOR_INFOTEXT, Scheme(kText)},
    };
    int indexes[std::size(entries)];
    COLORREF colors[std::size(entries)];
    for (std::size_t i = 0; i < std::size(entries); ++i) {
        indexes[i] = entries[i].index;
        colors[i] = entries[i].color;
    }
    SetSysColors(static_cast<int>(std::size(entries)), indexes, colors);
}

}  // namespace Pigmo::Host

IColorManager* GetColorManager() {
    static Pigmo::Host::ColorManager manager;
    return &manager;
}
