#pragma once

#include "Window.h"
#include "iparamb2.h"

namespace Pigmo::Host {

// The rollout of one parameter block: a dialog built from its description's template, whose file
// buttons the host serves itself and whose every message also goes to the description's user
// dialog procedure.
class ParamMap2 final : public IParamMap2 {
public:
    // Builds the dialog from the template of the description's class module as a child of parent;
    // GetHWnd() is null when it cannot be built.
    ParamMap2(ParamBlockDesc2& desc, ReferenceTarget* thing, HWND parent);
    // Destroys the dialog if it still stands.
    ~ParamMap2() override;
    ParamMap2(const ParamMap2&) = delete;
    ParamMap2& operator=(const ParamMap2&) = delete;

    HWND GetHWnd() override { return window_; }
    IParamBlock2* GetParamBlock() override;
    void SetUserDlgProc(ParamMap2UserDlgProc* proc) override;
    ParamMap2UserDlgProc* GetUserDlgProc() override { return userProc_; }

    // Moves the rollout to another object of the class.
    void SetThing(ReferenceTarget* thing);

private:
    static INT_PTR CALLBACK DialogProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam);
    INT_PTR Handle(UINT message, WPARAM wParam, LPARAM lParam);
    void Opened(HWND window);
    void Closed();
    void BrowseForFile(const ParamDef& def);

    ParamBlockDesc2& desc_;
    ReferenceTarget* thing_;
    HWND window_ = nullptr;
    ParamMap2UserDlgProc* userProc_ = nullptr;
};

}  // namespace Pigmo::Host
