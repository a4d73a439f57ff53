// The host's custom controls (push button, color swatch) and its interface colors, painted and
// clicked through the material editor's window.
#include <gtest/gtest.h>

#include <cmath>
#include <optional>
#include <string>
#include <vector>

#include "Desktop.h"
#include "MaterialEditor.h"
#include "custcont.h"
#include "maxapi.h"

namespace {

using Pigmo::Host::MaterialEditor;

constexpr int kButtonId = 1005;
// The button, in the editor's pixels; the recorder window under it starts at the editor's corner.
constexpr RECT kButton{20, 10, 120, 34};
const POINT kInside{70, 22};
const POINT kOutside{150, 60};

struct Command {
    WPARAM wParam;
    LPARAM lParam;
};

std::vector<Command>& Commands() {
    static std::vector<Command> commands;
    return commands;
}

LRESULT CALLBACK RecorderProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    if (message == WM_COMMAND) Commands().push_back({wParam, lParam});
    return DefWindowProcA(window, message, wParam, lParam);
}

COLORREF Pixel(const Pigmo::Host::Image& image, int x, int y) {
    const std::size_t at = (static_cast<std::size_t>(y) * image.width + x) * 3u;
    return RGB(image.rgb[at], image.rgb[at + 1], image.rgb[at + 2]);
}

class CustomControls : public testing::Test {
protected:
    void SetUp() override {
        static const ATOM recorder = [] {
            WNDCLASSA windowClass{};
            windowClass.lpfnWndProc = RecorderProc;
            windowClass.lpszClassName = "CommandRecorder";
            return RegisterClassA(&windowClass);
        }();
        ASSERT_NE(recorder, 0);
        Commands().clear();
        SetWindowPos(editor_.Window(), nullptr, 0, 0, 200, 100, SWP_NOMOVE);
        parent_ = CreateWindowExA(0, "CommandRecorder", "", WS_CHILD | WS_VISIBLE, 0, 0, 200, 100,
                                  editor_.Window(), nullptr, nullptr, nullptr);
        button_ = CreateWindowExA(0, "CustButton", "", WS_CHILD | WS_VISIBLE, kButton.left, kButton.top,
                                  kButton.right - kButton.left, kButton.bottom - kButton.top, parent_,
                                  reinterpret_cast<HMENU>(std::intptr_t{kButtonId}), nullptr, nullptr);
        ASSERT_NE(button_, nullptr);
    }

    void Mouse(UINT message, POINT at) { editor_.Mouse(message, at.x, at.y); }

    MaterialEditor editor_;
    HWND parent_ = nullptr;
    HWND button_ = nullptr;
};

class SwatchColor : public CustomControls, public testing::WithParamInterface<COLORREF> {};

TEST_P(SwatchColor, FillsTheFrameWithItsColor) {
    HWND swatch = CreateWindowExA(0, "ColorSwatch", "", WS_CHILD | WS_VISIBLE, 130, 40, 40, 30, parent_,
                                  nullptr, nullptr, nullptr);
    IColorSwatch* colors = GetIColorSwatch(swatch, GetParam(), "Current Color");
    ASSERT_NE(colors, nullptr);
    EXPECT_EQ(colors->GetColor(), GetParam());
    const Pigmo::Host::Image image = editor_.Snapshot(1);
    EXPECT_EQ(Pixel(image, 150, 55), GetParam());
    EXPECT_EQ(Pixel(image, 131, 41), GetParam());
    for (const POINT corner : {POINT{130, 40}, POINT{169, 69}})
        EXPECT_EQ(Pixel(image, corner.x, corner.y), GetSysColor(COLOR_BTNSHADOW));
    EXPECT_EQ(colors->SetColor(RGB(1, 2, 3)), GetParam());
    EXPECT_EQ(Pixel(editor_.Snapshot(1), 150, 55), RGB(1, 2, 3));
    EXPECT_EQ(editor_.ToolTipAt(150, 55), "Current Color");
    ReleaseIColorSwatch(colors);
}

