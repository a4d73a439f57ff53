#include <cstring>
#include <string>

#include "UiTest.h"

namespace {

using Pigmo::Platform::DrawnText;
using Pigmo::Platform::ForwardMouse;
using UiTest::Pixel;

constexpr int kItemHeight = 12;  // the cell of the default GUI font, which the controls use here
constexpr int kListId = 1007;

LPARAM Text(const char* text) {
    return reinterpret_cast<LPARAM>(text);
}

class Controls : public testing::Test {
protected:
    void SetUp() override {
        top_ = UiTest::TopLevel(220, 140);
        UiTest::received.clear();
    }
    void TearDown() override { DestroyWindow(top_); }

    // A bordered list box at 10,10, 100 wide, showing the given number of rows.
    HWND List(DWORD style, int rows) {
        return UiTest::Child(top_, kListId, 10, 10, 100, rows * kItemHeight + 2,
                             WS_VISIBLE | WS_BORDER | style, "ListBox");
    }

    void Click(int x, int y) {
        ForwardMouse(top_, WM_LBUTTONDOWN, x, y);
        ForwardMouse(top_, WM_LBUTTONUP, x, y);
    }

    std::vector<DrawnText> PaintAndWatch() {
        std::vector<DrawnText> drawn;
        Pigmo::Platform::SetTextHook([&](const DrawnText& text) { drawn.push_back(text); });
        Pigmo::Platform::PaintWindows(top_);
        Pigmo::Platform::SetTextHook({});
        return drawn;
    }

