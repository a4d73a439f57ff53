#pragma once

namespace Pigmo::Host {

// Gives the system colors, which the standard controls paint with, the host's scheme, so static
// texts, fields and lists match the custom controls.
void ApplySchemeToSystemColors();

}  // namespace Pigmo::Host
