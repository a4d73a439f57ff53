// The Color Map's rollout as the host builds it: template 101 of the library's resources, its
// controls in the host's editor, and the file button bound to the book parameter.
#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <iterator>
#include <optional>
#include <string>
#include <vector>

#include "Descriptor.h"
#include "DialogTemplate.h"
#include "FileDialog.h"
#include "IColorPalletteUser.h"
#include "MaterialEditor.h"
#include "PluginLibrary.h"
#include "Scene.h"

namespace {

using Pigmo::Host::FileDialogRequest;

struct Item {
    const char* className;
    int id;
    const char* text;
    short x, y, cx, cy;
    DWORD style;
};

// The rollout's eighteen controls in template order, in dialog units.
const Item kRolloutItems[] = {
    {"Static", -1, "ColorBook File:", 5, 2, 48, 8, 0x50020000},
    {"Static", -1, "Select a Color from the ColorBook File:", 7, 78, 124, 8, 0x50020000},
    {"Static", -1, "Measured Spectral Reflectance:", 5, 300, 103, 8, 0x50020000},
    {"ColorPallette", 1003, "ColorPallette", 4, 88, 208, 119, 0x50010000},
    {"ColorInformation", 1004, "ColorInfo", 80, 222, 132, 25, 0x58010000},
    {"Static", -1, "Selected Color Information:", 5, 210, 89, 8, 0x50020000},
    {"SpectralChart", 1002, "Custom1", 3, 312, 209, 73, 0x58010000},
    {"CustButton", 1005, "None", 4, 12, 207, 14, 0x50010000},
    {"ColorSwatch", 1006, "Custom1", 7, 224, 67, 69, 0x58010000},
    {"ListBox", 1007, "", 4, 30, 207, 45, 0x50A10101},
    {"Static", -1, "L*a*b*", 83, 249, 24, 8, 0x50020000},
    {"Edit", 1008, "", 121, 249, 89, 12, 0x50010880},
    {"Static", -1, "sRGB", 83, 260, 18, 8, 0x50020000},
    {"Edit", 1009, "", 121, 260, 89, 12, 0x50010880},
    {"Static", -1, "Tags", 82, 283, 16, 8, 0x50020000},
    {"Edit", 1010, "", 121, 283, 89, 12, 0x50010880},
    {"Static", -1, "Linear RGB", 83, 272, 36, 8, 0x50020000},
    {"Edit", 1011, "", 121, 272, 89, 12, 0x50010880},
};

class TemplateItem : public testing::TestWithParam<std::size_t> {};

TEST_P(TemplateItem, IsAsTheRolloutLists) {
    const DialogTemplate* rollout = Pigmo::FindResourceDialog(101);
    ASSERT_NE(rollout, nullptr);
    ASSERT_EQ(rollout->itemCount, std::size(kRolloutItems));
    const Item& expected = kRolloutItems[GetParam()];
    const DialogItemTemplate& item = rollout->items[GetParam()];
    EXPECT_STREQ(item.className, expected.className);
    EXPECT_EQ(item.id, expected.id);
    EXPECT_STREQ(item.text, expected.text);
    EXPECT_EQ(item.x, expected.x);
    EXPECT_EQ(item.y, expected.y);
    EXPECT_EQ(item.cx, expected.cx);
    EXPECT_EQ(item.cy, expected.cy);
    EXPECT_EQ(item.style, expected.style) << std::hex << item.style;
}

INSTANTIATE_TEST_SUITE_P(Rollout, TemplateItem, testing::Range<std::size_t>(0, std::size(kRolloutItems)));

TEST(Template, IsAChildPageInTheDialogFont) {
    const DialogTemplate* rollout = Pigmo::FindResourceDialog(101);
    ASSERT_NE(rollout, nullptr);
    EXPECT_EQ(rollout->style, 0x40080048u);
    EXPECT_EQ(rollout->exStyle, 0u);
    EXPECT_EQ(rollout->cx, 217);
    EXPECT_EQ(rollout->cy, 405);
    EXPECT_STREQ(rollout->fontFace, "MS Shell Dlg");
    EXPECT_EQ(rollout->pointSize, 8);
    EXPECT_EQ(Pigmo::FindResourceDialog(102), nullptr);
}

const std::string kTestBook = std::string(PIGMO_PALETTE_SOURCE_DIR) + "Test Color Samples.cxf";

// The real plug-in, loaded as the host loads it, with a new map on its default book.
class ColorMapRollout : public testing::Test {
protected:
    void SetUp() override {
        map_ = &scene_.NewMap(Pigmo::ColorMap::kColorMapClassID);
        editor_->Open(*map_);
    }
    void TearDown() override {
        Pigmo::Host::SetFileDialogHandler({});
        editor_.reset();
    }

