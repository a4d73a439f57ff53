#include "PaletteList.h"

#include "Map.h"
#include "PaletteDiscovery.h"

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

}  // namespace Pigmo::ColorMap
