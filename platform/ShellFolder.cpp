#include "ShellFolder.h"

#include <pwd.h>
#include <unistd.h>

#include <cstdlib>
#include <cstring>
#include <string>

namespace {

std::string HomeFolder() {
    if (const char* home = std::getenv("HOME"); home != nullptr && home[0] == '/') return home;
    if (const passwd* entry = getpwuid(getuid()); entry != nullptr && entry->pw_dir != nullptr)
        return entry->pw_dir;
    return {};
}

}  // namespace

HRESULT SHGetFolderPathA(HWND, int folder, HANDLE, DWORD, LPSTR path) {
    if (path == nullptr || folder != CSIDL_APPDATA) return E_INVALIDARG;
    std::string result;
    // A relative XDG_DATA_HOME is invalid and must be ignored.
    if (const char* data = std::getenv("XDG_DATA_HOME"); data != nullptr && data[0] == '/') {
        result = data;
    } else {
        const std::string home = HomeFolder();
        if (home.empty()) return E_FAIL;
        result = home + "/.local/share";
    }
    while (result.size() > 1 && result.back() == '/') result.pop_back();
    if (result.size() >= static_cast<std::size_t>(MAX_PATH)) return E_FAIL;
    std::memcpy(path, result.c_str(), result.size() + 1);
    return S_OK;
}
