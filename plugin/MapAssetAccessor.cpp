#include "MapAssetAccessor.h"

#include "Map.h"

namespace Pigmo::ColorMap {

MaxSDK::AssetManagement::AssetUser MapAssetAccessor::GetAsset() const {
    return map_->GetParamBlock(0)->GetAssetUser(colorBookFilePath);
}

bool MapAssetAccessor::SetAsset(const MaxSDK::AssetManagement::AssetUser& asset) {
    map_->GetParamBlock(0)->SetValue(colorBookFilePath, 0, asset);
    return true;
}

}  // namespace Pigmo::ColorMap
