#include <gtest/gtest.h>

#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include "FileSearch.h"
#include "Registry.h"
#include "ShellFolder.h"
#include "StringTable.h"
#include "TempFolder.h"

namespace fs = std::filesystem;
using Pigmo::Platform::RegistryStore;

namespace {

struct WildcardCase {
    const char* pattern;
    const char* name;
    bool matches;
};

class Wildcard : public testing::TestWithParam<WildcardCase> {};

TEST_P(Wildcard, MatchesAsWindowsDoes) {
    const WildcardCase& c = GetParam();
    EXPECT_EQ(Pigmo::Platform::MatchesWildcard(c.pattern, c.name), c.matches)
        << c.pattern << " vs " << c.name;
}

INSTANTIATE_TEST_SUITE_P(
    Cases, Wildcard,
    testing::Values(WildcardCase{"*.cxf", "book.cxf", true}, WildcardCase{"*.cxf", "BOOK.CxF", true},
                    WildcardCase{"*.cxf", "book.cxf.bak", false}, WildcardCase{"*.cxf", ".cxf", true},
                    WildcardCase{"?.cxf", "ab.cxf", false}, WildcardCase{"??.cxf", "ab.cxf", true},
                    WildcardCase{"a*b*c", "aXbYYbZc", true}, WildcardCase{"a*b*c", "aXbYYbZ", false},
                    WildcardCase{"**", "", true}, WildcardCase{"", "a", false},
                    WildcardCase{"*a", "bbb", false}));

std::vector<std::string> Search(const std::string& pattern) {
    std::vector<std::string> names;
    WIN32_FIND_DATAA found{};
    HANDLE search = FindFirstFileA(pattern.c_str(), &found);
    if (search == INVALID_HANDLE_VALUE) return names;
    do names.emplace_back(found.cFileName);
    while (FindNextFileA(search, &found));
    EXPECT_EQ(FindClose(search), TRUE);
    EXPECT_EQ(FindClose(search), FALSE);
    return names;
}

using FileSearch = TempFolder;

TEST_F(FileSearch, ListsMatchesInNameOrderWithEitherSeparator) {
    for (const char* name : {"b.cxf", "A.CXF", "notes.txt", "z.Cxf", "c.cxf.old"}) Write(name, "x");
    fs::create_directory(root_ + "/d.cxf");
    const std::vector<std::string> expected = {"A.CXF", "b.cxf", "d.cxf", "z.Cxf"};
    EXPECT_EQ(Search(root_ + "/*.cxf"), expected);
    std::string windowsStyle = root_ + "\\*.cxf";
    EXPECT_EQ(Search(windowsStyle), expected);
}

TEST_F(FileSearch, EmptyOrMissingFolderFindsNothing) {
    WIN32_FIND_DATAA found{};
    EXPECT_EQ(FindFirstFileA((root_ + "/*.cxf").c_str(), &found), INVALID_HANDLE_VALUE);
    EXPECT_EQ(FindFirstFileA((root_ + "/missing/*.cxf").c_str(), &found), INVALID_HANDLE_VALUE);
    EXPECT_EQ(FindNextFileA(INVALID_HANDLE_VALUE, &found), FALSE);
}

class Registry : public testing::Test {
protected:
    void TearDown() override {
        unsetenv("PIGMO_INSTALL_LOCATION");
        RegistryStore::Instance().Reset();
    }
};

std::string QueryInstallLocation(const char* key) {
    HKEY handle = nullptr;
    if (RegOpenKeyA(HKEY_LOCAL_MACHINE, key, &handle) != ERROR_SUCCESS) return "<no key>";
    char value[512] = {};
    DWORD size = sizeof value;
    const LONG status =
        RegQueryValueExA(handle, "InstallLocation", nullptr, nullptr, reinterpret_cast<LPBYTE>(value), &size);
    EXPECT_EQ(RegCloseKey(handle), ERROR_SUCCESS);
    EXPECT_EQ(RegCloseKey(handle), ERROR_INVALID_HANDLE);
    return status == ERROR_SUCCESS ? value : "<no value>";
}

TEST_F(Registry, StartsWithTheSuiteEntryAndHonoursTheEnvironment) {
    const std::string location = QueryInstallLocation(Pigmo::Platform::kSuiteUninstallKeyWow64);
    ASSERT_FALSE(location.empty());
    EXPECT_EQ(location.back(), '/');
    EXPECT_EQ(QueryInstallLocation(Pigmo::Platform::kSuiteUninstallKey), "<no key>");

    setenv("PIGMO_INSTALL_LOCATION", "/opt/suite\\", 1);
    RegistryStore::Instance().Reset();
    EXPECT_EQ(QueryInstallLocation(Pigmo::Platform::kSuiteUninstallKeyWow64), "/opt/suite\\");
}

TEST_F(Registry, KeysIgnoreCaseParentsOpenAndShortBuffersAreRefused) {
    RegistryStore& store = RegistryStore::Instance();
    store.Clear();
    store.SetString("Software\\Vendor\\App", "Path", "0123456789");
    EXPECT_EQ(QueryInstallLocation("SOFTWARE\\vendor\\APP"), "<no value>");
    EXPECT_EQ(QueryInstallLocation("Software\\Vendor\\Ap"), "<no key>");

    HKEY parent = nullptr, key = nullptr;
    ASSERT_EQ(RegOpenKeyA(HKEY_LOCAL_MACHINE, "software\\vendor", &parent), ERROR_SUCCESS);
    ASSERT_EQ(RegOpenKeyA(parent, "App", &key), ERROR_SUCCESS);
    char small[4] = {'?', '?', '?', '?'};
    DWORD size = sizeof small;
    EXPECT_EQ(RegQueryValueExA(key, "PATH", nullptr, nullptr, reinterpret_cast<LPBYTE>(small), &size),
              ERROR_MORE_DATA);
    EXPECT_EQ(size, 11u);
    EXPECT_EQ(small[0], '?');
    RegCloseKey(key);
    RegCloseKey(parent);
}

// Restores an environment variable when the test ends.
class SavedVariable {
public:
    explicit SavedVariable(const char* name) : name_(name), had_(std::getenv(name) != nullptr) {
        if (had_) value_ = std::getenv(name);
    }
    ~SavedVariable() {
        if (had_)
            setenv(name_, value_.c_str(), 1);
        else
            unsetenv(name_);
    }

private:
    const char* name_;
    bool had_;
    std::string value_;
};

TEST(ShellFolder, AppDataFollowsXdgDataHome) {
    SavedVariable xdg("XDG_DATA_HOME"), home("HOME");
    char path[MAX_PATH];

    setenv("XDG_DATA_HOME", "/data/home/", 1);
    ASSERT_EQ(SHGetFolderPathA(nullptr, CSIDL_APPDATA, nullptr, SHGFP_TYPE_CURRENT, path), S_OK);
    EXPECT_STREQ(path, "/data/home");

    setenv("XDG_DATA_HOME", "relative/ignored", 1);
    setenv("HOME", "/home/tester", 1);
    ASSERT_EQ(SHGetFolderPathA(nullptr, CSIDL_APPDATA, nullptr, SHGFP_TYPE_CURRENT, path), S_OK);
    EXPECT_STREQ(path, "/home/tester/.local/share");

    setenv("XDG_DATA_HOME", ("/" + std::string(MAX_PATH, 'x')).c_str(), 1);
    EXPECT_EQ(SHGetFolderPathA(nullptr, CSIDL_APPDATA, nullptr, SHGFP_TYPE_CURRENT, path), E_FAIL);
    EXPECT_EQ(SHGetFolderPathA(nullptr, 0x0005, nullptr, SHGFP_TYPE_CURRENT, path), E_INVALIDARG);
}

TEST(StringTable, HoldsIds102To120InOneSharedBuffer) {
    for (unsigned int id = 102; id <= 120; ++id) EXPECT_NE(Pigmo::FindResourceText(id), nullptr) << id;
    for (unsigned int id : {0u, 101u, 121u}) EXPECT_EQ(Pigmo::LoadResourceString(id), nullptr) << id;

    const char* first = Pigmo::LoadResourceString(IDS_CLASS_NAME);
    const std::string className = first;
    const char* second = Pigmo::LoadResourceString(IDS_CATEGORY);
    EXPECT_EQ(first, second);
    EXPECT_STREQ(second, Pigmo::FindResourceText(IDS_CATEGORY));
    EXPECT_NE(className, second);
}

}  // namespace