    Pigmo::IColorPalletteUser& Palette() {
        return *dynamic_cast<Pigmo::IColorPalletteUser*>(static_cast<Animatable*>(map_));
    }
    std::string Text(int id) {
        char text[MAX_PATH] = "";
        GetWindowTextA(GetDlgItem(editor_->Rollout(), id), text, sizeof text);
        return text;
    }

    Pigmo::Host::PluginLibrary library_{Pigmo::Host::PluginLibrary::DefaultPath()};
    Pigmo::Host::Scene scene_{library_.Classes()};
    Texmap* map_ = nullptr;
    std::optional<Pigmo::Host::MaterialEditor> editor_{std::in_place};
};

TEST_F(ColorMapRollout, HasEveryControlOfTheTemplate) {
    const HWND rollout = editor_->Rollout();
    ASSERT_NE(rollout, nullptr);
    for (const Item& item : kRolloutItems) {
        if (item.id == -1) continue;
        EXPECT_NE(GetDlgItem(rollout, item.id), nullptr) << item.id;
    }
    RECT size{0, 0, 217, 405};
    MapDialogRect(rollout, &size);
    EXPECT_EQ(editor_->Width(), size.right);
    EXPECT_EQ(editor_->Height(), size.bottom);
}

TEST_F(ColorMapRollout, FileButtonTakesTheChosenBook) {
    IParamBlock2& parameters = *map_->GetParamBlock(0);
    const std::string before = parameters.GetStr(0);
    const unsigned int colorsBefore = Palette().GetColorCount();
    std::vector<FileDialogRequest> requests;
    Pigmo::Host::SetFileDialogHandler([&](const FileDialogRequest& request) {
        requests.push_back(request);
        return std::optional<std::string>(kTestBook);
    });
    RECT button{4, 12, 4 + 207, 12 + 14};
    MapDialogRect(editor_->Rollout(), &button);
    const int x = (button.left + button.right) / 2, y = (button.top + button.bottom) / 2;
    editor_->Mouse(WM_LBUTTONDOWN, x, y);
    editor_->Mouse(WM_LBUTTONUP, x, y);

    ASSERT_EQ(requests.size(), 1u);
    EXPECT_EQ(requests[0].caption, "Select Location of a ColorBook File");
    ASSERT_EQ(requests[0].types.size(), 2u);
    EXPECT_EQ(requests[0].types[0].name, "CxF 2.1 (*.cxf)");
    EXPECT_EQ(requests[0].types[0].patterns, std::vector<std::string>{"*.cxf"});
    EXPECT_EQ(requests[0].types[1].name, "All (*.*)");
    EXPECT_EQ(requests[0].types[1].patterns, std::vector<std::string>{"*.*"});
    // The dialog opens at the book the map has, whose path palette discovery wrote the Windows way.
    std::string native = before;
    std::replace(native.begin(), native.end(), '\\', '/');
    EXPECT_EQ(requests[0].initialPath, native);

    // The host stored the file; the map read the new book and cleared its pick.
    EXPECT_EQ(std::string(parameters.GetStr(0)), kTestBook);
    EXPECT_NE(Palette().GetColorCount(), colorsBefore);
    EXPECT_GT(Palette().GetColorCount(), 0u);
    EXPECT_EQ(Palette().GetSelectedIndex(), -1);
    EXPECT_EQ(Text(1005), "Test Color Samples.cxf");
}

}  // namespace
