#pragma once

// A fresh folder under /tmp for each test, removed afterwards.
#include <gtest/gtest.h>
#include <stdlib.h>

#include <filesystem>
#include <fstream>
#include <string>

class TempFolder : public testing::Test {
protected:
    void SetUp() override {
        char name[] = "/tmp/pigmo-test-XXXXXX";
        ASSERT_NE(mkdtemp(name), nullptr);
        root_ = name;
    }
    void TearDown() override { std::filesystem::remove_all(root_); }

    // Writes a file below the folder, creating its parent folders; returns its path.
    std::string Write(const std::string& name, const std::string& content) {
        const std::string path = root_ + "/" + name;
        std::filesystem::create_directories(std::filesystem::path(path).parent_path());
        std::ofstream(path, std::ios::binary) << content;
        return path;
    }

    std::string root_;
};
