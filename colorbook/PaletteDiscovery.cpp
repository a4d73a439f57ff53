#include "PaletteDiscovery.h"

#include "ColorBookReader.h"
#include "Registry.h"
#include "ShellFolder.h"

namespace Pigmo {

namespace {

constexpr const char* kSystemPaletteFolder = "Resources\\System Palettes\\";
constexpr const char* kUserPaletteFolder = "\\Pigmo\\Tintora\\User\\";
constexpr const char* kPalettePattern = "*.cxf";

// Appends folder + name for the found file and every further one, then closes the search.
void CollectSearch(const std::string& folder, WIN32_FIND_DATAA& found, HANDLE search,
                   std::vector<std::string>& paths) {
    if (search == INVALID_HANDLE_VALUE) return;
    do {
        paths.push_back(folder + found.cFileName);
    } while (FindNextFileA(search, &found));
    FindClose(search);
}

}  // namespace

bool FindFirstSystemPalette(std::string& folder, WIN32_FIND_DATAA& found, HANDLE& search) {
    HKEY key = nullptr;
    if (RegOpenKeyA(HKEY_LOCAL_MACHINE, Platform::kSuiteUninstallKeyWow64, &key) != ERROR_SUCCESS &&
        RegOpenKeyA(HKEY_LOCAL_MACHINE, Platform::kSuiteUninstallKey, &key) != ERROR_SUCCESS)
        return false;
    char location[Platform::kInstallLocationCapacity] = {};
    DWORD size = sizeof location;
    DWORD type = REG_SZ;
    if (RegQueryValueExA(key, "InstallLocation", nullptr, &type, reinterpret_cast<LPBYTE>(location), &size) !=
        ERROR_SUCCESS) {
        RegCloseKey(key);
        return false;
    }
    // No separator is added: the suite writes the value with its trailing one.
    folder = std::string(location) + kSystemPaletteFolder;
    search = FindFirstFileA((folder + kPalettePattern).c_str(), &found);
    RegCloseKey(key);
    return search != INVALID_HANDLE_VALUE;
}

bool FindFirstUserPalette(std::string& folder, WIN32_FIND_DATAA& found, HANDLE& search) {
    char appData[MAX_PATH] = {};
    if (SHGetFolderPathA(nullptr, CSIDL_APPDATA, nullptr, SHGFP_TYPE_CURRENT, appData) != S_OK) return false;
    folder = std::string(appData) + kUserPaletteFolder;
    search = FindFirstFileA((folder + kPalettePattern).c_str(), &found);
    return true;
}

const char* FileNameOf(const char* path) {
    if (path == nullptr) return nullptr;
    const char* name = path;
    for (const char* c = path; *c != 0; ++c)
        if (*c == '/' || *c == '\\') name = c + 1;
    return name;
}

std::vector<std::string> CollectPalettePaths(std::size_t* systemCount) {
    std::vector<std::string> paths;
    std::string folder;
    WIN32_FIND_DATAA found{};
    HANDLE search = INVALID_HANDLE_VALUE;
    if (FindFirstSystemPalette(folder, found, search)) CollectSearch(folder, found, search, paths);
    if (systemCount != nullptr) *systemCount = paths.size();
    if (FindFirstUserPalette(folder, found, search)) CollectSearch(folder, found, search, paths);
    return paths;
}

bool FindDefaultPalettePath(std::string& path) {
    std::string folder;
    WIN32_FIND_DATAA found{};
    HANDLE search = INVALID_HANDLE_VALUE;
    if (!FindFirstSystemPalette(folder, found, search)) return false;
    path = folder + found.cFileName;
    FindClose(search);
    return true;
}

std::string PaletteDisplayName(const char* path) {
    std::string name;
    const char* ignored = nullptr;
    ReadPaletteName(path, name, &ignored);
    return name;
}

}  // namespace Pigmo
