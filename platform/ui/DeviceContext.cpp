#include "DeviceContext.h"

#include <algorithm>
#include <cmath>
#include <utility>
#include <vector>

#include "HandleTable.h"

namespace Pigmo::Platform::Ui {

namespace {

HandleTable<DeviceContext>& Contexts() {
    static HandleTable<DeviceContext> table;
    return table;
}

// What the context may paint, in its own coordinates, so that no walk goes past it.
struct Bounds {
    long long left, top, right, bottom;
};

Bounds ClipBounds(cairo_t* cairo) {
    double left, top, right, bottom;
    cairo_clip_extents(cairo, &left, &top, &right, &bottom);
    return {static_cast<long long>(std::floor(left)) - 1, static_cast<long long>(std::floor(top)) - 1,
            static_cast<long long>(std::ceil(right)) + 1, static_cast<long long>(std::ceil(bottom)) + 1};
}

// The ceiling of a / b for b > 0; wide enough for any pair of 32-bit coordinates.
long long CeilDiv(__int128 a, long long b) {
    return static_cast<long long>(a >= 0 ? (a + b - 1) / b : -((-a) / b));
}

// GDI's polygon fill, exactly: pixel centres lie on integer coordinates; a pixel is filled when its
// centre is inside by the alternate rule, centres on a left or top edge counting as inside and those on
// a right or bottom edge not. Adds one rectangle per run to the path.
void AddPolygonSpans(cairo_t* cairo, const POINT* points, const int* counts, int polygonCount) {
    struct Edge {
        POINT from, to;  // from.y < to.y
    };
    std::vector<Edge> edges;
    LONG top = 0, bottom = 0;
    const POINT* polygon = points;
    for (int i = 0; i < polygonCount; polygon += counts[i++]) {
        for (int k = 0; k < counts[i]; ++k) {
            POINT a = polygon[k];
            POINT b = polygon[(k + 1) % counts[i]];
            if (a.y == b.y) continue;
            if (a.y > b.y) std::swap(a, b);
            top = edges.empty() ? a.y : std::min(top, a.y);
            bottom = edges.empty() ? b.y : std::max(bottom, b.y);
            edges.push_back({a, b});
        }
    }
    const Bounds clip = ClipBounds(cairo);
    std::vector<long long> crossings;
    for (long long y = std::max<long long>(top, clip.top); y < std::min<long long>(bottom, clip.bottom);
         ++y) {
        crossings.clear();
        for (const Edge& edge : edges) {
            if (y < edge.from.y || y >= edge.to.y) continue;
            const long long height = edge.to.y - edge.from.y;
            crossings.push_back(
                CeilDiv(static_cast<__int128>(edge.from.x) * height +
                            static_cast<__int128>(y - edge.from.y) * (edge.to.x - edge.from.x),
                        height));
        }
        std::sort(crossings.begin(), crossings.end());
        for (std::size_t i = 0; i + 1 < crossings.size(); i += 2) {
            const long long left = std::max(crossings[i], clip.left);
            const long long right = std::min(crossings[i + 1], clip.right);
            if (right > left)
                cairo_rectangle(cairo, static_cast<double>(left), static_cast<double>(y),
                                static_cast<double>(right - left), 1);
        }
    }
}

// The pixels of a one-pixel line from a to b, b left out, as 1x1 squares of the path: one pixel per
// step along the longer axis, the other coordinate rounded (Bresenham's choice).
void AddLinePixels(cairo_t* cairo, POINT a, POINT b, const Bounds& clip) {
    const long long dx = static_cast<long long>(b.x) - a.x;
    const long long dy = static_cast<long long>(b.y) - a.y;
    const long long steps = std::max(std::llabs(dx), std::llabs(dy));
    if (steps == 0) return;
    const bool alongX = std::llabs(dx) >= std::llabs(dy);
    const long long start = alongX ? a.x : a.y;
    const long long minorStart = alongX ? a.y : a.x;
    const long long stride = (alongX ? dx : dy) > 0 ? 1 : -1;
    const long long minorRun = alongX ? dy : dx;
    const long long low = alongX ? clip.left : clip.top;
    const long long high = alongX ? clip.right : clip.bottom;
    const long long first = std::max(0LL, stride > 0 ? low - start : start - high);
    const long long last = std::min(steps - 1, stride > 0 ? high - start : start - low);
    for (long long i = first; i <= last; ++i) {
        const long long offset = (2 * i * std::llabs(minorRun) + steps) / (2 * steps);
        const long long major = start + stride * i;
        const long long minor = minorStart + (minorRun < 0 ? -offset : offset);
        cairo_rectangle(cairo, static_cast<double>(alongX ? major : minor),
                        static_cast<double>(alongX ? minor : major), 1, 1);
    }
}

// Outlines a polyline (closed when asked) with the selected pen: one-pixel pens pixel for pixel with
// each segment's end left out, wider ones centred on the pixels with round ends and joins.
void Outline(DeviceContext& context, const POINT* points, int count, bool closed) {
    const Pen& pen = std::get<Pen>(context.pen->value);
    if (pen.hollow || count < 1) return;
    cairo_t* cairo = context.cairo;
    cairo_new_path(cairo);
    if (pen.width <= 1) {
        const Bounds clip = ClipBounds(cairo);
        for (int i = 0; i + 1 < count; ++i) AddLinePixels(cairo, points[i], points[i + 1], clip);
        if (closed) AddLinePixels(cairo, points[count - 1], points[0], clip);
        SetSourceColor(cairo, pen.color);
        cairo_fill(cairo);
        return;
    }
    for (int i = 0; i < count; ++i) cairo_line_to(cairo, points[i].x + 0.5, points[i].y + 0.5);
    if (closed) cairo_close_path(cairo);
    SetSourceColor(cairo, pen.color);
    cairo_set_line_width(cairo, pen.width);
    cairo_set_line_cap(cairo, CAIRO_LINE_CAP_ROUND);
    cairo_set_line_join(cairo, CAIRO_LINE_JOIN_ROUND);
    cairo_stroke(cairo);
}

// Fills the path with the selected brush, unless it is hollow.
void FillWithBrush(DeviceContext& context) {
    const Brush& brush = std::get<Brush>(context.brush->value);
    if (brush.hollow) {
        cairo_new_path(context.cairo);
        return;
    }
    SetSourceColor(context.cairo, brush.color);
    cairo_fill(context.cairo);
}

}  // namespace

HDC OpenDeviceContext(Window& window, POINT origin, const cairo_region_t* clip) {
    auto context = std::make_shared<DeviceContext>();
    context->window = window.handle;
    context->cairo = cairo_create(RootOf(window).surface);
    cairo_set_antialias(context->cairo, CAIRO_ANTIALIAS_NONE);
    const int count = cairo_region_num_rectangles(clip);
    if (count == 0) cairo_rectangle(context->cairo, 0, 0, 0, 0);
    for (int i = 0; i < count; ++i) {
        cairo_rectangle_int_t part;
        cairo_region_get_rectangle(clip, i, &part);
        cairo_rectangle(context->cairo, part.x, part.y, part.width, part.height);
    }
    cairo_clip(context->cairo);
    cairo_translate(context->cairo, origin.x, origin.y);
    context->brush = ShareGdiObject(GetStockObject(WHITE_BRUSH));
    context->pen = ShareGdiObject(GetStockObject(BLACK_PEN));
    context->font = ShareGdiObject(window.font);
    if (context->font == nullptr || !std::holds_alternative<Font>(context->font->value))
        context->font = ShareGdiObject(GetStockObject(DEFAULT_GUI_FONT));
    return Contexts().Add<HDC>(std::move(context));
}

void CloseDeviceContext(HDC context) {
    const std::shared_ptr<DeviceContext> found = Contexts().Share(context);
    if (found == nullptr) return;
    cairo_surface_flush(cairo_get_target(found->cairo));
    Contexts().Remove(context);
}

void CloseDeviceContextsOf(HWND window) {
    for (const std::shared_ptr<DeviceContext>& context : Contexts().Snapshot())
        if (context->window == window) Contexts().Remove(context.get());
}

DeviceContext* ContextFromHandle(HDC context) {
    return Contexts().Find(context);
}

}  // namespace Pigmo::Platform::Ui

