#pragma once

#include <string>
#include <vector>

namespace Pigmo::Platform {

// Settings of the palette folders that cannot be used as they stand, one sentence each, so that tools
// report them instead of silently finding no palettes: an install location longer than the uninstall
// entry's readers take, and an application-data folder that is relative or longer than MAX_PATH.
std::vector<std::string> UnusableSettings();

}  // namespace Pigmo::Platform
