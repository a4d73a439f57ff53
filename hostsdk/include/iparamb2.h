#pragma once

// Parameter blocks: class descriptors that describe their parameters once, and the blocks that
// every instance keeps its parameter values in.

#include <memory>
#include <vector>

#include "ifnpub.h"
#include "ref.h"

namespace MaxSDK::AssetManagement {
class AssetUser;
}

// Parameter type codes.
enum ParamType2 : int {
    TYPE_FLOAT = 0,
    TYPE_INT = 1,
    TYPE_RGBA = 2,
    TYPE_POINT3 = 3,
    TYPE_BOOL = 4,
    TYPE_STRING = 8,
    TYPE_FILENAME = 9,
    TYPE_FRGBA = 23,
    TYPE_TAB = 0x800,
    TYPE_FLOAT_TAB = TYPE_FLOAT | TYPE_TAB,
    TYPE_STRING_TAB = TYPE_STRING | TYPE_TAB,
};

// Tags of the tagged parameter list.
enum ParamTags : int {
    p_default = static_cast<int>(0xC0000000),
    p_ui = static_cast<int>(0xC0000003),
    p_caption = static_cast<int>(0xC0000010),
    p_init_file = static_cast<int>(0xC0000011),
    p_file_types = static_cast<int>(0xC0000012),
    p_assetTypeID = static_cast<int>(0xC0000017),
    p_end = static_cast<int>(0xC0000400),
};

// Block description flags.
inline constexpr int P_AUTO_CONSTRUCT = 0x0002;
inline constexpr int P_AUTO_UI = 0x0004;

// Rollout control types of p_ui.
inline constexpr int TYPE_FILEOPENBUTTON = 11;

class ClassDesc2;
class IParamMap2;
class IMtlParams;
class ParamBlockDesc2;

// One parameter as the descriptor declares it.
struct HostExport ParamDef {
    ParamID ID = -1;
    CStr int_name;
    ParamType2 type = TYPE_INT;
    int flags = 0;
    StringResID local_name = 0;
    int tab_size = 0;
    // The default, in the member its type uses.
    int def_i = 0;
    float def_f = 0;
    AColor def_c;
    CStr def_s;
    // Rollout binding and file dialog.
    int ctrl_type = 0;
    int ctrl_id = 0;
    StringResID caption = 0;
    CStr init_file;
    StringResID file_types = 0;
    int asset_type = 0;
};

// The plug-in's own handling of a rollout the host builds for a block.
class HostExport ParamMap2UserDlgProc {
public:
    virtual ~ParamMap2UserDlgProc() = default;
    virtual INT_PTR DlgProc(TimeValue t, IParamMap2* map, HWND hWnd, UINT msg, WPARAM wParam,
                            LPARAM lParam) = 0;
    virtual void DeleteThis() = 0;
    virtual void SetThing(ReferenceTarget*) {}
    virtual void Update(TimeValue) {}
    virtual void SetParamBlock(IParamBlock2*) {}
};

// The rollout the host built for a parameter block.
class HostExport IParamMap2 {
public:
    virtual ~IParamMap2() = default;
    virtual HWND GetHWnd() = 0;
    virtual IParamBlock2* GetParamBlock() = 0;
    // Installs proc in place of the one the rollout has (which is deleted) and sends it WM_INITDIALOG.
    virtual void SetUserDlgProc(ParamMap2UserDlgProc* proc = nullptr) = 0;
    virtual ParamMap2UserDlgProc* GetUserDlgProc() = 0;
};

class HostExport ParamBlockDesc2 {
public:
    // The tagged list: for P_AUTO_CONSTRUCT the reference number; for P_AUTO_UI the dialog template,
    // title string, test flags, rollup flags and user dialog procedure; then each parameter as
    // id, internal name, type, [table size,] flags, label string, tags..., p_end; then p_end.
    ParamBlockDesc2(BlockID id, const MCHAR* int_name, StringResID local_name, ClassDesc2* cd, int flags,
                    ...);
    ~ParamBlockDesc2();

    int Count() const { return static_cast<int>(params_.size()); }
    int IDtoIndex(ParamID id) const;
    ParamID IndextoID(int index) const;
    ParamDef& GetParamDef(ParamID id);
    const ParamDef& paramdef(int index) const { return params_[index]; }

    // The procedure of the open rollout, which is handed it at once; the rollout owns it from then on.
    void SetUserDlgProc(ParamMap2UserDlgProc* proc = nullptr);
    ParamMap2UserDlgProc* GetUserDlgProc() const { return dlgProc_; }
    // The open rollout of this description; null when none is open.
    void SetParamMap(IParamMap2* map) { map_ = map; }
    IParamMap2* GetParamMap() const { return map_; }

    BlockID ID;
    CStr int_name;
    StringResID local_name;
    ClassDesc2* cd;
    int flags;
    int ref_no = 0;
    int dlg_template = 0;
    StringResID title = 0;

private:
    std::vector<ParamDef> params_;
    ParamMap2UserDlgProc* dlgProc_ = nullptr;
    IParamMap2* map_ = nullptr;
};

