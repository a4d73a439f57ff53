#include "ModuleResources.h"

#include <map>
#include <mutex>

namespace Pigmo::Host {

namespace {

struct Registry {
    std::mutex lock;
    std::map<HINSTANCE, ModuleResources> modules;
};

Registry& Modules() {
    static Registry registry;
    return registry;
}

bool Lookup(HINSTANCE module, ModuleResources& found) {
    Registry& registry = Modules();
    std::lock_guard guard(registry.lock);
    const auto entry = registry.modules.find(module);
    if (entry == registry.modules.end()) return false;
    found = entry->second;
    return true;
}

}  // namespace

void RegisterModuleResources(HINSTANCE module, ModuleResources resources) {
    Registry& registry = Modules();
    std::lock_guard guard(registry.lock);
    registry.modules[module] = resources;
}

void UnregisterModuleResources(HINSTANCE module) {
    Registry& registry = Modules();
    std::lock_guard guard(registry.lock);
    registry.modules.erase(module);
}

const DialogTemplate* FindDialogTemplate(HINSTANCE module, int id) {
    ModuleResources resources{};
    return Lookup(module, resources) && resources.dialog != nullptr ? resources.dialog(id) : nullptr;
}

const char* FindModuleText(HINSTANCE module, int id) {
    ModuleResources resources{};
    if (!Lookup(module, resources) || resources.text == nullptr || id < 0) return nullptr;
    return resources.text(static_cast<unsigned int>(id));
}

}  // namespace Pigmo::Host
