#include "Map.h"

#include <algorithm>
#include <cstring>
#include <new>

#include "ColorBookReader.h"
#include "ColorMapPostLoadCallback.h"
#include "MapAssetAccessor.h"
#include "MapDlgProc.h"
#include "MessageBox.h"
#include "PaletteList.h"

namespace Pigmo::ColorMap {

namespace {

constexpr const char* kMessageCaption = "Pigmo Color Map";
constexpr const char* kPassThroughShader = "adsk_Utility_ColorPassThrough";

WORD SixteenBits(float channel) {
    return static_cast<WORD>(std::clamp(channel, 0.0f, 1.0f) * 65535.0);
}

}  // namespace

Map::Map(Descriptor* descriptor, bool loading) : descriptor_(descriptor) {
    descriptor_->MakeAutoParamBlocks(this);
    if (!loading) LoadDefaultPalette(*this);
}

Map::~Map() {
    DiscardTexHandle();
}

void Map::GetClassName(MSTR& name) {
    const MCHAR* className = descriptor_->ClassName();
    name = className != nullptr ? className : "";
}

Animatable* Map::SubAnim(int i) {
    return i == 0 ? pblock_ : nullptr;
}

MSTR Map::SubAnimName(int i) {
    return i == 0 ? "Parameters" : "";
}

RefTargetHandle Map::GetReference(int i) {
    return i == 0 ? pblock_ : nullptr;
}

void Map::SetReference(int i, RefTargetHandle target) {
    if (i == 0) pblock_ = static_cast<IParamBlock2*>(target);
}

IParamBlock2* Map::GetParamBlock(int i) {
    return i == 0 ? pblock_ : nullptr;
}

IParamBlock2* Map::GetParamBlockByID(BlockID id) {
    return pblock_ != nullptr && pblock_->ID() == id ? pblock_ : nullptr;
}

void* Map::GetInterface(ULONG id) {
    if (id == I_SUBMAP) return static_cast<ISubMap*>(this);
    return Texmap::GetInterface(id);
}

BaseInterface* Map::GetInterface(Interface_ID id) {
    if (id == IMRSHADERTRANSLATION_INTERFACE_ID) return static_cast<imrShaderTranslation*>(this);
    return Texmap::GetInterface(id);
}

Point3 Map::CurrentLinearRGB() {
    return pblock_->GetPoint3(currentColorLinearRGB);
}

AColor Map::EvalColor(ShadeContext& sc) {
    if (!sc.doMaps) return AColor(0.0f, 0.0f, 0.0f, 0.0f);
    if (gbufID != 0) sc.SetGBufferID(gbufID);
    const Point3 color = CurrentLinearRGB();
    return AColor(color.x, color.y, color.z, 1.0f);
}

float Map::EvalMono(ShadeContext& sc) {
    if (!sc.doMaps) return 0.0f;
    if (gbufID != 0) sc.SetGBufferID(gbufID);
    const Point3 color = CurrentLinearRGB();
    return (color.x + color.y + color.z) / 3.0f;
}

Point3 Map::EvalNormalPerturb(ShadeContext&) {
    return Point3(0.0f, 0.0f, 1.0f);
}

BITMAPINFO* Map::GetVPDisplayDIB(TimeValue t, TexHandleMaker& maker, Interval& valid, BOOL, BOOL forceW,
                                 BOOL forceH) {
    using namespace MaxSDK::AssetManagement;
    Interval scratch;
    Update(t, scratch);
    const int size = maker.Size();
    BitmapInfo info;
    info.SetType(BMM_TRUE_32);
    info.SetWidth(size);
    info.SetHeight(size);
    // One asset for every map's viewport image, asked for once it is known to be missing.
    static AssetUser temporaryAsset;
    if (temporaryAsset.GetId() == kInvalidId)
        temporaryAsset = IAssetManager::GetInstance()->GetAsset("pigmoTemp", kBitmapAsset);
    info.SetAsset(temporaryAsset);
    Bitmap* bitmap = TheManager->Create(&info);
    if (bitmap == nullptr) return nullptr;
    const Point3 color = CurrentLinearRGB();
    bitmap->Fill(BMM_Color_64{SixteenBits(color.x), SixteenBits(color.y), SixteenBits(color.z), 0xFFFF});
    BITMAPINFO* dib = maker.BitmapToDIB(bitmap, 0, forceW, forceH);
    bitmap->DeleteThis();
    valid.SetInfinite();
    return dib;
}

DWORD_PTR Map::GetActiveTexHandle(TimeValue t, TexHandleMaker& maker) {
    if (texHandle_ != nullptr && texHandleValid_.InInterval(t)) return texHandle_->GetHandle();
    DiscardTexHandle();
    BITMAPINFO* dib = GetVPDisplayDIB(t, maker, texHandleValid_, FALSE, FALSE, FALSE);
    if (dib == nullptr) return 0;
    texHandle_ = maker.CreateHandle(dib);
    return texHandle_ != nullptr ? texHandle_->GetHandle() : 0;
}

void Map::ActivateTexDisplay(BOOL on) {
    if (!on) DiscardTexHandle();
}

void Map::DiscardTexHandle() {
    if (texHandle_ != nullptr) texHandle_->DeleteThis();
    texHandle_ = nullptr;
}

RefTargetHandle Map::Clone(RemapDir& remap) {
    Map* clone = new Map(descriptor_, true);
    *static_cast<MtlBase*>(clone) = *static_cast<MtlBase*>(this);
    clone->ReplaceReference(0, remap.CloneRef(pblock_));
    clone->valid_.SetEmpty();
    BaseClone(this, clone, remap);
    // The records come along, so the clone needs no second read of the book.
    clone->records_ = records_;
    return clone;
}

void Map::Reset() {
    descriptor_->Reset(this, TRUE, TRUE);
}

void Map::Update(TimeValue t, Interval& valid) {
    if (!valid_.InInterval(t)) valid_.SetInfinite();
    valid &= valid_;
}

Interval Map::Validity(TimeValue t) {
    Interval scratch = FOREVER;
    Update(t, scratch);
    return valid_;
}

IOResult Map::Load(ILoad* iload) {
    iload->RegisterPostLoadCallback(new ColorMapPostLoadCallback(this));
    return Texmap::Load(iload);
}

ParamDlg* Map::CreateParamDlg(HWND hwMtlEdit, IMtlParams* imp) {
    IAutoMParamDlg* dialogs = descriptor_->CreateParamDlgs(hwMtlEdit, imp, this);
    // The host deletes the procedure when the rollout closes.
    ParamBlockDesc2* description = descriptor_->ParameterDescription();
    if (dialogs != nullptr && description != nullptr) description->SetUserDlgProc(new MapDlgProc(this));
    return dialogs;
}

void Map::EnumAuxFiles(MaxSDK::AssetManagement::AssetEnumCallback& callback, DWORD flags) {
    using namespace MaxSDK::AssetManagement;
    if ((flags & FILE_ENUM_CHECK_AWORK1) != 0 && TestAFlag(A_WORK1)) return;
    if ((flags & FILE_ENUM_ACCESSOR_INTERFACE) != 0) {
        MapAssetAccessor accessor(this);
        // The host asks by accessor only of callbacks that take declarations.
        if (accessor.GetAsset().GetId() != kInvalidId)
            static_cast<IEnumAuxAssetsCallback&>(callback).DeclareAsset(accessor);
    }
    Texmap::EnumAuxFiles(callback, flags);
}

imrShader* Map::GetMRShader(imrShaderCreation& shaderCreation) {
    return shaderCreation.CreateShader(kPassThroughShader, GetFullName());
}

void Map::TranslateParameters(imrTranslation&, imrShader* shader, TimeValue, Interval&) {
    if (shader == nullptr) return;
    IParamBlock2* parameters = shader->GetParametersParamBlock();
    if (parameters == nullptr || shader->GetReferenceTarget() == nullptr) return;
    const Point3 rgb = CurrentLinearRGB();
    const AColor color(rgb.x, rgb.y, rgb.z, 1.0f);
    for (int i = 0; i < parameters->NumParams(); ++i) {
        const ParamID id = parameters->IndextoID(i);
        if (std::strcmp(parameters->GetParamDef(id).int_name, "color") == 0) {
            parameters->SetValue(id, 0, color);
            return;
        }
    }
}

IColorInformation* Map::GetColor(unsigned int index) {
    return index < records_.size() ? &records_[index] : nullptr;
}

void Map::SelectColor(int index) {
    // An index beyond the book would copy a color that is not there.
    if (index < -1 || (index >= 0 && static_cast<std::size_t>(index) >= records_.size())) return;
    pblock_->SetValue(selectedColorIndex, 0, index);
    if (index == -1) {
        for (const ParamID id : {currentColorName, currentColorCategory, currentColorSRGB,
                                 currentColorLinearRGB, currentColorLAB})
            pblock_->Reset(id, -1, TRUE, TRUE);
        pblock_->SetCount(currentColorSpectralReflectance, 0);
        pblock_->SetCount(currentTags, 0);
        scrollPosition_ = 0;
    } else {
        const ColorInformation& color = records_[static_cast<std::size_t>(index)];
        const auto triple = [](const float* v) { return Point3(v[0], v[1], v[2]); };
        pblock_->SetValue(currentColorName, 0, color.GetName());
        pblock_->SetValue(currentColorCategory, 0, color.GetCategory());
        pblock_->SetValue(currentColorSRGB, 0, triple(color.GetSRGB()));
        pblock_->SetValue(currentColorLinearRGB, 0, triple(color.GetLinearRGB()));
        pblock_->SetValue(currentColorLAB, 0, triple(color.GetLab()));
        const int bands = color.GetSpectralReflectanceCount();
        pblock_->SetCount(currentColorSpectralReflectance, bands);
        for (int i = 0; i < bands; ++i)
            pblock_->SetValue(currentColorSpectralReflectance, 0, color.GetSpectralReflectance()[i], i);
        const int tags = color.GetTagCount();
        pblock_->SetCount(currentTags, tags);
        for (int i = 0; i < tags; ++i)
            pblock_->SetValue(currentTags, 0, color.GetTag(static_cast<unsigned int>(i)), i);
    }
    RefreshRollout(this);
}

int Map::GetSelectedIndex() {
    return pblock_->GetInt(selectedColorIndex);
}

void Map::ReloadColorBook() {
    records_.clear();
    const MCHAR* path = pblock_->GetStr(colorBookFilePath);
    if (path == nullptr || path[0] == 0) return;
    const char* error = nullptr;
    bool loaded = false;
    try {
        loaded = LoadColorBook(path, records_, &error);
    } catch (const std::bad_alloc&) {
        // Nothing may leave a host call by exception; what was read is let go.
        records_.clear();
        records_.shrink_to_fit();
        error = "Out of memory while reading the ColorBook file";
    }
    if (!loaded)
        MessageBoxA(GetCOREInterface()->GetMAXHWnd(), error != nullptr ? error : "", kMessageCaption, MB_OK);
}

void Map::SetColorBookPath(const char* path) {
    // The parameter's change notification reads the book and refreshes the rollout.
    pblock_->SetValue(colorBookFilePath, 0, path);
    if (!records_.empty()) SelectColor(0);
}

RefResult Map::NotifyRefChanged(Interval, RefTargetHandle target, PartID&, RefMessage message) {
    if (message == REFMSG_CHANGE) {
        valid_.SetEmpty();
        if (target == pblock_) {
            const ParamID changed = pblock_->LastNotifyParamID();
            // -1 stands for a change of every parameter.
            if (changed >= 0) DiscardTexHandle();
            if (changed == colorBookFilePath) {
                pblock_->SetValue(selectedColorIndex, 0, -1);
                scrollPosition_ = 0;
                ReloadColorBook();
                RefreshRollout(this);
            }
        }
    } else if (message == REFMSG_UV_SYM_CHANGE) {
        DiscardTexHandle();
    }
    return REF_SUCCEED;
}

const char* Map::GetName() const {
    return pblock_->GetStr(currentColorName);
}

const char* Map::GetCategory() const {
    return pblock_->GetStr(currentColorCategory);
}

namespace {

const float* IntoBuffer(float (&buffer)[3], const Point3& value) {
    buffer[0] = value.x;
    buffer[1] = value.y;
    buffer[2] = value.z;
    return buffer;
}

}  // namespace

const float* Map::GetSRGB() const {
    static float buffer[3];
    return IntoBuffer(buffer, pblock_->GetPoint3(currentColorSRGB));
}

const float* Map::GetLinearRGB() const {
    static float buffer[3];
    return IntoBuffer(buffer, pblock_->GetPoint3(currentColorLinearRGB));
}

const float* Map::GetLab() const {
    static float buffer[3];
    return IntoBuffer(buffer, pblock_->GetPoint3(currentColorLAB));
}

const float* Map::GetSpectralReflectance() const {
    static std::vector<float> buffer;
    const int count = pblock_->Count(currentColorSpectralReflectance);
    buffer.resize(static_cast<std::size_t>(std::max(count, 0)));
    for (int i = 0; i < count; ++i)
        buffer[static_cast<std::size_t>(i)] = pblock_->GetFloat(currentColorSpectralReflectance, 0, i);
    return buffer.empty() ? nullptr : buffer.data();
}

int Map::GetSpectralReflectanceCount() const {
    return pblock_->Count(currentColorSpectralReflectance);
}

const char* Map::GetTag(unsigned int index) const {
    if (index >= static_cast<unsigned int>(GetTagCount())) return nullptr;
    return pblock_->GetStr(currentTags, 0, static_cast<int>(index));
}

int Map::GetTagCount() const {
    return pblock_->Count(currentTags);
}

}  // namespace Pigmo::ColorMap
