// Runs the built pigmo on careless and hostile input: files that are not files, huge declared
// sizes, results that are not numbers, control characters, settings that cannot be used.
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <nlohmann/json.hpp>
#include <string>
#include <vector>

#include "ColorBookReader.h"
#include "Output.h"
#include "RunPigmo.h"
#include "TempFolder.h"

namespace {

// Address space limits mean nothing to a sanitizer build, which reserves terabytes up front.
#if defined(__SANITIZE_ADDRESS__)
constexpr bool kAddressSpaceLimits = false;
#else
constexpr bool kAddressSpaceLimits = true;
#endif

std::string Book(const std::string& colors, const std::string& paletteName = "Hostile") {
    return "<?xml version=\"1.0\"?>\n<CxF:CxF xmlns:CxF=\"http://colorexchangeformat.com/v2\"><CxF:Palette "
           "PaletteName=\"" +
           paletteName + "\"><CxF:ColorSet>" + colors + "</CxF:ColorSet></CxF:Palette></CxF:CxF>\n";
}

// A color with a curve of count points whose wavelength attributes start at first and go by step.
std::string CurveColor(const std::string& name, int count, int first, int step) {
    std::string points;
    for (int i = 0; i < count; ++i) {
        points += "<CxF:ReflectancePoint Wavelength=\"" + std::to_string(first + i * step) + "\">" +
                  std::to_string(0.1 + 0.02 * i) + "</CxF:ReflectancePoint>";
    }
    return "<CxF:Color ColorName=\"" + name + "\"><CxF:ColorSpaceSpectral>" + points +
           "</CxF:ColorSpaceSpectral></CxF:Color>";
}

// A PNG signature and header chunk declaring width x height, with no image data.
std::string PngHeader(uint32_t width, uint32_t height) {
    std::string png = "\x89PNG\r\n\x1a\n";
    const auto put32 = [&](uint32_t v) {
        for (int shift = 24; shift >= 0; shift -= 8) png += static_cast<char>((v >> shift) & 0xFF);
    };
    put32(13);
    png += "IHDR";
    put32(width);
    put32(height);
    png += std::string("\x08\x02\x00\x00\x00", 5);
    put32(0);  // the checksum is not checked by the header reader
    return png;
}

class HostileInput : public TempFolder {
protected:
    void SetUp() override {
        TempFolder::SetUp();
        ASSERT_EQ(mkfifo((root_ + "/fifo.png").c_str(), 0600), 0);
        ASSERT_EQ(mkfifo((root_ + "/fifo.cxf").c_str(), 0600), 0);
        std::filesystem::create_directory(root_ + "/folder.cxf");
        std::filesystem::create_symlink(root_ + "/loop-a", root_ + "/loop-b");
        std::filesystem::create_symlink(root_ + "/loop-b", root_ + "/loop-a");
    }

