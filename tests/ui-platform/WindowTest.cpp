#include "UiTest.h"

namespace {

using UiTest::WindowsSent;

// top holds a (with aa inside it) and b, which has a border and a vertical scroll bar.
class WindowTree : public testing::Test {
protected:
    void SetUp() override {
        UiTest::received.clear();
        top_ = UiTest::TopLevel(200, 100);
        a_ = UiTest::Child(top_, 1, 10, 10, 50, 30);
        aa_ = UiTest::Child(a_, 11, 0, 0, 5, 5);
        b_ = UiTest::Child(top_, 2, 70, 10, 50, 30, WS_VISIBLE | WS_BORDER | WS_VSCROLL);
    }
    void TearDown() override { DestroyWindow(top_); }

    HWND top_, a_, aa_, b_;
};

TEST_F(WindowTree, IsBuiltAndTornDownInWindowsOrder) {
    EXPECT_EQ(WindowsSent(WM_CREATE), (std::vector<HWND>{top_, a_, aa_, b_}));
    EXPECT_EQ(GetParent(aa_), a_);
    EXPECT_EQ(GetParent(top_), nullptr);
    EXPECT_EQ(GetDlgItem(top_, 2), b_);
    EXPECT_EQ(GetDlgItem(top_, 11), nullptr);  // only direct children
    EXPECT_EQ(GetDlgCtrlID(aa_), 11);

    // WM_DESTROY reaches a window before its children, which still exist while it handles it.
    UiTest::received.clear();
    BOOL childAliveAtParentsDestroy = FALSE;
    UiTest::onMessage = [&](const UiTest::Message& m) {
        if (m.message == WM_DESTROY && m.window == top_) childAliveAtParentsDestroy = IsWindow(aa_);
    };
    EXPECT_EQ(DestroyWindow(top_), TRUE);
    UiTest::onMessage = nullptr;
    EXPECT_EQ(WindowsSent(WM_DESTROY), (std::vector<HWND>{top_, a_, aa_, b_}));
    EXPECT_EQ(childAliveAtParentsDestroy, TRUE);
    for (const HWND gone : {top_, a_, aa_, b_}) EXPECT_EQ(IsWindow(gone), FALSE);
}

TEST_F(WindowTree, KeepsUserDataTextAndEnabledState) {
    EXPECT_EQ(SetWindowLongPtrA(a_, GWLP_USERDATA, 42), 0);
    EXPECT_EQ(SetWindowLongPtrA(a_, GWLP_USERDATA, -7), 42);
    EXPECT_EQ(GetWindowLongPtrA(a_, GWLP_USERDATA), -7);
    EXPECT_EQ(SetWindowTextA(a_, "Swatches"), TRUE);
    char text[6];
    EXPECT_EQ(GetWindowTextA(a_, text, sizeof text), 5);
    EXPECT_STREQ(text, "Swatc");
    EXPECT_EQ(SendMessageA(a_, WM_GETTEXTLENGTH, 0, 0), 8);
    EXPECT_EQ(EnableWindow(a_, FALSE), FALSE);  // answers whether it was disabled
    EXPECT_EQ(IsWindowEnabled(a_), FALSE);
    EXPECT_EQ(EnableWindow(a_, TRUE), TRUE);
}

TEST_F(WindowTree, ClientAreasLeaveOutBorderAndScrollBar) {
    RECT client{};
    EXPECT_EQ(GetClientRect(b_, &client), TRUE);
    EXPECT_EQ(client.right, 50 - 2 - 17);
    EXPECT_EQ(client.bottom, 30 - 2);
    EXPECT_EQ(SetWindowPos(a_, nullptr, 0, 0, 80, 20, SWP_NOMOVE), TRUE);
    GetClientRect(a_, &client);
    EXPECT_EQ(client.right, 80);
    EXPECT_EQ(SetWindowPos(top_, HWND_TOPMOST, 0, 0, 0, 0, SWP_NOMOVE | SWP_NOSIZE | SWP_NOACTIVATE), TRUE);
    EXPECT_EQ(SetWindowPos(top_, nullptr, 5, 5, 30, 20, SWP_NOMOVE), TRUE);
    EXPECT_EQ(cairo_image_surface_get_width(Pigmo::Platform::WindowSurface(top_)), 30);
}

LRESULT CALLBACK Refusing(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    UiTest::RecordingProcedure(window, message, wParam, lParam);
    return message == WM_CREATE ? -1 : 0;
}

TEST(Windows, ClassesAreFoundInAnyCaseAndCreationCanBeRefused) {
    WNDCLASSA found{};
    for (const char* name : {"static", "LISTBOX", "Edit", "tooltips_class32", "#32770"})
        EXPECT_EQ(GetClassInfoA(nullptr, name, &found), TRUE) << name;
    EXPECT_EQ(UiTest::TopLevel(4, 4, "NoSuchClass"), nullptr);
    UiTest::received.clear();
    EXPECT_EQ(UiTest::TopLevel(4, 4, UiTest::Register("Refusing", Refusing)), nullptr);
    EXPECT_EQ(WindowsSent(WM_DESTROY).size(), 1u);
    EXPECT_EQ(IsWindow(UiTest::received[0].window), FALSE);
}

// Every call with a handle that is not, or no longer, a window answers as Windows does.
class StaleWindowHandles : public testing::TestWithParam<std::function<std::intptr_t(HWND)>> {};

TEST_P(StaleWindowHandles, AreRefused) {
    const HWND gone = UiTest::TopLevel(10, 10);
    DestroyWindow(gone);
    int notAWindow = 0;
    for (const HWND handle : {gone, HWND{}, reinterpret_cast<HWND>(&notAWindow)})
        EXPECT_EQ(GetParam()(handle), 0);
}

RECT rectangle{};
char buffer[8];
PAINTSTRUCT paint{};
std::intptr_t Value(std::intptr_t result) {
    return result;
}
template <typename T>
std::intptr_t Value(T* result) {
    return reinterpret_cast<std::intptr_t>(result);
}

INSTANTIATE_TEST_SUITE_P(
    Windows, StaleWindowHandles,
    testing::Values(
        [](HWND w) { return Value(DestroyWindow(w)); }, [](HWND w) { return Value(GetParent(w)); },
        [](HWND w) { return Value(GetDlgItem(w, 0)); }, [](HWND w) { return Value(GetDlgCtrlID(w)); },
        [](HWND w) { return Value(SetWindowLongPtrA(w, GWLP_USERDATA, 5)); },
        [](HWND w) { return Value(GetClientRect(w, &rectangle)); },
        [](HWND w) { return Value(SetWindowPos(w, nullptr, 0, 0, 1, 1, 0)); },
        [](HWND w) { return Value(EnableWindow(w, FALSE)); },
        [](HWND w) { return Value(SetWindowTextA(w, "x")); },
        [](HWND w) { return Value(GetWindowTextA(w, buffer, sizeof buffer) + buffer[0]); },
        [](HWND w) { return Value(SendMessageA(w, WM_GETTEXTLENGTH, 0, 0)); },
        [](HWND w) { return Value(DefWindowProcA(w, WM_PAINT, 0, 0)); },
        [](HWND w) { return Value(SetCapture(w)); },
        [](HWND w) { return Value(InvalidateRect(w, nullptr, 1)); },
        [](HWND w) { return Value(UpdateWindow(w)); }, [](HWND w) { return Value(BeginPaint(w, &paint)); },
        [](HWND w) { return Value(MapDialogRect(w, &rectangle)); },
        [](HWND w) { return Value(Pigmo::Platform::WindowSurface(w)); },
        [](HWND w) {
            Pigmo::Platform::PaintWindows(w);
            Pigmo::Platform::ForwardMouse(w, WM_LBUTTONDOWN, 1, 1);
            return Value(Pigmo::Platform::ToolTipTextAt(w, 1, 1).size());
        }));

}  // namespace