// The values of one instance's parameters, at time 0 here since nothing is animated.
class HostExport IParamBlock2 : public ReferenceTarget {
public:
    virtual BlockID ID() = 0;
    virtual ParamBlockDesc2* GetDesc() = 0;
    virtual ReferenceMaker* GetOwner() = 0;
    virtual int NumParams() = 0;
    virtual ParamID IndextoID(int index) = 0;
    virtual ParamDef& GetParamDef(ParamID id) = 0;

    virtual BOOL SetValue(ParamID id, TimeValue t, int v, int tabIndex = 0) = 0;
    virtual BOOL SetValue(ParamID id, TimeValue t, float v, int tabIndex = 0) = 0;
    virtual BOOL SetValue(ParamID id, TimeValue t, const Point3& v, int tabIndex = 0) = 0;
    virtual BOOL SetValue(ParamID id, TimeValue t, const Color& v, int tabIndex = 0) = 0;
    virtual BOOL SetValue(ParamID id, TimeValue t, const AColor& v, int tabIndex = 0) = 0;
    virtual BOOL SetValue(ParamID id, TimeValue t, const MCHAR* v, int tabIndex = 0) = 0;
    virtual BOOL SetValue(ParamID id, TimeValue t, const MaxSDK::AssetManagement::AssetUser& v,
                          int tabIndex = 0) = 0;

    virtual BOOL GetValue(ParamID id, TimeValue t, int& v, Interval& valid, int tabIndex = 0) = 0;
    virtual BOOL GetValue(ParamID id, TimeValue t, float& v, Interval& valid, int tabIndex = 0) = 0;
    virtual BOOL GetValue(ParamID id, TimeValue t, Point3& v, Interval& valid, int tabIndex = 0) = 0;
    virtual BOOL GetValue(ParamID id, TimeValue t, Color& v, Interval& valid, int tabIndex = 0) = 0;
    virtual BOOL GetValue(ParamID id, TimeValue t, AColor& v, Interval& valid, int tabIndex = 0) = 0;
    virtual BOOL GetValue(ParamID id, TimeValue t, const MCHAR*& v, Interval& valid, int tabIndex = 0) = 0;

    // Convenience reads; a value of another type reads as zero or empty.
    int GetInt(ParamID id, TimeValue t = 0, int tabIndex = 0);
    float GetFloat(ParamID id, TimeValue t = 0, int tabIndex = 0);
    Point3 GetPoint3(ParamID id, TimeValue t = 0, int tabIndex = 0);
    Color GetColor(ParamID id, TimeValue t = 0, int tabIndex = 0);
    const MCHAR* GetStr(ParamID id, TimeValue t = 0, int tabIndex = 0);
    virtual const MaxSDK::AssetManagement::AssetUser& GetAssetUser(ParamID id, TimeValue t = 0,
                                                                   int tabIndex = 0) = 0;

    virtual int Count(ParamID id) = 0;
    virtual int SetCount(ParamID id, int n) = 0;

    virtual void ResetAll(BOOL updateUI = TRUE, BOOL callSetHandlers = TRUE) = 0;
    virtual void Reset(ParamID id, int tabIndex = -1, BOOL updateUI = TRUE, BOOL callSetHandlers = TRUE) = 0;
    // The parameter that changed last, or -1 when a change touched them all.
    virtual ParamID LastNotifyParamID() = 0;
};

class HostExport ClassDesc {
public:
    virtual ~ClassDesc();
    virtual int IsPublic() = 0;
    virtual void* Create(BOOL loading = FALSE) = 0;
    virtual const MCHAR* ClassName() = 0;
    virtual SClass_ID SuperClassID() = 0;
    virtual Class_ID ClassID() = 0;
    virtual const MCHAR* Category() = 0;
    virtual const MCHAR* InternalName() { return nullptr; }
    virtual HINSTANCE HInstance() { return nullptr; }

    // Function-publishing interfaces registered with FPInterfaceDesc::LoadDescriptor.
    void AddInterface(FPInterface* fpi);
    int NumInterfaces() const { return static_cast<int>(interfaces_.size()); }
    FPInterface* GetInterfaceAt(int i) { return interfaces_[i]; }
    virtual FPInterface* GetInterface(Interface_ID id);

private:
    std::vector<FPInterface*> interfaces_;
};

class IAutoMParamDlg;

class HostExport ClassDesc2 : public ClassDesc {
public:
    ~ClassDesc2() override;

    // Builds the blocks whose descriptions ask for automatic construction and gives them to owner.
    virtual void MakeAutoParamBlocks(ReferenceMaker* owner);
    // Builds the rollouts whose descriptions ask for an automatic user interface.
    virtual IAutoMParamDlg* CreateParamDlgs(HWND hwMtlEdit, IMtlParams* imp, ReferenceTarget* obj);
    // Sets every parameter of obj's automatic blocks to its default.
    virtual void Reset(ReferenceTarget* obj, BOOL updateUI = TRUE, BOOL callSetHandlers = TRUE);

    void AddParamBlockDesc(ParamBlockDesc2* pbd);
    int NumParamBlockDescs() const { return static_cast<int>(descriptions_.size()); }
    ParamBlockDesc2* GetParamBlockDesc(int i) { return descriptions_[i]; }
    ParamBlockDesc2* GetParamBlockDescByID(BlockID id);

private:
    std::vector<ParamBlockDesc2*> descriptions_;
};
