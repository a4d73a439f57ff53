#include "ParamBlock2.h"

#include <algorithm>
#include <cmath>

using MaxSDK::AssetManagement::AssetType;
using MaxSDK::AssetManagement::AssetUser;

namespace Pigmo::Host {

namespace {

// Where a kind's values sit in ParamValue.
std::size_t Alternative(ParamKind kind) {
    switch (kind) {
        case ParamKind::Int:
            return 0;
        case ParamKind::Float:
            return 1;
        case ParamKind::Vector:
        case ParamKind::Color4:
            return 2;
        case ParamKind::Text:
            return 3;
        case ParamKind::File:
            return 4;
    }
    return 0;
}

bool IsTable(const ParamDef& def) {
    return (def.type & TYPE_TAB) != 0;
}

// Parameters keep finite numbers only, so whatever reads them (shading, scenes) never meets NaN.
bool Finite(std::initializer_list<float> values) {
    return std::all_of(values.begin(), values.end(), [](float v) { return std::isfinite(v); });
}

}  // namespace

bool KindOf(ParamType2 type, ParamKind& kind) {
    switch (type & ~TYPE_TAB) {
        case TYPE_INT:
        case TYPE_BOOL:
            kind = ParamKind::Int;
            return true;
        case TYPE_FLOAT:
            kind = ParamKind::Float;
            return true;
        case TYPE_POINT3:
        case TYPE_RGBA:
            kind = ParamKind::Vector;
            return true;
        case TYPE_FRGBA:
            kind = ParamKind::Color4;
            return true;
        case TYPE_STRING:
            kind = ParamKind::Text;
            return true;
        case TYPE_FILENAME:
            kind = ParamKind::File;
            return true;
        default:
            return false;
    }
}

ParamKind KindOf(const ParamDef& def) {
    ParamKind kind = ParamKind::Int;
    KindOf(def.type, kind);
    return kind;
}

AssetUser FileAsset(const MCHAR* file, int assetType) {
    const auto type = static_cast<AssetType>(assetType);
    if (file == nullptr || file[0] == '\0') return AssetUser(MaxSDK::AssetManagement::kInvalidId, type, "");
    return MaxSDK::AssetManagement::IAssetManager::GetInstance()->GetAsset(file, type);
}

ParamBlock2::ParamBlock2(ParamBlockDesc2* desc) : desc_(desc) {
    values_.reserve(static_cast<std::size_t>(desc_->Count()));
    for (int i = 0; i < desc_->Count(); ++i) values_.push_back(InitialValues(desc_->paramdef(i)));
}

ParamValue ParamBlock2::DefaultValue(const ParamDef& def) const {
    switch (KindOf(def)) {
        case ParamKind::Int:
            return ParamValue(std::in_place_type<int>, def.def_i);
        case ParamKind::Float:
            return ParamValue(std::in_place_type<float>, def.def_f);
        case ParamKind::Vector:
            return AColor(def.def_c.r, def.def_c.g, def.def_c.b, 0.0f);
        case ParamKind::Color4:
            return def.def_c;
        case ParamKind::Text:
            return std::string(def.def_s.data());
        case ParamKind::File:
            return FileAsset(def.def_s, def.asset_type);
    }
    return 0;
}

std::vector<ParamValue> ParamBlock2::InitialValues(const ParamDef& def) const {
    return std::vector<ParamValue>(IsTable(def) ? static_cast<std::size_t>(def.tab_size) : 1u,
                                   DefaultValue(def));
}

ParamValue* ParamBlock2::Find(ParamID id, int tabIndex, std::initializer_list<ParamKind> kinds) {
    const int index = desc_->IDtoIndex(id);
    if (index < 0) return nullptr;
    const ParamDef& def = desc_->paramdef(index);
    if (std::find(kinds.begin(), kinds.end(), KindOf(def)) == kinds.end()) return nullptr;
    std::vector<ParamValue>& values = values_[static_cast<std::size_t>(index)];
    if (tabIndex < 0 || static_cast<std::size_t>(tabIndex) >= values.size() ||
        (!IsTable(def) && tabIndex != 0))
        return nullptr;
    return &values[static_cast<std::size_t>(tabIndex)];
}

void ParamBlock2::Changed(ParamID id) {
    lastChanged_ = id;
    NotifyDependents(FOREVER, PART_ALL, REFMSG_CHANGE);
}

BOOL ParamBlock2::SetValue(ParamID id, TimeValue, int v, int tabIndex) {
    ParamValue* value = Find(id, tabIndex, {ParamKind::Int});
    if (value == nullptr) return FALSE;
    *value = v;
    Changed(id);
    return TRUE;
}

BOOL ParamBlock2::SetValue(ParamID id, TimeValue, float v, int tabIndex) {
    ParamValue* value = Find(id, tabIndex, {ParamKind::Float});
    if (value == nullptr || !Finite({v})) return FALSE;
    *value = v;
    Changed(id);
    return TRUE;
}

BOOL ParamBlock2::SetValue(ParamID id, TimeValue t, const Point3& v, int tabIndex) {
    return SetValue(id, t, Color(v), tabIndex);
}

BOOL ParamBlock2::SetValue(ParamID id, TimeValue, const Color& v, int tabIndex) {
    ParamValue* value = Find(id, tabIndex, {ParamKind::Vector});
    if (value == nullptr || !Finite({v.r, v.g, v.b})) return FALSE;
    *value = AColor(v.r, v.g, v.b, 0.0f);
    Changed(id);
    return TRUE;
}

BOOL ParamBlock2::SetValue(ParamID id, TimeValue, const AColor& v, int tabIndex) {
    ParamValue* value = Find(id, tabIndex, {ParamKind::Color4});
    if (value == nullptr || !Finite({v.r, v.g, v.b, v.a})) return FALSE;
    *value = v;
    Changed(id);
    return TRUE;
}

BOOL ParamBlock2::SetValue(ParamID id, TimeValue, const MCHAR* v, int tabIndex) {
    ParamValue* value = Find(id, tabIndex, {ParamKind::Text, ParamKind::File});
    if (value == nullptr) return FALSE;
    // Copied first: v may point into the value it replaces.
    std::string text = v != nullptr ? v : "";
    if (std::holds_alternative<std::string>(*value))
        *value = std::move(text);
    else
        *value = FileAsset(text.c_str(), GetParamDef(id).asset_type);
    Changed(id);
    return TRUE;
}

BOOL ParamBlock2::SetValue(ParamID id, TimeValue, const AssetUser& v, int tabIndex) {
    ParamValue* value = Find(id, tabIndex, {ParamKind::File});
    if (value == nullptr) return FALSE;
    *value = v;
    Changed(id);
    return TRUE;
}

BOOL ParamBlock2::GetValue(ParamID id, TimeValue, int& v, Interval&, int tabIndex) {
    const ParamValue* value = Find(id, tabIndex, {ParamKind::Int});
    if (value == nullptr) return FALSE;
    v = std::get<int>(*value);
    return TRUE;
}

BOOL ParamBlock2::GetValue(ParamID id, TimeValue, float& v, Interval&, int tabIndex) {
    const ParamValue* value = Find(id, tabIndex, {ParamKind::Float});
    if (value == nullptr) return FALSE;
    v = std::get<float>(*value);
    return TRUE;
}

BOOL ParamBlock2::GetValue(ParamID id, TimeValue t, Point3& v, Interval& valid, int tabIndex) {
    Color color;
    if (!GetValue(id, t, color, valid, tabIndex)) return FALSE;
    v = Point3(color.r, color.g, color.b);
    return TRUE;
}

BOOL ParamBlock2::GetValue(ParamID id, TimeValue, Color& v, Interval&, int tabIndex) {
    const ParamValue* value = Find(id, tabIndex, {ParamKind::Vector});
    if (value == nullptr) return FALSE;
    const AColor& stored = std::get<AColor>(*value);
    v = Color(stored.r, stored.g, stored.b);
    return TRUE;
}

BOOL ParamBlock2::GetValue(ParamID id, TimeValue, AColor& v, Interval&, int tabIndex) {
    const ParamValue* value = Find(id, tabIndex, {ParamKind::Color4});
    if (value == nullptr) return FALSE;
    v = std::get<AColor>(*value);
    return TRUE;
}

BOOL ParamBlock2::GetValue(ParamID id, TimeValue, const MCHAR*& v, Interval&, int tabIndex) {
    const ParamValue* value = Find(id, tabIndex, {ParamKind::Text, ParamKind::File});
    if (value == nullptr) return FALSE;
    v = std::holds_alternative<std::string>(*value) ? std::get<std::string>(*value).c_str()
                                                    : std::get<AssetUser>(*value).GetFileName().data();
    return TRUE;
}

const AssetUser& ParamBlock2::GetAssetUser(ParamID id, TimeValue, int tabIndex) {
    static const AssetUser none;
    const ParamValue* value = Find(id, tabIndex, {ParamKind::File});
    return value != nullptr ? std::get<AssetUser>(*value) : none;
}

int ParamBlock2::Count(ParamID id) {
    const int index = desc_->IDtoIndex(id);
    if (index < 0 || !IsTable(desc_->paramdef(index))) return 0;
    return static_cast<int>(values_[static_cast<std::size_t>(index)].size());
}

int ParamBlock2::SetCount(ParamID id, int n) {
    const int index = desc_->IDtoIndex(id);
    if (index < 0 || !IsTable(desc_->paramdef(index)) || n < 0 || n > kMaxTableCount) return Count(id);
    values_[static_cast<std::size_t>(index)].resize(static_cast<std::size_t>(n),
                                                    DefaultValue(desc_->paramdef(index)));
    Changed(id);
    return n;
}

void ParamBlock2::ResetAll(BOOL, BOOL) {
    for (int i = 0; i < desc_->Count(); ++i)
        values_[static_cast<std::size_t>(i)] = InitialValues(desc_->paramdef(i));
    // One message for the lot: -1 says every parameter changed.
    Changed(-1);
}

void ParamBlock2::Reset(ParamID id, int tabIndex, BOOL, BOOL) {
    const int index = desc_->IDtoIndex(id);
    if (index < 0) return;
    const ParamDef& def = desc_->paramdef(index);
    std::vector<ParamValue>& values = values_[static_cast<std::size_t>(index)];
    if (tabIndex == -1)
        values = InitialValues(def);
    else if (tabIndex >= 0 && static_cast<std::size_t>(tabIndex) < values.size() &&
             (IsTable(def) || tabIndex == 0))
        values[static_cast<std::size_t>(tabIndex)] = DefaultValue(def);
    else
        return;
    Changed(id);
}

RefTargetHandle ParamBlock2::Clone(RemapDir&) {
    auto* clone = new ParamBlock2(desc_);
    clone->values_ = values_;
    return clone;
}

const std::vector<ParamValue>* ParamBlock2::Values(ParamID id) const {
    const int index = desc_->IDtoIndex(id);
    return index < 0 ? nullptr : &values_[static_cast<std::size_t>(index)];
}

bool ParamBlock2::Restore(ParamID id, std::vector<ParamValue> values) {
    const int index = desc_->IDtoIndex(id);
    if (index < 0) return false;
    const ParamDef& def = desc_->paramdef(index);
    const bool countFits =
        IsTable(def) ? values.size() <= static_cast<std::size_t>(kMaxTableCount) : values.size() == 1;
    const std::size_t alternative = Alternative(KindOf(def));
    if (!countFits || std::any_of(values.begin(), values.end(),
                                  [&](const ParamValue& value) { return value.index() != alternative; }))
        return false;
    values_[static_cast<std::size_t>(index)] = std::move(values);
    return true;
}

void ParamBlock2::RefAdded(ReferenceMaker* maker) {
    if (owner_ == nullptr) owner_ = maker;
}

void ParamBlock2::RefDeleted(ReferenceMaker* maker) {
    if (owner_ == maker) owner_ = nullptr;
}

}  // namespace Pigmo::Host

int IParamBlock2::GetInt(ParamID id, TimeValue t, int tabIndex) {
    int value = 0;
    Interval valid = FOREVER;
    return GetValue(id, t, value, valid, tabIndex) ? value : 0;
}

float IParamBlock2::GetFloat(ParamID id, TimeValue t, int tabIndex) {
    float value = 0.0f;
    Interval valid = FOREVER;
    return GetValue(id, t, value, valid, tabIndex) ? value : 0.0f;
}

Point3 IParamBlock2::GetPoint3(ParamID id, TimeValue t, int tabIndex) {
    Point3 value;
    Interval valid = FOREVER;
    return GetValue(id, t, value, valid, tabIndex) ? value : Point3();
}

Color IParamBlock2::GetColor(ParamID id, TimeValue t, int tabIndex) {
    Color value;
    Interval valid = FOREVER;
    return GetValue(id, t, value, valid, tabIndex) ? value : Color();
}

const MCHAR* IParamBlock2::GetStr(ParamID id, TimeValue t, int tabIndex) {
    const MCHAR* value = nullptr;
    Interval valid = FOREVER;
    return GetValue(id, t, value, valid, tabIndex) ? value : "";
}
