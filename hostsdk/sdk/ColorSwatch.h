#pragma once

namespace Pigmo::Host {

// Registers the host's color swatch, window class "ColorSwatch": its color inside a one-pixel frame,
// with its title as its tooltip. IColorSwatch sets and reads the color.
void RegisterColorSwatchClass();

}  // namespace Pigmo::Host
