#pragma once

namespace Pigmo::ColorMap {

class Map;

// Brings the open rollout up to date with the map's book and pick; does nothing when no rollout is
// open.
void RefreshRollout(Map* map);

}  // namespace Pigmo::ColorMap
