#pragma once

// The mental ray renderer's side: shaders standing in for maps it does not shade itself.

#include <vector>

#include "iparamb2.h"

inline constexpr Interface_ID IMRSHADERTRANSLATION_INTERFACE_ID(0x1C396ABD, 0x5F964E0C);
inline constexpr Interface_ID IMRSHADERTRANSLATION_CLASSINFO_INTERFACE_ID(0x17A76FD6, 0x5AB32BCD);
inline constexpr Interface_ID IMTLRENDER_COMPATIBILITY_MTLBASE_INTERFACEID(0x5537445B, 0x70A97E02);

// A shader the renderer made, with its parameters in a block of named parameters.
class HostExport imrShader {
public:
    virtual ~imrShader() = default;
    virtual IParamBlock2* GetParametersParamBlock() = 0;
    virtual ReferenceTarget* GetReferenceTarget() = 0;
    virtual const MCHAR* GetName() = 0;
};

class HostExport imrShaderCreation {
public:
    virtual ~imrShaderCreation() = default;
    // A shader of the declared class, named after the object it stands in for.
    virtual imrShader* CreateShader(const MCHAR* declarationName, const MCHAR* mtlName) = 0;
};

class HostExport imrTranslation {
public:
    virtual ~imrTranslation() = default;
};

class HostExport imrShaderTranslation : public BaseInterface {
public:
    Interface_ID GetID() override { return IMRSHADERTRANSLATION_INTERFACE_ID; }
    virtual imrShader* GetMRShader(imrShaderCreation& shaderCreation) = 0;
    virtual void ReleaseMRShader() = 0;
    virtual bool NeedsAutomaticParamBlock2Translation() = 0;
    virtual void TranslateParameters(imrTranslation& translation, imrShader* shader, TimeValue t,
                                     Interval& valid) = 0;
    virtual void GetAdditionalReferenceDependencies(std::vector<ReferenceTarget*>&) {}
};

class HostExport imrShaderTranslation_ClassInfo : public FPStaticInterface {
public:
    // What the shader can be applied as, a set of the renderer's bits.
    virtual unsigned int GetApplyTypes() = 0;
};

class HostExport IMtlRender_Compatibility_MtlBase : public FPStaticInterface {
public:
    virtual bool IsCompatibleWithRenderer(ClassDesc& rendererClassDesc) = 0;
    virtual bool GetCustomMtlBrowserIcon(void*& imageList, int& inactiveIndex, int& activeIndex,
                                         int& disabledIndex) = 0;
};
