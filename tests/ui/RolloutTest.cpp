// The Color Map's rollout in the host's material editor: fields, file button, swatch, tooltip and the
// palette list, driven as the host and the user drive them.
#include <gtest/gtest.h>

#include <cstring>
#include <optional>
#include <string>
#include <vector>

#include "BookFiles.h"
#include "Descriptor.h"
#include "Map.h"
#include "MapDlgProc.h"
#include "MaterialEditor.h"
#include "Paths.h"

extern "C" ClassDesc* LibClassDesc(int i);

namespace {

using Pigmo::ColorMap::Map;
namespace CM = Pigmo::ColorMap;

// Where the template puts the file button and the color swatch, in dialog units.
constexpr RECT kButton = {4, 12, 211, 26};
constexpr RECT kSwatch = {7, 224, 74, 293};

class Rollout : public PaletteFolders {
protected:
    void TearDown() override {
        editor_.reset();
        if (map_ != nullptr) map_->DeleteThis();
        PaletteFolders::TearDown();
    }
    Map& OpenMap() {
        map_ = static_cast<Map*>(static_cast<Texmap*>(LibClassDesc(0)->Create(FALSE)));
        editor_.emplace();
        editor_->Open(*map_);
        return *map_;
    }
    std::string Text(int id) const {
        char text[MAX_PATH] = "";
        GetWindowTextA(GetDlgItem(editor_->Rollout(), id), text, sizeof text);
        return text;
    }
    // The centre of a control placed at these dialog units; the rollout fills the editor from its corner.
    POINT Centre(RECT units) const {
        MapDialogRect(editor_->Rollout(), &units);
        return {(units.left + units.right) / 2, (units.top + units.bottom) / 2};
    }
    COLORREF PixelAt(POINT point) {
        cairo_surface_t* surface = editor_->Paint();
        cairo_surface_flush(surface);
        const unsigned char* row =
            cairo_image_surface_get_data(surface) + point.y * cairo_image_surface_get_stride(surface);
        std::uint32_t argb;
        std::memcpy(&argb, row + 4 * point.x, 4);
        return RGB((argb >> 16) & 0xFF, (argb >> 8) & 0xFF, argb & 0xFF);
    }
    // A system palette; the suite's entry points at the test's folder.
    std::string Book(const std::string& name, const std::string& paletteName, const std::string& colors) {
        Pigmo::Platform::RegistryStore::Instance().SetString(Pigmo::Platform::kSuiteUninstallKey,
                                                             "InstallLocation", root_ + "/suite/");
        return System(name, BookFolder::Book(ColorSet(colors), " PaletteName=\"" + paletteName + "\""));
    }

