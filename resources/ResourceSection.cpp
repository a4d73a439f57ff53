// The library's resources, made known to the host for as long as the library is loaded, as a
// Windows module's resource section is.
#include <dlfcn.h>

#include "DialogTemplate.h"
#include "ModuleResources.h"
#include "StringTable.h"

namespace Pigmo {

namespace {

// The library's base address, which is also its instance handle.
HINSTANCE ThisModule() {
    Dl_info info{};
    return dladdr(reinterpret_cast<void*>(&ThisModule), &info) != 0 ? static_cast<HINSTANCE>(info.dli_fbase)
                                                                    : nullptr;
}

class ResourceSection {
public:
    ResourceSection() : module_(ThisModule()) {
        if (module_ != nullptr)
            Host::RegisterModuleResources(module_, {FindResourceDialog, FindResourceText});
    }
    ~ResourceSection() {
        if (module_ != nullptr) Host::UnregisterModuleResources(module_);
    }
    ResourceSection(const ResourceSection&) = delete;
    ResourceSection& operator=(const ResourceSection&) = delete;

private:
    HINSTANCE module_;
};

const ResourceSection section;

}  // namespace

}  // namespace Pigmo
