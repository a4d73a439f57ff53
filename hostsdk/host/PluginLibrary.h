#pragma once

#include <string>
#include <vector>

#include "iparamb2.h"

namespace Pigmo::Host {

// What LibVersion must answer: host release 13000, interface 35, SDK revision 0.
inline constexpr ULONG kPluginVersion = 0x32C82300;

// A plug-in library, loaded as the host loads one: dlopen, then LibVersion, LibNumberClasses and
// LibClassDesc. Unloaded when this object goes, so everything its classes made must go first.
class HostExport PluginLibrary {
public:
    // Throws std::runtime_error saying what is wrong: the loader's text, a missing entry point or
    // another version.
    explicit PluginLibrary(const std::string& path);
    ~PluginLibrary();
    PluginLibrary(const PluginLibrary&) = delete;
    PluginLibrary& operator=(const PluginLibrary&) = delete;

    // libpigmo.so in the folder of libpigmo-hostsdk.so: the two lie side by side, in the build tree
    // and when installed.
    static std::string DefaultPath();

    // The library's class descriptors, in its order.
    const std::vector<ClassDesc*>& Classes() const { return classes_; }
    // The class with that id and super class, when it describes its parameter blocks; else null.
    ClassDesc2* Find(Class_ID id, SClass_ID superClass) const;

private:
    void* handle_;
    std::vector<ClassDesc*> classes_;
};

}  // namespace Pigmo::Host
