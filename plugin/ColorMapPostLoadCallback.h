#pragma once

#include <max.h>

namespace Pigmo::ColorMap {

class Map;

// Reads a loaded map's book once the whole scene is in, and scrolls its palette to the pick.
class ColorMapPostLoadCallback final : public PostLoadCallback {
public:
    explicit ColorMapPostLoadCallback(Map* map) : map_(map) {}
    // Deletes itself.
    void proc(ILoad* iload) override;
    int Priority() override { return 5; }

private:
    Map* map_;
};

}  // namespace Pigmo::ColorMap
