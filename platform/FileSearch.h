#pragma once

#include <string_view>

#include "WinTypes.h"

inline constexpr DWORD FILE_ATTRIBUTE_DIRECTORY = 0x10;
inline constexpr DWORD FILE_ATTRIBUTE_NORMAL = 0x80;

struct WIN32_FIND_DATAA {
    DWORD dwFileAttributes;
    DWORD nFileSizeHigh;
    DWORD nFileSizeLow;
    char cFileName[MAX_PATH];
};

// Wildcard search over one folder: the pattern is a folder (either separator) followed by a file
// pattern with '*' and '?', matched case-insensitively as on Windows. Entries come in name order.
HANDLE FindFirstFileA(LPCSTR pattern, WIN32_FIND_DATAA* found);
BOOL FindNextFileA(HANDLE search, WIN32_FIND_DATAA* found);
BOOL FindClose(HANDLE search);

namespace Pigmo::Platform {

// True when name matches pattern ('*' any run, '?' one character), ignoring ASCII case.
bool MatchesWildcard(std::string_view pattern, std::string_view name);

}  // namespace Pigmo::Platform
