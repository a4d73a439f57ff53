#pragma once

#include <max.h>

#include <string>
#include <vector>

#include "ColorInformation.h"
#include "Descriptor.h"
#include "IColorPalletteUser.h"

namespace Pigmo::ColorMap {

// The Color Map texture: shades every point with the color picked from its color book. The pick is
// copied into the parameter block, so a saved scene renders it without the book.
class Map final : public Texmap,
                  public imrShaderTranslation,
                  public IColorPalletteUser,
                  public IColorInformation {
public:
    // A map being loaded from a scene chooses no default book; its post-load callback reads the book.
    Map(Descriptor* descriptor, bool loading);
    ~Map() override;

    Class_ID ClassID() override { return kColorMapClassID; }
    SClass_ID SuperClassID() override { return TEXMAP_CLASS_ID; }
    void GetClassName(MSTR& name) override;

    int NumSubs() override { return 1; }
    Animatable* SubAnim(int i) override;
    MSTR SubAnimName(int i) override;
    int NumRefs() override { return 1; }
    RefTargetHandle GetReference(int i) override;
    int NumParamBlocks() override { return 1; }
    IParamBlock2* GetParamBlock(int i) override;
    IParamBlock2* GetParamBlockByID(BlockID id) override;

    void* GetInterface(ULONG id) override;
    BaseInterface* GetInterface(Interface_ID id) override;

    AColor EvalColor(ShadeContext& sc) override;
    float EvalMono(ShadeContext& sc) override;
    Point3 EvalNormalPerturb(ShadeContext& sc) override;
    void GetUVTransform(Matrix3& uvtrans) override { uvtrans.IdentityMatrix(); }
    int GetTextureTiling() override { return U_WRAP | V_WRAP; }

    BITMAPINFO* GetVPDisplayDIB(TimeValue t, TexHandleMaker& maker, Interval& valid, BOOL mono, BOOL forceW,
                                BOOL forceH) override;
    DWORD_PTR GetActiveTexHandle(TimeValue t, TexHandleMaker& maker) override;
    void ActivateTexDisplay(BOOL on) override;

    RefTargetHandle Clone(RemapDir& remap) override;
    void Reset() override;
    void Update(TimeValue t, Interval& valid) override;
    Interval Validity(TimeValue t) override;
    IOResult Load(ILoad* iload) override;
    ParamDlg* CreateParamDlg(HWND hwMtlEdit, IMtlParams* imp) override;
    void EnumAuxFiles(MaxSDK::AssetManagement::AssetEnumCallback& callback, DWORD flags) override;

    // mental ray
    imrShader* GetMRShader(imrShaderCreation& shaderCreation) override;
    void ReleaseMRShader() override {}
    bool NeedsAutomaticParamBlock2Translation() override { return false; }
    void TranslateParameters(imrTranslation& translation, imrShader* shader, TimeValue t,
                             Interval& valid) override;

    // The book, the pick and the scroll position, for the palette control.
    unsigned int GetColorCount() override { return static_cast<unsigned int>(records_.size()); }
    IColorInformation* GetColor(unsigned int index) override;
    void SelectColor(int index) override;
    int GetSelectedIndex() override;
    int SetScrollPosition(int index) override { return scrollPosition_ = index; }
    int GetScrollPosition() override { return scrollPosition_; }

    // The current color, read from the parameters. The triples and the curve come back in buffers
    // shared by all maps, valid until the next call of the same operation.
    const char* GetName() const override;
    const char* GetCategory() const override;
    const float* GetSRGB() const override;
    const float* GetLinearRGB() const override;
    const float* GetLab() const override;
    const float* GetSpectralReflectance() const override;
    int GetSpectralReflectanceCount() const override;
    const char* GetTag(unsigned int index) const override;
    int GetTagCount() const override;

    // Reads the book parameter 0 names; a book that cannot be read is reported in a message box.
    void ReloadColorBook();
    // Takes another book, as the editor's palette list does, and picks its first color.
    void SetColorBookPath(const char* path);
    // The full paths behind the editor's palette list, in list order.
    std::vector<std::string>& PalettePaths() { return palettePaths_; }

protected:
    void SetReference(int i, RefTargetHandle target) override;

private:
    RefResult NotifyRefChanged(Interval changeInterval, RefTargetHandle target, PartID& part,
                               RefMessage message) override;
    void DiscardTexHandle();
    Point3 CurrentLinearRGB();

    Descriptor* descriptor_;
    IParamBlock2* pblock_ = nullptr;
    TexHandle* texHandle_ = nullptr;
    Interval texHandleValid_;
    Interval valid_;
    std::vector<std::string> palettePaths_;
    std::vector<ColorInformation> records_;
    int scrollPosition_ = 0;
};

}  // namespace Pigmo::ColorMap
