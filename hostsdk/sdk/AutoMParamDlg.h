#pragma once

#include "imtl.h"

namespace Pigmo::Host {

// What ClassDesc2::CreateParamDlgs gives the material editor: the object being edited and the
// rollout of its automatic block. The rollout has no window until the editor panel is built.
class AutoMParamDlg final : public IAutoMParamDlg {
public:
    AutoMParamDlg(Class_ID classId, ReferenceTarget* thing, BlockID blockId)
        : classId_(classId), map_(thing, blockId) {}

    Class_ID ClassID() override { return classId_; }
    void SetThing(ReferenceTarget* m) override { map_.thing = m; }
    ReferenceTarget* GetThing() override { return map_.thing; }
    void DeleteThis() override { delete this; }
    IParamMap2* GetMap(int i = 0) override { return i == 0 ? &map_ : nullptr; }

private:
    // Follows the edited object, so SetThing moves the rollout to the new object's block.
    struct Rollout final : IParamMap2 {
        Rollout(ReferenceTarget* thing, BlockID blockId) : thing(thing), blockId(blockId) {}
        HWND GetHWnd() override { return nullptr; }
        IParamBlock2* GetParamBlock() override { return thing != nullptr ? thing->GetParamBlockByID(blockId) : nullptr; }
        ReferenceTarget* thing;
        BlockID blockId;
    };

    Class_ID classId_;
    Rollout map_;
};

}  // namespace Pigmo::Host
