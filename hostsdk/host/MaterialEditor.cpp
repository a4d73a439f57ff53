#include "MaterialEditor.h"

#include <mutex>
#include <stdexcept>
#include <utility>

#include "ColorManager.h"
#include "ColorSwatch.h"
#include "CoreInterface.h"
#include "CustButton.h"
#include "Desktop.h"

namespace Pigmo::Host {

namespace {

constexpr const char* kWindowClass = "MaterialEditor";

// The rollout covers the window; what shows at all is the panels' grey.
LRESULT CALLBACK EditorProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    if (message != WM_PAINT) return DefWindowProcA(window, message, wParam, lParam);
    PAINTSTRUCT paint;
    HDC dc = BeginPaint(window, &paint);
    RECT client{};
    GetClientRect(window, &client);
    HBRUSH background = CreateSolidBrush(GetColorManager()->GetColor(0));
    FillRect(dc, &client, background);
    DeleteObject(background);
    EndPaint(window, &paint);
    return 0;
}

void StartInterface() {
    static std::once_flag started;
    std::call_once(started, [] {
        RegisterCustButtonClass();
        RegisterColorSwatchClass();
        ApplySchemeToSystemColors();
        WNDCLASSA windowClass{};
        windowClass.lpfnWndProc = EditorProc;
        windowClass.hCursor = LoadCursorA(nullptr, IDC_ARROW);
        windowClass.lpszClassName = kWindowClass;
        RegisterClassA(&windowClass);
    });
}

HWND CreateEditorWindow() {
    StartInterface();
    HWND window = CreateWindowExA(0, kWindowClass, "Material Editor", WS_POPUP | WS_VISIBLE, 0, 0, 1, 1,
                                  nullptr, nullptr, nullptr, nullptr);
    if (window == nullptr) throw std::runtime_error("cannot create the material editor's window");
    return window;
}

}  // namespace

// Follows the map shown: its changes come here through the reference.
class MaterialEditor::MapWatcher final : public ReferenceMaker {
public:
    MapWatcher(Texmap& map, const std::function<void()>& changed) : changed_(changed) {
        ReplaceReference(0, &map);
    }
    ~MapWatcher() override { DeleteAllRefsFromMe(); }

private:
    RefResult NotifyRefChanged(Interval, RefTargetHandle, PartID&, RefMessage message) override {
        if (message == REFMSG_CHANGE && changed_) changed_();
        return REF_SUCCEED;
    }

    const std::function<void()>& changed_;
};

MaterialEditor::MaterialEditor() : window_(CreateEditorWindow()) {
    SetMainWindow(window_);
}

MaterialEditor::~MaterialEditor() {
    Close();
    DestroyWindow(window_);
    if (GetCOREInterface()->GetMAXHWnd() == window_) SetMainWindow(nullptr);
}

void MaterialEditor::Open(Texmap& map) {
    Close();
    dialog_ = map.CreateParamDlg(window_, &params_);
    auto* rollouts = dynamic_cast<IAutoMParamDlg*>(dialog_);
    if (rollouts == nullptr || rollouts->GetMap(0) == nullptr) {
        if (dialog_ != nullptr) dialog_->DeleteThis();
        dialog_ = nullptr;
        throw std::runtime_error(std::string(map.GetFullName().data()) + " shows no rollout");
    }
    RECT size{};
    GetClientRect(Rollout(), &size);
    SetWindowPos(window_, nullptr, 0, 0, size.right - size.left, size.bottom - size.top, SWP_NOMOVE);
    InvalidateRect(window_, nullptr, TRUE);
    watcher_ = std::make_unique<MapWatcher>(map, changed_);
}

void MaterialEditor::Close() {
    watcher_.reset();
    if (dialog_ != nullptr) std::exchange(dialog_, nullptr)->DeleteThis();
}

HWND MaterialEditor::Rollout() const {
    auto* rollouts = dynamic_cast<IAutoMParamDlg*>(dialog_);
    IParamMap2* map = rollouts != nullptr ? rollouts->GetMap(0) : nullptr;
    return map != nullptr ? map->GetHWnd() : nullptr;
}

int MaterialEditor::Width() const {
    RECT client{};
    GetClientRect(window_, &client);
    return client.right - client.left;
}

int MaterialEditor::Height() const {
    RECT client{};
    GetClientRect(window_, &client);
    return client.bottom - client.top;
}

cairo_surface_t* MaterialEditor::Paint() {
    Platform::PaintWindows(window_);
    return Platform::WindowSurface(window_);
}

void MaterialEditor::Mouse(UINT message, int x, int y) {
    Platform::ForwardMouse(window_, message, x, y);
}

std::string MaterialEditor::ToolTipAt(int x, int y) const {
    return Platform::ToolTipTextAt(window_, x, y);
}

Image MaterialEditor::Snapshot(int scale) {
    if (scale < 1 || scale > kMaxSnapshotScale)
        throw std::invalid_argument("the scale must be 1 to " + std::to_string(kMaxSnapshotScale));
    cairo_surface_t* surface = Paint();
    cairo_surface_flush(surface);
    const int width = cairo_image_surface_get_width(surface),
              height = cairo_image_surface_get_height(surface);
    const int stride = cairo_image_surface_get_stride(surface);
    const unsigned char* data = cairo_image_surface_get_data(surface);
    Image image;
    image.width = width * scale;
    image.height = height * scale;
    image.rgb.resize(static_cast<std::size_t>(image.width) * static_cast<std::size_t>(image.height) * 3u);
    std::size_t at = 0;
    for (int y = 0; y < image.height; ++y) {
        const auto* row =
            reinterpret_cast<const std::uint32_t*>(data + static_cast<std::size_t>(y / scale) * stride);
        for (int x = 0; x < image.width; ++x) {
            // Premultiplied ARGB in native byte order; the window is opaque, so the channels are the color.
            const std::uint32_t pixel = row[x / scale];
            image.rgb[at++] = static_cast<std::uint8_t>(pixel >> 16);
            image.rgb[at++] = static_cast<std::uint8_t>(pixel >> 8);
            image.rgb[at++] = static_cast<std::uint8_t>(pixel);
        }
    }
    return image;
}

void MaterialEditor::SetChangeHandler(std::function<void()> handler) {
    changed_ = std::move(handler);
}

}  // namespace Pigmo::Host
