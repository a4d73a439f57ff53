#pragma once

namespace Pigmo::Host {

// Registers the host's push button, window class "CustButton": a framed face with its window text
// centred in the dialog font. A click (press and release over it) sends WM_COMMAND with the
// control's id and BN_CLICKED to its parent. ICustButton sets its text and its tooltip.
void RegisterCustButtonClass();

}  // namespace Pigmo::Host
