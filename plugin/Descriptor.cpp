#include "Descriptor.h"

#include <new>

#include "Map.h"
#include "Resource.h"

namespace Pigmo::ColorMap {

namespace {

// The nine parameters, as the host's tagged list. Parameters 2 to 8 copy the picked color, so a
// saved scene renders it without the book.
std::unique_ptr<ParamBlockDesc2> DescribeParameters(ClassDesc2* descriptor) {
    const MCHAR* imageFolder = IPathConfigMgr::GetPathConfigMgr()->GetDir(APP_IMAGE_DIR);
    const Point3 black(0.0f, 0.0f, 0.0f);
    // clang-format off
    return std::unique_ptr<ParamBlockDesc2>(new (std::nothrow) ParamBlockDesc2(
        0, "parameters", 0, descriptor, P_AUTO_CONSTRUCT | P_AUTO_UI,
        0,                                                 // reference number
        IDD_COLORMAP_PARAMS, IDS_PARAMS_ROLLOUT_TITLE, 0, 0, nullptr,  // rollout
        colorBookFilePath, "colorBookFilePath", TYPE_FILENAME, 0, IDS_COLORBOOK_FILE_PATH,
            p_ui, TYPE_FILEOPENBUTTON, IDC_COLORBOOK_BUTTON,
            p_caption, IDS_COLORBOOK_DIALOG_CAPTION,
            p_init_file, imageFolder,
            p_file_types, IDS_COLORBOOK_FILE_TYPES,
            p_assetTypeID, MaxSDK::AssetManagement::kBitmapAsset,
            p_end,
        selectedColorIndex, "selectedColorIndex", TYPE_INT, 0, IDS_SELECTED_COLOR_INDEX,
            p_default, -1,
            p_end,
        currentColorName, "currentColorName", TYPE_STRING, 0, IDS_CURRENT_COLOR_NAME,
            p_default, "",
            p_end,
        currentColorCategory, "currentColorCategory", TYPE_STRING, 0, IDS_CURRENT_COLOR_CATEGORY,
            p_default, "",
            p_end,
        currentColorSRGB, "currentColorSRGB", TYPE_POINT3, 0, IDS_CURRENT_COLOR_SRGB,
            p_default, black,
            p_end,
        currentColorLinearRGB, "currentColorLinearRGB", TYPE_POINT3, 0, IDS_CURRENT_COLOR_LINEAR_RGB,
            p_default, black,
            p_end,
        currentColorLAB, "currentColorLAB", TYPE_POINT3, 0, IDS_CURRENT_COLOR_LAB,
            p_default, black,
            p_end,
        currentColorSpectralReflectance, "currentColorSpectralReflectance", TYPE_FLOAT_TAB, 0, 0,
            IDS_CURRENT_COLOR_REFLECTANCE,
            p_end,
        currentTags, "currentTags", TYPE_STRING_TAB, 0, 0, IDS_CURRENT_TAGS,
            p_end,
        p_end));
    // clang-format on
}

}  // namespace

Descriptor::Descriptor() {
    parameters_ = DescribeParameters(this);
    imrShaderTranslation_ClassInfo::LoadDescriptor(IMRSHADERTRANSLATION_CLASSINFO_INTERFACE_ID,
                                                   "imrShaderTranslation_ClassInfo", 0, this, 0, p_end);
    IMtlRender_Compatibility_MtlBase::LoadDescriptor(IMTLRENDER_COMPATIBILITY_MTLBASE_INTERFACEID,
                                                     "IMtlRender_Compability_MtlBase", 0, this, 0, p_end);
}

void* Descriptor::Create(BOOL loading) {
    try {
        return static_cast<Texmap*>(new Map(this, loading != FALSE));
    } catch (const std::bad_alloc&) {
        return nullptr;
    }
}

const MCHAR* Descriptor::ClassName() {
    return GetString(IDS_CLASS_NAME);
}

const MCHAR* Descriptor::Category() {
    return GetString(IDS_CATEGORY);
}

HINSTANCE Descriptor::HInstance() {
    return ModuleInstance();
}

}  // namespace Pigmo::ColorMap
