#pragma once

#include <string>
#include <string_view>

namespace Pigmo::Platform {

// Paths may be written with backslashes, as on Windows; the file system wants slashes.
std::string NativePath(std::string_view path);

}  // namespace Pigmo::Platform
