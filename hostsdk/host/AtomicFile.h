#pragma once

#include <string>
#include <string_view>

#include "maxtypes.h"

namespace Pigmo::Host {

// Writes bytes to a new file beside path, flushes it to the disk and renames it over path, so path
// holds either its old content or all of bytes, whatever happens. Throws std::runtime_error
// ("cannot write PATH: why") on failure, leaving path as it was. A file being replaced keeps its
// permissions.
HostExport void WriteFileAtomically(const std::string& path, std::string_view bytes);

}  // namespace Pigmo::Host
