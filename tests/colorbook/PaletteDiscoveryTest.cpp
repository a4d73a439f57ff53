#include <gtest/gtest.h>
#include <pigmo/bp.h>

#include <algorithm>
#include <cstdlib>
#include <string>
#include <vector>

#include "BookFiles.h"
#include "ColorBookReader.h"
#include "PaletteDiscovery.h"
#include "Registry.h"

namespace {

using Pigmo::Platform::RegistryStore;

struct FileNameCase {
    const char* path;
    const char* expected;
};

class FileName : public testing::TestWithParam<FileNameCase> {};

TEST_P(FileName, IsTheTextAfterTheLastSeparator) {
    EXPECT_STREQ(Pigmo::FileNameOf(GetParam().path), GetParam().expected);
}

INSTANTIATE_TEST_SUITE_P(Cases, FileName,
                         testing::Values(FileNameCase{"C:\\Suite\\Palettes\\A.cxf", "A.cxf"},
                                         FileNameCase{"/usr/share/pigmo/B.cxf", "B.cxf"},
                                         FileNameCase{"/mixed\\path/C.cxf", "C.cxf"},
                                         FileNameCase{"/mixed/path\\D.cxf", "D.cxf"},
                                         FileNameCase{"E.cxf", "E.cxf"}, FileNameCase{"folder\\", ""},
                                         FileNameCase{"", ""}));

// Discovery against a fake registry and a fake data home inside the test's folder.
using Discovery = PaletteFolders;

TEST_F(Discovery, SystemPalettesComeFirstThenTheUsers) {
    RegistryStore::Instance().SetString(Pigmo::Platform::kSuiteUninstallKey, "InstallLocation",
                                        root_ + "/suite\\");
    System("b.cxf", Book("", R"( PaletteName="System B")"));
    System("a.CXF", "<NotABook/>");
    System("readme.txt", "");
    User("u.cxf", Book("", R"( PaletteName="User U")"));

    const std::vector<std::string> paths = Pigmo::CollectPalettePaths();
    const std::string system = root_ + "/suite\\Resources\\System Palettes\\";
    const std::string user = root_ + "/data\\Pigmo\\Tintora\\User\\";
    ASSERT_EQ(paths, (std::vector<std::string>{system + "a.CXF", system + "b.cxf", user + "u.cxf"}));
    std::vector<std::string> names;
    for (const std::string& path : paths) names.push_back(Pigmo::PaletteDisplayName(path.c_str()));
    EXPECT_EQ(names, (std::vector<std::string>{"", "System B", "User U"}));

    std::string first;
    ASSERT_TRUE(Pigmo::FindDefaultPalettePath(first));
    EXPECT_EQ(first, paths[0]);
}

TEST_F(Discovery, InstallLocationNeedsItsTrailingSeparator) {
    System("a.cxf", Book(""));
    const struct {
        const char* key;
        std::string location;
        bool found;
    } cases[] = {
        {Pigmo::Platform::kSuiteUninstallKeyWow64, root_ + "/suite/", true},
        {Pigmo::Platform::kSuiteUninstallKey, root_ + "/suite\\", true},
        {Pigmo::Platform::kSuiteUninstallKeyWow64, root_ + "/suite", false},
        {"Software\\Other", root_ + "/suite/", false},
    };
    for (const auto& c : cases) {
        RegistryStore::Instance().Clear();
        RegistryStore::Instance().SetString(c.key, "InstallLocation", c.location);
        std::string folder = "unset";
        WIN32_FIND_DATAA found{};
        HANDLE search = INVALID_HANDLE_VALUE;
        EXPECT_EQ(Pigmo::FindFirstSystemPalette(folder, found, search), c.found) << c.location;
        if (c.found) {
            EXPECT_STREQ(found.cFileName, "a.cxf");
            FindClose(search);
        }
        EXPECT_EQ(Pigmo::CollectPalettePaths().size(), c.found ? 1u : 0u);
    }
}

TEST_F(Discovery, EmptyOrMissingFoldersGiveNothing) {
    std::string path = "unset";
    EXPECT_FALSE(Pigmo::FindDefaultPalettePath(path));
    EXPECT_EQ(path, "unset");
    EXPECT_TRUE(Pigmo::CollectPalettePaths().empty());

    Write("data/Pigmo/Tintora/User/notes.txt", "");
    std::string folder;
    WIN32_FIND_DATAA found{};
    HANDLE search = nullptr;
    EXPECT_TRUE(Pigmo::FindFirstUserPalette(folder, found, search));
    EXPECT_EQ(search, INVALID_HANDLE_VALUE);
    EXPECT_EQ(folder, root_ + "/data\\Pigmo\\Tintora\\User\\");
}

TEST(ShippedBooks, TheBuildTreeFindsBothThroughItsDefaultRegistry) {
    unsetenv("PIGMO_INSTALL_LOCATION");  // each test runs in its own process
    RegistryStore::Instance().Reset();
    std::string path;
    ASSERT_TRUE(Pigmo::FindDefaultPalettePath(path));
    std::vector<std::string> names;
    for (const std::string& found : Pigmo::CollectPalettePaths())
        names.push_back(Pigmo::PaletteDisplayName(found.c_str()));
    EXPECT_NE(std::find(names.begin(), names.end(), "ISCC-NBS Centroid Colors"), names.end());
    EXPECT_NE(std::find(names.begin(), names.end(), "CIE Test Color Samples"), names.end());
}

TEST(ShippedBooks, LoadWithTheirCountsAndDerivedValues) {
    std::vector<Pigmo::ColorInformation> iscc, tcs;
    ASSERT_TRUE(Pigmo::LoadColorBook(PIGMO_PALETTE_SOURCE_DIR "ISCC-NBS Centroid Colors.cxf", iscc, nullptr));
    ASSERT_TRUE(Pigmo::LoadColorBook(PIGMO_PALETTE_SOURCE_DIR "Test Color Samples.cxf", tcs, nullptr));
    ASSERT_EQ(iscc.size(), 267u);
    ASSERT_EQ(tcs.size(), 15u);

    // Centroid 1 "Vivid Pink" in the Red/Pink category.
    EXPECT_STREQ(iscc[0].GetName(), "Vivid Pink");
    EXPECT_STREQ(iscc[0].GetCategory(), "Red/Pink");
    const float vividPink[3] = {80.656948f, 27.535981f, 8.233154f};
    for (int i = 0; i < 3; ++i) EXPECT_FLOAT_EQ(iscc[0].GetLab()[i], vividPink[i]);
    EXPECT_STREQ(iscc.back().GetName(), "Black");

    for (const Pigmo::ColorInformation& sample : tcs) {
        ASSERT_EQ(sample.GetSpectralReflectanceCount(), 36);
        const std::vector<double> curve(sample.GetSpectralReflectance(),
                                        sample.GetSpectralReflectance() + 36);
        double lab[3];
        ASSERT_EQ(BPConvert36BandSpectral2LabD502(curve.data(), lab), 1);
        for (int i = 0; i < 3; ++i)
            EXPECT_FLOAT_EQ(sample.GetLab()[i], static_cast<float>(lab[i])) << sample.GetName();
        EXPECT_GT(sample.GetLinearRGB()[0] + sample.GetLinearRGB()[1] + sample.GetLinearRGB()[2], 0.0f);
    }
    // TCS01 at 380 nm as the reference file prints it.
    EXPECT_FLOAT_EQ(tcs[0].GetSpectralReflectance()[0], 0.22f);
}

}  // namespace
