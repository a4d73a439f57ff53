#include <map>
#include <mutex>
#include <string>

#include "assetmanagement.h"

namespace MaxSDK::AssetManagement {

namespace {

// Gives each file name an id of its own, the same for as long as the process runs.
class AssetManager final : public IAssetManager {
public:
    AssetUser GetAsset(const MCHAR* file, AssetType type, bool) override {
        if (file == nullptr || file[0] == '\0') return AssetUser(kInvalidId, type, "");
        std::lock_guard guard(lock_);
        const auto [entry, added] = ids_.try_emplace(file, ids_.size() + 1);
        return AssetUser(AssetId(entry->second), type, file);
    }

private:
    std::mutex lock_;
    std::map<std::string, unsigned long long> ids_;
};

}  // namespace

IAssetManager* IAssetManager::GetInstance() {
    static AssetManager manager;
    return &manager;
}

}  // namespace MaxSDK::AssetManagement