    Map* map_ = nullptr;
    std::optional<Pigmo::Host::MaterialEditor> editor_;
};

const char* const kRedColor =
    R"(<CxF:Color ColorName="Red 032"><CxF:CustomAttribute><CxF:Name>category</CxF:Name><CxF:ValueChoice>)"
    "<CxF:StringValue>Reds</CxF:StringValue></CxF:ValueChoice></CxF:CustomAttribute><CxF:CustomAttribute>"
    "<CxF:Name>tags</CxF:Name><CxF:ValueChoice><CxF:StringValue>a</CxF:StringValue><CxF:StringValue>b"
    "</CxF:StringValue><CxF:StringValue>c</CxF:StringValue></CxF:ValueChoice></CxF:CustomAttribute>"
    "<CxF:ColorSpaceCIELab><CxF:L>50</CxF:L><CxF:A>-3.04</CxF:A><CxF:B>10</CxF:B></CxF:ColorSpaceCIELab>"
    "</CxF:Color>";

TEST_F(Rollout, WithoutABookTheFieldsReadZeroAndTheButtonNone) {
    OpenMap();
    EXPECT_EQ(Text(1008), "0.0, 0.0, 0.0");
    EXPECT_EQ(Text(1009), "0, 0, 0");
    EXPECT_EQ(Text(1011), "0.00, 0.00, 0.00");
    EXPECT_EQ(Text(1010), "");
    EXPECT_EQ(Text(1005), "None");
    const POINT button = Centre(kButton);
    EXPECT_EQ(editor_->ToolTipAt(button.x, button.y), "");
    EXPECT_EQ(SendMessageA(GetDlgItem(editor_->Rollout(), 1007), LB_GETCOUNT, 0, 0), 0);
}

TEST_F(Rollout, APickFillsTheFieldsAndTheBookNamesTheButton) {
    const std::string book = Book("reds.cxf", "Reds", kRedColor);
    Map& map = OpenMap();
    EXPECT_EQ(Text(1008), "50.0, -3.0, 10.0");
    EXPECT_EQ(Text(1010), "a, b, c");
    EXPECT_EQ(Text(1005), "reds.cxf");
    const POINT button = Centre(kButton);
    EXPECT_EQ(editor_->ToolTipAt(button.x, button.y), book);
    // The rollout's own surface names the current color.
    EXPECT_EQ(editor_->ToolTipAt(1, 1), "Red 032 (Reds)");
    map.SelectColor(-1);
    EXPECT_EQ(Text(1010), "");
    EXPECT_EQ(Text(1008), "0.0, 0.0, 0.0");
}

struct SwatchCase {
    Point3 sRGB;
    COLORREF expected;
};

class Swatch : public Rollout, public testing::WithParamInterface<SwatchCase> {};

// Each channel over 255 as a float, times 255 plus a half, truncated: what the swatch shows.
TEST_P(Swatch, RoundsTheCurrentSRGB) {
    Map& map = OpenMap();
    map.GetParamBlock(0)->SetValue(CM::currentColorSRGB, 0, GetParam().sRGB);
    CM::RefreshRollout(&map);
    EXPECT_EQ(PixelAt(Centre(kSwatch)), GetParam().expected);
}

INSTANTIATE_TEST_SUITE_P(Cases, Swatch,
                         testing::Values(SwatchCase{Point3(254.6f, 0.4f, 128.6f), RGB(255, 0, 129)},
                                         SwatchCase{Point3(128.5f, 0.0f, 0.0f), RGB(128, 0, 0)}));

TEST_F(Rollout, ListsSystemThenUserPalettesAndLoadsOnlyWhenChosen) {
    Book("b.cxf", "System B", kRedColor);
    Book("a.cxf", "System A", R"(<CxF:Color ColorName="First"/><CxF:Color ColorName="Second"/>)");
    const std::string user = User(
        "u.cxf", BookFolder::Book(ColorSet(R"(<CxF:Color ColorName="Mine"/>)"), R"( PaletteName="User U")"));
    Map& map = OpenMap();
    const std::string defaultBook = map.GetParamBlock(0)->GetStr(CM::colorBookFilePath);
    const HWND list = GetDlgItem(editor_->Rollout(), 1007);
    std::vector<std::string> entries;
    for (LRESULT i = 0; i < SendMessageA(list, LB_GETCOUNT, 0, 0); ++i) {
        char text[64] = "";
        SendMessageA(list, LB_GETTEXT, static_cast<WPARAM>(i), reinterpret_cast<LPARAM>(text));
        entries.emplace_back(text);
    }
    EXPECT_EQ(entries, (std::vector<std::string>{"System A", "System B", "User U"}));
    EXPECT_EQ(SendMessageA(list, LB_GETCURSEL, 0, 0), 0);
    EXPECT_EQ(map.GetParamBlock(0)->GetStr(CM::colorBookFilePath), defaultBook);

    // Choosing the user's entry, as a click in the list tells the rollout.
    SendMessageA(list, LB_SETCURSEL, 2, 0);
    SendMessageA(editor_->Rollout(), WM_COMMAND, MAKEWPARAM(1007, LBN_SELCHANGE),
                 reinterpret_cast<LPARAM>(list));
    EXPECT_EQ(Pigmo::Platform::NativePath(map.GetParamBlock(0)->GetStr(CM::colorBookFilePath)), user);
    EXPECT_EQ(map.GetSelectedIndex(), 0);
    EXPECT_STREQ(map.GetName(), "Mine");
    EXPECT_EQ(Text(1005), "u.cxf");

    // Reopened, the rollout lists what the folders hold now.
    User("v.cxf", BookFolder::Book(""));
    editor_->Open(map);
    EXPECT_EQ(SendMessageA(GetDlgItem(editor_->Rollout(), 1007), LB_GETCOUNT, 0, 0), 4);
}

}  // namespace
