#include "UiTest.h"

namespace {

using UiTest::Pixel;

constexpr COLORREF kWhite = RGB(255, 255, 255);
constexpr COLORREF kBlue = RGB(0, 0, 255);
constexpr COLORREF kRed = RGB(255, 0, 0);

struct Painted {
    HWND window;
    RECT area;
    BOOL erase;
};
std::vector<Painted> painted;

// Paints far beyond its client area in the color kept in its user data, to show the clipping.
LRESULT CALLBACK Painter(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    if (message != WM_PAINT) return DefWindowProcA(window, message, wParam, lParam);
    PAINTSTRUCT paint;
    const HDC dc = BeginPaint(window, &paint);
    painted.push_back({window, paint.rcPaint, paint.fErase});
    const HBRUSH brush = CreateSolidBrush(static_cast<COLORREF>(GetWindowLongPtrA(window, GWLP_USERDATA)));
    const RECT everywhere{-1000, -1000, 1000, 1000};
    FillRect(dc, &everywhere, brush);
    DeleteObject(brush);
    EndPaint(window, &paint);
    return 0;
}

std::vector<HWND> PaintedWindows() {
    std::vector<HWND> windows;
    for (const Painted& p : painted) windows.push_back(p.window);
    return windows;
}

// top 60x40 (white) holds a (blue, 10x10 at 10,10), whose child aa (red, 20x20 at 5,5) sticks out of
// it, b (blue, 20x20 at 30,5) and a hidden window over everything.
class Painting : public testing::Test {
protected:
    void SetUp() override {
        const char* painter = UiTest::Register("Painter", Painter);
        top_ = UiTest::TopLevel(60, 40, painter);
        a_ = UiTest::Child(top_, 1, 10, 10, 10, 10, WS_VISIBLE, painter);
        aa_ = UiTest::Child(a_, 2, 5, 5, 20, 20, WS_VISIBLE, painter);
        b_ = UiTest::Child(top_, 3, 30, 5, 20, 20, WS_VISIBLE, painter);
        const HWND hidden = UiTest::Child(top_, 4, 0, 0, 60, 40, 0, painter);
        const std::pair<HWND, COLORREF> colors[] = {
            {top_, kWhite}, {a_, kBlue}, {aa_, kRed}, {b_, kBlue}, {hidden, kRed}};
        for (const auto& [window, color] : colors) SetWindowLongPtrA(window, GWLP_USERDATA, color);
        painted.clear();
    }
    void TearDown() override {
        Pigmo::Platform::SetInvalidationHandler({});
        DestroyWindow(top_);
    }

    HWND top_, a_, aa_, b_;
};

TEST_F(Painting, PaintsInvalidWindowsParentsFirstEachWithinItsVisibleClientArea) {
    Pigmo::Platform::PaintWindows(top_);
    EXPECT_EQ(PaintedWindows(), (std::vector<HWND>{top_, a_, aa_, b_}));
    EXPECT_EQ(painted[0].erase, TRUE);  // no class brush: erasing is left to the window
    const std::vector<std::string> picture =
        UiTest::Picture(top_, {{kWhite, '.'}, {kBlue, 'B'}, {kRed, 'R'}});
    for (int y = 0; y < 40; ++y)
        for (int x = 0; x < 60; ++x) {
            const bool inA = x >= 10 && x < 20 && y >= 10 && y < 20;
            const bool inB = x >= 30 && x < 50 && y >= 5 && y < 25;
            ASSERT_EQ(picture[y][x], inA   ? (x >= 15 && y >= 15 ? 'R' : 'B')
                                     : inB ? 'B'
                                           : '.')
                << x << "," << y;
        }
    painted.clear();
    Pigmo::Platform::PaintWindows(top_);
    EXPECT_TRUE(painted.empty());
}

TEST_F(Painting, RepaintsOnlyTheInvalidAreaAndTheChildrenUnderIt) {
    Pigmo::Platform::PaintWindows(top_);
    painted.clear();
    std::vector<HWND> told;
    Pigmo::Platform::SetInvalidationHandler([&](HWND top) { told.push_back(top); });
    SetWindowLongPtrA(top_, GWLP_USERDATA, kRed);
    const RECT area{0, 0, 12, 12};
    EXPECT_EQ(InvalidateRect(top_, &area, FALSE), TRUE);
    EXPECT_EQ(InvalidateRect(aa_, nullptr, TRUE), TRUE);
    EXPECT_EQ(told, (std::vector<HWND>{top_, top_}));
    Pigmo::Platform::PaintWindows(top_);
    ASSERT_EQ(PaintedWindows(), (std::vector<HWND>{top_, a_, aa_}));
    EXPECT_EQ(painted[0].area.right, 12);
    EXPECT_EQ(painted[0].erase, FALSE);
    EXPECT_EQ(painted[1].area.right, 2);  // a's corner under the area
    EXPECT_EQ(Pixel(top_, 0, 0), kRed);
    EXPECT_EQ(Pixel(top_, 11, 11), kBlue);  // a painted again over its parent
    EXPECT_EQ(Pixel(top_, 12, 5), kWhite);  // outside the invalid area
    DestroyWindow(b_);
    Pigmo::Platform::PaintWindows(top_);
    EXPECT_EQ(Pixel(top_, 35, 10), kRed);  // where b was, its parent shows
}

TEST_F(Painting, UpdateWindowPaintsItsTreeAtOnce) {
    EXPECT_EQ(UpdateWindow(a_), TRUE);
    EXPECT_EQ(PaintedWindows(), (std::vector<HWND>{a_, aa_}));
}

TEST(PaintingDefaults, DefWindowProcValidatesErasesWithTheClassBrushAndFramesAreRepainted) {
    const COLORREF green = RGB(0, 255, 0);
    const char* filled = UiTest::Register("Filled", DefWindowProcA, CreateSolidBrush(green));
    const HWND top = UiTest::TopLevel(30, 20, filled);
    const HWND framed = UiTest::Child(top, 1, 5, 5, 10, 10, WS_VISIBLE | WS_BORDER, filled);
    for (int pass = 0; pass < 2; ++pass) {
        InvalidateRect(top, nullptr, TRUE);  // the parent paints over the border: it is painted again
        Pigmo::Platform::PaintWindows(top);
        EXPECT_EQ(Pixel(top, 1, 1), green);
        EXPECT_EQ(Pixel(top, 5, 5), RGB(100, 100, 100));  // COLOR_WINDOWFRAME
        EXPECT_EQ(Pixel(top, 14, 14), RGB(100, 100, 100));
        EXPECT_EQ(Pixel(top, 6, 6), green);
    }
    PAINTSTRUCT paint;
    ASSERT_NE(BeginPaint(framed, &paint), nullptr);
    EXPECT_EQ(paint.rcPaint.right, 0);  // DefWindowProcA validated it
    EndPaint(framed, &paint);
    DestroyWindow(top);
}

}  // namespace
