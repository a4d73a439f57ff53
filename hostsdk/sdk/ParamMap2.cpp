#include "ParamMap2.h"

#include <map>

#include "FileDialog.h"
#include "ModuleResources.h"
#include "Paths.h"
#include "custcont.h"

namespace Pigmo::Host {

namespace {

// A dialog procedure has only its window to go by.
std::map<HWND, ParamMap2*>& OpenMaps() {
    static std::map<HWND, ParamMap2*> maps;
    return maps;
}

HINSTANCE ModuleOf(const ParamBlockDesc2& desc) {
    return desc.cd != nullptr ? desc.cd->HInstance() : nullptr;
}

std::string ModuleText(HINSTANCE module, StringResID id) {
    const char* text = FindModuleText(module, id);
    return text != nullptr ? text : "";
}

}  // namespace

ParamMap2::ParamMap2(ParamBlockDesc2& desc, ReferenceTarget* thing, HWND parent)
    : desc_(desc), thing_(thing) {
    const HINSTANCE module = ModuleOf(desc);
    const DialogTemplate* dialog = FindDialogTemplate(module, desc.dlg_template);
    if (dialog == nullptr) return;
    // Templates of rollouts leave their dialog hidden; the host shows each page it builds.
    DialogTemplate shown = *dialog;
    shown.style |= WS_VISIBLE;
    CreateDialogIndirectParamA(module, &shown, parent, DialogProc, reinterpret_cast<LPARAM>(this));
}

ParamMap2::~ParamMap2() {
    if (window_ != nullptr) DestroyWindow(window_);
}

IParamBlock2* ParamMap2::GetParamBlock() {
    return thing_ != nullptr ? thing_->GetParamBlockByID(desc_.ID) : nullptr;
}

void ParamMap2::SetUserDlgProc(ParamMap2UserDlgProc* proc) {
    if (proc == userProc_) return;
    ParamMap2UserDlgProc* previous = userProc_;
    userProc_ = proc;
    if (previous != nullptr) previous->DeleteThis();
    if (proc != nullptr && window_ != nullptr) proc->DlgProc(0, this, window_, WM_INITDIALOG, 0, 0);
}

void ParamMap2::SetThing(ReferenceTarget* thing) {
    thing_ = thing;
    if (userProc_ != nullptr) userProc_->SetThing(thing);
}

INT_PTR CALLBACK ParamMap2::DialogProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    if (message == WM_INITDIALOG) reinterpret_cast<ParamMap2*>(lParam)->Opened(window);
    const auto found = OpenMaps().find(window);
    return found != OpenMaps().end() ? found->second->Handle(message, wParam, lParam) : FALSE;
}

void ParamMap2::Opened(HWND window) {
    window_ = window;
    OpenMaps()[window] = this;
    // A procedure the description already holds starts with this rollout, unless an open one has it.
    if (desc_.GetParamMap() == nullptr) userProc_ = desc_.GetUserDlgProc();
    desc_.SetParamMap(this);
}

INT_PTR ParamMap2::Handle(UINT message, WPARAM wParam, LPARAM lParam) {
    if (message == WM_COMMAND && HIWORD(wParam) == BN_CLICKED) {
        for (int i = 0; i < desc_.Count(); ++i) {
            const ParamDef& def = desc_.paramdef(i);
            if (def.ctrl_type == TYPE_FILEOPENBUTTON && def.ctrl_id == LOWORD(wParam)) BrowseForFile(def);
        }
    }
    const INT_PTR result =
        userProc_ != nullptr ? userProc_->DlgProc(0, this, window_, message, wParam, lParam) : FALSE;
    if (message == WM_DESTROY) Closed();
    return result;
}

// The procedure goes with the window; the description forgets both, so none is used once deleted.
void ParamMap2::Closed() {
    OpenMaps().erase(window_);
    window_ = nullptr;
    if (desc_.GetParamMap() == this) desc_.SetParamMap(nullptr);
    ParamMap2UserDlgProc* proc = userProc_;
    userProc_ = nullptr;
    if (proc == nullptr) return;
    if (desc_.GetUserDlgProc() == proc) desc_.SetUserDlgProc(nullptr);
    proc->DeleteThis();
}

void ParamMap2::BrowseForFile(const ParamDef& def) {
    const HINSTANCE module = ModuleOf(desc_);
    FileDialogRequest request;
    request.owner = window_;
    request.caption = ModuleText(module, def.caption);
    request.types = ParseFileTypes(ModuleText(module, def.file_types));
    request.initialPath = Platform::NativePath(def.init_file.data());
    const std::optional<std::string> chosen = ShowFileDialog(request);
    IParamBlock2* block = GetParamBlock();
    // The block tells its owner, which takes the file up.
    if (chosen && block != nullptr) block->SetValue(def.ID, 0, chosen->c_str());
}

}  // namespace Pigmo::Host
