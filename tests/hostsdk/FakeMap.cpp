#include "FakeMap.h"

#include <cstdio>

namespace Fake {

namespace {

class Descriptor final : public ClassDesc2 {
public:
    int IsPublic() override { return 0; }
    void* Create(BOOL loading) override { return static_cast<Texmap*>(new Map(this, loading != FALSE)); }
    const MCHAR* ClassName() override { return "Fake Map"; }
    SClass_ID SuperClassID() override { return TEXMAP_CLASS_ID; }
    Class_ID ClassID() override { return kClassID; }
    const MCHAR* Category() override { return "Tests"; }
    HINSTANCE HInstance() override { return Module(); }
};

class RecordingDlgProc final : public ParamMap2UserDlgProc {
public:
    INT_PTR DlgProc(TimeValue, IParamMap2* map, HWND hWnd, UINT msg, WPARAM wParam, LPARAM) override {
        // The procedure is told of its own rollout.
        const std::string which = map != nullptr && map->GetHWnd() == hWnd ? "" : " (another window)";
        if (msg == WM_INITDIALOG) DialogLog().push_back("init" + which);
        if (msg == WM_DESTROY) DialogLog().push_back("destroy" + which);
        if (msg == WM_COMMAND) DialogLog().push_back("command " + std::to_string(LOWORD(wParam)) + which);
        return FALSE;
    }
    void DeleteThis() override {
        DialogLog().push_back("deleted");
        delete this;
    }
    void SetThing(ReferenceTarget*) override { DialogLog().push_back("thing"); }
};

class Callback final : public PostLoadCallback {
public:
    explicit Callback(Map* map) : map_(map) {}
    void proc(ILoad*) override {
        PostLoadLog().push_back(std::string(map_->GetName().data()) +
                                " count=" + std::to_string(map_->GetParamBlock(0)->GetInt(kCount)) +
                                " changes=" + std::to_string(map_->changes.size()));
        delete this;
    }
    int Priority() override { return map_->GetGBufID(); }

private:
    Map* map_;
};

}  // namespace

Map::Map(ClassDesc2* cd, bool loading) : loading(loading), cd_(cd) {
    ++LiveMaps();
    cd_->MakeAutoParamBlocks(this);
}

Map::~Map() {
    --LiveMaps();
}

IParamBlock2* Map::GetParamBlockByID(BlockID id) {
    return block_ != nullptr && block_->ID() == id ? block_ : nullptr;
}

AColor Map::EvalColor(ShadeContext& sc) {
    if (!sc.doMaps) return AColor(0.0f, 0.0f, 0.0f, 0.0f);
    ++shadings;
    AColor tint;
    Interval valid;
    block_->GetValue(kTint, 0, tint, valid);
    return tint;
}

RefTargetHandle Map::Clone(RemapDir& remap) {
    auto* clone = new Map(cd_, true);
    clone->ReplaceReference(0, remap.CloneRef(block_));
    BaseClone(this, clone, remap);
    return clone;
}

ParamDlg* Map::CreateParamDlg(HWND hwMtlEdit, IMtlParams* imp) {
    IAutoMParamDlg* dialogs = cd_->CreateParamDlgs(hwMtlEdit, imp, this);
    if (dialogs != nullptr) cd_->GetParamBlockDesc(0)->SetUserDlgProc(new RecordingDlgProc);
    return dialogs;
}

IOResult Map::Load(ILoad* iload) {
    const IOResult result = Texmap::Load(iload);
    iload->RegisterPostLoadCallback(new Callback(this));
    return result;
}

void Map::SetReference(int i, RefTargetHandle target) {
    if (i == 0) block_ = static_cast<IParamBlock2*>(target);
}

RefResult Map::NotifyRefChanged(Interval, RefTargetHandle target, PartID&, RefMessage message) {
    if (message == REFMSG_CHANGE && target == block_) changes.push_back(block_->LastNotifyParamID());
    return REF_SUCCEED;
}

ClassDesc2& Class() {
    static Descriptor descriptor;
    // clang-format off
    static ParamBlockDesc2 parameters(
        0, "parameters", 0, &descriptor, P_AUTO_CONSTRUCT | P_AUTO_UI,
        0,
        101, 102, 0, 0, nullptr,
        kFile, "file", TYPE_FILENAME, 0, 104,
            p_ui, TYPE_FILEOPENBUTTON, 1005,
            p_caption, 103,
            p_init_file, "/images",
            p_file_types, 105,
            p_assetTypeID, MaxSDK::AssetManagement::kBitmapAsset,
            p_end,
        kCount, "count", TYPE_INT, 0, 0, p_default, 7, p_end,
        kLabel, "label", TYPE_STRING, 0, 0, p_default, "none", p_end,
        kPosition, "position", TYPE_POINT3, 0, 0, p_default, Point3(1.0f, 2.0f, 3.0f), p_end,
        kWeight, "weight", TYPE_FLOAT, 0, 0, p_default, 0.5, p_end,
        kTint, "tint", TYPE_FRGBA, 0, 0, p_default, AColor(0.25f, 0.5f, 0.75f, 1.0f), p_end,
        kCurve, "curve", TYPE_FLOAT_TAB, 2, 0, 0, p_default, 0.25, p_end,
        kTags, "tags", TYPE_STRING_TAB, 0, 0, 0, p_end,
        kShade, "shade", TYPE_RGBA, 0, 0, p_default, Color(0.125f, 0.5f, 1.0f), p_end,
        kEnabled, "enabled", TYPE_BOOL, 0, 0, p_default, 1, p_end,
        p_end);
    // clang-format on
    return descriptor;
}

std::string Describe(IParamBlock2& block) {
    std::string text;
    char number[64];
    const auto add = [&](float value) {
        std::snprintf(number, sizeof number, " %.9g", value);
        text += number;
    };
    Interval valid;
    for (int i = 0; i < block.NumParams(); ++i) {
        const ParamID id = block.IndextoID(i);
        const ParamDef& def = block.GetParamDef(id);
        const bool table = (def.type & TYPE_TAB) != 0;
        text += std::to_string(id) + ":";
        for (int entry = 0; entry < (table ? block.Count(id) : 1); ++entry) {
            switch (def.type & ~TYPE_TAB) {
                case TYPE_INT:
                case TYPE_BOOL:
                    text += ' ';
                    text += std::to_string(block.GetInt(id, 0, entry));
                    break;
                case TYPE_FLOAT:
                    add(block.GetFloat(id, 0, entry));
                    break;
                case TYPE_POINT3:
                case TYPE_RGBA: {
                    const Point3 p = block.GetPoint3(id, 0, entry);
                    for (float v : {p.x, p.y, p.z}) add(v);
                    break;
                }
                case TYPE_FRGBA: {
                    AColor c;
                    block.GetValue(id, 0, c, valid, entry);
                    for (float v : {c.r, c.g, c.b, c.a}) add(v);
                    break;
                }
                default:
                    text += " \"" + std::string(block.GetStr(id, 0, entry)) + "\"";
                    break;
            }
        }
        text += "\n";
    }
    return text;
}

HINSTANCE Module() {
    // Any address of the module tells it apart.
    return reinterpret_cast<HINSTANCE>(&LiveMaps);
}

std::vector<std::string>& DialogLog() {
    static std::vector<std::string> log;
    return log;
}

int& LiveMaps() {
    static int count = 0;
    return count;
}

std::vector<std::string>& PostLoadLog() {
    static std::vector<std::string> log;
    return log;
}

}  // namespace Fake
