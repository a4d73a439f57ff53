#pragma once

#include <memory>
#include <vector>

#include "ParamMap2.h"
#include "imtl.h"

namespace Pigmo::Host {

// What ClassDesc2::CreateParamDlgs gives the material editor: the object being edited and the
// rollouts of its blocks with an automatic user interface. Deleting it closes them.
class AutoMParamDlg final : public IAutoMParamDlg {
public:
    AutoMParamDlg(Class_ID classId, ReferenceTarget* thing, std::vector<std::unique_ptr<ParamMap2>> maps)
        : classId_(classId), thing_(thing), maps_(std::move(maps)) {}

    Class_ID ClassID() override { return classId_; }
    void SetThing(ReferenceTarget* m) override {
        thing_ = m;
        for (const auto& map : maps_) map->SetThing(m);
    }
    ReferenceTarget* GetThing() override { return thing_; }
    void DeleteThis() override { delete this; }
    IParamMap2* GetMap(int i = 0) override {
        return i >= 0 && static_cast<std::size_t>(i) < maps_.size() ? maps_[static_cast<std::size_t>(i)].get()
                                                                    : nullptr;
    }

private:
    Class_ID classId_;
    ReferenceTarget* thing_;
    std::vector<std::unique_ptr<ParamMap2>> maps_;
};

}  // namespace Pigmo::Host
