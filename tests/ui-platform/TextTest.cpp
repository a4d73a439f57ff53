#include <algorithm>

#include "UiTest.h"

namespace {

using Pigmo::Platform::DrawnText;

// Draws text in a font on the canvas; answers what DrawTextA returned.
int DrawIn(UiTest::Canvas& canvas, HFONT font, const char* text, RECT rect, UINT format) {
    int result = 0;
    canvas.Paint([&](HDC dc) {
        SelectObject(dc, font);
        result = DrawTextA(dc, text, -1, &rect, format);
    });
    return result;
}

struct CellCase {
    const char* face;
    int height;
    int weight;
    int cell;
};

class FontCells : public testing::TestWithParam<CellCase> {};

// DrawTextA answers lines times the cell: a positive height is the cell, a negative one the em, whose
// cell follows from the face's ascent and descent (2288 and 2268 per 2048 for Liberation Sans and Serif).
TEST_P(FontCells, AreTheHeightGdiGives) {
    const CellCase& c = GetParam();
    UiTest::Canvas canvas(60, 80);
    const HFONT font = UiTest::Font(c.face, c.height, c.weight);
    EXPECT_EQ(DrawIn(canvas, font, "Ag", {0, 0, 60, 80}, DT_LEFT), c.cell);
    EXPECT_EQ(DrawIn(canvas, font, "Ag\nAg\r\nAg", {0, 0, 60, 80}, DT_LEFT), 3 * c.cell);
    EXPECT_EQ(DrawIn(canvas, font, "Ag\nAg", {0, 0, 60, 80}, DT_SINGLELINE), c.cell);
    EXPECT_EQ(DeleteObject(font), TRUE);
}

INSTANTIATE_TEST_SUITE_P(Fonts, FontCells,
                         testing::Values(CellCase{"Arial", 12, FW_NORMAL, 12},
                                         CellCase{"Times New Roman", 20, FW_BOLD, 20},
                                         CellCase{"MS Shell Dlg", 33, 0, 33}, CellCase{"Arial", -11, 0, 12},
                                         CellCase{"Arial", -20, FW_BOLD, 22},
                                         CellCase{"Times New Roman", -16, 0, 17},
                                         CellCase{"Arial", 0, 0, 16}));

struct FaceCase {
    const char* asked;
    int askedWeight;
    const char* installed;
    int installedWeight;
    bool same;
};

class FaceMapping : public testing::TestWithParam<FaceCase> {};

TEST_P(FaceMapping, DrawsWindowsFacesWithTheirLiberationFaces) {
    const FaceCase& c = GetParam();
    const auto pixels = [](const char* face, int weight) {
        UiTest::Canvas canvas(70, 24);
        const HFONT font = UiTest::Font(face, -16, weight);
        DrawIn(canvas, font, "Wag Ri", {0, 0, 70, 24}, DT_LEFT);
        DeleteObject(font);
        std::vector<COLORREF> all;
        for (int y = 0; y < 24; ++y)
            for (int x = 0; x < 70; ++x) all.push_back(UiTest::Pixel(canvas.Window(), x, y));
        return all;
    };
    const std::vector<COLORREF> asked = pixels(c.asked, c.askedWeight);
    EXPECT_NE(std::count(asked.begin(), asked.end(), RGB(0, 0, 0)), 0);
    EXPECT_EQ(asked == pixels(c.installed, c.installedWeight), c.same);
}

INSTANTIATE_TEST_SUITE_P(Fonts, FaceMapping,
                         testing::Values(FaceCase{"times new roman", FW_BOLD, "Liberation Serif", FW_BOLD,
                                                  true},
                                         FaceCase{"MS Shell Dlg", 0, "Liberation Sans", 0, true},
                                         FaceCase{"MS Sans Serif", 0, "Liberation Sans", 0, true},
                                         FaceCase{"Arial", FW_NORMAL, "Liberation Sans", 0, true},
                                         FaceCase{"Arial", FW_BOLD, "Liberation Sans", FW_NORMAL, false},
                                         FaceCase{"Times New Roman", 0, "Liberation Sans", 0, false}));

struct PlacementCase {
    UINT format;
    int horizontal;  // the share of the free width left of the text, in halves: 0 left, 1 centre, 2 right
    int down;        // pixels below the top-aligned text
    int returned;
};

class Placement : public testing::TestWithParam<PlacementCase> {};

// A rectangle 100 wide and 30 high, a cell of 18: 12 pixels to spare below.
TEST_P(Placement, FollowsTheFormatFlags) {
    const PlacementCase& c = GetParam();
    const RECT rect{10, 5, 110, 35};
    const HFONT font = UiTest::Font("Arial", 18);
    UiTest::Canvas canvas(120, 40);
    DrawIn(canvas, font, "Wg", rect, DT_RIGHT);
    const RECT right = UiTest::InkBounds(canvas.Window());
    DrawIn(canvas, font, "Wg", rect, DT_LEFT);
    const RECT left = UiTest::InkBounds(canvas.Window());
    const LONG spare = right.left - left.left;
    EXPECT_GT(spare, 0);
    EXPECT_LE(right.right, rect.right);
    EXPECT_GE(left.left, rect.left);
    EXPECT_EQ(DrawIn(canvas, font, "Wg", rect, c.format), c.returned);
    const RECT ink = UiTest::InkBounds(canvas.Window());
    EXPECT_EQ(ink.left - left.left, spare * c.horizontal / 2);
    EXPECT_EQ(ink.top - left.top, c.down);
    DeleteObject(font);
}

INSTANTIATE_TEST_SUITE_P(DrawText, Placement,
                         testing::Values(PlacementCase{DT_CENTER, 1, 0, 18},
                                         PlacementCase{DT_RIGHT, 2, 0, 18},
                                         // Without DT_SINGLELINE the vertical flags do nothing.
                                         PlacementCase{DT_BOTTOM, 0, 0, 18},
                                         PlacementCase{DT_VCENTER | DT_CENTER, 1, 0, 18},
                                         // With it they answer the offset from the top to the text's bottom.
                                         PlacementCase{DT_SINGLELINE | DT_BOTTOM, 0, 12, 30},
                                         PlacementCase{DT_SINGLELINE | DT_VCENTER | DT_RIGHT, 2, 6, 24}));

TEST(DrawText, ClipsToTheRectangleUnlessTold) {
    const HFONT font = UiTest::Font("Arial", 18);
    UiTest::Canvas canvas(80, 40);
    const RECT small{10, 10, 20, 16};
    DrawIn(canvas, font, "WWW", small, DT_LEFT);
    const RECT clipped = UiTest::InkBounds(canvas.Window());
    EXPECT_TRUE(clipped.left >= small.left && clipped.top >= small.top && clipped.right <= small.right &&
                clipped.bottom <= small.bottom && clipped.right > 0);
    DrawIn(canvas, font, "WWW", small, DT_LEFT | DT_NOCLIP);
    EXPECT_GT(UiTest::InkBounds(canvas.Window()).right, small.right + 20);
    DeleteObject(font);
}

TEST(DrawText, ReportsEveryCallToTheHookAsAsked) {
    std::vector<DrawnText> drawn;
    Pigmo::Platform::SetTextHook([&](const DrawnText& text) { drawn.push_back(text); });
    const HFONT font = UiTest::Font("Times New Roman", 12, FW_BOLD);
    UiTest::Canvas canvas(80, 40);
    canvas.Paint([&](HDC dc) {
        RECT rect{-5, 3, 50, 2};
        SetTextColor(dc, RGB(1, 2, 3));
        DrawTextA(dc, "Plain", -1, &rect, DT_BOTTOM);
        SelectObject(dc, font);
        DrawTextA(dc, "Hello", 3, &rect, DT_CENTER | DT_NOCLIP);
        // Latin-1 as well as UTF-8 text draws.
        DrawTextA(dc, "Caf\xE9", -1, &rect, DT_LEFT);
    });
    Pigmo::Platform::SetTextHook({});
    canvas.Paint([](HDC dc) {
        RECT rect{0, 0, 10, 10};
        DrawTextA(dc, "unseen", -1, &rect, DT_LEFT);
    });
    ASSERT_EQ(drawn.size(), 3u);
    EXPECT_EQ(drawn[0].window, canvas.Window());
    EXPECT_EQ(drawn[0].face, "MS Shell Dlg");  // the default GUI font
    EXPECT_EQ(drawn[0].height, -11);
    EXPECT_EQ(drawn[0].weight, FW_NORMAL);
    EXPECT_EQ(drawn[1].text, "Hel");
    EXPECT_EQ(drawn[1].rect.left, -5);
    EXPECT_EQ(drawn[1].rect.bottom, 2);
    EXPECT_EQ(drawn[1].format, DT_CENTER | DT_NOCLIP);
    EXPECT_EQ(drawn[1].face, "Times New Roman");
    EXPECT_EQ(drawn[1].height, 12);
    EXPECT_EQ(drawn[1].weight, FW_BOLD);
    EXPECT_EQ(drawn[1].color, RGB(1, 2, 3));
    DeleteObject(font);
}

}  // namespace