INSTANTIATE_TEST_SUITE_P(Colors, SwatchColor,
                         testing::Values(RGB(255, 0, 129), RGB(0, 0, 0), RGB(12, 200, 7)));

TEST_F(CustomControls, InterfacesOnlyForTheirOwnClass) {
    HWND swatch = CreateWindowExA(0, "ColorSwatch", "", WS_CHILD | WS_VISIBLE, 130, 40, 40, 30, parent_,
                                  nullptr, nullptr, nullptr);
    EXPECT_EQ(GetICustButton(swatch), nullptr);
    EXPECT_EQ(GetICustButton(parent_), nullptr);
    EXPECT_EQ(GetICustButton(nullptr), nullptr);
    EXPECT_EQ(GetIColorSwatch(button_, 0, "x"), nullptr);
    DestroyWindow(swatch);
    EXPECT_EQ(GetIColorSwatch(swatch, 0, "x"), nullptr);
}

TEST_F(CustomControls, ButtonKeepsItsTextAndShowsItCentredInTheDialogFont) {
    ICustButton* button = GetICustButton(button_);
    ASSERT_NE(button, nullptr);
    button->SetText("Reds.cxf");
    char text[5] = "????";
    button->GetText(text, sizeof text);
    EXPECT_STREQ(text, "Reds");
    std::vector<Pigmo::Platform::DrawnText> drawn;
    Pigmo::Platform::SetTextHook([&](const Pigmo::Platform::DrawnText& t) {
        if (t.window == button_) drawn.push_back(t);
    });
    editor_.Paint();
    Pigmo::Platform::SetTextHook({});
    ASSERT_EQ(drawn.size(), 1u);
    EXPECT_EQ(drawn[0].text, "Reds.cxf");
    EXPECT_EQ(drawn[0].format, DT_CENTER | DT_VCENTER | DT_SINGLELINE);
    EXPECT_EQ(drawn[0].face, "MS Shell Dlg");
    EXPECT_EQ(drawn[0].height, -11);
    EXPECT_EQ(drawn[0].color, GetSysColor(COLOR_BTNTEXT));
    ReleaseICustButton(button);
}

TEST_F(CustomControls, ButtonTooltipOnlyWhenSwitchedOn) {
    ICustButton* button = GetICustButton(button_);
    EXPECT_EQ(editor_.ToolTipAt(kInside.x, kInside.y), "");
    button->SetTooltip(TRUE, "/books/Reds.cxf");
    EXPECT_EQ(editor_.ToolTipAt(kInside.x, kInside.y), "/books/Reds.cxf");
    EXPECT_EQ(editor_.ToolTipAt(kOutside.x, kOutside.y), "");
    button->SetTooltip(FALSE, "/books/Reds.cxf");
    EXPECT_EQ(editor_.ToolTipAt(kInside.x, kInside.y), "");
    ReleaseICustButton(button);
}

TEST_F(CustomControls, ButtonFaceShowsThePress) {
    const POINT face{kButton.left + 3, kButton.top + 3};
    EXPECT_EQ(Pixel(editor_.Snapshot(1), face.x, face.y), GetSysColor(COLOR_BTNFACE));
    EXPECT_EQ(Pixel(editor_.Snapshot(1), kButton.left, kButton.top), GetSysColor(COLOR_BTNSHADOW));
    EXPECT_EQ(Pixel(editor_.Snapshot(1), kButton.right - 1, kButton.bottom - 1),
              GetSysColor(COLOR_BTNSHADOW));
    Mouse(WM_LBUTTONDOWN, kInside);
    EXPECT_EQ(Pixel(editor_.Snapshot(1), face.x, face.y), GetSysColor(COLOR_HIGHLIGHT));
    Mouse(WM_MOUSEMOVE, kOutside);
    EXPECT_EQ(Pixel(editor_.Snapshot(1), face.x, face.y), GetSysColor(COLOR_BTNFACE));
    Mouse(WM_MOUSEMOVE, kInside);
    Mouse(WM_LBUTTONUP, kInside);
    EXPECT_EQ(Pixel(editor_.Snapshot(1), face.x, face.y), GetSysColor(COLOR_BTNFACE));
}

