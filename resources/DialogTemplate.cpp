#include "DialogTemplate.h"

#include <iterator>

#include "Resource.h"

namespace Pigmo {

namespace {

constexpr DWORD kLabel = WS_CHILD | WS_VISIBLE | WS_GROUP | SS_LEFT;
constexpr DWORD kControl = WS_CHILD | WS_VISIBLE | WS_TABSTOP;
constexpr DWORD kDisplay = kControl | WS_DISABLED;
constexpr DWORD kList = kControl | WS_BORDER | WS_VSCROLL | LBS_NOINTEGRALHEIGHT | LBS_NOTIFY;
constexpr DWORD kField = kControl | ES_READONLY | ES_AUTOHSCROLL;
constexpr int kNoId = -1;

// The Color Map's rollout, in dialog units.
constexpr DialogItemTemplate kRolloutItems[] = {
    {"Static", kNoId, "ColorBook File:", 5, 2, 48, 8, kLabel},
    {"Static", kNoId, "Select a Color from the ColorBook File:", 7, 78, 124, 8, kLabel},
    {"Static", kNoId, "Measured Spectral Reflectance:", 5, 300, 103, 8, kLabel},
    {"ColorPallette", IDC_COLOR_PALLETTE, "ColorPallette", 4, 88, 208, 119, kControl},
    {"ColorInformation", IDC_COLOR_INFORMATION, "ColorInfo", 80, 222, 132, 25, kDisplay},
    {"Static", kNoId, "Selected Color Information:", 5, 210, 89, 8, kLabel},
    {"SpectralChart", IDC_SPECTRAL_CHART, "Custom1", 3, 312, 209, 73, kDisplay},
    {"CustButton", IDC_COLORBOOK_BUTTON, "None", 4, 12, 207, 14, kControl},
    {"ColorSwatch", IDC_COLOR_SWATCH, "Custom1", 7, 224, 67, 69, kDisplay},
    {"ListBox", IDC_PALETTE_LIST, "", 4, 30, 207, 45, kList},
    {"Static", kNoId, "L*a*b*", 83, 249, 24, 8, kLabel},
    {"Edit", IDC_LAB_FIELD, "", 121, 249, 89, 12, kField},
    {"Static", kNoId, "sRGB", 83, 260, 18, 8, kLabel},
    {"Edit", IDC_SRGB_FIELD, "", 121, 260, 89, 12, kField},
    {"Static", kNoId, "Tags", 82, 283, 16, 8, kLabel},
    {"Edit", IDC_TAGS_FIELD, "", 121, 283, 89, 12, kField},
    {"Static", kNoId, "Linear RGB", 83, 272, 36, 8, kLabel},
    {"Edit", IDC_LINEAR_RGB_FIELD, "", 121, 272, 89, 12, kField},
};

constexpr DialogTemplate kRollout = {
    WS_CHILD | WS_SYSMENU | DS_FIXEDSYS | DS_SETFONT,
    0,
    217,
    405,
    "MS Shell Dlg",
    8,
    kRolloutItems,
    std::size(kRolloutItems),
};

}  // namespace

const DialogTemplate* FindResourceDialog(int id) {
    return id == IDD_COLORMAP_PARAMS ? &kRollout : nullptr;
}

}  // namespace Pigmo
