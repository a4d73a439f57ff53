#include <algorithm>

#include "AutoMParamDlg.h"
#include "ParamBlock2.h"

ClassDesc::~ClassDesc() = default;

void ClassDesc::AddInterface(FPInterface* fpi) {
    if (fpi != nullptr && std::find(interfaces_.begin(), interfaces_.end(), fpi) == interfaces_.end())
        interfaces_.push_back(fpi);
}

FPInterface* ClassDesc::GetInterface(Interface_ID id) {
    for (FPInterface* fpi : interfaces_)
        if (fpi->GetID() == id) return fpi;
    return nullptr;
}

// The descriptions belong to the plug-in, which may keep them beyond the descriptor.
ClassDesc2::~ClassDesc2() = default;

void ClassDesc2::MakeAutoParamBlocks(ReferenceMaker* owner) {
    for (ParamBlockDesc2* desc : descriptions_)
        if ((desc->flags & P_AUTO_CONSTRUCT) != 0)
            owner->ReplaceReference(desc->ref_no, new Pigmo::Host::ParamBlock2(desc));
}

// Null when a rollout cannot be built (its template or a control's class is missing).
IAutoMParamDlg* ClassDesc2::CreateParamDlgs(HWND hwMtlEdit, IMtlParams*, ReferenceTarget* obj) {
    std::vector<std::unique_ptr<Pigmo::Host::ParamMap2>> maps;
    for (ParamBlockDesc2* desc : descriptions_) {
        if ((desc->flags & P_AUTO_UI) == 0) continue;
        maps.push_back(std::make_unique<Pigmo::Host::ParamMap2>(*desc, obj, hwMtlEdit));
        if (maps.back()->GetHWnd() == nullptr) return nullptr;
    }
    if (maps.empty()) return nullptr;
    return new Pigmo::Host::AutoMParamDlg(ClassID(), obj, std::move(maps));
}

void ClassDesc2::Reset(ReferenceTarget* obj, BOOL updateUI, BOOL callSetHandlers) {
    for (ParamBlockDesc2* desc : descriptions_) {
        if ((desc->flags & P_AUTO_CONSTRUCT) == 0) continue;
        if (IParamBlock2* block = obj->GetParamBlockByID(desc->ID))
            block->ResetAll(updateUI, callSetHandlers);
    }
}

void ClassDesc2::AddParamBlockDesc(ParamBlockDesc2* pbd) {
    if (pbd != nullptr && std::find(descriptions_.begin(), descriptions_.end(), pbd) == descriptions_.end())
        descriptions_.push_back(pbd);
}

ParamBlockDesc2* ClassDesc2::GetParamBlockDescByID(BlockID id) {
    for (ParamBlockDesc2* desc : descriptions_)
        if (desc->ID == id) return desc;
    return nullptr;
}
