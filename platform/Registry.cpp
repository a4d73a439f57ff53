#include "Registry.h"

#include <dlfcn.h>
#include <limits.h>
#include <link.h>
#include <unistd.h>

#include <algorithm>
#include <cctype>
#include <cstdlib>
#include <cstring>

namespace {

std::string Folded(std::string text) {
    for (char& c : text) c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
    return text;
}

std::string RealPath(const std::string& path) {
    char* resolved = path.empty() ? nullptr : realpath(path.c_str(), nullptr);
    if (resolved == nullptr) return {};
    std::string result = resolved;
    std::free(resolved);
    return result;
}

// The file this code was loaded from: the shared library that holds it, or else the program.
std::string ModuleFile() {
    Dl_info info{};
    link_map* map = nullptr;
    if (dladdr1(reinterpret_cast<void*>(&ModuleFile), &info, reinterpret_cast<void**>(&map),
                RTLD_DL_LINKMAP) != 0 &&
        map != nullptr && map->l_name != nullptr && map->l_name[0] != 0)
        return map->l_name;
    // The program's own entry has no name, and dladdr's stand-in for it is argv[0], which anyone can fake.
    char path[PATH_MAX];
    const ssize_t length = readlink("/proc/self/exe", path, sizeof path);
    return length > 0 && static_cast<std::size_t>(length) < sizeof path ? std::string(path, length)
                                                                        : std::string();
}

// Open keys: a handle names a key path; the table owns the names.
struct KeyTable {
    std::mutex lock;
    std::map<std::uintptr_t, std::string> keys;
    std::uintptr_t lastHandle = 0;
};

KeyTable& Keys() {
    static KeyTable table;
    return table;
}

bool KeyPath(HKEY key, std::string& path) {
    if (key == HKEY_LOCAL_MACHINE) {
        path.clear();
        return true;
    }
    KeyTable& table = Keys();
    std::lock_guard guard(table.lock);
    const auto it = table.keys.find(reinterpret_cast<std::uintptr_t>(key));
    if (it == table.keys.end()) return false;
    path = it->second;
    return true;
}

}  // namespace

namespace Pigmo::Platform {

RegistryStore& RegistryStore::Instance() {
    static RegistryStore store;
    return store;
}

RegistryStore::RegistryStore() {
    Reset();
}

void RegistryStore::SetString(const std::string& subKey, const std::string& name, const std::string& value) {
    std::lock_guard guard(lock_);
    keys_[Folded(subKey)][Folded(name)] = value;
}

void RegistryStore::RemoveKey(const std::string& subKey) {
    const std::string key = Folded(subKey);
    std::lock_guard guard(lock_);
    std::erase_if(
        keys_, [&](const auto& entry) { return entry.first == key || entry.first.starts_with(key + "\\"); });
}

void RegistryStore::Clear() {
    std::lock_guard guard(lock_);
    keys_.clear();
}

void RegistryStore::Reset() {
    Clear();
    // Without a known location there is no entry, rather than one that searches the working folder.
    if (const std::string location = DefaultInstallLocation(); !location.empty())
        SetString(kSuiteUninstallKeyWow64, "InstallLocation", location);
}

bool RegistryStore::HasKey(const std::string& subKey) {
    const std::string key = Folded(subKey);
    std::lock_guard guard(lock_);
    if (key.empty()) return true;
    // A key exists when it holds values or has a subkey below it.
    if (keys_.contains(key)) return true;
    const auto below = keys_.lower_bound(key + "\\");
    return below != keys_.end() && below->first.starts_with(key + "\\");
}

bool RegistryStore::GetString(const std::string& subKey, const std::string& name, std::string& value) {
    std::lock_guard guard(lock_);
    const auto key = keys_.find(Folded(subKey));
    if (key == keys_.end()) return false;
    const auto entry = key->second.find(Folded(name));
    if (entry == key->second.end()) return false;
    value = entry->second;
    return true;
}

std::string RegistryStore::DefaultInstallLocation() {
    if (const char* location = std::getenv("PIGMO_INSTALL_LOCATION");
        location != nullptr && location[0] != 0) {
        std::string value = location;
        // The suite writes its value with the separator; people setting the variable often do not.
        if (value.back() != '/' && value.back() != '\\') value += '/';
        return value;
    }
    const std::string module = RealPath(ModuleFile());
    const std::size_t slash = module.rfind('/');
    if (slash == std::string::npos) return {};
    const std::string folder = module.substr(0, slash);
    const std::string build = RealPath(PIGMO_BUILD_DIR);
    if (!build.empty() && (folder == build || folder.starts_with(build + "/")))
        return build + "/share/pigmo/";
    // An installed copy keeps its data in <prefix>/share/pigmo beside <prefix>/bin and <prefix>/lib.
    const std::size_t parent = folder.rfind('/');
    if (parent == std::string::npos) return {};
    return folder.substr(0, parent) + "/share/pigmo/";
}

}  // namespace Pigmo::Platform

using Pigmo::Platform::RegistryStore;

LONG RegOpenKeyA(HKEY root, LPCSTR subKey, HKEY* result) {
    if (result == nullptr) return ERROR_INVALID_PARAMETER;
    std::string path;
    if (!KeyPath(root, path)) return ERROR_INVALID_HANDLE;
    if (subKey != nullptr && subKey[0] != 0) path = path.empty() ? subKey : path + "\\" + subKey;
    if (!RegistryStore::Instance().HasKey(path)) return ERROR_FILE_NOT_FOUND;
    KeyTable& table = Keys();
    std::lock_guard guard(table.lock);
    const std::uintptr_t handle = ++table.lastHandle;
    table.keys.emplace(handle, path);
    *result = reinterpret_cast<HKEY>(handle);
    return ERROR_SUCCESS;
}

LONG RegQueryValueExA(HKEY key, LPCSTR valueName, LPDWORD, LPDWORD type, LPBYTE data, LPDWORD dataSize) {
    std::string path;
    if (!KeyPath(key, path)) return ERROR_INVALID_HANDLE;
    if (data != nullptr && dataSize == nullptr) return ERROR_INVALID_PARAMETER;
    std::string value;
    if (!RegistryStore::Instance().GetString(path, valueName != nullptr ? valueName : "", value))
        return ERROR_FILE_NOT_FOUND;
    if (type != nullptr) *type = REG_SZ;
    const DWORD needed = static_cast<DWORD>(value.size() + 1);
    if (data == nullptr) {
        if (dataSize != nullptr) *dataSize = needed;
        return ERROR_SUCCESS;
    }
    if (*dataSize < needed) {
        *dataSize = needed;
        return ERROR_MORE_DATA;
    }
    std::memcpy(data, value.c_str(), needed);
    *dataSize = needed;
    return ERROR_SUCCESS;
}

LONG RegCloseKey(HKEY key) {
    if (key == HKEY_LOCAL_MACHINE) return ERROR_SUCCESS;
    KeyTable& table = Keys();
    std::lock_guard guard(table.lock);
    return table.keys.erase(reinterpret_cast<std::uintptr_t>(key)) == 1 ? ERROR_SUCCESS
                                                                        : ERROR_INVALID_HANDLE;
}
