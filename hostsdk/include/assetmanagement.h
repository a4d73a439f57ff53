#pragma once

// Assets: the files a scene depends on, known to the host's asset manager by id.

#include "maxtypes.h"

namespace MaxSDK::AssetManagement {

enum AssetType { kOtherAsset = 0, kBitmapAsset = 1 };

class HostExport AssetId {
public:
    AssetId() = default;
    explicit AssetId(unsigned long long value) : value_(value) {}
    bool operator==(const AssetId& other) const = default;

private:
    unsigned long long value_ = 0;
};
inline const AssetId kInvalidId;

// One use of an asset: its id and what the asset manager knows of it.
class HostExport AssetUser {
public:
    AssetUser() = default;
    AssetUser(AssetId id, AssetType type, const MCHAR* file) : id_(id), type_(type), file_(file) {}
    const AssetId& GetId() const { return id_; }
    AssetType GetType() const { return type_; }
    const MSTR& GetFileName() const { return file_; }

private:
    AssetId id_;
    AssetType type_ = kOtherAsset;
    MSTR file_;
};

class HostExport IAssetManager {
public:
    virtual ~IAssetManager() = default;
    static IAssetManager* GetInstance();
    // The asset for a file name and type, made known on first request.
    virtual AssetUser GetAsset(const MCHAR* file, AssetType type, bool autoAcquire = true) = 0;
};

// How the host reaches an asset an object keeps, to list or retarget it.
class HostExport IAssetAccessor {
public:
    virtual ~IAssetAccessor() = default;
    virtual AssetType GetAssetType() const = 0;
    virtual AssetUser GetAsset() const = 0;
    virtual bool SetAsset(const AssetUser& asset) = 0;
};

class HostExport AssetEnumCallback {
public:
    virtual ~AssetEnumCallback() = default;
    virtual void RecordAsset(const AssetUser& asset) = 0;
};

// What an object declares its assets to when the host enumerates by accessor.
class HostExport IEnumAuxAssetsCallback : public AssetEnumCallback {
public:
    virtual void DeclareAsset(IAssetAccessor& accessor) = 0;
};

}  // namespace MaxSDK::AssetManagement

// EnumAuxFiles flags.
inline constexpr DWORD FILE_ENUM_CHECK_AWORK1 = 0x0800;
inline constexpr DWORD FILE_ENUM_ACCESSOR_INTERFACE = 0x4000;
