#pragma once

#include <cstdlib>
#include <optional>
#include <string>

#include "Registry.h"
#include "TempFolder.h"

// A temporary folder per test with small CxF books written into it.
class BookFolder : public TempFolder {
protected:
    // A version-2 book around the given palette content.
    static std::string Book(const std::string& paletteContent, const std::string& paletteAttributes = "") {
        return "<?xml version=\"1.0\"?>\n<CxF:CxF xmlns:CxF=\"http://colorexchangeformat.com/v2\">"
               "<CxF:Palette" +
               paletteAttributes + ">" + paletteContent + "</CxF:Palette></CxF:CxF>";
    }
    static std::string ColorSet(const std::string& colors) {
        return "<CxF:ColorSet>" + colors + "</CxF:ColorSet>";
    }
};

// Books in a folder of their own, with an empty registry and the user's data folder inside the test's
// folder, so only the palettes a test writes are found.
class PaletteFolders : public BookFolder {
protected:
    void SetUp() override {
        BookFolder::SetUp();
        if (const char* xdg = std::getenv("XDG_DATA_HOME")) savedXdg_ = xdg;
        setenv("XDG_DATA_HOME", (root_ + "/data").c_str(), 1);
        Pigmo::Platform::RegistryStore::Instance().Clear();
    }
    void TearDown() override {
        if (savedXdg_)
            setenv("XDG_DATA_HOME", savedXdg_->c_str(), 1);
        else
            unsetenv("XDG_DATA_HOME");
        Pigmo::Platform::RegistryStore::Instance().Reset();
        BookFolder::TearDown();
    }
    std::string System(const std::string& name, const std::string& content) {
        return Write("suite/Resources/System Palettes/" + name, content);
    }
    std::string User(const std::string& name, const std::string& content) {
        return Write("data/Pigmo/Tintora/User/" + name, content);
    }

private:
    std::optional<std::string> savedXdg_;
};
