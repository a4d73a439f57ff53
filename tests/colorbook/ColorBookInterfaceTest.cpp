#include <gtest/gtest.h>
#include <pigmo/bp.h>

#include <atomic>
#include <cstring>
#include <filesystem>
#include <string>
#include <thread>
#include <vector>

#include "BookFiles.h"
#include "Registry.h"

namespace {

std::string Attribute(const std::string& name, const std::string& value) {
    return "<CxF:CustomAttribute><CxF:Name>" + name + "</CxF:Name><CxF:ValueChoice><CxF:StringValue>" +
           value + "</CxF:StringValue></CxF:ValueChoice></CxF:CustomAttribute>";
}

// Two colors: one with every field in the book, one with a name only.
std::string FullColor() {
    std::string points;
    for (int i = 0; i < 36; ++i)
        points += "<CxF:ReflectancePoint>" + std::to_string(i / 100.0) + "</CxF:ReflectancePoint>";
    return R"(<CxF:Color ColorName="Moss">)" + Attribute("category", "Greens") + Attribute("tags", "dark") +
           Attribute("tags", "leaf") +
           "<CxF:ColorSpaceCIELab><CxF:L>40</CxF:L><CxF:A>-20</CxF:A><CxF:B>30</CxF:B></CxF:ColorSpaceCIELab>"
           "<CxF:ColorSpaceSRGB><CxF:Red>0.2</CxF:Red><CxF:Green>0.4</CxF:Green><CxF:Blue>0.1</CxF:Blue>"
           "</CxF:ColorSpaceSRGB><CxF:ColorSpaceSpectral>" +
           points + "</CxF:ColorSpaceSpectral></CxF:Color>" + R"(<CxF:Color ColorName="Bare"/>)";
}

struct Triple {
    double values[3] = {-1, -1, -1};
};

using BookInterface = BookFolder;

TEST_F(BookInterface, GivesEveryFieldOfEveryColor) {
    BPColorBook* book = BPColorBookOpen(
        Write("b.cxf", Book(ColorSet(FullColor()), R"( PaletteName="Woods")")).c_str(), nullptr, 0);
    ASSERT_NE(book, nullptr);
    EXPECT_STREQ(BPColorBookGetName(book), "Woods");
    ASSERT_EQ(BPColorBookGetColorCount(book), 2);

    EXPECT_STREQ(BPColorBookGetColorName(book, 0), "Moss");
    EXPECT_STREQ(BPColorBookGetColorCategory(book, 0), "Greens");
    Triple lab, srgb, linear, expectedSRGB;
    ASSERT_EQ(BPColorBookGetColorLab(book, 0, lab.values), 1);
    EXPECT_DOUBLE_EQ(lab.values[1], -20);
    // sRGB always follows the CIELAB; linear RGB decodes the book's own sRGB.
    ASSERT_EQ(BPColorBookGetColorSRGB(book, 0, srgb.values), 1);
    BPConvertLab2sRGB(lab.values, expectedSRGB.values);
    ASSERT_EQ(BPColorBookGetColorLinearRGB(book, 0, linear.values), 1);
    const double decoded[3] = {0.0331048, 0.1328683, 0.0100228};
    for (int i = 0; i < 3; ++i) {
        EXPECT_NEAR(srgb.values[i], expectedSRGB.values[i], 1e-4);
        EXPECT_NEAR(linear.values[i], decoded[i], 1e-6);
    }
    ASSERT_EQ(BPColorBookGetColorTagCount(book, 0), 2);
    EXPECT_STREQ(BPColorBookGetColorTag(book, 0, 1), "leaf");
    ASSERT_EQ(BPColorBookGetColorReflectanceCount(book, 0), 36);
    std::vector<double> curve(40, -1);
    EXPECT_EQ(BPColorBookGetColorReflectance(book, 0, curve.data(), 40), 36);
    EXPECT_NEAR(curve[35], 0.35, 1e-7);
    EXPECT_EQ(curve[36], -1);
    EXPECT_EQ(BPColorBookGetColorReflectance(book, 0, curve.data(), 3), 3);

    EXPECT_STREQ(BPColorBookGetColorCategory(book, 1), "Default");
    EXPECT_EQ(BPColorBookGetColorReflectanceCount(book, 1), 0);
    EXPECT_EQ(BPColorBookGetColorTagCount(book, 1), 0);
    BPColorBookClose(book);
}

TEST_F(BookInterface, NullHandlesAndBadIndicesAreHarmless) {
    BPColorBook* book = BPColorBookOpen(Write("b.cxf", Book(ColorSet(FullColor()))).c_str(), nullptr, 0);
    ASSERT_NE(book, nullptr);
    EXPECT_STREQ(BPColorBookGetName(book), "");
    double out[3] = {7, 7, 7};
    for (BPColorBook* handle : {static_cast<BPColorBook*>(nullptr), book}) {
        for (int index : {-1, 2, 1 << 30}) {
            EXPECT_EQ(BPColorBookGetColorName(handle, index), nullptr);
            EXPECT_EQ(BPColorBookGetColorCategory(handle, index), nullptr);
            EXPECT_EQ(BPColorBookGetColorLab(handle, index, out), 0);
            EXPECT_EQ(BPColorBookGetColorSRGB(handle, index, out), 0);
            EXPECT_EQ(BPColorBookGetColorLinearRGB(handle, index, out), 0);
            EXPECT_EQ(BPColorBookGetColorTagCount(handle, index), 0);
            EXPECT_EQ(BPColorBookGetColorTag(handle, index, 0), nullptr);
            EXPECT_EQ(BPColorBookGetColorReflectanceCount(handle, index), 0);
            EXPECT_EQ(BPColorBookGetColorReflectance(handle, index, out, 3), 0);
        }
    }
    EXPECT_EQ(out[0], 7);
    EXPECT_EQ(BPColorBookGetColorTag(book, 0, 2), nullptr);
    EXPECT_EQ(BPColorBookGetColorTag(book, 0, -1), nullptr);
    EXPECT_EQ(BPColorBookGetColorLab(book, 0, nullptr), 0);
    EXPECT_EQ(BPColorBookGetColorReflectance(book, 0, out, 0), 0);
    EXPECT_EQ(BPColorBookGetName(nullptr), nullptr);
    EXPECT_EQ(BPColorBookGetColorCount(nullptr), 0);
    BPColorBookClose(book);
    BPColorBookClose(nullptr);
}

struct OpenFailureCase {
    const char* label;
    const char* content;  // null: nothing at the path; "<dir>": a folder
    const char* message;  // what follows "<path>: ", or the whole text when it names the path itself
};

class BookOpenFailure : public BookFolder, public testing::WithParamInterface<OpenFailureCase> {};

TEST_P(BookOpenFailure, CopiesTheReadersMessageNamingTheFile) {
    const OpenFailureCase& c = GetParam();
    const std::string path = root_ + "/entry.cxf";
    if (c.content != nullptr && std::strcmp(c.content, "<dir>") == 0)
        std::filesystem::create_directory(path);
    else if (c.content != nullptr)
        Write("entry.cxf", c.content);
    char text[512];
    std::memset(text, 'x', sizeof text);
    EXPECT_EQ(BPColorBookOpen(path.c_str(), text, sizeof text), nullptr);
    const std::string expected =
        c.content == nullptr ? "ColorBook file '" + path + "' doesn't exist" : path + ": " + c.message;
    EXPECT_EQ(std::string(text), expected);

    // A short buffer gets the start of the text, terminated.
    char shortText[6];
    EXPECT_EQ(BPColorBookOpen(path.c_str(), shortText, sizeof shortText), nullptr);
    EXPECT_EQ(std::string(shortText), expected.substr(0, 5));
    EXPECT_EQ(BPColorBookOpen(path.c_str(), nullptr, 100), nullptr);
}

INSTANTIATE_TEST_SUITE_P(
    Cases, BookOpenFailure,
    testing::Values(
        OpenFailureCase{"Missing", nullptr, nullptr},
        OpenFailureCase{"Directory", "<dir>", "Specified file is not a valid CXF ColorBook (is a directory)"},
        OpenFailureCase{"Empty", "", "Specified file is not a valid CXF ColorBook (the file is empty)"},
        OpenFailureCase{"OtherVersion", "<CxF:CxF xmlns:CxF=\"http://colorexchangeformat.com/v3\"/>",
                        "Only version 2.1 of CXF ColorBooks is supported (xmlns:CxF is "
                        "'http://colorexchangeformat.com/v3')"}),
    [](const testing::TestParamInfo<OpenFailureCase>& info) { return info.param.label; });

// Threads open good and missing books at once; each must see its own book and its own message.
TEST_F(BookInterface, OpensOnManyThreadsWithTheirOwnMessages) {
    const std::string good = Write("b.cxf", Book(ColorSet(FullColor()), R"( PaletteName="Woods")"));
    constexpr int kThreads = 4, kRounds = 25;
    std::atomic<int> wrong{0};
    std::vector<std::thread> threads;
    for (int t = 0; t < kThreads; ++t) {
        threads.emplace_back([&, t] {
            const std::string missing = root_ + "/missing-" + std::to_string(t) + ".cxf";
            const std::string expected = "ColorBook file '" + missing + "' doesn't exist";
            for (int round = 0; round < kRounds; ++round) {
                char text[256];
                if (BPColorBookOpen(missing.c_str(), text, sizeof text) != nullptr || expected != text)
                    ++wrong;
                BPColorBook* book = BPColorBookOpen(good.c_str(), text, sizeof text);
                if (book == nullptr || BPColorBookGetColorCount(book) != 2 ||
                    std::strcmp(BPColorBookGetColorName(book, 0), "Moss") != 0)
                    ++wrong;
                BPColorBookClose(book);
            }
        });
    }
    for (std::thread& thread : threads) thread.join();
    EXPECT_EQ(wrong.load(), 0);
}

struct HtmlCase {
    double srgb[3];
    const char* code;
};

TEST(HtmlColorCode, TruncatesAfterAHundredthAndClamps) {
    const HtmlCase cases[] = {{{255, 178.38, 160.32}, "#FFB2A0"},
                              {{39.9958, 0, 15.98}, "#28000F"},
                              {{-3, 300, 254.999}, "#00FFFF"}};
    for (const HtmlCase& c : cases) {
        char code[8];
        ASSERT_EQ(BPGetHtmlColorCode(c.srgb, code, sizeof code), 1);
        EXPECT_STREQ(code, c.code);
    }
    char code[4];
    EXPECT_EQ(BPGetHtmlColorCode(cases[0].srgb, code, sizeof code), 1);
    EXPECT_STREQ(code, "#FF");
    EXPECT_EQ(BPGetHtmlColorCode(nullptr, code, sizeof code), 0);
    EXPECT_EQ(BPGetHtmlColorCode(cases[0].srgb, nullptr, 8), 0);
    EXPECT_EQ(BPGetHtmlColorCode(cases[0].srgb, code, 0), 0);
}

using PaletteInterface = PaletteFolders;

TEST_F(PaletteInterface, ListsSystemThenUserPalettesWithNamesPathsAndKinds) {
    Pigmo::Platform::RegistryStore::Instance().SetString(Pigmo::Platform::kSuiteUninstallKey,
                                                         "InstallLocation", root_ + "/suite\\");
    System("b.cxf", Book("", R"( PaletteName="System B")"));
    System("a.cxf", "<NotABook/>");
    User("u.cxf", Book("", R"( PaletteName="User U")"));

    BPPaletteList* list = BPPaletteListFind();
    ASSERT_NE(list, nullptr);
    ASSERT_EQ(BPPaletteListGetCount(list), 3);
    const std::string system = root_ + "/suite/Resources/System Palettes/";
    const struct {
        const char* name;
        std::string path;
        int user;
    } expected[] = {{"", system + "a.cxf", 0},
                    {"System B", system + "b.cxf", 0},
                    {"User U", root_ + "/data/Pigmo/Tintora/User/u.cxf", 1}};
    for (int i = 0; i < 3; ++i) {
        EXPECT_STREQ(BPPaletteListGetName(list, i), expected[i].name);
        EXPECT_EQ(std::string(BPPaletteListGetPath(list, i)), expected[i].path);
        EXPECT_EQ(BPPaletteListIsUser(list, i), expected[i].user);
    }
    for (BPPaletteList* handle : {static_cast<BPPaletteList*>(nullptr), list}) {
        EXPECT_EQ(BPPaletteListGetName(handle, 3), nullptr);
        EXPECT_EQ(BPPaletteListGetPath(handle, -1), nullptr);
        EXPECT_EQ(BPPaletteListIsUser(handle, 3), -1);
    }
    EXPECT_EQ(BPPaletteListGetCount(nullptr), 0);
    BPPaletteListFree(list);
    BPPaletteListFree(nullptr);
}

}  // namespace
