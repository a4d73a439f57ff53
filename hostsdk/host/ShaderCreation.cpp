#include "ShaderCreation.h"

#include "ParamBlock2.h"

namespace Pigmo::Host {

Shader::Shader(std::string declaration, std::string name, std::shared_ptr<ParamBlockDesc2> parameters)
    : declaration_(std::move(declaration)), name_(std::move(name)), parameters_(std::move(parameters)) {
    ReplaceReference(0, new ParamBlock2(parameters_.get()));
}

Shader::~Shader() {
    // The block goes while its description is still here.
    DeleteAllRefsFromMe();
}

RefTargetHandle Shader::GetReference(int i) {
    return i == 0 ? block_ : nullptr;
}

void Shader::SetReference(int i, RefTargetHandle target) {
    if (i == 0) block_ = static_cast<IParamBlock2*>(target);
}

ShaderCreation::ShaderCreation() {
    Declare("adsk_Utility_ColorPassThrough",
            std::make_shared<ParamBlockDesc2>(0, "parameters", 0, nullptr, 0,  //
                                              0, "color", TYPE_FRGBA, 0, 0, p_end,  //
                                              p_end));
}

ShaderCreation::~ShaderCreation() {
    for (Shader* shader : shaders_) shader->DeleteThis();
}

void ShaderCreation::Declare(const std::string& declaration, std::shared_ptr<ParamBlockDesc2> parameters) {
    declarations_[declaration] = std::move(parameters);
}

imrShader* ShaderCreation::CreateShader(const MCHAR* declarationName, const MCHAR* mtlName) {
    if (declarationName == nullptr) return nullptr;
    const auto declared = declarations_.find(declarationName);
    if (declared == declarations_.end()) return nullptr;
    shaders_.reserve(shaders_.size() + 1);
    shaders_.push_back(new Shader(declared->first, mtlName != nullptr ? mtlName : "", declared->second));
    return shaders_.back();
}

}  // namespace Pigmo::Host