// A click is a press and a release over the button, wherever the pointer went between.
struct Gesture {
    const char* name;
    std::vector<std::pair<UINT, POINT>> steps;
    std::size_t clicks;
};

class ButtonClick : public CustomControls, public testing::WithParamInterface<Gesture> {};

TEST_P(ButtonClick, TellsTheParent) {
    for (const auto& [message, at] : GetParam().steps) Mouse(message, at);
    ASSERT_EQ(Commands().size(), GetParam().clicks);
    for (const Command& command : Commands()) {
        EXPECT_EQ(command.wParam, MAKEWPARAM(kButtonId, BN_CLICKED));
        EXPECT_EQ(command.lParam, reinterpret_cast<LPARAM>(button_));
    }
    EXPECT_EQ(GetCapture(), nullptr);
}

INSTANTIATE_TEST_SUITE_P(
    Gestures, ButtonClick,
    testing::Values(Gesture{"PressAndRelease", {{WM_LBUTTONDOWN, kInside}, {WM_LBUTTONUP, kInside}}, 1},
                    Gesture{"ReleasedOutside",
                            {{WM_LBUTTONDOWN, kInside}, {WM_MOUSEMOVE, kOutside}, {WM_LBUTTONUP, kOutside}},
                            0},
                    Gesture{"DraggedBack",
                            {{WM_LBUTTONDOWN, kInside},
                             {WM_MOUSEMOVE, kOutside},
                             {WM_MOUSEMOVE, kInside},
                             {WM_LBUTTONUP, kInside}},
                            1},
                    Gesture{"ReleaseOnly", {{WM_LBUTTONUP, kInside}}, 0},
                    Gesture{"PressedElsewhere", {{WM_LBUTTONDOWN, kOutside}, {WM_LBUTTONUP, kInside}}, 0},
                    Gesture{"Twice",
                            {{WM_LBUTTONDOWN, kInside},
                             {WM_LBUTTONUP, kInside},
                             {WM_LBUTTONDOWN, kInside},
                             {WM_LBUTTONUP, kInside}},
                            2}),
    [](const testing::TestParamInfo<Gesture>& info) { return info.param.name; });

double Luminance(COLORREF c) {
    return 0.2126 * GetRValue(c) + 0.7152 * GetGValue(c) + 0.0722 * GetBValue(c);
}

// The standard controls paint with the same scheme as the custom ones, and every text or line stands
// out from what it is drawn on.
TEST_F(CustomControls, OneColorSchemeForSystemAndHostColors) {
    IColorManager* colors = GetColorManager();
    const std::pair<int, ColorId> same[] = {{COLOR_BTNFACE, 0},
                                            {COLOR_BTNTEXT, 1},
                                            {COLOR_WINDOWTEXT, 1},
                                            {COLOR_WINDOW, 7},
                                            {COLOR_HIGHLIGHT, 61}};
    for (const auto& [system, host] : same) EXPECT_EQ(GetSysColor(system), colors->GetColor(host)) << system;
    const std::pair<ColorId, ColorId> onTop[] = {{1, 0},   {1, 7},  {20, 0}, {1, 39},
                                                 {60, 39}, {61, 0}, {61, 7}};
    for (const auto& [front, back] : onTop)
        EXPECT_GT(std::abs(Luminance(colors->GetColor(front)) - Luminance(colors->GetColor(back))), 40.0)
            << front << " on " << back;
    EXPECT_NE(colors->GetColor(59), colors->GetColor(39));
}

}  // namespace
