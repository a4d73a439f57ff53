#include <algorithm>

#include "ParamBlock2.h"
#include "ref.h"

using Pigmo::Host::ParamBlock2;

Animatable::~Animatable() = default;

RefTargetHandle RemapDir::CloneRef(RefTargetHandle oldTarget) {
    if (oldTarget == nullptr) return nullptr;
    for (const auto& [original, clone] : clones_)
        if (original == oldTarget) return clone;
    RefTargetHandle clone = oldTarget->Clone(*this);
    clones_.emplace_back(oldTarget, clone);
    return clone;
}

RemapDir* NewRemapDir() {
    return new RemapDir;
}

namespace {

// Takes maker off target's dependents; a parameter block no one references any more goes with it,
// since it exists only for its owner.
void Release(ReferenceMaker* maker, RefTargetHandle target, std::vector<ReferenceMaker*>& dependents,
             bool deleteUnreferenced) {
    const auto found = std::find(dependents.begin(), dependents.end(), maker);
    if (found != dependents.end()) dependents.erase(found);
    if (auto* block = dynamic_cast<ParamBlock2*>(target)) {
        block->RefDeleted(maker);
        if (deleteUnreferenced && dependents.empty()) block->DeleteThis();
    }
}

}  // namespace

ReferenceMaker::~ReferenceMaker() {
    // The derived object is gone, so nothing is told; the targets only forget this maker.
    std::vector<RefTargetHandle> held = std::move(references_);
    for (RefTargetHandle target : held)
        if (target != nullptr) Release(this, target, target->dependents_, true);
}

RefResult ReferenceMaker::ReplaceReference(int which, RefTargetHandle newTarget, BOOL deleteOld) {
    if (which < 0) return REF_FAIL;
    if (references_.size() <= static_cast<std::size_t>(which)) references_.resize(which + 1u, nullptr);
    RefTargetHandle oldTarget = references_[which];
    if (oldTarget == newTarget) return REF_SUCCEED;
    if (newTarget != nullptr) {
        newTarget->dependents_.push_back(this);
        if (auto* block = dynamic_cast<ParamBlock2*>(newTarget)) block->RefAdded(this);
    }
    references_[which] = newTarget;
    SetReference(which, newTarget);
    // Dropped last, so a deleted block is no longer held by anyone.
    if (oldTarget != nullptr) Release(this, oldTarget, oldTarget->dependents_, deleteOld != FALSE);
    return REF_SUCCEED;
}

RefResult ReferenceMaker::DeleteAllRefsFromMe() {
    for (std::size_t i = 0; i < references_.size(); ++i) ReplaceReference(static_cast<int>(i), nullptr);
    return REF_SUCCEED;
}

void ReferenceMaker::EnumAuxFiles(MaxSDK::AssetManagement::AssetEnumCallback& callback, DWORD flags) {
    // A copy: an object may change its references while it is asked for its files.
    const std::vector<RefTargetHandle> held = references_;
    for (RefTargetHandle target : held)
        if (target != nullptr) target->EnumAuxFiles(callback, flags);
}

ReferenceTarget::~ReferenceTarget() {
    // Makers still referencing this object are told it is gone, so none keeps a dangling pointer.
    const std::vector<ReferenceMaker*> makers = std::move(dependents_);
    for (ReferenceMaker* maker : makers) {
        for (std::size_t i = 0; i < maker->references_.size(); ++i) {
            if (maker->references_[i] != this) continue;
            maker->references_[i] = nullptr;
            maker->SetReference(static_cast<int>(i), nullptr);
        }
    }
}

RefResult ReferenceTarget::NotifyDependents(Interval changeInterval, PartID part, RefMessage message) {
    const std::vector<ReferenceMaker*> makers = dependents_;
    for (ReferenceMaker* maker : makers) {
        // One told before may have dropped or deleted another.
        if (std::find(dependents_.begin(), dependents_.end(), maker) == dependents_.end()) continue;
        PartID changed = part;
        const RefResult result = maker->NotifyRefChanged(changeInterval, this, changed, message);
        // As in the host, a change travels on to whatever references the maker, unless the maker
        // stops it (or has gone meanwhile).
        if (result == REF_STOP ||
            std::find(dependents_.begin(), dependents_.end(), maker) == dependents_.end())
            continue;
        if (auto* target = dynamic_cast<ReferenceTarget*>(maker))
            target->NotifyDependents(changeInterval, changed, message);
    }
    return REF_SUCCEED;
}