    // RunPigmo with "ROOT" in arguments and prefix replaced by this test's folder.
    RunResult Run(std::string arguments, const std::string& input = "", std::string prefix = "") {
        for (std::string* text : {&arguments, &prefix})
            for (std::size_t at; (at = text->find("ROOT")) != std::string::npos;) text->replace(at, 4, root_);
        return RunPigmo(arguments, input, prefix);
    }
};

struct FailureCase {
    const char* name;
    std::string arguments;  // ROOT is the test's folder
    std::string input;
    std::string message;  // part of the one line on stderr
};

class RefusedInput : public HostileInput, public testing::WithParamInterface<FailureCase> {};

TEST_P(RefusedInput, EndsWithOneClearLine) {
    const FailureCase& c = GetParam();
    if (c.name == std::string("HugeImageHeader")) Write("huge.png", PngHeader(18900, 18900));
    if (c.name == std::string("ImageAboveGivenLimit")) Write("small.png", PngHeader(100, 100));
    const RunResult run = Run(c.arguments, c.input);
    EXPECT_EQ(run.exitCode, 1) << run.err;
    EXPECT_EQ(std::count(run.err.begin(), run.err.end(), '\n'), 1) << run.err;
    EXPECT_NE(run.err.find(c.message), std::string::npos) << run.err;
}

const std::string kLongLine(std::size_t{3} << 20, '1');

INSTANTIATE_TEST_SUITE_P(
    Cli, RefusedInput,
    testing::Values(
        // Files that are not regular files, and what hides behind "doesn't exist" or "not valid".
        FailureCase{"ExtractFifo", "extract ROOT/fifo.png", "", "fifo.png': is a FIFO, not a regular file"},
        FailureCase{"ExtractFolder", "extract ROOT/folder.cxf", "", "is a directory"},
        FailureCase{"BookFifo", "book ROOT/fifo.cxf", "", "not a valid CXF ColorBook (is a FIFO"},
        FailureCase{"BookFolder", "book ROOT/folder.cxf", "", "not a valid CXF ColorBook (is a directory)"},
        FailureCase{"BookSymlinkLoop", "book ROOT/loop-a", "",
                    "doesn't exist (too many levels of symbolic links)"},
        FailureCase{"BookMissingSaysNoMore", "book ROOT/none.cxf", "", "none.cxf' doesn't exist\n"},
        // Results that are not finite numbers.
        FailureCase{"AppearanceToXYZ", "translate ciecam02-jch xyz 50 -10 20", "", "not a finite number"},
        FailureCase{"HugeLab", "translate lab srgb 1e308 1e308 1e308", "", "not a finite number"},
        FailureCase{"LineOfTheNonFiniteResult", "translate lab lch", "50 0 0\n1e308 1e308 1e308\n",
                    "line 2: cannot convert from lab (3) to lch (4): the result is not a finite number"},
        FailureCase{"ZeroWeights", "delta-e -w 0,0,0 50 1 2 50 3 4", "", "--weights: '0' is not positive"},
        FailureCase{"HarmonyOfHugeLab", "harmony triadic 1e308 1e308 1e308", "", "not a finite number"},
        FailureCase{"NameOfHugeLab", "name 1e308 1e308 1e308", "", "not a finite number"},
        FailureCase{"Overflow", "translate lab lch 1e400 0 0", "", "'1e400' is too large"},
        // Sizes that would take memory far beyond the input's.
        FailureCase{"HugeImageHeader", "extract ROOT/huge.png", "",
                    "is 18900 x 18900 pixels (357.2 megapixels), above the limit of 100000000 pixels"},
        FailureCase{"ImageAboveGivenLimit", "extract --max-pixels 9999 ROOT/small.png", "", "(--max-pixels)"},
        FailureCase{"LongStdinLine", "delta-e", "50 0 0 50 1 1\n" + kLongLine,
                    "line 2: longer than 1048576 bytes"},
        FailureCase{"FineSpectralGrid", "translate --from-step 1e-5 spectral lab", "",
                    "has 35000001 bands; at most 100000 are allowed (--from-step)"},
        // Control characters from input never reach the terminal raw.
        FailureCase{"EscapedInError", "translate lab lch 1 2 \"$(printf '\\033[31mred')\"", "",
                    "'\\x1b[31mred' is not a number"},
        FailureCase{"LeadingDotIsAValueOfAnOption", "translate --to-white -.5,1,1 xyz xyz 1 1 1", "",
                    "--to-white: components must be positive"}),
    [](const auto& info) { return std::string(info.param.name); });

struct ValueCase {
    const char* name;
    std::string arguments;
    std::string input;
    std::string output;
};

class AcceptedInput : public HostileInput, public testing::WithParamInterface<ValueCase> {};

TEST_P(AcceptedInput, PrintsTheResult) {
    const ValueCase& c = GetParam();
    const RunResult run = Run(c.arguments, c.input);
    EXPECT_EQ(run.exitCode, 0) << run.err;
    EXPECT_EQ(run.out, c.output);
}

INSTANTIATE_TEST_SUITE_P(
    Cli, AcceptedInput,
    testing::Values(ValueCase{"ByteOrderMarkOnStdin", "translate lab lch",
                              "\xEF\xBB\xBF"
                              "50 0 -10\n",
                              "50 10 270\n"},
                    ValueCase{"LeadingDotNegative", "translate lab lch 50 -.5 0", "", "50 0.5 180\n"},
                    ValueCase{"UnderflowIsZero", "translate lab lch 50 1e-400 -10", "", "50 10 270\n"}),
    [](const auto& info) { return std::string(info.param.name); });

TEST_F(HostileInput, ControlCharactersInBooksAreEscaped) {
    const std::string book =
        Write("evil.cxf",
              Book("<CxF:Color ColorName=\"Red&#10;2  Fake&#27;[2J\xc2\x9b\"/>", "Evil&#10;system  Fake"));
    const RunResult run = Run("book " + book);
    ASSERT_EQ(run.exitCode, 0) << run.err;
    EXPECT_NE(run.out.find("Evil\\nsystem  Fake (1 color)\n"), std::string::npos) << run.out;
    EXPECT_NE(run.out.find("1  Red\\n2  Fake\\x1b[2J\\u009b\n"), std::string::npos) << run.out;

    Write("user/Pigmo/Tintora/User/evil.cxf", Book("", "Evil&#10;system  /etc/passwd"));
    const RunResult list = Run("palettes", "", "XDG_DATA_HOME=ROOT/user");
    ASSERT_EQ(list.exitCode, 0) << list.err;
    EXPECT_NE(list.out.find("user    Evil\\nsystem  /etc/passwd\n"), std::string::npos) << list.out;
    EXPECT_EQ(list.out.find("\nsystem  /etc/passwd"), std::string::npos) << list.out;
}

TEST_F(HostileInput, CurvesTheRecordsCannotUseAreNamedOnce) {
    const std::string book =
        Write("curves.cxf", Book(CurveColor("Short", 31, 400, 10) + CurveColor("Good", 36, 380, 10) +
                                 CurveColor("Downwards", 36, 730, -10)));
    const RunResult run = Run("book " + book);
    ASSERT_EQ(run.exitCode, 0) << run.err;
    EXPECT_EQ(
        run.err,
        "pigmo book: warning: 2 colors have a reflectance curve that is not read as 36 bands from 380 to "
        "730 nm by 10 nm: Short (31 values); Downwards (point 1 says 730 nm, read as 380 nm)\n");
}

TEST_F(HostileInput, JsonListsEveryColorOfTheBook) {
    std::string colors;
    for (int i = 0; i < 3; ++i) colors += CurveColor("C" + std::to_string(i), 36, 380, 10);
    const std::string book = Write("book.cxf", Book(colors + "<CxF:Color ColorName=\"Plain\"/>"));
    const RunResult run = Run("book --json " + book);
    ASSERT_EQ(run.exitCode, 0) << run.err;
    const nlohmann::json listing = nlohmann::json::parse(run.out);
    std::vector<Pigmo::ColorInformation> records;
    ASSERT_TRUE(Pigmo::LoadColorBook(book.c_str(), records, nullptr));
    EXPECT_EQ(listing["palette"], "Hostile");
    ASSERT_EQ(listing["colors"].size(), records.size());
    for (std::size_t i = 0; i < records.size(); ++i) {
        const nlohmann::json& color = listing["colors"][i];
        EXPECT_EQ(color["name"], records[i].GetName());
        EXPECT_FLOAT_EQ(color["lab"][2].get<float>(), records[i].GetLab()[2]);
        EXPECT_EQ(color["reflectance"].size(),
                  static_cast<std::size_t>(records[i].GetSpectralReflectanceCount()));
    }
}

// Memory stays near the input's size: these limits are far below what the whole-document listings took.
TEST_F(HostileInput, LargeBooksListInBoundedMemory) {
    if (!kAddressSpaceLimits) GTEST_SKIP() << "address space limits do not apply under AddressSanitizer";
    std::string colors;
    for (int i = 0; i < 100000; ++i) colors += "<CxF:Color ColorName=\"c" + std::to_string(i) + "\"/>";
    const std::string book = Write("many.cxf", Book(colors));
    const RunResult json = Run("book --json " + book, "", "ulimit -v 120000;");
    ASSERT_EQ(json.exitCode, 0) << json.err;
    EXPECT_EQ(nlohmann::json::parse(json.out)["colors"].size(), 100000u);

    // Far too little for the document, though enough for the program and its libraries (Cairo among
    // them, for the editor panel): one line saying so, not a crash or a wrong text.
    const RunResult starved = Run("book " + book, "", "ulimit -v 24000;");
    EXPECT_EQ(starved.exitCode, 1);
    EXPECT_EQ(starved.err, "pigmo book: out of memory\n");

    // A 40 MB book in the user folder: its name is read from its start.
    std::filesystem::create_directories(root_ + "/user/Pigmo/Tintora/User");
    std::ofstream big(root_ + "/user/Pigmo/Tintora/User/big.cxf", std::ios::binary);
    big << "<CxF:CxF xmlns:CxF=\"http://colorexchangeformat.com/v2\"><CxF:Palette "
           "PaletteName=\"Big\"><CxF:ColorSet>";
    const std::string color =
        "<CxF:Color "
        "ColorName=\"x\"><CxF:ColorSpaceCIELab><CxF:L>1</CxF:L></CxF:ColorSpaceCIELab></CxF:Color>";
    for (std::size_t written = 0; written < (std::size_t{40} << 20); written += color.size()) big << color;
    big << "</CxF:ColorSet></CxF:Palette></CxF:CxF>";
    big.close();
    const RunResult list = Run("palettes", "", "ulimit -v 100000; XDG_DATA_HOME=ROOT/user");
    ASSERT_EQ(list.exitCode, 0) << list.err;
    EXPECT_NE(list.out.find("user    Big\n"), std::string::npos) << list.out;
}

TEST_F(HostileInput, UnusableSettingsAreReported) {
    Write("data/Resources/System Palettes/one.cxf", Book("", "One"));
    const RunResult noSeparator =
        Run("palettes", "", "PIGMO_INSTALL_LOCATION=ROOT/data XDG_DATA_HOME=ROOT/user");
    ASSERT_EQ(noSeparator.exitCode, 0) << noSeparator.err;
    EXPECT_NE(noSeparator.out.find("system  One\n"), std::string::npos) << noSeparator.out;

    const std::string deep = "/" + std::string(600, 'd');
    const RunResult tooLong =
        Run("palettes", "", "PIGMO_INSTALL_LOCATION=" + deep + " XDG_DATA_HOME=" + deep);
    EXPECT_EQ(tooLong.exitCode, 0);
    EXPECT_NE(tooLong.err.find("PIGMO_INSTALL_LOCATION is 602 bytes long, more than the 511"),
              std::string::npos)
        << tooLong.err;
    EXPECT_NE(tooLong.err.find("XDG_DATA_HOME is missing or longer than the 259 bytes"), std::string::npos)
        << tooLong.err;
}

struct PrintableCase {
    std::string text;
    std::string shown;
};

class PrintableText : public testing::TestWithParam<PrintableCase> {};

TEST_P(PrintableText, EscapesControlsKeepsUtf8) {
    EXPECT_EQ(Printable(GetParam().text), GetParam().shown);
}

INSTANTIATE_TEST_SUITE_P(
    Cases, PrintableText,
    testing::Values(PrintableCase{"plain text", "plain text"}, PrintableCase{"a\nb\tc\r", "a\\nb\\tc\\r"},
                    PrintableCase{"\x1b[31m\x7f", "\\x1b[31m\\x7f"},
                    PrintableCase{std::string("a\0b", 3), "a\\x00b"},
                    PrintableCase{"caf\xc3\xa9 \xe2\x82\xac \xf0\x9f\x8e\xa8",
                                  "caf\xc3\xa9 \xe2\x82\xac \xf0\x9f\x8e\xa8"},
                    PrintableCase{"\xc2\x9b"
                                  "2J",
                                  "\\u009b2J"},
                    PrintableCase{"\x9b\xff\xc3", "\\x9b\\xff\\xc3"},
                    PrintableCase{"\xc0\xaf \xed\xa0\x80", "\\xc0\\xaf \\xed\\xa0\\x80"}));

}  // namespace
