#include "dpxlsx/readers/xml/plain_xml.h"

#include <fcntl.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <initializer_list>

#include "dpxlsx/readers/limits.h"
#include "dpxlsx/readers/xml/progress.h"

namespace dp {

namespace {

// Well below what libxml2 and the readers allow, so that neither has to be asked.
constexpr std::size_t kPlainDepth = kXmlDepth / 2;
constexpr std::ptrdiff_t kPlainTag = kLongMarkup / 2;
// libxml2 keeps every name, namespace and blank text once, 10 MB of them, and fails beyond.
constexpr std::size_t kPlainNames = 512 << 10;
constexpr std::size_t kBriefText = 3;            // of which there are too few to count
constexpr std::size_t kPlainBlanks = 256 << 10;  // bytes in front of and behind the root
constexpr std::size_t kPlainPrefixes = 64;       // in scope; each prefix is looked for among them

constexpr unsigned char kNameStart = 1;
constexpr unsigned char kNamePart = 2;
constexpr unsigned char kSpace = 4;
constexpr unsigned char kOrdinaryText = 8;    // in a text stands for itself
constexpr unsigned char kOrdinaryValue = 16;  // in an attribute value stands for itself

constexpr std::array<unsigned char, 256> classify() {
    std::array<unsigned char, 256> classes{};
    const auto add = [&classes](std::string_view members, unsigned char flags) {
        for (const char c : members) classes[static_cast<unsigned char>(c)] |= flags;
    };
    for (std::size_t c = 0x20; c < 0x80; ++c) classes[c] = kOrdinaryText | kOrdinaryValue;
    for (const char c : std::string_view("<&]"))
        classes[static_cast<unsigned char>(c)] &= 0xFF ^ kOrdinaryText;
    for (const char c : std::string_view("<&\"'"))
        classes[static_cast<unsigned char>(c)] &= 0xFF ^ kOrdinaryValue;
    add("\t\n", kOrdinaryText);
    add(" \t\n\r", kSpace);
    add("ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz_", kNameStart | kNamePart);
    add("0123456789.-:", kNamePart);
    return classes;
}
constexpr std::array<unsigned char, 256> kClasses = classify();

bool is(unsigned char flag, char c) {
    return (kClasses[static_cast<unsigned char>(c)] & flag) != 0;
}

template <class Char>
Char* skip(unsigned char flag, Char* p) {
    while (is(flag, *p)) ++p;
    return p;
}

bool isCharacter(std::uint32_t code) {
    return code == '\t' || code == '\n' || code == '\r' || (code >= 0x20 && code < 0xD800) ||
           (code >= 0xE000 && code < 0xFFFE) || (code >= 0x10000 && code < 0x110000);
}

// A character reference or predefined entity between '&' and ';'; 0 for anything else.
std::uint32_t referred(std::string_view text) {
    if (text == "lt") return '<';
    if (text == "gt") return '>';
    if (text == "amp") return '&';
    if (text == "quot") return '"';
    if (text == "apos") return '\'';
    if (text.size() < 2 || text[0] != '#') return 0;
    const bool hexadecimal = text[1] == 'x';
    const std::string_view digits = text.substr(hexadecimal ? 2 : 1);
    const std::uint32_t base = hexadecimal ? 16 : 10;
    std::uint32_t code = 0;
    for (const char c : digits) {
        std::uint32_t digit = base;
        if (c >= '0' && c <= '9') digit = static_cast<std::uint32_t>(c - '0');
        if (c >= 'a' && c <= 'f') digit = static_cast<std::uint32_t>(c - 'a' + 10);
        if (c >= 'A' && c <= 'F') digit = static_cast<std::uint32_t>(c - 'A' + 10);
        if (digit >= base) return 0;
        code = code * base + digit;
    }
    return !digits.empty() && isCharacter(code) ? code : 0;
}
constexpr std::ptrdiff_t kLongestReference = 9;  // "#x10FFFF" and one more

char* appendUtf8(char* p, std::uint32_t code) {
    const auto tail = [&p, code](unsigned shift) {
        *p++ = static_cast<char>(0x80 | (code >> shift & 0x3F));
    };
    if (code < 0x80) {
        *p++ = static_cast<char>(code);
    } else if (code < 0x800) {
        *p++ = static_cast<char>(0xC0 | code >> 6);
        tail(0);
    } else if (code < 0x10000) {
        *p++ = static_cast<char>(0xE0 | code >> 12);
        tail(6);
        tail(0);
    } else {
        *p++ = static_cast<char>(0xF0 | code >> 18);
        tail(12);
        tail(6);
        tail(0);
    }
    return p;
}

// Puts the value of a text or an attribute, whose white space is `lineEnd` throughout unless that
// is a line feed, in the place of how it was written. Returns its end.
char* decode(char* begin, char* end, char lineEnd) {
    char* to = begin;
    for (char* from = begin; from != end;) {
        if (*from == '&') {
            char* const semicolon = std::find(from, end, ';');
            to = appendUtf8(to,
                            referred({from + 1, static_cast<std::size_t>(semicolon - from - 1)}));
            from = semicolon + 1;
        } else if (*from == '\r') {
            from += from + 1 != end && from[1] == '\n' ? 2 : 1;
            *to++ = lineEnd;
        } else if (lineEnd == ' ' && is(kSpace, *from)) {
            ++from;
            *to++ = ' ';
        } else {
            *to++ = *from++;
        }
    }
    return to;
}

// The bytes behind `prefix` when `text` begins with it.
bool take(std::string_view& text, std::string_view prefix) {
    if (text.substr(0, prefix.size()) != prefix) return false;
    text.remove_prefix(prefix.size());
    return true;
}

bool takeSpace(std::string_view& text) {
    const std::size_t size = std::min(text.find_first_not_of(" \t\r\n"), text.size());
    text.remove_prefix(size);
    return size > 0;
}

// `name`="value" with either kind of quotes.
bool takeSetting(std::string_view& text, std::string_view name,
                 std::initializer_list<std::string_view> values) {
    std::string_view rest = text;
    if (!takeSpace(rest) || !take(rest, name) || !take(rest, "=") || rest.empty()) return false;
    const std::string_view quote = rest.substr(0, 1);
    if (quote != "\"" && quote != "'") return false;
    rest.remove_prefix(1);
    for (const std::string_view value : values) {
        std::string_view behind = rest;
        if (take(behind, value) && take(behind, quote)) {
            text = behind;
            return true;
        }
    }
    return false;
}

// Passes over the byte-order mark and the declaration. False when they are not plain.
bool takeBeginning(std::string_view& text) {
    take(text, "\xEF\xBB\xBF");
    if (take(text, "<?xml")) {
        if (!takeSetting(text, "version", {"1.0"})) return false;
        takeSetting(text, "encoding", {"UTF-8", "utf-8"});
        takeSetting(text, "standalone", {"yes", "no"});
        takeSpace(text);
        return take(text, "?>");
    }
    return !text.empty() && text[0] == '<';
}

struct QName {
    std::string_view prefix;
    std::string_view local;
};

QName split(std::string_view name) {
    const std::size_t colon = name.find(':');
    if (colon == name.npos) return {{}, name};
    return {name.substr(0, colon), name.substr(colon + 1)};
}

std::size_t slotOf(std::string_view text, std::size_t slots) {
    const auto byte = [](char c) { return std::size_t{static_cast<unsigned char>(c)}; };
    return (text.size() * 31 + byte(text.front()) * 7 + byte(text.back())) % slots;
}

}  // namespace

PlainXml::PlainXml(ReadingWindow window) : window_(window) {}

PlainXml::~PlainXml() {
    if (descriptor_ >= 0) ::close(descriptor_);
}

bool PlainXml::open(const std::string& path) {
    Progress::beginPart(path);
    descriptor_ = ::open(path.c_str(), O_RDONLY | O_CLOEXEC);
    if (descriptor_ < 0) return false;
    buffer_.reset(new char[window_.size + kZeros]);
    at_ = end_ = buffer_.get();
    constexpr std::ptrdiff_t kLongestBeginning = 256;
    while (end_ - at_ < kLongestBeginning && fill()) {
    }
    const std::string_view beginning(
        at_, static_cast<std::size_t>(std::min(end_ - at_, kLongestBeginning)));
    std::string_view rest = beginning;
    if (readError_ || !takeBeginning(rest)) return false;
    at_ += beginning.size() - rest.size();
    return true;
}

// More bytes behind those from at_ on, which move to the window's beginning. False at the end of
// the file and when the window is full.
bool PlainXml::fill() {
    const auto kept = static_cast<std::size_t>(end_ - at_);
    const std::size_t size = std::min(window_.step, window_.size - kept);
    if (endOfFile_ || size == 0) return false;
    std::memmove(buffer_.get(), at_, kept);
    at_ = buffer_.get();
    end_ = at_ + kept;
    ssize_t count = -1;
    do count = ::read(descriptor_, end_, size);
    while (count < 0 && errno == EINTR);
    readError_ = count < 0;
    endOfFile_ = count <= 0;
    if (count > 0) end_ += count;
    std::memset(end_, 0, kZeros);
    if (!endOfFile_) Progress::countRead(static_cast<std::uint64_t>(count));
    Progress::tell();
    return !endOfFile_;
}

char* PlainXml::ahead() {
    if (lessIsZero_) *at_ = '<';
    lessIsZero_ = false;
    return at_;
}

PlainXml::Node PlainXml::next() {
    ahead();
    if (openLengths_.empty()) return nextOutsideRoot();
    Node node = Node::Text;
    for (;;) {
        const Scan scan = *at_ == '<' ? scanMarkup(node) : scanText();
        if (scan == Scan::Complete) return node;
        if (scan == Scan::NotPlain || !fill()) return Node::NotPlain;
    }
}

PlainXml::Node PlainXml::nextOutsideRoot() {
    Node node = Node::Start;
    for (;;) {
        char* const markup = skip(kSpace, at_);
        blanksOutside_ += static_cast<std::size_t>(markup - at_);
        at_ = markup;
        if (blanksOutside_ > kPlainBlanks) return Node::NotPlain;
        Scan scan = stopAt(at_);
        if (*at_ == '<' && !rootSeen_) scan = scanStartTag(node);
        if (scan == Scan::Complete) return node;
        if (scan == Scan::NotPlain) return Node::NotPlain;
        const bool complete = rootSeen_ && at_ == end_;
        if (!fill()) return complete && !readError_ ? Node::Finished : Node::NotPlain;
    }
}

PlainXml::Scan PlainXml::scanMarkup(Node& node) {
    if (at_[1] != '/') return scanStartTag(node);
    node = Node::End;
    return scanEndTag();
}

PlainXml::Scan PlainXml::scanEndTag() {
    char* p = at_ + 2;
    const std::string_view expected = innermost();
    for (const char c : expected)
        if (*p++ != c) return stopAt(p - 1);
    name_ = {p - expected.size(), expected.size()};
    p = skip(kSpace, p);
    if (*p != '>') return stopAt(p);
    ++p;
    if (p - at_ > kPlainTag) return Scan::NotPlain;
    at_ = p;
    popElement();
    return Scan::Complete;
}

PlainXml::Scan PlainXml::scanStartTag(Node& node) {
    char* p = at_ + 1;
    if (!is(kNameStart, *p)) return stopAt(p);
    p = skip(kNamePart, p);
    name_ = {at_ + 1, static_cast<std::size_t>(p - at_ - 1)};
    if (const Scan scan = scanAttributes(p); scan != Scan::Complete) return scan;
    node = *p == '/' ? Node::Empty : Node::Start;
    if (*p == '/') ++p;
    if (*p != '>') return stopAt(p);
    ++p;
    if (p - at_ > kPlainTag || openLengths_.size() == kPlainDepth) return Scan::NotPlain;
    pushElement();
    if (!acceptTag()) return Scan::NotPlain;
    if (node == Node::Empty) popElement();
    rootSeen_ = true;
    at_ = p;
    return Scan::Complete;
}

// Stops at what ends the tag.
PlainXml::Scan PlainXml::scanAttributes(char*& p) {
    for (attributeCount_ = 0;; ++attributeCount_) {
        char* const name = skip(kSpace, p);
        const bool separated = name != p;
        p = name;
        if (*p == '>' || *p == '/') return Scan::Complete;
        if (!separated || !is(kNameStart, *p)) return stopAt(p);
        if (attributeCount_ == kAttributes) return Scan::NotPlain;
        if (const Scan scan = scanAttribute(p); scan != Scan::Complete) return scan;
    }
}

PlainXml::Scan PlainXml::scanAttribute(char*& p) {
    Attribute& attribute = attributes_[attributeCount_];
    char* const name = p;
    p = skip(kNamePart, p);
    attribute.name = {name, static_cast<std::size_t>(p - name)};
    p = skip(kSpace, p);
    if (*p != '=') return stopAt(p);
    p = skip(kSpace, p + 1);
    if (*p != '"' && *p != '\'') return stopAt(p);
    return scanValue(p, attribute);
}

PlainXml::Scan PlainXml::scanValue(char*& p, Attribute& attribute) {
    const char quote = *p++;
    attribute.value = p;
    attribute.raw = false;
    for (;;) {
        p = skip(kOrdinaryValue, p);
        if (*p == quote) break;
        if (*p == '"' || *p == '\'') {
            ++p;
            continue;
        }
        if (*p == '<') return Scan::NotPlain;
        attribute.raw = true;
        if (const Scan scan = scanCharacter(p); scan != Scan::Complete) return scan;
    }
    attribute.valueEnd = p++;
    return Scan::Complete;
}

// Passes over a character that is not an ordinary one.
PlainXml::Scan PlainXml::scanCharacter(char*& p) const {
    if (*p == '&') return scanReference(p);
    if (is(kSpace, *p)) {
        ++p;
        return Scan::Complete;
    }
    const auto byte = [p](int i) { return static_cast<unsigned char>(p[i]); };
    if (byte(0) < 0xC2 || byte(0) > 0xF4) return stopAt(p);
    const int size = byte(0) < 0xE0 ? 2 : byte(0) < 0xF0 ? 3 : 4;
    if (end_ - p < size) return Scan::Incomplete;
    std::uint32_t code = byte(0) & (0x7FU >> size);
    for (int i = 1; i < size; ++i) {
        if ((byte(i) & 0xC0) != 0x80) return Scan::NotPlain;
        code = code << 6 | (byte(i) & 0x3F);
    }
    constexpr std::uint32_t kSmallest[] = {0, 0, 0x80, 0x800, 0x10000};
    if (code < kSmallest[size] || !isCharacter(code)) return Scan::NotPlain;
    p += size;
    return Scan::Complete;
}

PlainXml::Scan PlainXml::scanReference(char*& p) const {
    char* const limit = std::min(p + 1 + kLongestReference, end_);
    char* const semicolon = std::find(p + 1, limit, ';');
    if (semicolon == limit) return stopAt(limit);
    if (referred({p + 1, static_cast<std::size_t>(semicolon - p - 1)}) == 0) return Scan::NotPlain;
    p = semicolon + 1;
    return Scan::Complete;
}

PlainXml::Scan PlainXml::scanText() {
    char* p = at_;
    bool raw = false;
    for (;;) {
        p = skip(kOrdinaryText, p);
        if (*p == '<') break;
        if (*p == ']') {
            const char* const third = p[1] == ']' ? p + 2 : p + 1;
            if (*third == '\0') return stopAt(third);
            if (third == p + 2 && *third == '>') return Scan::NotPlain;
            ++p;
            continue;
        }
        raw = true;
        if (const Scan scan = scanCharacter(p); scan != Scan::Complete) return scan;
    }
    const bool blank = skip(kSpace, at_) == p;
    if (blank && !remember({at_, static_cast<std::size_t>(p - at_)})) return Scan::NotPlain;
    text_ = at_;
    textEnd_ = p;
    textRaw_ = raw;
    at_ = p;
    return Scan::Complete;
}

// What a tag declares holds for itself and what it holds: the element has been pushed.
bool PlainXml::acceptTag() {
    for (std::size_t i = 0; i < attributeCount_; ++i)
        if (!isUnique(i) || !acceptAttribute(attributes_[i])) return false;
    for (std::size_t i = 0; i < attributeCount_; ++i) {
        const std::string_view prefix = split(attributes_[i].name).prefix;
        if (prefix != "xml" && prefix != "xmlns" && !isDeclared(prefix)) return false;
    }
    return acceptName(name_) && isDeclared(split(name_).prefix);
}

// Names with a prefix count as the same when what follows it is.
bool PlainXml::isUnique(std::size_t index) const {
    const QName name = split(attributes_[index].name);
    const auto isSame = [&name](const Attribute& other) {
        const QName otherName = split(other.name);
        return name.local == otherName.local && name.prefix.empty() == otherName.prefix.empty();
    };
    const auto end = attributes_.begin() + static_cast<std::ptrdiff_t>(index);
    return std::none_of(attributes_.begin(), end, isSame);
}

bool PlainXml::acceptName(std::string_view name) {
    const std::string_view local = split(name).local;
    return !local.empty() && is(kNameStart, local[0]) && local.find(':') == local.npos &&
           remember(name);
}

bool PlainXml::acceptAttribute(const Attribute& attribute) {
    if (!acceptName(attribute.name)) return false;
    const QName name = split(attribute.name);
    const std::string_view value(attribute.value,
                                 static_cast<std::size_t>(attribute.valueEnd - attribute.value));
    if (name.prefix == "xml") return name.local == "space" && value == "preserve";
    if (attribute.name != "xmlns" && name.prefix != "xmlns") return true;
    // The namespaces that XML itself has may be named in one way only.
    if (attribute.raw || value.empty() || value.find("w3.org/XML") != value.npos ||
        value.find("w3.org/2000/xmlns") != value.npos)
        return false;
    if (!std::all_of(value.begin(), value.end(),
                     [](char c) { return is(kNamePart, c) || c == '/'; }))
        return false;
    if (!remember(value)) return false;
    if (name.prefix.empty()) return true;
    if (name.local == "xml" || name.local == "xmlns") return false;
    if (prefixes_.size() == kPlainPrefixes) return false;
    prefixes_.push_back({std::string(name.local), openLengths_.size()});
    return true;
}

// Elements with a prefix that XML itself has are not plain: `xmlns` is undeclared there, whereby
// the whole name, prefix and all, becomes the local one.
bool PlainXml::isDeclared(std::string_view prefix) const {
    return prefix.empty() ||
           std::any_of(prefixes_.begin(), prefixes_.end(),
                       [prefix](const Prefix& known) { return known.name == prefix; });
}

// False when the document has too many names, namespaces and blank texts.
bool PlainXml::remember(std::string_view text) {
    if (text.size() <= kBriefText) return true;
    std::string& lately = lately_[slotOf(text, lately_.size())];
    if (lately == text) return true;
    lately = text;
    if (known_.insert(lately).second) knownSize_ += text.size();
    return knownSize_ <= kPlainNames;
}

void PlainXml::pushElement() {
    openNames_ += name_;
    openLengths_.push_back(static_cast<std::uint16_t>(name_.size()));
}

void PlainXml::popElement() {
    while (!prefixes_.empty() && prefixes_.back().depth == openLengths_.size())
        prefixes_.pop_back();
    openNames_.resize(openNames_.size() - openLengths_.back());
    openLengths_.pop_back();
}

std::string_view PlainXml::innermost() const {
    return std::string_view(openNames_).substr(openNames_.size() - openLengths_.back());
}

std::string_view PlainXml::parentName() const { return split(innermost()).local; }

const char* PlainXml::attribute(std::string_view name) {
    for (std::size_t i = 0; i < attributeCount_; ++i) {
        Attribute& attribute = attributes_[i];
        if (attribute.name != name) continue;
        if (attribute.raw) attribute.valueEnd = decode(attribute.value, attribute.valueEnd, ' ');
        attribute.raw = false;
        *attribute.valueEnd = '\0';
        return attribute.value;
    }
    return nullptr;
}

std::string_view PlainXml::text() {
    if (textRaw_) textEnd_ = decode(text_, textEnd_, '\n');
    textRaw_ = false;
    lessIsZero_ = lessIsZero_ || textEnd_ == at_;
    *textEnd_ = '\0';
    return {text_, static_cast<std::size_t>(textEnd_ - text_)};
}

char* PlainXml::endOfOrdinaryText(char* text) { return skip(kOrdinaryText, text); }

}  // namespace dp
