#include "PluginLibrary.h"

#include <dlfcn.h>

#include <cstdio>
#include <stdexcept>

namespace Pigmo::Host {

namespace {

// Any one library's classes; more than this says the entry point answers nonsense.
constexpr int kMaxClasses = 1000;

std::string LoaderError() {
    const char* text = dlerror();
    return text != nullptr ? text : "unknown error";
}

template <class Function>
Function EntryPoint(void* handle, const std::string& path, const char* name) {
    dlerror();
    void* symbol = dlsym(handle, name);
    if (symbol == nullptr) throw std::runtime_error(path + ": not a plug-in of this host (no entry point " + name + ")");
    return reinterpret_cast<Function>(symbol);
}

std::string Hex(ULONG value) {
    char text[24];
    std::snprintf(text, sizeof text, "0x%08lX", value);
    return text;
}

}  // namespace

PluginLibrary::PluginLibrary(const std::string& path) : handle_(dlopen(path.c_str(), RTLD_NOW | RTLD_LOCAL)) {
    if (handle_ == nullptr) throw std::runtime_error("cannot load the plug-in: " + LoaderError());
    try {
        const ULONG version = EntryPoint<ULONG (*)()>(handle_, path, "LibVersion")();
        if (version != kPluginVersion)
            throw std::runtime_error(path + ": plug-in version " + Hex(version) + ", but this host loads version " +
                                     Hex(kPluginVersion));
        const int count = EntryPoint<int (*)()>(handle_, path, "LibNumberClasses")();
        if (count < 0 || count > kMaxClasses)
            throw std::runtime_error(path + ": LibNumberClasses says " + std::to_string(count));
        const auto classDesc = EntryPoint<ClassDesc* (*)(int)>(handle_, path, "LibClassDesc");
        for (int i = 0; i < count; ++i)
            if (ClassDesc* cd = classDesc(i)) classes_.push_back(cd);
    } catch (...) {
        dlclose(handle_);
        throw;
    }
}

PluginLibrary::~PluginLibrary() {
    dlclose(handle_);
}

std::string PluginLibrary::DefaultPath() {
    Dl_info self{};
    if (dladdr(reinterpret_cast<void*>(&PluginLibrary::DefaultPath), &self) == 0 || self.dli_fname == nullptr)
        return "libpigmo.so";
    const std::string library = self.dli_fname;
    const std::size_t slash = library.rfind('/');
    return slash == std::string::npos ? "libpigmo.so" : library.substr(0, slash + 1) + "libpigmo.so";
}

ClassDesc2* PluginLibrary::Find(Class_ID id, SClass_ID superClass) const {
    for (ClassDesc* cd : classes_)
        if (cd->ClassID() == id && cd->SuperClassID() == superClass) return dynamic_cast<ClassDesc2*>(cd);
    return nullptr;
}

}  // namespace Pigmo::Host
