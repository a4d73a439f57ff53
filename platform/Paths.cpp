#include "Paths.h"

#include <algorithm>

namespace Pigmo::Platform {

std::string NativePath(std::string_view path) {
    std::string native(path);
    std::replace(native.begin(), native.end(), '\\', '/');
    return native;
}

}  // namespace Pigmo::Platform
