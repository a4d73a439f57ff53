// The palette part of the C interface: a snapshot of the palettes found, as the palette list shows them.
#include <pigmo/bp.h>

#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include "ColorBookReader.h"
#include "PaletteDiscovery.h"
#include "Paths.h"

struct BPPaletteList {
    struct Entry {
        std::string name;
        std::string path;
        bool user;
    };
    std::vector<Entry> entries;
};

namespace {

const BPPaletteList::Entry* EntryAt(const BPPaletteList* list, int index) {
    if (list == nullptr || index < 0 || static_cast<size_t>(index) >= list->entries.size()) return nullptr;
    return &list->entries[static_cast<size_t>(index)];
}

}  // namespace

extern "C" {

BPPaletteList* BPPaletteListFind(void) {
    try {
        auto list = std::make_unique<BPPaletteList>();
        size_t systemCount = 0;
        // Reading names goes through the reader's shared buffers.
        std::lock_guard guard(Pigmo::ColorBookReaderLock());
        const std::vector<std::string> paths = Pigmo::CollectPalettePaths(&systemCount);
        for (size_t i = 0; i < paths.size(); ++i)
            list->entries.push_back({Pigmo::PaletteDisplayName(paths[i].c_str()),
                                     Pigmo::Platform::NativePath(paths[i]), i >= systemCount});
        return list.release();
    } catch (...) {
        return nullptr;
    }
}

void BPPaletteListFree(BPPaletteList* list) {
    delete list;
}

int BPPaletteListGetCount(const BPPaletteList* list) {
    return list != nullptr ? static_cast<int>(list->entries.size()) : 0;
}

const char* BPPaletteListGetName(const BPPaletteList* list, int index) {
    const BPPaletteList::Entry* entry = EntryAt(list, index);
    return entry != nullptr ? entry->name.c_str() : nullptr;
}

const char* BPPaletteListGetPath(const BPPaletteList* list, int index) {
    const BPPaletteList::Entry* entry = EntryAt(list, index);
    return entry != nullptr ? entry->path.c_str() : nullptr;
}

int BPPaletteListIsUser(const BPPaletteList* list, int index) {
    const BPPaletteList::Entry* entry = EntryAt(list, index);
    return entry != nullptr ? static_cast<int>(entry->user) : -1;
}

}  // extern "C"
