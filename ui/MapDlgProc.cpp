#include "MapDlgProc.h"

namespace Pigmo::ColorMap {

// The map's rollout arrives with the editor panel; until then none is ever open.
void RefreshRollout(Map*) {}

}  // namespace Pigmo::ColorMap
