// The host's rollouts: CreateParamDlgs builds a block's dialog from its class module's template,
// hands every message to the block's user dialog procedure and serves the file button itself.
#include <gtest/gtest.h>

#include <functional>
#include <iterator>
#include <optional>
#include <string>
#include <vector>

#include "FakeMap.h"
#include "FileDialog.h"
#include "MaterialEditor.h"
#include "ModuleResources.h"

namespace {

using Pigmo::Host::FileDialogRequest;
using Pigmo::Host::FileType;
using Pigmo::Host::MaterialEditor;

constexpr int kFileButton = 1005;
constexpr int kSwatch = 1006;

// The fake class's template 101 and strings, in dialog units.
constexpr DialogItemTemplate kItems[] = {
    {"Static", -1, "File:", 4, 4, 40, 8, WS_CHILD | WS_VISIBLE},
    {"CustButton", kFileButton, "None", 4, 14, 100, 14, WS_CHILD | WS_VISIBLE | WS_TABSTOP},
    {"ColorSwatch", kSwatch, "", 4, 32, 20, 20, WS_CHILD | WS_VISIBLE | WS_DISABLED},
};
constexpr DialogTemplate kTemplate = {WS_CHILD | DS_SETFONT, 0, 120,    60,
                                      "MS Shell Dlg",        8, kItems, std::size(kItems)};

const DialogTemplate* Dialog(int id) {
    return id == 101 ? &kTemplate : nullptr;
}

const char* Text(unsigned int id) {
    switch (id) {
        case 103:
            return "Pick a file";
        case 105:
            return "Pictures (*.png;*.jpg)|*.png;*.jpg|All (*.*)|*.*|";
        default:
            return nullptr;
    }
}

class Rollout : public testing::Test {
protected:
    void SetUp() override {
        Pigmo::Host::RegisterModuleResources(Fake::Module(), {Dialog, Text});
        Fake::DialogLog().clear();
        map_ = static_cast<Fake::Map*>(static_cast<Texmap*>(Fake::Class().Create(FALSE)));
        map_->SetName("Map #1");
    }
    void TearDown() override {
        Pigmo::Host::SetFileDialogHandler({});
        editor_.reset();
        map_->DeleteThis();
        Pigmo::Host::UnregisterModuleResources(Fake::Module());
    }

    // The centre of a control of the rollout, in the editor window's pixels.
    POINT Centre(int id) {
        const DialogItemTemplate& item = *std::find_if(
            std::begin(kItems), std::end(kItems), [id](const DialogItemTemplate& i) { return i.id == id; });
        RECT area{item.x, item.y, item.x + item.cx, item.y + item.cy};
        MapDialogRect(editor_->Rollout(), &area);
        return {(area.left + area.right) / 2, (area.top + area.bottom) / 2};
    }
    void Click(int id) {
        const POINT at = Centre(id);
        editor_->Mouse(WM_LBUTTONDOWN, at.x, at.y);
        editor_->Mouse(WM_LBUTTONUP, at.x, at.y);
    }

