#pragma once

#include <max.h>

namespace Pigmo::ColorMap {

class Map;

// The map's own handling of its rollout: the palette list, the fields, the swatch, the custom
// controls' owners and the tooltip that names the current color. The host deletes it when the
// rollout closes.
class MapDlgProc final : public ParamMap2UserDlgProc {
public:
    explicit MapDlgProc(Map* map) : map_(map) {}
    INT_PTR DlgProc(TimeValue t, IParamMap2* map, HWND hWnd, UINT msg, WPARAM wParam, LPARAM lParam) override;
    void DeleteThis() override { delete this; }
    void SetThing(ReferenceTarget* m) override;

private:
    Map* map_;
};

// Brings the open rollout up to date with the map's book and pick; does nothing when no rollout is
// open.
void RefreshRollout(Map* map);

}  // namespace Pigmo::ColorMap
