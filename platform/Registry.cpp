#include "Registry.h"

#include <dlfcn.h>
#include <sys/stat.h>

#include <algorithm>
#include <cctype>
#include <cstdlib>
#include <cstring>

namespace {

std::string Folded(std::string text) {
    for (char& c : text) c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
    return text;
}

bool IsFolder(const std::string& path) {
    struct stat status {};
    return stat(path.c_str(), &status) == 0 && S_ISDIR(status.st_mode);
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
    SetString(kSuiteUninstallKeyWow64, "InstallLocation", DefaultInstallLocation());
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
    if (const char* location = std::getenv("PIGMO_INSTALL_LOCATION"); location != nullptr && location[0] != 0)
        return location;
    // An installed copy keeps its data in <prefix>/share/pigmo beside <prefix>/bin and <prefix>/lib.
    Dl_info info{};
    if (dladdr(reinterpret_cast<void*>(&RegistryStore::DefaultInstallLocation), &info) != 0 &&
        info.dli_fname != nullptr) {
        std::string module = info.dli_fname;
        const std::size_t slash = module.rfind('/');
        if (slash != std::string::npos) {
            const std::string data = module.substr(0, slash + 1) + "../share/pigmo/";
            if (IsFolder(data + "Resources/System Palettes")) {
                if (char* resolved = realpath(data.c_str(), nullptr)) {
                    std::string location = std::string(resolved) + "/";
                    std::free(resolved);
                    return location;
                }
            }
        }
    }
    return PIGMO_BUILD_DATA_DIR;
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
