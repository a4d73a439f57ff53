#pragma once

#include <cairo.h>

#include <functional>
#include <memory>
#include <string>

#include "Render.h"
#include "imtl.h"

namespace Pigmo::Host {

// The most a snapshot may be enlarged.
inline constexpr int kMaxSnapshotScale = 8;

// The host's material editor: one top-level window, exactly the size of the rollout it shows, drawn
// off screen. A window system shows its pixels and brings it the mouse; a tool photographs it.
// The first editor sets up the host's interface: its custom controls and its color scheme.
class HostExport MaterialEditor {
public:
    MaterialEditor();
    // Closes the rollout first.
    ~MaterialEditor();
    MaterialEditor(const MaterialEditor&) = delete;
    MaterialEditor& operator=(const MaterialEditor&) = delete;

    // Shows map's rollout in place of the one shown and fits the window to it. Throws
    // std::runtime_error when the map builds none.
    void Open(Texmap& map);
    // Closes the rollout: its user dialog procedure gets WM_DESTROY and is deleted.
    void Close();

    HWND Window() const { return window_; }
    // The open rollout's dialog; null when none is open.
    HWND Rollout() const;
    int Width() const;
    int Height() const;

    // Paints what is invalid; the pixels stay valid until the window changes size.
    cairo_surface_t* Paint();
    // WM_LBUTTONDOWN, WM_MOUSEMOVE or WM_LBUTTONUP at a point of the window.
    void Mouse(UINT message, int x, int y);
    std::string ToolTipAt(int x, int y) const;
    // The painted window, each pixel repeated scale x scale times. Throws std::invalid_argument for a
    // scale outside 1..kMaxSnapshotScale.
    Image Snapshot(int scale);

    // Called after each change of the map shown (a pick, a book); empty to stop.
    void SetChangeHandler(std::function<void()> handler);

private:
    class MapWatcher;

    HWND window_;
    IMtlParams params_;
    ParamDlg* dialog_ = nullptr;
    std::function<void()> changed_;
    std::unique_ptr<MapWatcher> watcher_;
};

}  // namespace Pigmo::Host
