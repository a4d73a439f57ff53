#pragma once

#include <map>
#include <memory>
#include <string>
#include <vector>

#include "mentalray.h"

namespace Pigmo::Host {

// A shader the stand-in renderer made: its declared class, its name and its parameter block.
class HostExport Shader final : public ReferenceTarget, public imrShader {
public:
    Shader(std::string declaration, std::string name, std::shared_ptr<ParamBlockDesc2> parameters);
    ~Shader() override;

    const std::string& Declaration() const { return declaration_; }

    IParamBlock2* GetParametersParamBlock() override { return block_; }
    ReferenceTarget* GetReferenceTarget() override { return this; }
    const MCHAR* GetName() override { return name_.c_str(); }
    int NumRefs() override { return 1; }
    RefTargetHandle GetReference(int i) override;

protected:
    void SetReference(int i, RefTargetHandle target) override;

private:
    RefResult NotifyRefChanged(Interval, RefTargetHandle, PartID&, RefMessage) override { return REF_SUCCEED; }

    std::string declaration_;
    std::string name_;
    std::shared_ptr<ParamBlockDesc2> parameters_;
    IParamBlock2* block_ = nullptr;
};

// The renderer's shader factory. It knows each shader class by its declaration name and the
// parameters it takes, and keeps the shaders it made (the renderer owns them, not the maps).
class HostExport ShaderCreation final : public imrShaderCreation {
public:
    // Knows "adsk_Utility_ColorPassThrough", whose one parameter is the color "color".
    ShaderCreation();
    ~ShaderCreation() override;
    ShaderCreation(const ShaderCreation&) = delete;
    ShaderCreation& operator=(const ShaderCreation&) = delete;

    // Declares a shader class, or declares it anew; shaders made before keep their parameters.
    void Declare(const std::string& declaration, std::shared_ptr<ParamBlockDesc2> parameters);
    // A new shader of a declared class; null for another.
    imrShader* CreateShader(const MCHAR* declarationName, const MCHAR* mtlName) override;

private:
    std::map<std::string, std::shared_ptr<ParamBlockDesc2>> declarations_;
    std::vector<Shader*> shaders_;
};

}  // namespace Pigmo::Host
