#pragma once

#include <gtest/gtest.h>
#include <stdlib.h>

#include <filesystem>
#include <fstream>
#include <string>

// A temporary folder per test, and small CxF books written into it.
class BookFolder : public testing::Test {
protected:
    void SetUp() override {
        char name[] = "/tmp/pigmo-books-XXXXXX";
        ASSERT_NE(mkdtemp(name), nullptr);
        root_ = name;
    }
    void TearDown() override { std::filesystem::remove_all(root_); }

    std::string Write(const std::string& name, const std::string& content) {
        const std::string path = root_ + "/" + name;
        std::filesystem::create_directories(std::filesystem::path(path).parent_path());
        std::ofstream(path, std::ios::binary) << content;
        return path;
    }

    // A version-2 book around the given palette content.
    static std::string Book(const std::string& paletteContent, const std::string& paletteAttributes = "") {
        return "<?xml version=\"1.0\"?>\n<CxF:CxF xmlns:CxF=\"http://colorexchangeformat.com/v2\">"
               "<CxF:Palette" +
               paletteAttributes + ">" + paletteContent + "</CxF:Palette></CxF:CxF>";
    }
    static std::string ColorSet(const std::string& colors) {
        return "<CxF:ColorSet>" + colors + "</CxF:ColorSet>";
    }

    std::string root_;
};
