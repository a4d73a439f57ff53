#include <fcntl.h>
#include <gtest/gtest.h>
#include <unistd.h>

#include <cstring>
#include <fstream>
#include <pugixml.hpp>
#include <string>
#include <tuple>
#include <vector>

#include "BookFiles.h"
#include "BookHead.h"

namespace {

const std::string kRoot = R"(<CxF:CxF xmlns:CxF="http://colorexchangeformat.com/v2">)";
const std::string kEnd = "</CxF:CxF>";
const std::string kDeclaration = R"(<?xml version="1.0"?>)";

std::string Palette(const std::string& name) {
    return R"(<CxF:Palette PaletteName=")" + name + R"("/>)";
}

// What listing takes from a document, parsed as the reader parses a book (in place); "" when it fails.
std::string Summary(const std::string& bytes) {
    char* buffer = static_cast<char*>(pugi::get_memory_allocation_function()(bytes.size() + 1));
    std::memcpy(buffer, bytes.data(), bytes.size());
    pugi::xml_document document;
    constexpr unsigned int kOptions = pugi::parse_default | pugi::parse_comments | pugi::parse_trim_pcdata;
    if (!document.load_buffer_inplace_own(buffer, bytes.size(), kOptions, pugi::encoding_auto)) return "";
    const pugi::xml_node root = document.document_element();
    std::string summary = root.name();
    for (const pugi::xml_attribute attribute : root.attributes())
        summary += std::string(" ") + attribute.name() + "=" + attribute.value();
    if (const pugi::xml_node palette = root.child("CxF:Palette")) {
        summary += " | palette";
        for (const pugi::xml_attribute attribute : palette.attributes())
            summary += std::string(" ") + attribute.name() + "=" + attribute.value();
    }
    return summary;
}

// The first palette's name, from a copy of the bytes (not in place).
std::string FirstPaletteName(const std::string& bytes) {
    pugi::xml_document document;
    document.load_buffer(bytes.data(), bytes.size(), pugi::parse_default, pugi::encoding_auto);
    return document.document_element().child("CxF:Palette").attribute("PaletteName").value();
}

// UTF-8 text in a wider encoding; width 2 or 4 bytes, either byte order.
std::string Widen(const std::string& utf8, int width, bool bigEndian) {
    std::string out;
    for (std::size_t i = 0; i < utf8.size();) {
        const unsigned char lead = utf8[i];
        const int extra = lead < 0x80 ? 0 : lead < 0xe0 ? 1 : 2;
        char32_t c = extra == 0 ? lead : lead & (extra == 1 ? 0x1f : 0x0f);
        for (int k = 1; k <= extra; ++k) c = c << 6 | (utf8[i + k] & 0x3f);
        i += 1 + extra;
        for (int k = 0; k < width; ++k) out += static_cast<char>(c >> 8 * (bigEndian ? width - 1 - k : k));
    }
    return out;
}

const std::string kBom = "\xef\xbb\xbf";
const std::string kCafe = kRoot + Palette("Caf\xc3\xa9") + kEnd;

struct HeadCase {
    const char* label;
    std::string bytes;
    bool readable = true;
    const char* name = "";  // the first palette's name the head gives
};

const std::vector<HeadCase> kCases = {
    {"Plain",
     kDeclaration + "\n" + kRoot + "<CxF:Palette PaletteName=\"Plain\"><CxF:ColorSet/></CxF:Palette>" + kEnd,
     true, "Plain"},
    {"Latin1Declaration",
     R"(<?xml version="1.0" encoding="ISO-8859-1"?>)" + kRoot + Palette("Caf\xe9") + kEnd, true,
     "Caf\xc3\xa9"},
    {"Utf8Bom", kBom + kCafe, true, "Caf\xc3\xa9"},
    {"Utf16LeBom", Widen(kBom + kCafe, 2, false), true, "Caf\xc3\xa9"},
    {"Utf16Le", Widen(kDeclaration + kCafe, 2, false), true, "Caf\xc3\xa9"},
    {"Utf16BeBom", Widen(kBom + kCafe, 2, true), true, "Caf\xc3\xa9"},
    {"Utf16Be", Widen(kCafe, 2, true), true, "Caf\xc3\xa9"},
    {"Utf32LeBom", Widen(kBom + kCafe, 4, false), true, "Caf\xc3\xa9"},
    {"Utf32Be", Widen(kCafe, 4, true), true, "Caf\xc3\xa9"},
    // pugixml drops a lone surrogate, so this name is "CxF:Palette".
    {"Utf16LoneSurrogateInName",
     Widen(kRoot + "<CxF:Pal", 2, false) + std::string("\x00\xd8", 2) +
         Widen(R"(ette PaletteName="S"/>)" + kEnd, 2, false),
     true, "S"},
    {"Prolog",
     kDeclaration +
         "<!-- a > b -- c -->\n<!DOCTYPE CxF:CxF [ <!ENTITY e \"a>b\"> <!-- > --> <?p > ?> "
         "<![ IGNORE [ <![ x ]]> > ]]> <!ELEMENT a (b)> ]>\n<?pi x?>text" +
         kRoot + "<!-- " + Palette("Comment") + " --><?p " + Palette("Pi") + "?>" + Palette("Real") + kEnd,
     true, "Real"},
    {"CommentEndSearchedAfterOpening", "<!--><a/>-->" + kRoot + Palette("Real") + kEnd, true, "Real"},
    {"DeeperAndCdataPalettesSkipped",
     kRoot + "<![CDATA[" + Palette("Cdata") + "]]><CxF:FileInformation>" + Palette("Deep") +
         "</CxF:FileInformation ><CxF:Palettes/><CxF:Palett/>" + Palette("Real") + kEnd,
     true, "Real"},
    {"AttributeValues",
     R"(<CxF:CxF note='a>b/>c' xmlns:CxF="http://colorexchangeformat.com/v2" >)"
     R"(<CxF:Palette Note='x/>y' PaletteName = "A&amp;B&#10;C"></CxF:Palette>)" +
         kEnd,
     true, "A&B\nC"},
    {"SiblingBeforePalette",
     kRoot + "<CxF:FileInformation><CxF:Creator>x &lt; y</CxF:Creator></CxF:FileInformation>\n" +
         Palette("Second") + kEnd,
     true, "Second"},
    {"SelfClosingRoot", R"(<CxF:CxF xmlns:CxF="http://colorexchangeformat.com/v2"/>)" + Palette("After")},
    {"RootWithoutPalette", kRoot + "<CxF:ColorSet/>" + kEnd + Palette("After")},
    // In place, pugixml reads the NUL as the file's last byte.
    {"NulEndsSelfClosingRoot",
     R"(<CxF:CxF xmlns:CxF="http://colorexchangeformat.com/v2"/)" + std::string(1, '\0') + "junk>"},
    {"NulEndsRootEndTag", kRoot + "<CxF:ColorSet/></CxF:CxF " + std::string(1, '\0') + ">"},
    {"DamageAfterPalette", kRoot + Palette("Kept") + "<broken", true, "Kept"},
    {"NoRoot", kDeclaration + "<!-- only -->", false},
    {"UnclosedComment", "<!-- " + kCafe, false},
    {"UnclosedCdata", kRoot + "<![CDATA[" + Palette("Cdata") + "]>" + kEnd, false},
    {"UnclosedDoctype", "<!DOCTYPE x [ <!ENTITY e '>]>" + kCafe, false},
    {"DoctypeInsideRoot", kRoot + "<!DOCTYPE x>" + Palette("P") + kEnd, false},
    {"EndTagBeforeRoot", "</x>" + kCafe, false},
    {"NulBeforePalette", kRoot + std::string(1, '\0') + Palette("P") + kEnd, false},
    {"Utf16NulBeforePalette",
     Widen(kRoot, 2, false) + std::string(2, '\0') + Widen(Palette("P") + kEnd, 2, false), false},
};

bool ReadHead(const std::string& path, std::size_t chunkSize, std::string& head) {
    const int fd = open(path.c_str(), O_RDONLY | O_CLOEXEC);
    const bool read = fd >= 0 && Pigmo::ReadBookHead(fd, head, chunkSize);
    if (fd >= 0) close(fd);
    return read;
}

class BookHead : public BookFolder, public testing::WithParamInterface<std::tuple<HeadCase, std::size_t>> {};

TEST_P(BookHead, SaysWhatTheWholeFileSays) {
    const auto& [book, chunkSize] = GetParam();
    std::string head;
    ASSERT_EQ(ReadHead(Write("book.cxf", book.bytes), chunkSize, head), book.readable);
    const std::string whole = Summary(book.bytes);
    if (!book.readable) {
        EXPECT_EQ(whole, "");
        return;
    }
    if (!whole.empty()) {
        EXPECT_EQ(Summary(head), whole);
    }
    EXPECT_EQ(FirstPaletteName(head), book.name);
}

INSTANTIATE_TEST_SUITE_P(Books, BookHead,
                         testing::Combine(testing::ValuesIn(kCases),
                                          testing::Values(1, 3, 7, Pigmo::kBookHeadChunkSize)),
                         [](const auto& info) {
                             return std::string(std::get<0>(info.param).label) + "_" +
                                    std::to_string(std::get<1>(info.param));
                         });

class BookHeadLimits : public BookFolder {};

TEST_F(BookHeadLimits, OnlyKeptTagsAreBounded) {
    const std::string big(Pigmo::kBookHeadTagLimit, 'x');
    const std::string longRoot = R"(<CxF:CxF a=")" + big + R"(">)" + Palette("P") + kEnd;
    const std::string longSibling = kRoot + R"(<CxF:Other a=")" + big + big + R"("/>)" + Palette("P") + kEnd;
    std::string head;
    EXPECT_FALSE(ReadHead(Write("root.cxf", longRoot), Pigmo::kBookHeadChunkSize, head));
    ASSERT_TRUE(ReadHead(Write("sibling.cxf", longSibling), Pigmo::kBookHeadChunkSize, head));
    EXPECT_EQ(Summary(head), Summary(longSibling));
}

TEST_F(BookHeadLimits, ReadErrorFails) {
    std::string head;
    EXPECT_FALSE(Pigmo::ReadBookHead(-1, head));
    EXPECT_FALSE(ReadHead(root_, Pigmo::kBookHeadChunkSize, head));  // a directory
}

// 50 MB of other content before the palette and more after it: the head stays small and the file's
// end is never read.
TEST_F(BookHeadLimits, LargeBookReadsOnlyItsStart) {
    const std::string path = root_ + "/large.cxf";
    const std::string colors(1 << 20, ' ');
    {
        std::ofstream file(path, std::ios::binary);
        file << kDeclaration << kRoot << "<CxF:FileInformation>";
        for (int i = 0; i < 50; ++i) file << "<CxF:Tag>" << colors << "</CxF:Tag>";
        file << "</CxF:FileInformation>" << Palette("Big");
        for (int i = 0; i < 16; ++i) file << colors;
        file << kEnd;
    }
    const int fd = open(path.c_str(), O_RDONLY | O_CLOEXEC);
    ASSERT_GE(fd, 0);
    std::string head;
    EXPECT_TRUE(Pigmo::ReadBookHead(fd, head));
    const off_t stoppedAt = lseek(fd, 0, SEEK_CUR);
    close(fd);
    EXPECT_LT(head.size(), 200u);
    EXPECT_LT(stoppedAt, 51 << 20);
    EXPECT_EQ(FirstPaletteName(head), "Big");
}

}  // namespace
