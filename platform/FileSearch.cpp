#include "FileSearch.h"

#include <dirent.h>
#include <sys/stat.h>

#include <algorithm>
#include <cctype>
#include <cstring>
#include <map>
#include <mutex>
#include <string>
#include <vector>

#include "Paths.h"

namespace {

struct Entry {
    std::string name;
    DWORD attributes;
    unsigned long long size;
};

struct Search {
    std::vector<Entry> entries;
    std::size_t next = 0;
};

// Handle table of the open searches; handles are small integers, never 0 or INVALID_HANDLE_VALUE.
struct SearchTable {
    std::mutex lock;
    std::map<std::uintptr_t, Search> searches;
    std::uintptr_t lastHandle = 0;
};

SearchTable& Table() {
    static SearchTable table;
    return table;
}

char Lower(char c) {
    return static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
}

void Fill(const Entry& entry, WIN32_FIND_DATAA* found) {
    std::memset(found, 0, sizeof *found);
    found->dwFileAttributes = entry.attributes;
    found->nFileSizeHigh = static_cast<DWORD>(entry.size >> 32);
    found->nFileSizeLow = static_cast<DWORD>(entry.size & 0xFFFFFFFFu);
    const std::size_t length = std::min(entry.name.size(), static_cast<std::size_t>(MAX_PATH - 1));
    std::memcpy(found->cFileName, entry.name.data(), length);
}

std::vector<Entry> ListMatches(const std::string& folder, std::string_view pattern) {
    std::vector<Entry> entries;
    DIR* dir = opendir(folder.empty() ? "." : folder.c_str());
    if (dir == nullptr) return entries;
    while (const dirent* item = readdir(dir)) {
        const std::string name = item->d_name;
        if (name == "." || name == ".." || !Pigmo::Platform::MatchesWildcard(pattern, name)) continue;
        Entry entry{name, FILE_ATTRIBUTE_NORMAL, 0};
        struct stat status {};
        if (stat((folder + "/" + name).c_str(), &status) == 0) {
            if (S_ISDIR(status.st_mode))
                entry.attributes = FILE_ATTRIBUTE_DIRECTORY;
            else
                entry.size = static_cast<unsigned long long>(status.st_size);
        }
        entries.push_back(std::move(entry));
    }
    closedir(dir);
    std::sort(entries.begin(), entries.end(), [](const Entry& a, const Entry& b) { return a.name < b.name; });
    return entries;
}

}  // namespace

namespace Pigmo::Platform {

bool MatchesWildcard(std::string_view pattern, std::string_view name) {
    // Greedy match with one backtrack point: linear in practice, never recursive.
    std::size_t p = 0, n = 0, star = std::string_view::npos, resume = 0;
    while (n < name.size()) {
        if (p < pattern.size() && pattern[p] == '*') {
            star = p++;
            resume = n;
        } else if (p < pattern.size() && (pattern[p] == '?' || Lower(pattern[p]) == Lower(name[n]))) {
            ++p;
            ++n;
        } else if (star != std::string_view::npos) {
            p = star + 1;
            n = ++resume;
        } else {
            return false;
        }
    }
    while (p < pattern.size() && pattern[p] == '*') ++p;
    return p == pattern.size();
}

}  // namespace Pigmo::Platform

HANDLE FindFirstFileA(LPCSTR pattern, WIN32_FIND_DATAA* found) {
    if (pattern == nullptr || found == nullptr) return INVALID_HANDLE_VALUE;
    const std::string native = Pigmo::Platform::NativePath(pattern);
    const std::size_t slash = native.rfind('/');
    const std::string folder = slash == std::string::npos ? "" : native.substr(0, slash == 0 ? 1 : slash);
    const std::string_view filePattern =
        slash == std::string::npos ? std::string_view(native) : std::string_view(native).substr(slash + 1);

    Search search{ListMatches(folder, filePattern)};
    if (search.entries.empty()) return INVALID_HANDLE_VALUE;
    Fill(search.entries[0], found);
    search.next = 1;

    SearchTable& table = Table();
    std::lock_guard guard(table.lock);
    const std::uintptr_t handle = ++table.lastHandle;
    table.searches.emplace(handle, std::move(search));
    return reinterpret_cast<HANDLE>(handle);
}

BOOL FindNextFileA(HANDLE search, WIN32_FIND_DATAA* found) {
    if (found == nullptr) return FALSE;
    SearchTable& table = Table();
    std::lock_guard guard(table.lock);
    const auto it = table.searches.find(reinterpret_cast<std::uintptr_t>(search));
    if (it == table.searches.end() || it->second.next >= it->second.entries.size()) return FALSE;
    Fill(it->second.entries[it->second.next++], found);
    return TRUE;
}

BOOL FindClose(HANDLE search) {
    SearchTable& table = Table();
    std::lock_guard guard(table.lock);
    return table.searches.erase(reinterpret_cast<std::uintptr_t>(search)) == 1 ? TRUE : FALSE;
}
