#include "UiTest.h"

namespace {

constexpr COLORREF kRed = RGB(255, 0, 0);
constexpr COLORREF kBlue = RGB(0, 0, 255);

// Drawn with a red pen of the given width (0: the stock null pen) and a blue brush (or the null one).
struct ShapeCase {
    const char* name;
    int penWidth;
    bool hollowBrush;
    std::function<void(HDC)> draw;
    std::vector<std::string> expected;
};

class Shapes : public testing::TestWithParam<ShapeCase> {};

TEST_P(Shapes, CoverExactlyThePixelsGdiCovers) {
    const ShapeCase& c = GetParam();
    UiTest::Canvas canvas(static_cast<int>(c.expected[0].size()), static_cast<int>(c.expected.size()));
    canvas.Paint([&](HDC dc) {
        const HPEN pen = c.penWidth > 0 ? CreatePen(PS_SOLID, c.penWidth, kRed) : GetStockObject(NULL_PEN);
        const HBRUSH brush = c.hollowBrush ? GetStockObject(NULL_BRUSH) : CreateSolidBrush(kBlue);
        const HGDIOBJ oldPen = SelectObject(dc, pen);
        const HGDIOBJ oldBrush = SelectObject(dc, brush);
        c.draw(dc);
        EXPECT_EQ(SelectObject(dc, oldPen), pen);
        EXPECT_EQ(SelectObject(dc, oldBrush), brush);
        DeleteObject(pen);
        DeleteObject(brush);
    });
    const std::map<COLORREF, char> legend{
        {RGB(255, 255, 255), '.'}, {kRed, 'R'}, {kBlue, 'B'}, {GetSysColor(COLOR_HIGHLIGHT), 'H'}};
    EXPECT_EQ(UiTest::Picture(canvas.Window(), legend), c.expected) << c.name;
}

const POINT kTriangles[] = {{1, 1}, {1, 5}, {5, 5}, {7, 1}, {10, 1}, {10, 4}};
const POINT kSquares[] = {{1, 1}, {5, 1}, {5, 5}, {1, 5}, {3, 3}, {7, 3}, {7, 7}, {3, 7}};
const int kThrees[] = {3, 3};
const int kFours[] = {4, 4};

INSTANTIATE_TEST_SUITE_P(
    Gdi, Shapes,
    testing::Values(
        ShapeCase{"FillRect with a system color, right and bottom left out",
                  0,
                  false,
                  [](HDC dc) {
                      const RECT rect{2, 1, 6, 4};
                      FillRect(dc, &rect, reinterpret_cast<HBRUSH>(std::uintptr_t{COLOR_HIGHLIGHT + 1}));
                  },
                  {"........", "..HHHH..", "..HHHH..", "..HHHH..", "........"}},
        ShapeCase{"Rectangle, one-pixel pen",
                  1,
                  false,
                  [](HDC dc) { Rectangle(dc, 1, 1, 7, 6); },
                  {"........", ".RRRRRR.", ".RBBBBR.", ".RBBBBR.", ".RBBBBR.", ".RRRRRR.", "........"}},
        ShapeCase{"Rectangle, corners the other way round",
                  1,
                  true,
                  [](HDC dc) { Rectangle(dc, 6, 5, 1, 1); },
                  {".......", ".RRRRR.", ".R...R.", ".R...R.", ".RRRRR.", "......."}},
        ShapeCase{"Rectangle, three-pixel pen centred on the outline",
                  3,
                  false,
                  [](HDC dc) { Rectangle(dc, 2, 2, 9, 9); },
                  {"...........", ".RRRRRRRRR.", ".RRRRRRRRR.", ".RRRRRRRRR.", ".RRRBBBRRR.", ".RRRBBBRRR.",
                   ".RRRBBBRRR.", ".RRRRRRRRR.", ".RRRRRRRRR.", ".RRRRRRRRR.", "..........."}},
        ShapeCase{"Rectangle, null pen fills one pixel less",
                  0,
                  false,
                  [](HDC dc) { Rectangle(dc, 1, 1, 6, 5); },
                  {".......", ".BBBB..", ".BBBB..", ".BBBB..", ".......", "......."}},
        ShapeCase{
            "LineTo leaves out the end pixel, any direction",
            1,
            false,
            [](HDC dc) {
                const POINT lines[][2] = {
                    {{1, 1}, {5, 1}}, {{7, 1}, {7, 5}}, {{1, 3}, {4, 6}}, {{8, 6}, {5, 6}}};
                for (const auto& line : lines) {
                    MoveToEx(dc, line[0].x, line[0].y, nullptr);
                    LineTo(dc, line[1].x, line[1].y);
                }
            },
            {".........", ".RRRR..R.", ".......R.", ".R.....R.", "..R....R.", "...R.....", "......RRR"}},
        ShapeCase{"PolyPolygon, two triangles",
                  1,
                  false,
                  [](HDC dc) { EXPECT_EQ(PolyPolygon(dc, kTriangles, kThrees, 2), TRUE); },
                  {"............", ".R.....RRRR.", ".RR.....RBR.", ".RBR.....RR.", ".RBBR.....R.",
                   ".RRRRR......", "............"}},
        ShapeCase{"PolyPolygon fills by the alternate rule",
                  0,
                  false,
                  [](HDC dc) { EXPECT_EQ(PolyPolygon(dc, kSquares, kFours, 2), TRUE); },
                  {"........", ".BBBB...", ".BBBB...", ".BB..BB.", ".BB..BB.", "...BBBB.", "...BBBB.",
                   "........"}}));

TEST(Gdi, DeletedOrStockObjectsAndEndedContextsAreHandledAsWindowsDoes) {
    UiTest::Canvas canvas(4, 4);
    HDC ended = nullptr;
    canvas.Paint([&](HDC dc) {
        ended = dc;
        const HBRUSH blue = CreateSolidBrush(kBlue);
        const HGDIOBJ white = SelectObject(dc, blue);
        EXPECT_EQ(white, GetStockObject(WHITE_BRUSH));
        EXPECT_EQ(DeleteObject(blue), TRUE);  // still selected: it draws until replaced
        EXPECT_EQ(DeleteObject(blue), FALSE);
        EXPECT_EQ(SelectObject(dc, blue), nullptr);
        SelectObject(dc, GetStockObject(NULL_PEN));
        Rectangle(dc, 0, 0, 3, 3);
        EXPECT_EQ(SelectObject(dc, white), blue);
        EXPECT_EQ(DeleteObject(GetStockObject(WHITE_BRUSH)), TRUE);  // stock objects stay
        EXPECT_EQ(SelectObject(dc, GetStockObject(WHITE_BRUSH)), white);
    });
    EXPECT_EQ(UiTest::Pixel(canvas.Window(), 1, 1), kBlue);
    RECT rect{0, 0, 2, 2};
    EXPECT_EQ(SelectObject(ended, GetStockObject(WHITE_BRUSH)), nullptr);
    EXPECT_EQ(FillRect(ended, &rect, GetStockObject(WHITE_BRUSH)), 0);
    EXPECT_EQ(LineTo(ended, 1, 1), FALSE);
    EXPECT_EQ(DrawTextA(ended, "x", -1, &rect, DT_LEFT), 0);
    PAINTSTRUCT paint{ended, FALSE, {}};
    EXPECT_EQ(EndPaint(canvas.Window(), &paint), FALSE);
    EXPECT_EQ(GetStockObject(4), nullptr);  // BLACK_BRUSH is not in the subset
}

TEST(Gdi, SystemColorsStartAtWindowsDefaultsAndChangeAllOrNothing) {
    EXPECT_EQ(GetSysColor(COLOR_BTNFACE), RGB(240, 240, 240));
    EXPECT_EQ(GetSysColor(31), 0u);
    const int indexes[] = {COLOR_INFOBK, 40};
    const COLORREF colors[] = {RGB(1, 2, 3), RGB(4, 5, 6)};
    EXPECT_EQ(SetSysColors(2, indexes, colors), FALSE);
    EXPECT_EQ(GetSysColor(COLOR_INFOBK), RGB(255, 255, 225));
}

}  // namespace
