#pragma once

#include <max.h>

#include <memory>

namespace Pigmo::ColorMap {

inline constexpr Class_ID kColorMapClassID(0x52EA6278, 0xA76B89F1);

// Parameter ids of the map's block; scenes store the values under these numbers.
enum ParameterId : ParamID {
    colorBookFilePath = 0,
    selectedColorIndex = 1,
    currentColorName = 2,
    currentColorCategory = 3,
    currentColorSRGB = 4,
    currentColorLinearRGB = 5,
    currentColorLAB = 6,
    currentColorSpectralReflectance = 7,
    currentTags = 8,
};

// The one class descriptor of the library: what the Color Map is to the host and to mental ray.
class Descriptor final : public ClassDesc2,
                         public imrShaderTranslation_ClassInfo,
                         public IMtlRender_Compatibility_MtlBase {
public:
    Descriptor();

    int IsPublic() override { return 1; }
    void* Create(BOOL loading) override;
    const MCHAR* ClassName() override;
    SClass_ID SuperClassID() override { return TEXMAP_CLASS_ID; }
    Class_ID ClassID() override { return kColorMapClassID; }
    const MCHAR* Category() override;
    const MCHAR* InternalName() override { return "PigmoColorMap"; }
    HINSTANCE HInstance() override;

    unsigned int GetApplyTypes() override { return 0x00108042; }
    bool IsCompatibleWithRenderer(ClassDesc&) override { return true; }
    bool GetCustomMtlBrowserIcon(void*&, int&, int&, int&) override { return false; }

    // The description of the map's parameter block; null when it could not be allocated.
    ParamBlockDesc2* ParameterDescription() const { return parameters_.get(); }

private:
    // Lives as long as the descriptor, so unloading the library frees it.
    std::unique_ptr<ParamBlockDesc2> parameters_;
};

// The library's module handle, known from process attach on; null before.
HINSTANCE ModuleInstance();

// A string-table text in the shared buffer, or null when the module is not attached or there is
// no such string.
const MCHAR* GetString(int id);

}  // namespace Pigmo::ColorMap
