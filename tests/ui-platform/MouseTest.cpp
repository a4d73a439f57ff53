#include "UiTest.h"

namespace {

using Pigmo::Platform::ForwardMouse;
using UiTest::received;

// top 100x100 holds a at 10,10 (40x40) with aa at 5,5 (10x10) inside it, a disabled b at 50,10 and
// a hidden c.
class Mouse : public testing::Test {
protected:
    void SetUp() override {
        top_ = UiTest::TopLevel(100, 100);
        a_ = UiTest::Child(top_, 1, 10, 10, 40, 40);
        aa_ = UiTest::Child(a_, 2, 5, 5, 10, 10);
        UiTest::Child(top_, 3, 50, 10, 40, 40, WS_VISIBLE | WS_DISABLED);
        UiTest::Child(top_, 4, 10, 60, 20, 20, 0);
        received.clear();
    }
    void TearDown() override {
        ForwardMouse(top_, WM_LBUTTONUP, 0, 0);
        ReleaseCapture();
        DestroyWindow(top_);
    }

    HWND top_, a_, aa_;
};

struct RouteCase {
    int x, y;
    char receiver;  // 't' top, 'a', 'A' (aa), '-' nobody
    int clientX, clientY;
};

class MouseRouting : public Mouse, public testing::WithParamInterface<RouteCase> {};

TEST_P(MouseRouting, ReachesTheDeepestVisibleEnabledWindow) {
    const RouteCase& c = GetParam();
    ForwardMouse(top_, WM_MOUSEMOVE, c.x, c.y);
    const std::map<char, HWND> windows{{'t', top_}, {'a', a_}, {'A', aa_}};
    ASSERT_EQ(received.size(), c.receiver == '-' ? 0u : 1u);
    if (c.receiver == '-') return;
    EXPECT_EQ(received[0].window, windows.at(c.receiver));
    EXPECT_EQ(GET_X_LPARAM(received[0].lParam), c.clientX);
    EXPECT_EQ(GET_Y_LPARAM(received[0].lParam), c.clientY);
}

INSTANTIATE_TEST_SUITE_P(Points, MouseRouting,
                         testing::Values(RouteCase{12, 14, 'a', 2, 4}, RouteCase{49, 49, 'a', 39, 39},
                                         RouteCase{15, 15, 'A', 0, 0}, RouteCase{24, 24, 'A', 9, 9},
                                         RouteCase{25, 25, 'a', 15, 15},
                                         // Disabled and hidden windows let the point through to the parent.
                                         RouteCase{60, 20, 't', 60, 20}, RouteCase{12, 65, 't', 12, 65},
                                         RouteCase{100, 50, '-', 0, 0}, RouteCase{-1, 50, '-', 0, 0}));

TEST_F(Mouse, CaptureTakesEveryPointAndItsLoserIsTold) {
    EXPECT_EQ(SetCapture(aa_), nullptr);
    ForwardMouse(top_, WM_MOUSEMOVE, 0, 99);
    ASSERT_EQ(received.size(), 1u);
    EXPECT_EQ(received[0].window, aa_);
    EXPECT_EQ(GET_X_LPARAM(received[0].lParam), -15);  // signed 16-bit halves
    EXPECT_EQ(GET_Y_LPARAM(received[0].lParam), 84);
    EXPECT_EQ(SetCapture(top_), aa_);
    EXPECT_EQ(ReleaseCapture(), TRUE);
    EXPECT_EQ(GetCapture(), nullptr);
    const std::vector<UiTest::Message> lost = UiTest::Sent(WM_CAPTURECHANGED);
    ASSERT_EQ(lost.size(), 2u);
    EXPECT_EQ(lost[0].window, aa_);
    EXPECT_EQ(lost[0].lParam, reinterpret_cast<LPARAM>(top_));
    EXPECT_EQ(lost[1].window, top_);
    EXPECT_EQ(lost[1].lParam, 0);
    // Disabling or destroying the window that holds the capture releases it.
    SetCapture(aa_);
    EnableWindow(a_, FALSE);
    EXPECT_EQ(GetCapture(), nullptr);
    SetCapture(aa_);
    DestroyWindow(a_);
    EXPECT_EQ(GetCapture(), nullptr);
}

TEST_F(Mouse, WParamHoldsTheLeftButtonWhileItIsDown) {
    const UINT messages[] = {WM_LBUTTONDOWN, WM_MOUSEMOVE, WM_LBUTTONUP, WM_MOUSEMOVE};
    for (const UINT message : messages) ForwardMouse(top_, message, 20, 20);
    ASSERT_EQ(received.size(), 4u);
    for (int i = 0; i < 4; ++i) {
        EXPECT_EQ(received[i].message, messages[i]);
        EXPECT_EQ(received[i].wParam, i < 2 ? 1u : 0u);
    }
}

}  // namespace
