#include "Settings.h"

#include <cstdlib>

#include "Registry.h"
#include "ShellFolder.h"

namespace Pigmo::Platform {

std::vector<std::string> UnusableSettings() {
    std::vector<std::string> problems;
    const char* install = std::getenv("PIGMO_INSTALL_LOCATION");
    const bool installGiven = install != nullptr && install[0] != 0;
    std::string location;
    if (RegistryStore::Instance().GetString(kSuiteUninstallKeyWow64, "InstallLocation", location) &&
        location.size() >= kInstallLocationCapacity) {
        problems.push_back(std::string(installGiven ? "PIGMO_INSTALL_LOCATION" : "the installation folder") +
                           " is " + std::to_string(location.size()) + " bytes long, more than the " +
                           std::to_string(kInstallLocationCapacity - 1) +
                           " the palette search takes: the system palettes are not listed");
    }
    const char* data = std::getenv("XDG_DATA_HOME");
    if (data != nullptr && data[0] != 0 && data[0] != '/')
        problems.emplace_back("XDG_DATA_HOME is not an absolute path and is ignored");
    char folder[MAX_PATH];
    if (SHGetFolderPathA(nullptr, CSIDL_APPDATA, nullptr, SHGFP_TYPE_CURRENT, folder) != S_OK) {
        const bool dataGiven = data != nullptr && data[0] == '/';
        problems.push_back(std::string(dataGiven ? "XDG_DATA_HOME" : "the home folder") +
                           " is missing or longer than the " + std::to_string(MAX_PATH - 1) +
                           " bytes the user palette folder takes: the user palettes are not listed");
    }
    return problems;
}

}  // namespace Pigmo::Platform
