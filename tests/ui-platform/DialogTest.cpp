#include "UiTest.h"

namespace {

std::vector<UiTest::Message> dialogMessages;
std::vector<HWND> controlsAtInit;

INT_PTR CALLBACK RecordingDialogProc(HWND dialog, UINT message, WPARAM wParam, LPARAM lParam) {
    dialogMessages.push_back({dialog, message, wParam, lParam});
    if (message == WM_INITDIALOG)
        for (const int id : {-1, 1007, 1008, 1003, 1004}) controlsAtInit.push_back(GetDlgItem(dialog, id));
    constexpr UINT kAnswered = 0x8001;
    return message == kAnswered ? 5 : 0;
}

// Part of a rollout page: a label, the palette list, a read-only field and two custom controls.
const DialogItemTemplate kItems[] = {
    {"Static", -1, "ColorBook File:", 5, 2, 48, 8, 0x50020000},
    {"ListBox", 1007, "", 4, 30, 207, 45, 0x50A10101},
    {"Edit", 1008, "", 121, 249, 89, 12, 0x50010880},
    {"Recorder", 1003, "ColorPallette", 4, 88, 208, 119, 0x50010000},
    {"Recorder", 1004, "ColorInfo", 80, 222, 132, 25, 0x58010000},
};

HWND CreatePage(const char* face = "MS Shell Dlg", int points = 8, LPARAM param = 0) {
    UiTest::Register("Recorder", UiTest::RecordingProcedure);
    dialogMessages.clear();
    controlsAtInit.clear();
    const DialogTemplate page{0x40080048, 0, 217, 405, face, points, kItems, std::size(kItems)};
    return CreateDialogIndirectParamA(nullptr, &page, nullptr, RecordingDialogProc, param);
}

struct FontUnits {
    const char* face;
    int points;
    int baseX, baseY;
};

class DialogUnits : public testing::TestWithParam<FontUnits> {};

// MS Shell Dlg at 8 points measures 6 by 12 with Liberation Sans (Windows' Tahoma: 6 by 13).
TEST_P(DialogUnits, ConvertWithTheBaseUnitsOfTheTemplatesFont) {
    const FontUnits& c = GetParam();
    const HWND dialog = CreatePage(c.face, c.points);
    ASSERT_NE(dialog, nullptr);
    RECT units{1, 3, 4, 8};
    EXPECT_EQ(MapDialogRect(dialog, &units), TRUE);
    EXPECT_EQ(units.right, c.baseX);
    EXPECT_EQ(units.bottom, c.baseY);
    EXPECT_EQ(units.left, (2 * c.baseX + 4) / 8);  // MulDiv rounds halves up
    EXPECT_EQ(units.top, (6 * c.baseY + 8) / 16);
    RECT page{0, 0, 217, 405};
    MapDialogRect(dialog, &page);
    EXPECT_EQ(cairo_image_surface_get_width(Pigmo::Platform::WindowSurface(dialog)), page.right);
    EXPECT_EQ(cairo_image_surface_get_height(Pigmo::Platform::WindowSurface(dialog)), page.bottom);

    // The palette sits at its template rectangle: its corner reaches it, the pixel before the dialog.
    const HWND palette = GetDlgItem(dialog, 1003);
    RECT area{4, 88, 4 + 208, 88 + 119};
    MapDialogRect(dialog, &area);
    RECT client{};
    GetClientRect(palette, &client);
    EXPECT_EQ(client.right, area.right - area.left);
    EXPECT_EQ(client.bottom, area.bottom - area.top);
    UiTest::received.clear();
    Pigmo::Platform::ForwardMouse(dialog, WM_MOUSEMOVE, area.left - 1, area.top - 1);
    Pigmo::Platform::ForwardMouse(dialog, WM_MOUSEMOVE, area.left, area.top);
    ASSERT_EQ(UiTest::received.size(), 1u);
    EXPECT_EQ(UiTest::received[0].window, palette);
    EXPECT_EQ(UiTest::received[0].lParam, 0);
    EXPECT_EQ(dialogMessages.back().message, static_cast<UINT>(WM_MOUSEMOVE));
    DestroyWindow(dialog);
}

INSTANTIATE_TEST_SUITE_P(Fonts, DialogUnits,
                         testing::Values(FontUnits{"MS Shell Dlg", 8, 6, 12},
                                         FontUnits{"Times New Roman", 12, 9, 17}));

TEST(Dialogs, InitialiseOnceEveryControlExistsAndPaintInTheDialogFont) {
    const HWND dialog = CreatePage("MS Shell Dlg", 8, 1234);
    ASSERT_NE(dialog, nullptr);
    ASSERT_EQ(dialogMessages.size(), 1u);  // a dialog procedure sees no WM_CREATE
    EXPECT_EQ(dialogMessages[0].message, static_cast<UINT>(WM_INITDIALOG));
    EXPECT_EQ(dialogMessages[0].lParam, 1234);
    EXPECT_EQ(dialogMessages[0].wParam,
              reinterpret_cast<WPARAM>(GetDlgItem(dialog, 1007)));  // first tab stop
    for (const HWND control : controlsAtInit) EXPECT_NE(control, nullptr);
    EXPECT_EQ(controlsAtInit.size(), 5u);
    EXPECT_EQ(IsWindowEnabled(GetDlgItem(dialog, 1004)), FALSE);
    EXPECT_EQ(SendMessageA(dialog, 0x8001, 0, 0), 5);            // what the dialog procedure answers
    EXPECT_EQ(SendMessageA(dialog, WM_GETTEXTLENGTH, 0, 0), 0);  // else DefWindowProcA

    std::vector<Pigmo::Platform::DrawnText> drawn;
    Pigmo::Platform::SetTextHook([&](const Pigmo::Platform::DrawnText& text) { drawn.push_back(text); });
    Pigmo::Platform::PaintWindows(dialog);
    Pigmo::Platform::SetTextHook({});
    EXPECT_EQ(UiTest::Pixel(dialog, 300, 5), GetSysColor(COLOR_BTNFACE));
    ASSERT_EQ(drawn.size(), 2u);  // the label and the empty field
    EXPECT_EQ(drawn[0].text, "ColorBook File:");
    EXPECT_EQ(drawn[0].face, "MS Shell Dlg");
    EXPECT_EQ(drawn[0].height, -11);
    DestroyWindow(dialog);

    const DialogItemTemplate unknown[] = {kItems[0],
                                          {"NoSuchClass", 1005, "None", 4, 12, 207, 14, 0x50010000}};
    const DialogTemplate page{0x40080048, 0, 217, 405, "MS Shell Dlg", 8, unknown, std::size(unknown)};
    dialogMessages.clear();
    EXPECT_EQ(CreateDialogIndirectParamA(nullptr, &page, nullptr, RecordingDialogProc, 0), nullptr);
    for (const UiTest::Message& m : dialogMessages) EXPECT_NE(m.message, static_cast<UINT>(WM_INITDIALOG));
}

}  // namespace
