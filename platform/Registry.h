#pragma once

#include <map>
#include <mutex>
#include <string>

#include "WinTypes.h"

inline HKEY const HKEY_LOCAL_MACHINE = reinterpret_cast<HKEY>(std::uintptr_t{0x80000002});
inline constexpr DWORD REG_SZ = 1;

// Registry functions over the in-process store below. Key and value names ignore ASCII case.
LONG RegOpenKeyA(HKEY root, LPCSTR subKey, HKEY* result);
LONG RegQueryValueExA(HKEY key, LPCSTR valueName, LPDWORD reserved, LPDWORD type, LPBYTE data,
                      LPDWORD dataSize);
LONG RegCloseKey(HKEY key);

namespace Pigmo::Platform {

// Uninstall entry of the companion suite: the 32-bit view on 64-bit Windows first, then the native one.
inline constexpr const char* kSuiteUninstallKeyWow64 =
    "Software\\Wow6432Node\\Microsoft\\Windows\\CurrentVersion\\Uninstall\\Kromalo Photo_is1";
inline constexpr const char* kSuiteUninstallKey =
    "Software\\Microsoft\\Windows\\CurrentVersion\\Uninstall\\Kromalo Photo_is1";
// Bytes its readers give the entry's "InstallLocation", terminator included.
inline constexpr DWORD kInstallLocationCapacity = 512;

// The in-process registry: string values under HKEY_LOCAL_MACHINE. It starts with the suite's
// uninstall entry (under kSuiteUninstallKeyWow64) whose "InstallLocation" is the data folder of
// this installation, or of the build tree when run uninstalled; PIGMO_INSTALL_LOCATION overrides it.
class RegistryStore {
public:
    static RegistryStore& Instance();

    void SetString(const std::string& subKey, const std::string& name, const std::string& value);
    void RemoveKey(const std::string& subKey);
    // Empties the store; Reset brings back the initial contents.
    void Clear();
    void Reset();

    bool HasKey(const std::string& subKey);
    bool GetString(const std::string& subKey, const std::string& name, std::string& value);

    // "InstallLocation" as the store starts with it, ending with a separator: PIGMO_INSTALL_LOCATION
    // when set, else the data folder of the installation this code was loaded from (a build tree's
    // own copy when it runs from a build tree); empty when neither is known.
    static std::string DefaultInstallLocation();

private:
    RegistryStore();

    std::mutex lock_;
    std::map<std::string, std::map<std::string, std::string>> keys_;
};

}  // namespace Pigmo::Platform
