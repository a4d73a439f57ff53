// The palette, information and chart controls painted off screen and driven by mouse messages.
#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>
#include <string>
#include <vector>

#include "Desktop.h"
#include "IColorPalletteUser.h"
#include "InformationControl.h"
#include "PaletteControl.h"
#include "SpectralChart.h"
#include "maxapi.h"

namespace {

using Pigmo::IColorInformation;
using Pigmo::IColorPalletteUser;

// A color with a name, an sRGB triple and optionally a curve.
class FakeColor final : public IColorInformation {
public:
    FakeColor(std::string name, float r, float g, float b) : name_(std::move(name)), sRGB_{r, g, b} {}
    const char* GetName() const override { return name_.c_str(); }
    const char* GetCategory() const override { return "Reds"; }
    const float* GetSRGB() const override { return sRGB_; }
    const float* GetLinearRGB() const override { return sRGB_; }
    const float* GetLab() const override { return lab; }
    const float* GetSpectralReflectance() const override { return curve.empty() ? nullptr : curve.data(); }
    int GetSpectralReflectanceCount() const override { return static_cast<int>(curve.size()); }
    const char* GetTag(unsigned int) const override { return nullptr; }
    int GetTagCount() const override { return 0; }

    float lab[3] = {50.0f, -3.04f, 10.0f};
    std::vector<float> curve;

private:
    std::string name_;
    float sRGB_[3];
};

class FakeBook final : public IColorPalletteUser {
public:
    explicit FakeBook(int count) {
        // Distinct colors: the index spread over red and green.
        for (int i = 0; i < count; ++i)
            colors.emplace_back("C" + std::to_string(i), static_cast<float>(i % 256),
                                static_cast<float>(i / 256 * 40), 200.0f);
    }
    unsigned int GetColorCount() override { return static_cast<unsigned int>(colors.size()); }
    IColorInformation* GetColor(unsigned int index) override { return &colors[index]; }
    void SelectColor(int index) override { selected = index; }
    int GetSelectedIndex() override { return selected; }
    int SetScrollPosition(int index) override { return scroll = index; }
    int GetScrollPosition() override { return scroll; }

    std::vector<FakeColor> colors;
    int selected = -1;
    int scroll = 0;
};

LRESULT CALLBACK PlainHost(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    return DefWindowProcA(window, message, wParam, lParam);
}

COLORREF Scheme(ColorId id) {
    return GetColorManager()->GetColor(id);
}

// One control of a class in a top-level window of its size, painted off screen.
class Control : public testing::Test {
protected:
    void Open(const char* className, WNDPROC procedure, int width, int height, const void* owner) {
        WNDCLASSA windowClass{};
        windowClass.lpfnWndProc = procedure;
        windowClass.lpszClassName = className;
        RegisterClassA(&windowClass);  // a second registration of the same class is refused, harmlessly
        windowClass.lpfnWndProc = PlainHost;
        windowClass.lpszClassName = "ControlTestHost";
        RegisterClassA(&windowClass);
        top_ = CreateWindowExA(0, "ControlTestHost", "", WS_POPUP, 0, 0, width, height, nullptr, nullptr,
                               nullptr, nullptr);
        control_ = CreateWindowExA(0, className, "", WS_CHILD | WS_VISIBLE, 0, 0, width, height, top_,
                                   reinterpret_cast<HMENU>(std::uintptr_t{1}), nullptr, nullptr);
        SetWindowLongPtrA(control_, GWLP_USERDATA, reinterpret_cast<LONG_PTR>(owner));
        Pigmo::Platform::SetTextHook(
            [this](const Pigmo::Platform::DrawnText& text) { texts_.push_back(text); });
    }
    void TearDown() override {
        Pigmo::Platform::SetTextHook({});
        DestroyWindow(top_);
    }
    void Paint() {
        texts_.clear();
        InvalidateRect(control_, nullptr, TRUE);
        Pigmo::Platform::PaintWindows(top_);
    }
    COLORREF Pixel(int x, int y) const {
        cairo_surface_t* surface = Pigmo::Platform::WindowSurface(top_);
        cairo_surface_flush(surface);
        const unsigned char* row =
            cairo_image_surface_get_data(surface) + y * cairo_image_surface_get_stride(surface);
        std::uint32_t argb;
        std::memcpy(&argb, row + 4 * x, 4);
        return RGB((argb >> 16) & 0xFF, (argb >> 8) & 0xFF, argb & 0xFF);
    }
    void Mouse(UINT message, int x, int y) { Pigmo::Platform::ForwardMouse(top_, message, x, y); }
    std::vector<std::string> Texts() const {
        std::vector<std::string> all;
        for (const auto& text : texts_) all.push_back(text.text);
        return all;
    }