    HWND top_;
};

TEST_F(Controls, ListBoxAnswersItsMessagesAsWindowsDoes) {
    const HWND list = List(LBS_NOTIFY, 3);
    const struct {
        UINT message;
        WPARAM wParam;
        LPARAM lParam;
        LRESULT expected;
    } steps[] = {{LB_GETCURSEL, 0, 0, LB_ERR},
                 {LB_ADDSTRING, 0, Text("Reds"), 0},
                 {LB_ADDSTRING, 0, Text("Greens"), 1},
                 {LB_ADDSTRING, 0, 0, LB_ERR},
                 {LB_GETCOUNT, 0, 0, 2},
                 {LB_SETITEMDATA, 1, 77, TRUE},
                 {LB_GETITEMDATA, 1, 0, 77},
                 {LB_GETITEMDATA, 2, 0, LB_ERR},
                 {LB_GETTEXTLEN, 1, 0, 6},
                 {LB_GETTEXTLEN, WPARAM(-1), 0, LB_ERR},
                 {LB_SETCURSEL, 1, 0, 1},
                 {LB_SETCURSEL, 2, 0, LB_ERR},
                 {LB_GETCURSEL, 0, 0, 1},
                 {LB_SETCURSEL, WPARAM(-1), 0, LB_ERR},  // clears, yet LB_ERR
                 {LB_GETCURSEL, 0, 0, LB_ERR},
                 {LB_RESETCONTENT, 0, 0, 0},
                 {LB_GETCOUNT, 0, 0, 0}};
    for (const auto& step : steps)
        EXPECT_EQ(SendMessageA(list, step.message, step.wParam, step.lParam), step.expected)
            << "message 0x" << std::hex << step.message << " with " << std::dec << step.wParam;
    SendMessageA(list, LB_ADDSTRING, 0, Text("Greys"));
    char text[16] = "";
    EXPECT_EQ(SendMessageA(list, LB_GETTEXT, 0, reinterpret_cast<LPARAM>(text)), 5);
    EXPECT_STREQ(text, "Greys");
    EXPECT_TRUE(UiTest::Sent(WM_COMMAND).empty());  // LB_SETCURSEL notifies no one
}

TEST_F(Controls, ListBoxClickSelectsNotifiesOnlyWithLbsNotifyAndHighlights) {
    for (const DWORD style : {DWORD{LBS_NOTIFY}, DWORD{0}}) {
        const HWND list = List(style, 4);
        for (const char* item : {"System", "User", "Other"}) SendMessageA(list, LB_ADDSTRING, 0, Text(item));
        UiTest::received.clear();
        Click(13, 11 + kItemHeight + 2);      // the client area starts at 11,11: row 1
        Click(13, 11 + 3 * kItemHeight + 2);  // below the last item: nothing
        EXPECT_EQ(SendMessageA(list, LB_GETCURSEL, 0, 0), 1);
        const std::vector<UiTest::Message> commands = UiTest::Sent(WM_COMMAND);
        ASSERT_EQ(commands.size(), style == LBS_NOTIFY ? 1u : 0u);
        if (style == LBS_NOTIFY) {
            EXPECT_EQ(commands[0].window, top_);
            EXPECT_EQ(commands[0].wParam, MAKEWPARAM(kListId, LBN_SELCHANGE));
            EXPECT_EQ(commands[0].lParam, reinterpret_cast<LPARAM>(list));
        }
        const std::vector<DrawnText> drawn = PaintAndWatch();
        ASSERT_EQ(drawn.size(), 3u);
        EXPECT_EQ(drawn[1].text, "User");
        EXPECT_EQ(drawn[1].color, GetSysColor(COLOR_HIGHLIGHTTEXT));
        EXPECT_EQ(drawn[1].rect.top, kItemHeight);
        EXPECT_EQ(Pixel(top_, 10, 10), RGB(100, 100, 100));  // COLOR_WINDOWFRAME
        EXPECT_EQ(Pixel(top_, 108, 11), GetSysColor(COLOR_WINDOW));
        EXPECT_EQ(Pixel(top_, 108, 11 + kItemHeight), GetSysColor(COLOR_HIGHLIGHT));
        DestroyWindow(list);
    }
}

// 20 items in 6 rows: the bar has arrows of 17 pixels and a thumb of 11 on a track of 38, so presses
// at 45 page down until the thumb comes under them.
TEST_F(Controls, ListBoxScrollBarAppearsWhenNeededAndScrollsByLineAndPage) {
    const HWND list = List(WS_VSCROLL, 6);
    RECT client{};
    SendMessageA(list, LB_ADDSTRING, 0, Text("0"));
    GetClientRect(list, &client);
    EXPECT_EQ(client.right, 98);
    for (int i = 1; i < 20; ++i) SendMessageA(list, LB_ADDSTRING, 0, Text(std::to_string(i).c_str()));
    GetClientRect(list, &client);
    EXPECT_EQ(client.right, 98 - 17);
    const auto firstShown = [&] {
        Click(15, 12);
        return SendMessageA(list, LB_GETCURSEL, 0, 0);
    };
    const int presses[][2] = {{65, 1},  {45, 7},  {5, 6},   {20, 0}, {45, 6},
                              {45, 12}, {45, 12}, {55, 14}, {65, 14}};
    for (const auto& [barY, first] : presses) {
        Click(100, 10 + barY);
        EXPECT_EQ(firstShown(), first) << "after a press at " << barY;
    }
    SendMessageA(list, LB_SETCURSEL, 2, 0);  // scrolls it into view
    EXPECT_EQ(firstShown(), 2);
}

TEST_F(Controls, EditAndStaticShowTheirTextInTheirColors) {
    const HWND readOnly =
        UiTest::Child(top_, 1, 10, 10, 80, 18, WS_VISIBLE | ES_READONLY | ES_AUTOHSCROLL, "Edit");
    UiTest::Child(top_, 2, 10, 40, 80, 18, WS_VISIBLE, "Edit");
    const HWND label = UiTest::Child(top_, -1, 10, 70, 60, 12, WS_VISIBLE | SS_LEFT, "static");
    EXPECT_EQ(SendMessageA(readOnly, WM_SETTEXT, 0, Text("50.0, -3.0, 10.0")), TRUE);
    SetWindowTextA(label, "Tags");
    char text[8];
    EXPECT_EQ(SendMessageA(readOnly, WM_GETTEXT, sizeof text, reinterpret_cast<LPARAM>(text)), 7);
    EXPECT_STREQ(text, "50.0, -");
    EXPECT_EQ(SendMessageA(readOnly, WM_GETTEXTLENGTH, 0, 0), 16);

    const std::vector<DrawnText> drawn = PaintAndWatch();
    ASSERT_EQ(drawn.size(), 3u);
    EXPECT_EQ(drawn[0].text, "50.0, -3.0, 10.0");
    EXPECT_EQ(drawn[0].window, readOnly);
    EXPECT_EQ(drawn[2].text, "Tags");
    EXPECT_EQ(drawn[2].face, "MS Shell Dlg");
    EXPECT_EQ(Pixel(top_, 10, 10), GetSysColor(COLOR_BTNSHADOW));
    EXPECT_EQ(Pixel(top_, 11, 11), RGB(105, 105, 105));  // COLOR_3DDKSHADOW
    EXPECT_EQ(Pixel(top_, 89, 27), GetSysColor(COLOR_BTNHIGHLIGHT));
    EXPECT_EQ(Pixel(top_, 87, 12), GetSysColor(COLOR_BTNFACE));  // read-only
    EXPECT_EQ(Pixel(top_, 87, 42), GetSysColor(COLOR_WINDOW));
    EXPECT_EQ(Pixel(top_, 69, 81), GetSysColor(COLOR_BTNFACE));
    // A new scheme repaints every window.
    const int face = COLOR_BTNFACE;
    const COLORREF standard = GetSysColor(face), dark = RGB(40, 40, 40);
    SetSysColors(1, &face, &dark);
    PaintAndWatch();
    EXPECT_EQ(Pixel(top_, 69, 81), dark);
    SetSysColors(1, &face, &standard);
}

// The tool's window answers the tooltip's request with this text, by pointer or in szText.
std::string answer;
bool answerInBuffer = false;
NMHDR request{};

LRESULT CALLBACK ToolHost(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    UiTest::RecordingProcedure(window, message, wParam, lParam);
    auto* info = reinterpret_cast<NMTTDISPINFOA*>(lParam);
    if (message != WM_NOTIFY || info->hdr.code != TTN_GETDISPINFOA) return 0;
    request = info->hdr;
    if (answerInBuffer)
        std::strncpy(info->szText, answer.c_str(), sizeof info->szText - 1);
    else
        info->lpszText = answer.data();
    return 0;
}

TEST_F(Controls, ToolTipsAskTheToolsWindowForTheirText) {
    const HWND host = UiTest::TopLevel(100, 100, UiTest::Register("ToolHost", ToolHost));
    const HWND child = UiTest::Child(host, 1, 10, 10, 20, 20);
    UiTest::Child(host, 2, 40, 10, 20, 20, WS_VISIBLE | WS_DISABLED);
    const HWND tip =
        CreateWindowExA(0, TOOLTIPS_CLASSA, nullptr, WS_POPUP | TTS_ALWAYSTIP | TTS_NOPREFIX, CW_USEDEFAULT,
                        CW_USEDEFAULT, CW_USEDEFAULT, CW_USEDEFAULT, nullptr, nullptr, nullptr, nullptr);
    EXPECT_EQ(SetWindowPos(tip, HWND_TOPMOST, 0, 0, 0, 0, SWP_NOMOVE | SWP_NOSIZE | SWP_NOACTIVATE), TRUE);
    const auto addTool = [&](UINT size, UINT flags, HWND window, UINT_PTR id, LPSTR text, RECT rect) {
        TOOLINFOA tool{size, flags, window, id, rect, nullptr, text, 0};
        return SendMessageA(tip, TTM_ADDTOOLA, 0, reinterpret_cast<LPARAM>(&tool));
    };
    const auto id = reinterpret_cast<UINT_PTR>(host);
    EXPECT_EQ(addTool(TTTOOLINFOA_V2_SIZE - 1, TTF_IDISHWND, host, id, LPSTR_TEXTCALLBACKA, {}), FALSE);
    EXPECT_EQ(addTool(TTTOOLINFOA_V2_SIZE, TTF_IDISHWND | TTF_SUBCLASS, host, id, LPSTR_TEXTCALLBACKA, {}),
              TRUE);
    char plain[] = "Plain";
    EXPECT_EQ(addTool(sizeof(TOOLINFOA), 0, child, 7, plain, {0, 0, 10, 10}), TRUE);  // the child's corner
    plain[0] = 'X';  // the tooltip keeps its own copy

    answer = "Red 032 (Reds)";
    EXPECT_EQ(Pigmo::Platform::ToolTipTextAt(host, 5, 5), "Red 032 (Reds)");
    EXPECT_EQ(UiTest::WindowsSent(WM_NOTIFY), std::vector<HWND>{host});
    EXPECT_EQ(request.hwndFrom, tip);
    EXPECT_EQ(request.idFrom, id);
    // Over an enabled child the pointer is not on the tool's window; a disabled one lets it through.
    EXPECT_EQ(Pigmo::Platform::ToolTipTextAt(host, 25, 25), "");
    EXPECT_EQ(Pigmo::Platform::ToolTipTextAt(host, 15, 15), "Plain");
    answerInBuffer = true;
    answer = "In the buffer";
    EXPECT_EQ(Pigmo::Platform::ToolTipTextAt(host, 45, 15), "In the buffer");
    EXPECT_EQ(DestroyWindow(tip), TRUE);
    EXPECT_EQ(Pigmo::Platform::ToolTipTextAt(host, 5, 5), "");
    DestroyWindow(host);
}

}  // namespace