using namespace Pigmo::Platform::Ui;

HGDIOBJ SelectObject(HDC dc, HGDIOBJ object) {
    DeviceContext* context = ContextFromHandle(dc);
    std::shared_ptr<GdiObject> selected = ShareGdiObject(object);
    if (context == nullptr || selected == nullptr) return nullptr;
    std::shared_ptr<GdiObject>& slot = std::holds_alternative<Brush>(selected->value) ? context->brush
                                       : std::holds_alternative<Pen>(selected->value) ? context->pen
                                                                                      : context->font;
    return reinterpret_cast<HGDIOBJ>(std::exchange(slot, std::move(selected)).get());
}

int FillRect(HDC dc, const RECT* rect, HBRUSH brush) {
    DeviceContext* context = ContextFromHandle(dc);
    const std::optional<Brush> fill = BrushOf(brush);
    if (context == nullptr || rect == nullptr || !fill) return 0;
    if (fill->hollow || rect->right <= rect->left || rect->bottom <= rect->top) return 1;
    cairo_t* cairo = context->cairo;
    cairo_new_path(cairo);
    cairo_rectangle(cairo, rect->left, rect->top, static_cast<double>(rect->right) - rect->left,
                    static_cast<double>(rect->bottom) - rect->top);
    SetSourceColor(cairo, fill->color);
    cairo_fill(cairo);
    return 1;
}

