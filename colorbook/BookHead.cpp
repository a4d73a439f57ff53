#include "BookHead.h"

#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstdint>
#include <initializer_list>
#include <string_view>
#include <vector>

namespace Pigmo {

namespace {

// pugixml turns every encoding into UTF-8 before it parses, and there anything beyond ASCII is a name
// character; so the scanner sees ASCII as itself and all else as kOther.
constexpr int kOther = 0x80;

constexpr std::string_view kPaletteName = "CxF:Palette";

bool IsSpace(int c) {
    return c == ' ' || c == '\t' || c == '\n' || c == '\r';
}
bool IsNameStart(int c) {
    return c == kOther || (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || c == '_' || c == ':';
}
bool IsNameChar(int c) {
    return IsNameStart(c) || (c >= '0' && c <= '9') || c == '-' || c == '.';
}
bool IsQuote(int c) {
    return c == '"' || c == '\'';
}

// How the file stores its characters, as pugixml's encoding_auto decides from the first four bytes.
struct Layout {
    std::size_t width = 1;  // bytes per code unit
    bool bigEndian = false;
    std::size_t bom = 0;  // bytes of byte-order mark, which the parse skips
};

Layout GuessLayout(const unsigned char* d, std::size_t size) {
    if (size < 4) return {};
    const auto starts = [d](std::initializer_list<int> bytes) {
        return std::equal(bytes.begin(), bytes.end(), d);
    };
    if (starts({0, 0, 0xfe, 0xff})) return {4, true, 4};
    if (starts({0xff, 0xfe, 0, 0})) return {4, false, 4};
    if (starts({0xfe, 0xff})) return {2, true, 2};
    if (starts({0xff, 0xfe})) return {2, false, 2};
    if (starts({0xef, 0xbb, 0xbf})) return {1, false, 3};
    if (starts({0, 0, 0, '<'})) return {4, true, 0};
    if (starts({'<', 0, 0, 0})) return {4, false, 0};
    if (starts({0, '<'})) return {2, true, 0};
    if (starts({'<', 0})) return {2, false, 0};
    return {};
}

enum class Step { More, Done, Fail };

// What the start tag being read is to the head; Candidate until its name says whether it is the palette.
enum class Role { Root, Candidate, Palette, Other };

enum class State {
    Text,
    Open,  // after '<'
    Name,
    Attributes,
    AttributeName,
    BeforeEquals,
    AfterEquals,
    Value,
    AfterValue,
    Slash,
    EndName,
    EndSpace,
    PiStart,
    PiTarget,
    PiBody,
    PiQuestion,
    Bang,
    BangDash,
    Comment,
    CdataOpen,
    Cdata,
    DoctypeOpen,
    Group,  // DOCTYPE body
    GroupOpen,
    GroupBang,
    GroupBangDash,
    GroupQuote,
    GroupPi,
    GroupComment,
    Ignore,  // <![ ... ]]> inside a DOCTYPE
};

// Follows pugixml's parse_tree one character at a time, so that chunks may split anything, and keeps
// the raw bytes of the tags the head needs. Only the document and root levels are told apart; deeper
// elements are counted.
class Scanner {
public:
    Step Feed(int c, const unsigned char* raw, std::size_t size);
    // A code unit pugixml drops (a lone UTF-16 surrogate): part of a kept tag, but no character.
    void Drop(const unsigned char* raw, std::size_t size) { Keep(raw, size); }
    Step AtNul(bool inPlace);
    // Plain text comes next until a '<' or NUL, and nothing needs to see it.
    bool InText() const { return state_ == State::Text && !atStart_; }

    std::string declaration;
    std::string root;             // the root's start tag
    std::size_t rootNameEnd = 0;  // bytes of root taken by '<' and the name
    bool rootClosed = false;      // by its own start tag
    std::string palette;          // the first palette's start tag, empty when there is none
    bool paletteClosed = false;

private:
    void StartKeeping(const unsigned char* raw, std::size_t size);
    void Keep(const unsigned char* raw, std::size_t size);
    void StopKeeping() { keeping_ = false; }
    Step TagEnd(bool selfClosing);

    State state_ = State::Text;
    std::size_t depth_ = 0;
    bool atStart_ = true;
    bool declarationCandidate_ = false;
    Role role_ = Role::Other;
    std::size_t matched_ = 0;  // name characters matched so far, of the palette's or "xml"
    int quote_ = 0;
    int run_ = 0;  // closing characters seen in a row, or characters matched of a keyword
    std::size_t groupDepth_ = 0;
    std::size_t ignoreDepth_ = 0;
    int ignoreOpen_ = 0;   // characters seen of "<!["
    int ignoreClose_ = 0;  // characters seen of "]]>"
    bool keeping_ = false;
    bool overflow_ = false;
    std::string kept_;
    std::size_t nameEnd_ = 0;
};

void Scanner::StartKeeping(const unsigned char* raw, std::size_t size) {
    kept_.assign(raw, raw + size);
    keeping_ = true;
    overflow_ = false;
}

void Scanner::Keep(const unsigned char* raw, std::size_t size) {
    if (!keeping_ || overflow_) return;
    // A tag that will not be kept after all may still overflow; only a kept one fails.
    if (kept_.size() + size > kBookHeadTagLimit)
        overflow_ = true;
    else
        kept_.append(raw, raw + size);
}

Step Scanner::TagEnd(bool selfClosing) {
    keeping_ = false;
    state_ = State::Text;
    switch (role_) {
        case Role::Root:
            if (overflow_) return Step::Fail;
            root = std::move(kept_);
            rootNameEnd = nameEnd_;
            rootClosed = selfClosing;
            depth_ = 1;
            return selfClosing ? Step::Done : Step::More;
        case Role::Palette:
            if (overflow_) return Step::Fail;
            palette = std::move(kept_);
            paletteClosed = selfClosing;
            return Step::Done;
        default:
            if (!selfClosing) ++depth_;
            return Step::More;
    }
}

Step Scanner::Feed(int c, const unsigned char* raw, std::size_t size) {
    const bool first = atStart_;
    atStart_ = false;
    Keep(raw, size);
    for (;;) {
        switch (state_) {
            case State::Text:
                if (c == '<') {
                    // Only the document and root levels hold tags the head keeps.
                    if (depth_ <= 1) StartKeeping(raw, size);
                    declarationCandidate_ = first;
                    state_ = State::Open;
                }
                return Step::More;
            case State::Open:
                if (IsNameStart(c)) {
                    role_ = depth_ == 0 ? Role::Root : depth_ == 1 ? Role::Candidate : Role::Other;
                    matched_ = 0;
                    state_ = State::Name;
                    continue;
                }
                if (c == '?') {
                    // Kept while it may be the declaration, which can name the encoding.
                    if (!declarationCandidate_) StopKeeping();
                    matched_ = 0;
                    state_ = State::PiStart;
                    return Step::More;
                }
                StopKeeping();
                if (c == '/') {
                    state_ = State::EndName;
                    return depth_ == 0 ? Step::Fail : Step::More;
                }
                if (c == '!') {
                    state_ = State::Bang;
                    return Step::More;
                }
                return Step::Fail;
            case State::Name:
                if (IsNameChar(c)) {
                    if (role_ == Role::Candidate) {
                        if (matched_ < kPaletteName.size() && c == kPaletteName[matched_]) {
                            ++matched_;
                        } else {
                            role_ = Role::Other;
                            StopKeeping();
                        }
                    }
                    return Step::More;
                }
                if (role_ == Role::Candidate) {
                    role_ = matched_ == kPaletteName.size() ? Role::Palette : Role::Other;
                    if (role_ == Role::Other) StopKeeping();
                }
                if (role_ == Role::Root && !overflow_) nameEnd_ = kept_.size() - size;
                if (c == '>') return TagEnd(false);
                if (c == '/') {
                    state_ = State::Slash;
                    return Step::More;
                }
                if (!IsSpace(c)) return Step::Fail;
                state_ = State::Attributes;
                return Step::More;
            case State::Attributes:
                if (IsSpace(c)) return Step::More;
                if (c == '>') return TagEnd(false);
                if (c == '/') {
                    state_ = State::Slash;
                    return Step::More;
                }
                if (!IsNameStart(c)) return Step::Fail;
                state_ = State::AttributeName;
                return Step::More;
            case State::AttributeName:
                if (IsNameChar(c)) return Step::More;
                [[fallthrough]];
            case State::BeforeEquals:
                if (IsSpace(c)) {
                    state_ = State::BeforeEquals;
                    return Step::More;
                }
                if (c != '=') return Step::Fail;
                state_ = State::AfterEquals;
                return Step::More;
            case State::AfterEquals:
                if (IsSpace(c)) return Step::More;
                if (!IsQuote(c)) return Step::Fail;
                quote_ = c;
                state_ = State::Value;
                return Step::More;
            case State::Value:
                if (c == quote_) state_ = State::AfterValue;
                return Step::More;
            case State::AfterValue:
                // pugixml wants a separator between an attribute's value and the next one's name.
                if (IsNameStart(c)) return Step::Fail;
                state_ = State::Attributes;
                continue;
            case State::Slash:
                return c == '>' ? TagEnd(true) : Step::Fail;
            case State::EndName:
                if (IsNameChar(c)) return Step::More;
                [[fallthrough]];
            case State::EndSpace:
                if (IsSpace(c)) {
                    state_ = State::EndSpace;
                    return Step::More;
                }
                if (c != '>') return Step::Fail;
                state_ = State::Text;
                return --depth_ == 0 ? Step::Done : Step::More;
            case State::PiStart:
                if (!IsNameStart(c)) return Step::Fail;
                state_ = State::PiTarget;
                continue;
            case State::PiTarget:
                if (IsNameChar(c)) {
                    // The target "xml", in any case, makes the declaration.
                    if (matched_ < 4)
                        matched_ = matched_ < 3 && (c | 0x20) == "xml"[matched_] ? matched_ + 1 : 4;
                    return Step::More;
                }
                if (matched_ != 3) StopKeeping();
                state_ = State::PiBody;
                continue;
            case State::PiBody:
                if (c == '?') state_ = State::PiQuestion;
                return Step::More;
            case State::PiQuestion:
                if (c == '>') {
                    if (keeping_) {
                        if (overflow_) return Step::Fail;
                        declaration = std::move(kept_);
                        keeping_ = false;
                    }
                    state_ = State::Text;
                } else if (c != '?') {
                    state_ = State::PiBody;
                }
                return Step::More;
            case State::Bang:
                run_ = 0;
                if (c == '-')
                    state_ = State::BangDash;
                else if (c == '[')
                    state_ = State::CdataOpen;
                else if (c == 'D')
                    state_ = State::DoctypeOpen;
                else
                    return Step::Fail;
                return Step::More;
            case State::BangDash:
                if (c != '-') return Step::Fail;
                state_ = State::Comment;
                return Step::More;
            case State::GroupBangDash:
                if (c != '-') return Step::Fail;
                run_ = 0;
                state_ = State::GroupComment;
                return Step::More;
            case State::Comment:
            case State::Cdata:
            case State::GroupComment:
                // The end is searched from right after the opening, so "<!-->" does not close.
                if (c == '>' && run_ == 2) {
                    state_ = state_ == State::GroupComment ? State::Group : State::Text;
                } else {
                    const int mark = state_ == State::Cdata ? ']' : '-';
                    run_ = c == mark ? std::min(run_ + 1, 2) : 0;
                }
                return Step::More;
            case State::CdataOpen:
                if (c != "CDATA["[run_]) return Step::Fail;
                if (++run_ == 6) {
                    run_ = 0;
                    state_ = State::Cdata;
                }
                return Step::More;
            case State::DoctypeOpen:
                if (c != "OCTYPE"[run_]) return Step::Fail;
                if (++run_ == 6) {
                    // pugixml takes a DOCTYPE only outside every element.
                    if (depth_ > 0) return Step::Fail;
                    groupDepth_ = 0;
                    state_ = State::Group;
                }
                return Step::More;
            case State::Group:
                if (c == '<') {
                    state_ = State::GroupOpen;
                } else if (IsQuote(c)) {
                    quote_ = c;
                    state_ = State::GroupQuote;
                } else if (c == '>') {
                    if (groupDepth_ == 0)
                        state_ = State::Text;
                    else
                        --groupDepth_;
                }
                return Step::More;
            case State::GroupOpen:
                if (c == '!') {
                    state_ = State::GroupBang;
                } else if (c == '?') {
                    run_ = 0;
                    state_ = State::GroupPi;
                } else {
                    return Step::Fail;
                }
                return Step::More;
            case State::GroupBang:
                if (c == '[') {
                    ignoreDepth_ = 0;
                    ignoreOpen_ = ignoreClose_ = 0;
                    state_ = State::Ignore;
                    return Step::More;
                }
                if (c == '-') {
                    state_ = State::GroupBangDash;
                    return Step::More;
                }
                // A nested declaration such as <!ENTITY; its first character is plain.
                ++groupDepth_;
                state_ = State::Group;
                continue;
            case State::GroupQuote:
                if (c == quote_) state_ = State::Group;
                return Step::More;
            case State::GroupPi:
                if (c == '>' && run_ == 1)
                    state_ = State::Group;
                else
                    run_ = c == '?';
                return Step::More;
            case State::Ignore:
                // "<![" opens a nested section and "]]>" closes one; the two share no character.
                if (ignoreOpen_ == 2 && c == '[') {
                    ++ignoreDepth_;
                    ignoreOpen_ = ignoreClose_ = 0;
                } else if (ignoreClose_ == 2 && c == '>') {
                    if (ignoreDepth_ == 0)
                        state_ = State::Group;
                    else
                        --ignoreDepth_;
                    ignoreOpen_ = ignoreClose_ = 0;
                } else {
                    ignoreOpen_ = c == '<' ? 1 : ignoreOpen_ == 1 && c == '!' ? 2 : 0;
                    ignoreClose_ = c == ']' ? std::min(ignoreClose_ + 1, 2) : 0;
                }
                return Step::More;
        }
        return Step::Fail;
    }
}

// A NUL ends the document before the head is complete. pugixml parses UTF-8 (and Latin-1 without bytes
// above 127) in place, with a NUL over the file's last byte, and at any NUL acts as if that byte stood
// there: a root lacking only its closing '>' at the NUL closes when the file ends in '>'. That turns on
// the file past the root's end, which the head does not check, so the root counts as closed.
Step Scanner::AtNul(bool inPlace) {
    if (!inPlace) return Step::Fail;
    if (state_ == State::Slash && role_ == Role::Root) {
        if (overflow_) return Step::Fail;
        root = std::move(kept_);
        root += '>';
        rootNameEnd = nameEnd_;
        rootClosed = true;
        return Step::Done;
    }
    const bool rootEndTag = (state_ == State::EndName || state_ == State::EndSpace) && depth_ == 1;
    return rootEndTag ? Step::Done : Step::Fail;
}

// Splits the file's bytes into code units for the scanner and puts the head together.
class HeadBuilder {
public:
    Step Take(const unsigned char* data, std::size_t size);
    std::string Head() const;

private:
    Step Begin();
    Step Decode(const unsigned char* data, std::size_t size);
    Step Unit();
    std::string Encode(std::string_view ascii) const;

    unsigned char start_[4] = {};
    std::size_t started_ = 0;
    bool begun_ = false;
    Layout layout_;
    std::string bom_;
    unsigned char unit_[4] = {};
    std::size_t unitSize_ = 0;
    bool lead_ = false;  // a UTF-16 lead surrogate waits for its trail
    unsigned char leadRaw_[2] = {};
    Scanner scanner_;
};

Step HeadBuilder::Take(const unsigned char* data, std::size_t size) {
    if (!begun_) {
        const std::size_t count = std::min(sizeof start_ - started_, size);
        std::copy(data, data + count, start_ + started_);
        started_ += count;
        data += count;
        size -= count;
        if (started_ < sizeof start_) return Step::More;
        const Step step = Begin();
        if (step != Step::More) return step;
    }
    return Decode(data, size);
}

Step HeadBuilder::Begin() {
    begun_ = true;
    layout_ = GuessLayout(start_, started_);
    bom_.assign(start_, start_ + layout_.bom);
    return Decode(start_ + layout_.bom, started_ - layout_.bom);
}

Step HeadBuilder::Decode(const unsigned char* data, std::size_t size) {
    const unsigned char* end = data + size;
    while (data != end) {
        if (layout_.width == 1 && scanner_.InText()) {
            data = std::find_if(data, end, [](unsigned char b) { return b == '<' || b == 0; });
            if (data == end) break;
        }
        unit_[unitSize_++] = *data++;
        if (unitSize_ < layout_.width) continue;
        unitSize_ = 0;
        const Step step = Unit();
        if (step != Step::More) return step;
    }
    return Step::More;
}

Step HeadBuilder::Unit() {
    std::uint32_t value = 0;
    for (std::size_t i = 0; i < layout_.width; ++i)
        value = value << 8 | unit_[layout_.bigEndian ? i : layout_.width - 1 - i];
    if (layout_.width == 2) {
        // As pugixml's UTF-16 decoding: a pair is one character, a lone surrogate none.
        const bool isLead = value >= 0xd800 && value < 0xdc00;
        const bool isTrail = value >= 0xdc00 && value < 0xe000;
        if (lead_) {
            lead_ = false;
            if (isTrail) {
                const unsigned char pair[4] = {leadRaw_[0], leadRaw_[1], unit_[0], unit_[1]};
                return scanner_.Feed(kOther, pair, sizeof pair);
            }
            scanner_.Drop(leadRaw_, sizeof leadRaw_);
        }
        if (isLead) {
            lead_ = true;
            std::copy(unit_, unit_ + 2, leadRaw_);
            return Step::More;
        }
        if (isTrail) {
            scanner_.Drop(unit_, 2);
            return Step::More;
        }
    }
    if (value == 0) return scanner_.AtNul(layout_.width == 1);
    return scanner_.Feed(value < 0x80 ? static_cast<int>(value) : kOther, unit_, layout_.width);
}

std::string HeadBuilder::Encode(std::string_view ascii) const {
    std::string units;
    for (const char c : ascii) {
        if (layout_.bigEndian) units.append(layout_.width - 1, '\0');
        units += c;
        if (!layout_.bigEndian) units.append(layout_.width - 1, '\0');
    }
    return units;
}

std::string HeadBuilder::Head() const {
    std::string head = bom_ + scanner_.declaration + scanner_.root;
    if (scanner_.rootClosed) return head;
    if (!scanner_.palette.empty()) {
        head += scanner_.palette;
        if (!scanner_.paletteClosed) head += Encode("</CxF:Palette>");
    }
    head += Encode("</");
    head.append(scanner_.root, layout_.width, scanner_.rootNameEnd - layout_.width);
    head += Encode(">");
    return head;
}

}  // namespace

bool ReadBookHead(int fd, std::string& head, std::size_t chunkSize) {
    chunkSize = std::max<std::size_t>(chunkSize, 1);
    std::vector<unsigned char> chunk(chunkSize);
    HeadBuilder builder;
    Step step = Step::More;
    while (step == Step::More) {
        const ssize_t count = read(fd, chunk.data(), chunkSize);
        if (count < 0 && errno == EINTR) continue;
        // The end of the file before the end of the head fails too. A file under four bytes, never
        // decoded, holds no root.
        if (count <= 0) return false;
        step = builder.Take(chunk.data(), static_cast<std::size_t>(count));
    }
    if (step != Step::Done) return false;
    head = builder.Head();
    return true;
}

}  // namespace Pigmo
