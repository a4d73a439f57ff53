#pragma once

#include <max.h>

namespace Pigmo::ColorMap {

class Map;

// The host's handle on the map's color book as an asset, for listing and retargeting scene files.
class MapAssetAccessor final : public MaxSDK::AssetManagement::IAssetAccessor {
public:
    explicit MapAssetAccessor(Map* map) : map_(map) {}
    MaxSDK::AssetManagement::AssetType GetAssetType() const override {
        return MaxSDK::AssetManagement::kBitmapAsset;
    }
    MaxSDK::AssetManagement::AssetUser GetAsset() const override;
    bool SetAsset(const MaxSDK::AssetManagement::AssetUser& asset) override;

private:
    Map* map_;
};

}  // namespace Pigmo::ColorMap