    HWND top_ = nullptr;
    HWND control_ = nullptr;
    std::vector<Pigmo::Platform::DrawnText> texts_;
};

COLORREF ColorOf(const FakeColor& color) {
    const float* c = color.GetSRGB();
    return RGB(static_cast<int>(c[0]), static_cast<int>(c[1]), static_cast<int>(c[2]));
}

// A 200 x 126 palette: the strip is x 150..190, the swatches x 0..130; 120 pixels of height to share.
constexpr int kWidth = 200, kHeight = 126;

using Palette = Control;

TEST_F(Palette, EmptyBookSaysSoInTheLowerHalf) {
    FakeBook book(0);
    Open("ColorPallette", Pigmo::ColorMap::ColorPalletteProc, kWidth, kHeight,
         static_cast<IColorPalletteUser*>(&book));
    Paint();
    ASSERT_EQ(texts_.size(), 1u);
    EXPECT_EQ(texts_[0].text, "- No Colors Present -");
    EXPECT_EQ(texts_[0].rect.top, kHeight / 2);
    EXPECT_EQ(texts_[0].format, DT_CENTER);
    EXPECT_EQ(texts_[0].face, "Times New Roman");
    EXPECT_EQ(Pixel(5, 5), Scheme(0));
    EXPECT_EQ(Pixel(170, 60), Scheme(0));  // no strip
    // The mouse does nothing.
    Mouse(WM_LBUTTONDOWN, 170, 100);
    EXPECT_EQ(book.scroll, 0);
    EXPECT_EQ(GetCapture(), nullptr);
}

TEST_F(Palette, ThreeColorsThreeRowsBandsAndMarkers) {
    FakeBook book(3);
    book.selected = 1;
    Open("ColorPallette", Pigmo::ColorMap::ColorPalletteProc, kWidth, kHeight,
         static_cast<IColorPalletteUser*>(&book));
    Paint();
    // Bands of 40 pixels: 2..42, 42..82, 82..122.
    for (const auto& [y, i] : {std::pair{20, 0}, {60, 1}, {100, 2}})
        EXPECT_EQ(Pixel(170, y), ColorOf(book.colors[i])) << y;
    // The scroll marker beside band 0 in the text color, the pick's beside band 1.
    EXPECT_EQ(Pixel(143, 5), Scheme(1));
    EXPECT_EQ(Pixel(196, 5), Scheme(1));
    EXPECT_EQ(Pixel(143, 45), Scheme(61));
    // Rows of 120 / 7 pixels: three swatches with their labels, then nothing.
    EXPECT_EQ(Pixel(60, 3), ColorOf(book.colors[0]));
    EXPECT_EQ(Pixel(60, 20), ColorOf(book.colors[1]));
    EXPECT_EQ(Pixel(60, 37), ColorOf(book.colors[2]));
    EXPECT_EQ(Pixel(60, 80), Scheme(0));
    EXPECT_EQ(Texts(), (std::vector<std::string>{"C0", "C1", "C2"}));
    // The thick frame around the picked row.
    EXPECT_EQ(Pixel(60, 17), Scheme(61));
}

TEST_F(Palette, ManyColorsOverlapLaterOnTopAndOnlyVisibleRowsAreFramed) {
    FakeBook book(300);
    book.scroll = 299;
    book.selected = 3;
    Open("ColorPallette", Pigmo::ColorMap::ColorPalletteProc, kWidth, kHeight,
         static_cast<IColorPalletteUser*>(&book));
    Paint();
    // 300 bands in 120 pixels: each row shows the last band that covers it.
    const float step = 120.0f / 300.0f;
    for (int y : {10, 64, 118}) {
        int last = -1;
        float top = 1.0f;
        for (int i = 0; i < 300; ++i, top += step) {
            const int bandTop = static_cast<int>(top) + 1,
                      bandBottom = static_cast<int>(bandTop + step + 1.0f);
            if (y >= bandTop && y < bandBottom) last = i;
        }
        ASSERT_GE(last, 0);
        EXPECT_EQ(Pixel(170, y), ColorOf(book.colors[last])) << y;
    }
    // Scrolled to the last color: one row, and no frame for the pick above it.
    EXPECT_EQ(Texts(), std::vector<std::string>{"C299"});
    EXPECT_EQ(Pixel(60, 3), ColorOf(book.colors[299]));
    EXPECT_EQ(Pixel(60, 30), Scheme(0));
}

struct MouseCase {
    const char* name;
    int count;
    int scroll;
    std::vector<std::pair<UINT, POINT>> moves;
    int expectedScroll;
    int expectedPick;
};

class PaletteMouse : public Control, public testing::WithParamInterface<MouseCase> {};

TEST_P(PaletteMouse, ScrollsInTheStripAndPicksOverTheSwatches) {
    const MouseCase& c = GetParam();
    FakeBook book(c.count);
    book.scroll = c.scroll;
    Open("ColorPallette", Pigmo::ColorMap::ColorPalletteProc, kWidth, kHeight,
         static_cast<IColorPalletteUser*>(&book));
    for (const auto& [message, point] : c.moves) Mouse(message, point.x, point.y);
    EXPECT_EQ(book.scroll, c.expectedScroll);
    EXPECT_EQ(book.selected, c.expectedPick);
    EXPECT_EQ(GetCapture(), nullptr);
}

INSTANTIATE_TEST_SUITE_P(Cases, PaletteMouse,
                         testing::Values(MouseCase{"StripTopScrollsToTheFirst",
                                                   50,
                                                   10,
                                                   {{WM_LBUTTONDOWN, {150, 0}}, {WM_LBUTTONUP, {150, 0}}},
                                                   0,
                                                   -1},
                                         MouseCase{"StripBottomScrollsToTheLast",
                                                   50,
                                                   0,
                                                   {{WM_LBUTTONDOWN, {190, 125}}, {WM_LBUTTONUP, {190, 125}}},
                                                   49,
                                                   -1},
                                         MouseCase{"DragAlongTheStrip",
                                                   50,
                                                   0,
                                                   {{WM_LBUTTONDOWN, {170, 0}},
                                                    {WM_MOUSEMOVE, {170, 63}},
                                                    {WM_MOUSEMOVE, {300, 90}},
                                                    {WM_LBUTTONUP, {300, 90}}},
                                                   25,
                                                   -1},
                                         MouseCase{"LowRowsOfAShortBookPickTheLast",
                                                   3,
                                                   0,
                                                   {{WM_LBUTTONDOWN, {60, 120}}, {WM_LBUTTONUP, {60, 120}}},
                                                   0,
                                                   2},
                                         MouseCase{"RowOffTheScrollPosition",
                                                   50,
                                                   10,
                                                   {{WM_LBUTTONDOWN, {0, 40}}, {WM_LBUTTONUP, {0, 40}}},
                                                   10,
                                                   12},
                                         MouseCase{"NegativeScrollStillPicksFromZero",
                                                   50,
                                                   -5,
                                                   {{WM_LBUTTONDOWN, {130, 0}}, {WM_LBUTTONUP, {130, 0}}},
                                                   -5,
                                                   0},
                                         MouseCase{"GapBetweenSwatchesAndStripDoesNothing",
                                                   50,
                                                   0,
                                                   {{WM_LBUTTONDOWN, {140, 60}}, {WM_LBUTTONUP, {140, 60}}},
                                                   0,
                                                   -1}),
                         [](const auto& info) { return std::string(info.param.name); });

using Information = Control;

TEST_F(Information, ShowsPlaceholdersWithoutAColor) {
    Open("ColorInformation", Pigmo::ColorMap::ColorInformationProc, 198, 38, nullptr);
    Paint();
    EXPECT_EQ(Texts(),
              (std::vector<std::string>{"N/A", "N/A", "L*a*b*", "*, *, *", "sRGB", "*, *, *", "HTML", "#*"}));
    EXPECT_EQ(Pixel(190, 30), Scheme(0));
}

TEST_F(Information, WritesTheColorWithItsFonts) {
    FakeColor color("Red 032", 254.6f, 0.4f, 128.6f);
    Open("ColorInformation", Pigmo::ColorMap::ColorInformationProc, 198, 200,
         static_cast<IColorInformation*>(&color));
    Paint();
    EXPECT_EQ(Texts(), (std::vector<std::string>{"Red 032", "Reds", "L*a*b*", "50.0, -3.0, 10.0", "sRGB",
                                                 "255, 0, 129", "HTML", "#FE0080"}));
    struct Expected {
        int top, left, height, weight;
        COLORREF color;
    };
    const Expected expected[] = {{0, 0, 20, FW_BOLD, Scheme(1)}, {24, 0, 16, FW_BOLD, Scheme(20)},
                                 {44, 0, 14, 0, Scheme(20)},     {44, 50, 14, FW_BOLD, Scheme(1)},
                                 {61, 0, 14, 0, Scheme(20)},     {61, 50, 14, FW_BOLD, Scheme(1)},
                                 {78, 0, 14, 0, Scheme(20)},     {78, 50, 14, FW_BOLD, Scheme(1)}};
    ASSERT_EQ(texts_.size(), std::size(expected));
    for (std::size_t i = 0; i < texts_.size(); ++i) {
        EXPECT_EQ(texts_[i].rect.top, expected[i].top) << i;
        EXPECT_EQ(texts_[i].rect.left, expected[i].left) << i;
        EXPECT_EQ(texts_[i].rect.right, 188) << i;
        EXPECT_EQ(texts_[i].height, expected[i].height) << i;
        EXPECT_EQ(texts_[i].weight, expected[i].weight) << i;
        EXPECT_EQ(texts_[i].color, expected[i].color) << i;
        EXPECT_EQ(texts_[i].format, 0u) << i;
    }
}

using Chart = Control;

// A 314 x 110 chart: the plot spans x 24..290 and y 1..109.
TEST_F(Chart, LabelsTheGridAndPlotsTheCurve) {
    FakeColor color("Grey", 128, 128, 128);
    color.curve.assign(36, 0.5f);
    color.curve[0] = 1.0f;
    color.curve[35] = 0.0f;
    Open("SpectralChart", Pigmo::ColorMap::SpectralChartProc, 314, 110,
         static_cast<IColorInformation*>(&color));
    Paint();
    EXPECT_EQ(Texts(), (std::vector<std::string>{"1", "0.89", "0.78", "0.67", "0.56", "0.44", "0.33", "0.22",
                                                 "0.11", "0"}));
    for (std::size_t i = 0; i < texts_.size(); ++i) {
        const int y = 1 + static_cast<int>(i * 10.8);
        EXPECT_EQ(texts_[i].rect.top, y) << i;
        EXPECT_EQ(texts_[i].rect.left, 4) << i;
        EXPECT_EQ(texts_[i].rect.bottom, y + 12) << i;
        EXPECT_EQ(texts_[i].format, DT_BOTTOM) << i;
    }
    EXPECT_EQ(Pixel(150, 11), Scheme(59));  // the second grid line
    EXPECT_EQ(Pixel(150, 30), Scheme(39));
    // Markers: the first at the left edge and height 0, the last at the right edge, 0.5 at half height.
    EXPECT_EQ(Pixel(24, 1), Scheme(60));
    EXPECT_EQ(Pixel(290 - 1, 107), Scheme(60));
    const int middleX = 24 + static_cast<int>(266.0 * 17 / 35);
    EXPECT_EQ(Pixel(middleX, 54), Scheme(60));
}

TEST_F(Chart, WithoutAColorOnlyTheGrid) {
    Open("SpectralChart", Pigmo::ColorMap::SpectralChartProc, 314, 110, nullptr);
    Paint();
    EXPECT_EQ(texts_.size(), 10u);
    for (int x = 24; x < 290; x += 7) EXPECT_NE(Pixel(x, 54), Scheme(60)) << x;
}

}  // namespace
