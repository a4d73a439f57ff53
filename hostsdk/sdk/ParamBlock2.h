#pragma once

#include <string>
#include <variant>
#include <vector>

#include "assetmanagement.h"
#include "iparamb2.h"

namespace Pigmo::Host {

// The most entries a table parameter holds; larger counts are refused.
inline constexpr int kMaxTableCount = 1 << 16;

// How a parameter's values are kept, whatever its declared type.
enum class ParamKind {
    Int,     // TYPE_INT, TYPE_BOOL
    Float,   // TYPE_FLOAT
    Vector,  // TYPE_POINT3, TYPE_RGBA: three floats, read and written as Point3 or Color
    Color4,  // TYPE_FRGBA
    Text,    // TYPE_STRING
    File,    // TYPE_FILENAME: the text and its asset
};

// The kind of a declared type, table flag aside; false for a type no block can keep.
bool KindOf(ParamType2 type, ParamKind& kind);
// The kind of a described parameter (descriptions hold known types only).
ParamKind KindOf(const ParamDef& def);

// One stored value: int, float, AColor (three-float kinds leave alpha 0), text or file asset, in
// the order of ParamKind.
using ParamValue = std::variant<int, float, AColor, std::string, MaxSDK::AssetManagement::AssetUser>;

// The asset a file name stands for; no asset for an empty name.
MaxSDK::AssetManagement::AssetUser FileAsset(const MCHAR* file, int assetType);

// The host's parameter block: one value per parameter, or a counted table of them, typed by the
// description. Every successful change tells the owner (REFMSG_CHANGE) after recording which
// parameter changed; a wrong id, type or table index changes nothing.
class ParamBlock2 final : public IParamBlock2 {
public:
    explicit ParamBlock2(ParamBlockDesc2* desc);

    BlockID ID() override { return desc_->ID; }
    ParamBlockDesc2* GetDesc() override { return desc_; }
    ReferenceMaker* GetOwner() override { return owner_; }
    int NumParams() override { return desc_->Count(); }
    ParamID IndextoID(int index) override { return desc_->IndextoID(index); }
    ParamDef& GetParamDef(ParamID id) override { return desc_->GetParamDef(id); }

    BOOL SetValue(ParamID id, TimeValue t, int v, int tabIndex = 0) override;
    BOOL SetValue(ParamID id, TimeValue t, float v, int tabIndex = 0) override;
    BOOL SetValue(ParamID id, TimeValue t, const Point3& v, int tabIndex = 0) override;
    BOOL SetValue(ParamID id, TimeValue t, const Color& v, int tabIndex = 0) override;
    BOOL SetValue(ParamID id, TimeValue t, const AColor& v, int tabIndex = 0) override;
    BOOL SetValue(ParamID id, TimeValue t, const MCHAR* v, int tabIndex = 0) override;
    BOOL SetValue(ParamID id, TimeValue t, const MaxSDK::AssetManagement::AssetUser& v, int tabIndex = 0) override;

    BOOL GetValue(ParamID id, TimeValue t, int& v, Interval& valid, int tabIndex = 0) override;
    BOOL GetValue(ParamID id, TimeValue t, float& v, Interval& valid, int tabIndex = 0) override;
    BOOL GetValue(ParamID id, TimeValue t, Point3& v, Interval& valid, int tabIndex = 0) override;
    BOOL GetValue(ParamID id, TimeValue t, Color& v, Interval& valid, int tabIndex = 0) override;
    BOOL GetValue(ParamID id, TimeValue t, AColor& v, Interval& valid, int tabIndex = 0) override;
    BOOL GetValue(ParamID id, TimeValue t, const MCHAR*& v, Interval& valid, int tabIndex = 0) override;
    const MaxSDK::AssetManagement::AssetUser& GetAssetUser(ParamID id, TimeValue t = 0, int tabIndex = 0) override;

    // The entries of a table; 0 for anything else.
    int Count(ParamID id) override;
    // Grows a table with default entries or shrinks it; returns the count it then has (unchanged when
    // refused: not a table, below 0 or above kMaxTableCount).
    int SetCount(ParamID id, int n) override;

    void ResetAll(BOOL updateUI = TRUE, BOOL callSetHandlers = TRUE) override;
    // A table with tabIndex -1 goes back to its initial count of defaults.
    void Reset(ParamID id, int tabIndex = -1, BOOL updateUI = TRUE, BOOL callSetHandlers = TRUE) override;
    ParamID LastNotifyParamID() override { return lastChanged_; }

    RefTargetHandle Clone(RemapDir& remap) override;

    // The stored values of parameter id, table entries in order; null for an unknown id.
    const std::vector<ParamValue>* Values(ParamID id) const;
    // Puts values in place without telling anyone, as a scene load does. False, and nothing changed,
    // for an unknown id, a value of another kind, or a count the parameter cannot have.
    bool Restore(ParamID id, std::vector<ParamValue> values);

    // Reference bookkeeping: the first maker to reference the block is its owner.
    void RefAdded(ReferenceMaker* maker);
    void RefDeleted(ReferenceMaker* maker);

private:
    RefResult NotifyRefChanged(Interval, RefTargetHandle, PartID&, RefMessage) override { return REF_SUCCEED; }

    // The value at tabIndex of parameter id when its kind is one of kinds; else null.
    ParamValue* Find(ParamID id, int tabIndex, std::initializer_list<ParamKind> kinds);
    ParamValue DefaultValue(const ParamDef& def) const;
    std::vector<ParamValue> InitialValues(const ParamDef& def) const;
    void Changed(ParamID id);

    ParamBlockDesc2* desc_;
    ReferenceMaker* owner_ = nullptr;
    std::vector<std::vector<ParamValue>> values_;  // in the description's order
    ParamID lastChanged_ = -1;
};

}  // namespace Pigmo::Host
