#include "MapDlgProc.h"

#include <cstdio>
#include <string>

#include "Map.h"
#include "PaletteDiscovery.h"
#include "PaletteList.h"
#include "Paths.h"
#include "Resource.h"
#include "Truncate.h"

namespace Pigmo::ColorMap {

namespace {

// One rollout at a time: the last one opened is the one the map refreshes.
HWND rolloutWindow = nullptr;
HWND toolTipWindow = nullptr;
// The text the tooltip points at, rebuilt for every request.
std::string toolTipText;

template <typename... Values>
std::string Format(const char* format, Values... values) {
    char text[128];
    std::snprintf(text, sizeof text, format, values...);
    return text;
}

void SetOwner(int id, const void* owner) {
    const HWND control = GetDlgItem(rolloutWindow, id);
    SetWindowLongPtrA(control, GWLP_USERDATA, reinterpret_cast<LONG_PTR>(owner));
    // The owner changes what the control shows, so it repaints at once.
    InvalidateRect(control, nullptr, FALSE);
}

void SetField(int id, const std::string& text) {
    SetWindowTextA(GetDlgItem(rolloutWindow, id), text.c_str());
}

// A tooltip over the rollout's own surface that names the current color.
void CreateToolTip(HWND rollout) {
    toolTipWindow = CreateWindowExA(0, TOOLTIPS_CLASSA, nullptr, WS_POPUP | TTS_NOPREFIX | TTS_ALWAYSTIP,
                                    CW_USEDEFAULT, CW_USEDEFAULT, CW_USEDEFAULT, CW_USEDEFAULT, nullptr,
                                    nullptr, ModuleInstance(), nullptr);
    SetWindowPos(toolTipWindow, HWND_TOPMOST, 0, 0, 0, 0, SWP_NOMOVE | SWP_NOSIZE | SWP_NOACTIVATE);
    TOOLINFOA tool{};
    tool.cbSize = TTTOOLINFOA_V2_SIZE;
    tool.uFlags = TTF_IDISHWND | TTF_SUBCLASS;
    tool.hwnd = rollout;
    tool.uId = reinterpret_cast<UINT_PTR>(rollout);
    tool.lpszText = LPSTR_TEXTCALLBACKA;
    SendMessageA(toolTipWindow, TTM_ADDTOOLA, 0, reinterpret_cast<LPARAM>(&tool));
}

// The swatch's color: each sRGB channel over 255 as a float, back to a byte rounded half up.
COLORREF SwatchColor(const Color& sRGB) {
    const auto byte = [](float channel) {
        const float fraction = static_cast<float>(channel / 255.0);
        return Truncate(fraction * 255.0 + 0.5) & 0xFF;
    };
    return RGB(byte(sRGB.r), byte(sRGB.g), byte(sRGB.b));
}

}  // namespace

void MapDlgProc::SetThing(ReferenceTarget* m) {
    map_ = static_cast<Map*>(m);
}

INT_PTR MapDlgProc::DlgProc(TimeValue, IParamMap2*, HWND hWnd, UINT msg, WPARAM wParam, LPARAM lParam) {
    switch (msg) {
        case WM_INITDIALOG:
            rolloutWindow = hWnd;
            RefreshRollout(map_);
            if (map_ != nullptr) PopulatePaletteList(*map_, hWnd);
            CreateToolTip(hWnd);
            return 0;
        case WM_DESTROY:
            if (rolloutWindow == hWnd) rolloutWindow = nullptr;
            // The tooltip goes with the rollout it describes.
            DestroyWindow(toolTipWindow);
            toolTipWindow = nullptr;
            return 0;
        case WM_NOTIFY: {
            auto* info = reinterpret_cast<NMTTDISPINFOA*>(lParam);
            if (info == nullptr || info->hdr.code != TTN_GETDISPINFOA || map_ == nullptr) return 0;
            toolTipText = std::string(map_->GetName()) + " (" + map_->GetCategory() + ")";
            info->lpszText = toolTipText.data();
            return 0;
        }
        case WM_COMMAND:
            if (LOWORD(wParam) == IDC_PALETTE_LIST && HIWORD(wParam) == LBN_SELCHANGE && map_ != nullptr) {
                const HWND list = GetDlgItem(hWnd, IDC_PALETTE_LIST);
                const LRESULT selection = SendMessageA(list, LB_GETCURSEL, 0, 0);
                if (selection == LB_ERR) return 0;
                const auto* path = reinterpret_cast<const char*>(
                    SendMessageA(list, LB_GETITEMDATA, static_cast<WPARAM>(selection), 0));
                if (path != nullptr && path != reinterpret_cast<const char*>(LB_ERR))
                    map_->SetColorBookPath(path);
            }
            return 0;
        default:
            return 0;
    }
}

void RefreshRollout(Map* map) {
    if (rolloutWindow == nullptr) return;
    SetOwner(IDC_COLOR_PALLETTE, map != nullptr ? static_cast<IColorPalletteUser*>(map) : nullptr);
    const IColorInformation* current =
        map != nullptr && map->GetSelectedIndex() != -1 ? static_cast<IColorInformation*>(map) : nullptr;
    SetOwner(IDC_COLOR_INFORMATION, current);
    SetOwner(IDC_SPECTRAL_CHART, current);
    if (map == nullptr) return;

    const float* lab = map->GetLab();
    SetField(IDC_LAB_FIELD, Format("%.1f, %.1f, %.1f", lab[0], lab[1], lab[2]));
    const float* sRGB = map->GetSRGB();
    SetField(IDC_SRGB_FIELD, Format("%.0f, %.0f, %.0f", sRGB[0], sRGB[1], sRGB[2]));
    const float* linear = map->GetLinearRGB();
    SetField(IDC_LINEAR_RGB_FIELD, Format("%.2f, %.2f, %.2f", linear[0], linear[1], linear[2]));
    std::string tags;
    for (int i = 0; i < map->GetTagCount(); ++i)
        tags += (i > 0 ? ", " : "") + std::string(map->GetTag(static_cast<unsigned int>(i)));
    SetField(IDC_TAGS_FIELD, tags);

    IParamBlock2* block = map->GetParamBlock(0);
    if (ICustButton* button = GetICustButton(GetDlgItem(rolloutWindow, IDC_COLORBOOK_BUTTON))) {
        const MCHAR* path = block->GetStr(colorBookFilePath);
        if (path != nullptr && path[0] != 0) {
            button->SetText(FileNameOf(path));
            // Shown with this system's separators; the parameter keeps the path as it was given.
            button->SetTooltip(TRUE, Platform::NativePath(path).c_str());
            // The file dialog opens at the current book next time.
            block->GetParamDef(colorBookFilePath).init_file = path;
        } else {
            button->SetText("None");
            button->SetTooltip(FALSE, "");
        }
        ReleaseICustButton(button);
    }
    if (IColorSwatch* swatch =
            GetIColorSwatch(GetDlgItem(rolloutWindow, IDC_COLOR_SWATCH),
                            SwatchColor(block->GetColor(currentColorSRGB)), "Current Color"))
        ReleaseIColorSwatch(swatch);
}

}  // namespace Pigmo::ColorMap
