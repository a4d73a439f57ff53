#include "PaletteList.h"

#include <string>

#include "ColorBookReader.h"
#include "Map.h"
#include "PaletteDiscovery.h"
#include "Resource.h"

namespace Pigmo::ColorMap {

void LoadDefaultPalette(Map& map) {
    std::string folder;
    WIN32_FIND_DATAA found{};
    HANDLE search = INVALID_HANDLE_VALUE;
    if (FindFirstSystemPalette(folder, found, search)) {
        // The parameter's change notification reads the book and refreshes the rollout.
        map.GetParamBlock(0)->SetValue(colorBookFilePath, 0, (folder + found.cFileName).c_str());
        if (map.GetColorCount() > 0) map.SelectColor(0);
    }
    FindClose(search);
}

void AddPaletteToList(const char* path, HWND dialog) {
    std::string name;
    const char* ignored = nullptr;
    ReadPaletteName(path, name, &ignored);
    const HWND list = GetDlgItem(dialog, IDC_PALETTE_LIST);
    const LRESULT entry = SendMessageA(list, LB_ADDSTRING, 0, reinterpret_cast<LPARAM>(name.c_str()));
    SendMessageA(list, LB_SETITEMDATA, static_cast<WPARAM>(entry), reinterpret_cast<LPARAM>(path));
}

void PopulatePaletteList(Map& map, HWND dialog) {
    // The whole list first, so the strings the entries point at no longer move.
    std::vector<std::string>& paths = map.PalettePaths();
    paths = CollectPalettePaths();
    for (const std::string& path : paths) AddPaletteToList(path.c_str(), dialog);
    // Selecting this way sends no notification, so the map keeps its book.
    if (!paths.empty()) SendMessageA(GetDlgItem(dialog, IDC_PALETTE_LIST), LB_SETCURSEL, 0, 0);
}

}  // namespace Pigmo::ColorMap
