#include <gtest/gtest.h>
#include <pigmo/bp.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cstring>
#include <filesystem>
#include <string>
#include <vector>

#include "BookFiles.h"
#include "ColorBookReader.h"

namespace {

using Pigmo::ColorInformation;

std::string Points(int count, const std::string& value) {
    std::string points;
    for (int i = 0; i < count; ++i) points += "<CxF:ReflectancePoint>" + value + "</CxF:ReflectancePoint>";
    return points;
}
const std::string kCurve20 = Points(20, "0.5"), kCurve16 = Points(16, "0.25");

std::vector<double> Curve36() {
    std::vector<double> curve(20, 0.5);
    curve.resize(36, 0.25);
    return curve;
}

enum class LabFrom { Given, Curve, RGB };

struct ColorCase {
    const char* label;
    std::string xml;
    const char* name = "Unnamed";
    const char* category = "Default";
    LabFrom labFrom = LabFrom::Given;
    float lab[3] = {};  // the given CIELAB, or the sRGB (0..255) it is derived from
    float linear[3] = {};
    int curveCount = 0;
    std::vector<std::string> tags = {};
};

std::string Attribute(const std::string& name, const std::string& values) {
    return "<CxF:CustomAttribute><CxF:Name>" + name + "</CxF:Name><CxF:ValueChoice>" + values +
           "</CxF:ValueChoice></CxF:CustomAttribute>";
}

const std::vector<ColorCase>& ColorCases() {
    static const std::vector<ColorCase> cases = {
        {.label = "OnlyName", .xml = R"(<CxF:Color ColorName="Plain"/>)", .name = "Plain"},
        {.label = "NoName", .xml = "<CxF:Color/>"},
        {.label = "EmptyName", .xml = R"(<CxF:Color ColorName=""/>)", .name = ""},
        {.label = "SRGBAsAtofReadsIt",
         .xml = "<CxF:Color><CxF:ColorSpaceSRGB><CxF:Red>0.5</CxF:Red><CxF:Green>1</CxF:Green>"
                "<CxF:Blue>abc</CxF:Blue></CxF:ColorSpaceSRGB></CxF:Color>",
         .labFrom = LabFrom::RGB,
         .lab = {127.5f, 255, 0},
         .linear = {0.214041f, 1, 0}},
        {.label = "IncompleteLabLeavesCurve",
         .xml = "<CxF:Color><CxF:ColorSpaceCIELab><CxF:L>50</CxF:L><CxF:A>1</CxF:A></CxF:ColorSpaceCIELab>"
                "<CxF:ColorSpaceSpectral>" +
                kCurve20 + "</CxF:ColorSpaceSpectral><CxF:ColorSpaceSpectral>" + kCurve16 +
                "</CxF:ColorSpaceSpectral></CxF:Color>",
         .labFrom = LabFrom::Curve,
         .curveCount = 36},
        {.label = "OnePointIsNoCurve",
         .xml = "<CxF:Color><CxF:ColorSpaceSpectral><CxF:ReflectancePoint>0.5</CxF:ReflectancePoint>"
                "</CxF:ColorSpaceSpectral></CxF:Color>"},
        {.label = "TagsAccumulateCategoryReplaced",
         .xml = "<CxF:Color>" +
                Attribute("tags",
                          "<CxF:StringValue>a</CxF:StringValue><CxF:StringValue/>"
                          "<CxF:StringValue>b</CxF:StringValue>") +
                Attribute("category", "<CxF:StringValue>first</CxF:StringValue>") +
                Attribute("tags", "<CxF:StringValue><![CDATA[c<d]]></CxF:StringValue>") +
                Attribute("category", "<CxF:StringValue>second</CxF:StringValue>") +
                "<CxF:CustomAttribute><CxF:Name>category</CxF:Name><CxF:ValueChoice/></CxF:CustomAttribute>" +
                Attribute("Tags", "<CxF:StringValue>x</CxF:StringValue>") + "</CxF:Color>",
         .category = "second",
         .tags = {"a", "b", "c<d"}},
        {.label = "NumbersReadAsAtofWithoutOverflow",
         .xml =
             "<CxF:Color><CxF:ColorSpaceCIELab><CxF:L>  12.5abc</CxF:L><CxF:A>nan</CxF:A><CxF:B>1e999</CxF:B>"
             "</CxF:ColorSpaceCIELab><CxF:ColorSpaceCIELab><CxF:L>-inf</CxF:L><CxF:A/></CxF:ColorSpaceCIELab>"
             "</CxF:Color>",
         .lab = {12.5f, 0, 0}},
        {.label = "LaterCompleteLabWins",
         .xml =
             "<CxF:Color><CxF:ColorSpaceCIELab><CxF:L>10</CxF:L><CxF:A>2</CxF:A><CxF:B>3</CxF:B>"
             "</CxF:ColorSpaceCIELab><CxF:ColorSpaceCIELab><CxF:B>9</CxF:B><CxF:A>8</CxF:A><CxF:L>70</CxF:L>"
             "<CxF:L>1</CxF:L></CxF:ColorSpaceCIELab></CxF:Color>",
         .lab = {70, 8, 9}},
        {.label = "NonTextFirstChildHasNoText",
         .xml = "<CxF:Color><CxF:ColorSpaceCIELab><CxF:L><!-- measured -->40</CxF:L><CxF:A><x/>5</CxF:A>"
                "<CxF:B>6</CxF:B></CxF:ColorSpaceCIELab><CxF:CustomAttribute><CxF:Name><!-- c -->category"
                "</CxF:Name><CxF:ValueChoice><CxF:StringValue>hidden</CxF:StringValue></CxF:ValueChoice>"
                "</CxF:CustomAttribute></CxF:Color>",
         .lab = {0, 0, 6}},
        {.label = "OtherPrefixesAreNotTheBooks",
         .xml =
             R"(<CxF:Color xmlns:cc="http://colorexchangeformat.com/v2"><cc:ColorSpaceCIELab><cc:L>5</cc:L>)"
             "<cc:A>5</cc:A><cc:B>5</cc:B></cc:ColorSpaceCIELab><ColorSpaceCIELab><L>5</L><A>5</A><B>5</B>"
             "</ColorSpaceCIELab><CxF:colorspacecielab><CxF:L>5</CxF:L><CxF:A>5</CxF:A><CxF:B>5</CxF:B>"
             "</CxF:colorspacecielab></CxF:Color>"},
    };
    return cases;
}

class ColorElement : public BookFolder, public testing::WithParamInterface<ColorCase> {};

TEST_P(ColorElement, ReadsAsTheTableSays) {
    const ColorCase& c = GetParam();
    const std::string path = Write("book.cxf", Book(ColorSet(c.xml)));
    std::vector<ColorInformation> records;
    const char* error = "untouched";
    ASSERT_TRUE(Pigmo::LoadColorBook(path.c_str(), records, &error));
    EXPECT_STREQ(error, "untouched");
    ASSERT_EQ(records.size(), 1u);
    const ColorInformation& record = records[0];
    EXPECT_STREQ(record.GetName(), c.name);
    EXPECT_STREQ(record.GetCategory(), c.category);
    EXPECT_EQ(record.GetSpectralReflectanceCount(), c.curveCount);
    ASSERT_EQ(record.GetTagCount(), static_cast<int>(c.tags.size()));
    for (std::size_t i = 0; i < c.tags.size(); ++i) EXPECT_EQ(record.GetTag(i), c.tags[i]);

    double lab[3] = {c.lab[0], c.lab[1], c.lab[2]};
    if (c.labFrom == LabFrom::Curve) {
        ASSERT_EQ(BPConvert36BandSpectral2LabD502(Curve36().data(), lab), 1);
    } else if (c.labFrom == LabFrom::RGB) {
        const double rgb[3] = {c.lab[0], c.lab[1], c.lab[2]};
        ASSERT_EQ(BPConvertsRGB2Lab(rgb, lab), 1);
    }
    for (int i = 0; i < 3; ++i) {
        EXPECT_NEAR(record.GetLab()[i], lab[i], 1e-4) << i;
        if (c.labFrom != LabFrom::Curve) {
            EXPECT_NEAR(record.GetLinearRGB()[i], c.linear[i], 1e-5) << i;
        }
    }
}

INSTANTIATE_TEST_SUITE_P(Cases, ColorElement, testing::ValuesIn(ColorCases()),
                         [](const testing::TestParamInfo<ColorCase>& info) { return info.param.label; });

struct FailureCase {
    const char* label;
    const char* content;  // null: no file; "<dir>" / "<fifo>" / "<dangling>" / "<loop>": that kind of entry
    const char* expected;
    const char* cause;  // the start of what a tool may add to the text
};

class OpenFailure : public BookFolder, public testing::WithParamInterface<FailureCase> {};

TEST_P(OpenFailure, ReportsTheTableText) {
    const FailureCase& c = GetParam();
    const std::string path = root_ + "/entry.cxf";
    if (c.content == nullptr) {
    } else if (std::strcmp(c.content, "<dir>") == 0) {
        std::filesystem::create_directory(path);
    } else if (std::strcmp(c.content, "<fifo>") == 0) {
        ASSERT_EQ(mkfifo(path.c_str(), 0600), 0);
    } else if (std::strcmp(c.content, "<dangling>") == 0) {
        std::filesystem::create_symlink(root_ + "/gone.cxf", path);
    } else if (std::strcmp(c.content, "<loop>") == 0) {
        std::filesystem::create_symlink(path, path);
    } else {
        Write("entry.cxf", c.content);
    }
    std::vector<ColorInformation> records;
    const char* error = nullptr;
    EXPECT_FALSE(Pigmo::LoadColorBook(path.c_str(), records, &error));
    EXPECT_TRUE(records.empty());
    ASSERT_NE(error, nullptr);
    const std::string expected =
        std::strstr(c.expected, "%s") ? "ColorBook file '" + path + "' doesn't exist" : c.expected;
    EXPECT_EQ(error, expected);

    struct Ignore final : Pigmo::ColorBookVisitor {
        void Begin(const std::string&, std::size_t) override { ADD_FAILURE(); }
        void Color(const ColorInformation&, const std::vector<double>&) override { ADD_FAILURE(); }
    } ignore;
    Pigmo::ColorBookFailure failure{"untouched", true};
    EXPECT_FALSE(Pigmo::ReadColorBook(path.c_str(), ignore, &error, &failure));
    EXPECT_TRUE(failure.cause.starts_with(c.cause)) << failure.cause;
    EXPECT_EQ(failure.cause.empty(), c.cause[0] == 0) << failure.cause;
    EXPECT_FALSE(failure.outOfMemory);

    std::string name = "kept";
    error = nullptr;
    EXPECT_FALSE(Pigmo::ReadPaletteName(path.c_str(), name, &error));
    EXPECT_EQ(name, "kept");
    EXPECT_NE(error, nullptr);
}

constexpr const char* kInvalid = "Specified file is not a valid CXF ColorBook";
constexpr const char* kVersion = "Only version 2.1 of CXF ColorBooks is supported";
constexpr const char* kMissing = "%s";

INSTANTIATE_TEST_SUITE_P(
    Cases, OpenFailure,
    testing::Values(
        FailureCase{"Missing", nullptr, kMissing, ""},
        FailureCase{"DanglingLink", "<dangling>", kMissing, ""},
        FailureCase{"LinkLoop", "<loop>", kMissing, "too many levels of symbolic links"},
        FailureCase{"Empty", "", kInvalid, "the file is empty"},
        FailureCase{"Directory", "<dir>", kInvalid, "is a directory"},
        FailureCase{"Pipe", "<fifo>", kInvalid, "is a FIFO, not a regular file"},
        FailureCase{"NotXml", "ColorBook", kInvalid, "XML error at byte "},
        FailureCase{"Unclosed", "<CxF:CxF xmlns:CxF=\"http://colorexchangeformat.com/v2\">", kInvalid,
                    "XML error at byte 54: Start-end tags mismatch"},
        FailureCase{"RootCase", "<CxF:cxf xmlns:CxF=\"http://colorexchangeformat.com/v2\"/>", kInvalid,
                    "the root element is 'CxF:cxf', not 'CxF:CxF'"},
        FailureCase{"OnlyComment", "<!-- CxF:CxF -->", kInvalid, "XML error at byte "},
        FailureCase{"NamespaceOffByOne", "<CxF:CxF xmlns:CxF=\"http://colorexchangeformat.com/v3\"/>",
                    kVersion, "xmlns:CxF is 'http://colorexchangeformat.com/v3'"},
        FailureCase{"NamespaceTrailingSlash", "<CxF:CxF xmlns:CxF=\"http://colorexchangeformat.com/v2/\"/>",
                    kVersion, "xmlns:CxF is "},
        FailureCase{"NamespaceMissing", "<CxF:CxF/>", kVersion, "the root has no xmlns:CxF"},
        FailureCase{"NamespaceUnderOtherPrefix", "<CxF:CxF xmlns:cc=\"http://colorexchangeformat.com/v2\"/>",
                    kVersion, "the root has no xmlns:CxF"}),
    [](const testing::TestParamInfo<FailureCase>& info) { return info.param.label; });

using Reader = BookFolder;

TEST_F(Reader, LongMissingPathIsCutToTheMessageBuffer) {
    const std::string path = "/" + std::string(4000, 'p') + ".cxf";
    std::vector<ColorInformation> records;
    const char* error = nullptr;
    ASSERT_FALSE(Pigmo::LoadColorBook(path.c_str(), records, &error));
    ASSERT_NE(error, nullptr);
    EXPECT_EQ(std::strlen(error), Pigmo::kColorBookMessageCapacity - 1);
    EXPECT_EQ(std::string(error),
              ("ColorBook file '" + path).substr(0, Pigmo::kColorBookMessageCapacity - 1));
}

TEST_F(Reader, ReadsColorSetsAtAnyDepthInDocumentOrderAndAppends) {
    const std::string colors = ColorSet(R"(<CxF:Color ColorName="A"/><CxF:Color ColorName="B"/>)") +
                               R"(<CxF:Color ColorName="NotInASet"/><Group><Deeper>)" +
                               ColorSet(R"(<CxF:Color ColorName="C"/>)") + "</Deeper></Group>" +
                               ColorSet(R"(<CxF:Color ColorName="D"/><CxF:Other ColorName="E"/>)");
    const std::string book = "<CxF:CxF xmlns:CxF=\"http://colorexchangeformat.com/v2\"><CxF:Palette>" +
                             colors + "</CxF:Palette>" +
                             ColorSet(R"(<CxF:Color ColorName="OutsidePalette"/>)") + "</CxF:CxF>";
    const std::string path = Write("sets.cxf", book);

    std::vector<ColorInformation> records;
    records.emplace_back("Earlier", "", nullptr, nullptr, nullptr, 0, nullptr);
    ASSERT_TRUE(Pigmo::LoadColorBook(path.c_str(), records, nullptr));
    std::vector<std::string> names;
    for (const ColorInformation& record : records) names.emplace_back(record.GetName());
    EXPECT_EQ(names, (std::vector<std::string>{"Earlier", "A", "B", "C", "D"}));

    records.clear();
    ASSERT_TRUE(Pigmo::LoadColorBook(Write("none.cxf", Book("")).c_str(), records, nullptr));
    EXPECT_TRUE(records.empty());
}

TEST_F(Reader, PaletteNameCases) {
    struct NameCase {
        std::string book;
        std::string expected;
    };
    const NameCase cases[] = {
        {Book("", R"( PaletteName="Mine")") + "", "Mine"},
        {"<CxF:CxF xmlns:CxF=\"http://colorexchangeformat.com/v2\"><CxF:Palette PaletteName=\"One\"/>"
         "<CxF:Palette PaletteName=\"Two\"/></CxF:CxF>",
         "One"},
        {Book(""), ""},
        {"<CxF:CxF xmlns:CxF=\"http://colorexchangeformat.com/v2\"><Palette PaletteName=\"x\"/></CxF:CxF>",
         "kept"},
    };
    for (const NameCase& c : cases) {
        std::string name = "kept";
        EXPECT_TRUE(Pigmo::ReadPaletteName(Write("named.cxf", c.book).c_str(), name, nullptr));
        EXPECT_EQ(name, c.expected) << c.book;
    }
}

TEST_F(Reader, SurvivesDeepNestingAndManyColors) {
    std::string deep;
    constexpr int kDepth = 100000;
    for (int i = 0; i < kDepth; ++i) deep += "<CxF:ColorSet>";
    deep += R"(<CxF:Color ColorName="Deep"/>)";
    for (int i = 0; i < kDepth; ++i) deep += "</CxF:ColorSet>";
    std::vector<ColorInformation> records;
    ASSERT_TRUE(Pigmo::LoadColorBook(Write("deep.cxf", Book(deep)).c_str(), records, nullptr));
    ASSERT_EQ(records.size(), 1u);
    EXPECT_STREQ(records[0].GetName(), "Deep");

    std::string many;
    constexpr int kColors = 100000;
    for (int i = 0; i < kColors; ++i)
        many += "<CxF:Color><CxF:ColorSpaceCIELab><CxF:L>" + std::to_string(i % 100) +
                "</CxF:L><CxF:A>1</CxF:A><CxF:B>-1</CxF:B></CxF:ColorSpaceCIELab></CxF:Color>";
    records.clear();
    ASSERT_TRUE(Pigmo::LoadColorBook(Write("many.cxf", Book(ColorSet(many))).c_str(), records, nullptr));
    ASSERT_EQ(records.size(), static_cast<std::size_t>(kColors));
    EXPECT_EQ(records.back().GetLab()[0], static_cast<float>((kColors - 1) % 100));
}

}  // namespace