    std::optional<MaterialEditor> editor_{std::in_place};
    Fake::Map* map_ = nullptr;
};

TEST_F(Rollout, IsBuiltFromTheTemplateAndFillsTheEditor) {
    editor_->Open(*map_);
    const HWND rollout = editor_->Rollout();
    ASSERT_NE(rollout, nullptr);
    EXPECT_EQ(GetParent(rollout), editor_->Window());
    for (const DialogItemTemplate& item : kItems) {
        if (item.id == -1) continue;
        EXPECT_NE(GetDlgItem(rollout, item.id), nullptr) << item.className;
    }
    RECT size{0, 0, kTemplate.cx, kTemplate.cy};
    MapDialogRect(rollout, &size);
    EXPECT_EQ(editor_->Width(), size.right);
    EXPECT_EQ(editor_->Height(), size.bottom);
    cairo_surface_t* surface = editor_->Paint();
    EXPECT_EQ(cairo_image_surface_get_width(surface), size.right);
    EXPECT_EQ(cairo_image_surface_get_height(surface), size.bottom);
    // The procedure installed after CreateParamDlgs was initialised with this rollout.
    EXPECT_EQ(Fake::DialogLog(), std::vector<std::string>{"init"});
    EXPECT_NE(Fake::Class().GetParamBlockDesc(0)->GetUserDlgProc(), nullptr);
}

TEST_F(Rollout, WithoutTheModulesTemplateThereIsNone) {
    Pigmo::Host::UnregisterModuleResources(Fake::Module());
    EXPECT_EQ(Fake::Class().CreateParamDlgs(editor_->Window(), nullptr, map_), nullptr);
    try {
        editor_->Open(*map_);
        ADD_FAILURE() << "opened";
    } catch (const std::runtime_error& e) {
        EXPECT_STREQ(e.what(), "Map #1 (Fake Map) shows no rollout");
    }
    EXPECT_EQ(editor_->Rollout(), nullptr);
    EXPECT_TRUE(Fake::DialogLog().empty());
}

// However the rollout goes, its procedure hears WM_DESTROY and is then deleted, and the description
// forgets both.
struct Closing {
    const char* name;
    std::function<void(std::optional<MaterialEditor>&)> close;
};

class RolloutClosing : public Rollout, public testing::WithParamInterface<Closing> {};

TEST_P(RolloutClosing, TellsAndDeletesTheProcedure) {
    editor_->Open(*map_);
    GetParam().close(editor_);
    ASSERT_GE(Fake::DialogLog().size(), 3u);
    EXPECT_EQ(std::vector<std::string>(Fake::DialogLog().begin(), Fake::DialogLog().begin() + 3),
              (std::vector<std::string>{"init", "destroy", "deleted"}));
    if (editor_) editor_->Close();
    EXPECT_EQ(Fake::DialogLog().back(), "deleted");
    EXPECT_EQ(Fake::Class().GetParamBlockDesc(0)->GetUserDlgProc(), nullptr);
    EXPECT_EQ(Fake::Class().GetParamBlockDesc(0)->GetParamMap(), nullptr);
}

INSTANTIATE_TEST_SUITE_P(
    Ways, RolloutClosing,
    testing::Values(Closing{"Close", [](std::optional<MaterialEditor>& e) { e->Close(); }},
                    Closing{"EditorDeleted", [](std::optional<MaterialEditor>& e) { e.reset(); }},
                    Closing{"EditorWindowDestroyed",
                            [](std::optional<MaterialEditor>& e) { DestroyWindow(e->Window()); }},
                    Closing{"RolloutDestroyed",
                            [](std::optional<MaterialEditor>& e) { DestroyWindow(e->Rollout()); }},
                    Closing{"AnotherMapOpened",
                            [](std::optional<MaterialEditor>& e) {
                                auto* other = static_cast<Fake::Map*>(
                                    static_cast<Texmap*>(Fake::Class().Create(FALSE)));
                                e->Open(*other);
                                EXPECT_EQ(Fake::DialogLog().back(), "init");
                                e->Close();
                                other->DeleteThis();
                            }}),
    [](const testing::TestParamInfo<Closing>& info) { return info.param.name; });

class SecondDlgProc final : public ParamMap2UserDlgProc {
public:
    INT_PTR DlgProc(TimeValue, IParamMap2*, HWND, UINT msg, WPARAM, LPARAM) override {
        if (msg == WM_INITDIALOG) Fake::DialogLog().push_back("second init");
        if (msg == WM_DESTROY) Fake::DialogLog().push_back("second destroy");
        return FALSE;
    }
    void DeleteThis() override {
        Fake::DialogLog().push_back("second deleted");
        delete this;
    }
};

TEST_F(Rollout, ANewProcedureReplacesTheOldOneAtOnce) {
    editor_->Open(*map_);
    Fake::Class().GetParamBlockDesc(0)->SetUserDlgProc(new SecondDlgProc);
    editor_->Close();
    EXPECT_EQ(Fake::DialogLog(), (std::vector<std::string>{"init", "deleted", "second init", "second destroy",
                                                           "second deleted"}));
}

TEST_F(Rollout, TwoEditorsOfOneClassKeepTheirOwnProcedures) {
    auto* other = static_cast<Fake::Map*>(static_cast<Texmap*>(Fake::Class().Create(FALSE)));
    std::optional<MaterialEditor> second{std::in_place};
    editor_->Open(*map_);
    second->Open(*other);
    editor_->Close();
    second.reset();
    EXPECT_EQ(Fake::DialogLog(),
              (std::vector<std::string>{"init", "init", "destroy", "deleted", "destroy", "deleted"}));
    other->DeleteThis();
}

TEST_F(Rollout, FollowsTheEditedObject) {
    auto* dialog = dynamic_cast<IAutoMParamDlg*>(map_->CreateParamDlg(editor_->Window(), nullptr));
    ASSERT_NE(dialog, nullptr);
    EXPECT_EQ(dialog->ClassID(), Fake::kClassID);
    IParamMap2* rollout = dialog->GetMap(0);
    const HWND window = rollout->GetHWnd();
    EXPECT_NE(window, nullptr);
    EXPECT_EQ(dialog->GetMap(1), nullptr);
    EXPECT_EQ(rollout->GetParamBlock(), map_->GetParamBlock(0));
    auto* other = static_cast<Fake::Map*>(static_cast<Texmap*>(Fake::Class().Create(FALSE)));
    dialog->SetThing(other);
    EXPECT_EQ(dialog->GetThing(), other);
    EXPECT_EQ(rollout->GetParamBlock(), other->GetParamBlock(0));
    dialog->DeleteThis();
    EXPECT_FALSE(IsWindow(window));
    EXPECT_EQ(Fake::DialogLog(), (std::vector<std::string>{"init", "thing", "destroy", "deleted"}));
    other->DeleteThis();
}

TEST_F(Rollout, MessagesOfTheRolloutReachTheProcedure) {
    editor_->Open(*map_);
    Click(kFileButton);
    EXPECT_EQ(Fake::DialogLog(), (std::vector<std::string>{"init", "command 1005"}));
}

// The file button: the host asks its file dialog with the parameter's texts and stores the answer
// in the parameter itself.
struct Browse {
    const char* name;
    bool handler;
    std::optional<std::string> answer;
    std::string stored;  // the parameter afterwards
};

class FileButton : public Rollout, public testing::WithParamInterface<Browse> {};

TEST_P(FileButton, StoresTheChosenFile) {
    editor_->Open(*map_);
    std::vector<FileDialogRequest> requests;
    if (GetParam().handler) {
        Pigmo::Host::SetFileDialogHandler([&](const FileDialogRequest& request) {
            requests.push_back(request);
            return GetParam().answer;
        });
    }
    map_->changes.clear();
    Click(kFileButton);
    EXPECT_STREQ(map_->GetParamBlock(0)->GetStr(Fake::kFile), GetParam().stored.c_str());
    EXPECT_EQ(map_->changes, GetParam().answer && GetParam().handler ? std::vector<ParamID>{Fake::kFile}
                                                                     : std::vector<ParamID>{});
    if (!GetParam().handler) return;
    ASSERT_EQ(requests.size(), 1u);
    EXPECT_EQ(requests[0].owner, editor_->Rollout());
    EXPECT_EQ(requests[0].caption, "Pick a file");
    ASSERT_EQ(requests[0].types.size(), 2u);
    EXPECT_EQ(requests[0].types[0].name, "Pictures (*.png;*.jpg)");
    EXPECT_EQ(requests[0].types[0].patterns, (std::vector<std::string>{"*.png", "*.jpg"}));
    EXPECT_EQ(requests[0].initialPath, "/images");
}

INSTANTIATE_TEST_SUITE_P(Answers, FileButton,
                         testing::Values(Browse{"Chosen", true, "/books/red.cxf", "/books/red.cxf"},
                                         Browse{"Cancelled", true, std::nullopt, ""},
                                         Browse{"NoDialog", false, std::nullopt, ""}),
                         [](const testing::TestParamInfo<Browse>& info) { return info.param.name; });

TEST_F(Rollout, ChangesOfTheMapShownReachTheEditor) {
    int changes = 0;
    editor_->SetChangeHandler([&] { ++changes; });
    editor_->Open(*map_);
    map_->GetParamBlock(0)->SetValue(Fake::kCount, 0, 3);
    EXPECT_EQ(changes, 1);
    editor_->Close();
    map_->GetParamBlock(0)->SetValue(Fake::kCount, 0, 4);
    EXPECT_EQ(changes, 1);
}

struct Filter {
    const char* text;
    std::vector<FileType> types;
};

class FileTypes : public testing::TestWithParam<Filter> {};

TEST_P(FileTypes, ComeFromAWindowsFilter) {
    const std::vector<FileType> types = Pigmo::Host::ParseFileTypes(GetParam().text);
    ASSERT_EQ(types.size(), GetParam().types.size());
    for (std::size_t i = 0; i < types.size(); ++i) {
        EXPECT_EQ(types[i].name, GetParam().types[i].name);
        EXPECT_EQ(types[i].patterns, GetParam().types[i].patterns);
    }
}

INSTANTIATE_TEST_SUITE_P(Filters, FileTypes,
                         testing::Values(Filter{"CxF 2.1 (*.cxf)|*.cxf|All (*.*)|*.*|",
                                                {{"CxF 2.1 (*.cxf)", {"*.cxf"}}, {"All (*.*)", {"*.*"}}}},
                                         Filter{"Images|*.png;*.jpg", {{"Images", {"*.png", "*.jpg"}}}},
                                         Filter{"Images|*.png;;|Lonely|", {{"Images", {"*.png"}}}},
                                         Filter{"No patterns||", {}}, Filter{"", {}}));

}  // namespace