BOOL Rectangle(HDC dc, int left, int top, int right, int bottom) {
    DeviceContext* context = ContextFromHandle(dc);
    if (context == nullptr) return FALSE;
    if (left > right) std::swap(left, right);
    if (top > bottom) std::swap(top, bottom);
    // The brush covers left..right-2 and top..bottom-2, the outline left..right-1 and top..bottom-1.
    cairo_new_path(context->cairo);
    cairo_rectangle(context->cairo, left, top, std::max(static_cast<double>(right) - 1 - left, 0.0),
                    std::max(static_cast<double>(bottom) - 1 - top, 0.0));
    FillWithBrush(*context);
    const POINT corners[] = {{left, top}, {right - 1, top}, {right - 1, bottom - 1}, {left, bottom - 1}};
    Outline(*context, corners, 4, true);
    return TRUE;
}

BOOL MoveToEx(HDC dc, int x, int y, POINT* previous) {
    DeviceContext* context = ContextFromHandle(dc);
    if (context == nullptr) return FALSE;
    if (previous != nullptr) *previous = context->position;
    context->position = {x, y};
    return TRUE;
}

BOOL LineTo(HDC dc, int x, int y) {
    DeviceContext* context = ContextFromHandle(dc);
    if (context == nullptr) return FALSE;
    const POINT ends[] = {context->position, {x, y}};
    Outline(*context, ends, 2, false);
    context->position = {x, y};
    return TRUE;
}

BOOL PolyPolygon(HDC dc, const POINT* points, const int* counts, int polygonCount) {
    DeviceContext* context = ContextFromHandle(dc);
    if (context == nullptr || points == nullptr || counts == nullptr || polygonCount <= 0) return FALSE;
    if (std::any_of(counts, counts + polygonCount, [](int count) { return count < 2; })) return FALSE;
    cairo_new_path(context->cairo);
    AddPolygonSpans(context->cairo, points, counts, polygonCount);
    FillWithBrush(*context);
    const POINT* polygon = points;
    for (int i = 0; i < polygonCount; polygon += counts[i++]) Outline(*context, polygon, counts[i], true);
    return TRUE;
}

COLORREF SetTextColor(HDC dc, COLORREF color) {
    constexpr COLORREF CLR_INVALID = 0xFFFFFFFF;
    DeviceContext* context = ContextFromHandle(dc);
    return context != nullptr ? std::exchange(context->textColor, color) : CLR_INVALID;
}

COLORREF SetBkColor(HDC dc, COLORREF color) {
    constexpr COLORREF CLR_INVALID = 0xFFFFFFFF;
    DeviceContext* context = ContextFromHandle(dc);
    return context != nullptr ? std::exchange(context->backgroundColor, color) : CLR_INVALID;
}

int SetBkMode(HDC dc, int mode) {
    DeviceContext* context = ContextFromHandle(dc);
    if (context == nullptr || (mode != TRANSPARENT && mode != OPAQUE)) return 0;
    return std::exchange(context->backgroundMode, mode);
}
