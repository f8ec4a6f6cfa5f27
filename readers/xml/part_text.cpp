#include "dpxlsx/readers/xml/part_text.h"

#include <iconv.h>
#include <strings.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <utility>

#include "dpxlsx/readers/xml/progress.h"

namespace dp {

namespace {

using namespace std::string_view_literals;

constexpr std::size_t kBlock = std::size_t{32} << 10;

// What documents begin with whose characters are wider than a byte; they need not declare it, and
// what they declare cannot be true if it differs.
constexpr struct {
    std::string_view start;
    const char* encoding;
} kWideEncodings[] = {{"\xFF\xFE"sv, "UTF-16LE"}, {"\xFE\xFF"sv, "UTF-16BE"},
                      {"<\0?\0"sv, "UTF-16LE"},   {"\0<\0?"sv, "UTF-16BE"},
                      {"<\0\0\0"sv, "UTF-32LE"},  {"\0\0\0<"sv, "UTF-32BE"}};

// "<?xm" in every kind of EBCDIC. All of them write a declaration as this one does.
constexpr std::string_view kEbcdicStart = "\x4C\x6F\xA7\x94";
constexpr const char* kEbcdic = "IBM037";
constexpr std::size_t kDeclarationSize = 256;

struct Declaration {
    std::string encoding;  // empty when none is declared
    std::size_t end = 0;   // of its name, in the document
};

Declaration declarationOf(std::string_view document) {
    std::string_view rest = document;
    const auto take = [&rest](std::string_view text) {
        const bool found = rest.starts_with(text);
        if (found) rest.remove_prefix(text.size());
        return found;
    };
    const auto takeSpace = [&rest] {
        const std::size_t size = std::min(rest.find_first_not_of(" \t\r\n"), rest.size());
        rest.remove_prefix(size);
        return size > 0;
    };
    take("\xEF\xBB\xBF");
    if (!take("<?xml")) return {};
    std::string_view value;
    for (const std::string_view setting : {"version"sv, "encoding"sv}) {
        if (!takeSpace() || !take(setting)) return {};
        takeSpace();
        if (!take("=")) return {};
        takeSpace();
        if (!rest.starts_with('"') && !rest.starts_with('\'')) return {};
        const std::size_t end = rest.find(rest.front(), 1);
        if (end == rest.npos) return {};
        value = rest.substr(1, end - 1);
        rest.remove_prefix(end + 1);
    }
    return {std::string(value), document.size() - rest.size()};
}

bool isName(const std::string& encoding, const char* name) {
    return ::strcasecmp(encoding.c_str(), name) == 0;
}

bool isUtf8(const std::string& encoding) {
    return isName(encoding, "UTF-8") || isName(encoding, "UTF8");
}

// iconv's name for what libxml2 calls otherwise.
const char* iconvName(const std::string& encoding) {
    if (isName(encoding, "ISO-LATIN-1")) return "ISO-8859-1";
    return isName(encoding, "ISO-LATIN-2") ? "ISO-8859-2" : encoding.c_str();
}

// Null for an unknown encoding. Behind a slash there would be instructions for iconv.
Decoder decoderOf(const std::string& encoding) {
    if (encoding.find('/') != encoding.npos) return nullptr;
    const iconv_t decoder = ::iconv_open("UTF-8", iconvName(encoding));
    // NOLINTNEXTLINE(performance-no-int-to-ptr): what iconv returns on an error
    return Decoder(decoder == reinterpret_cast<iconv_t>(-1) ? nullptr : decoder);
}

// Removes from `bytes` what it could decode, and returns that. Without bytes, returns the character
// that the decoder has kept back because the next one might have changed it.
std::string_view decode(const Decoder& decoder, std::string_view& bytes, std::vector<char>& text) {
    text.resize(kBlock);
    char* from = const_cast<char*>(bytes.data());  // iconv only reads
    std::size_t left = bytes.size();
    char* to = text.data();
    std::size_t room = text.size();
    ::iconv(decoder.get(), bytes.empty() ? nullptr : &from, &left, &to, &room);
    bytes.remove_prefix(bytes.size() - left);
    return {text.data(), text.size() - room};
}

std::string declaredEbcdic(std::string_view document) {
    const Decoder decoder = decoderOf(kEbcdic);
    if (!decoder) return kEbcdic;
    std::string_view start = document.substr(0, kDeclarationSize);
    std::vector<char> text;
    const std::string declared = declarationOf(decode(decoder, start, text)).encoding;
    return declared.empty() ? kEbcdic : declared;
}

}  // namespace

void CloseDecoder::operator()(void* decoder) const { ::iconv_close(decoder); }

PartText::PartText(int descriptor)
    : descriptor_(descriptor), bytes_(kBlock), isReadable_(fill() && detectEncoding()) {}

std::optional<std::string_view> PartText::next() {
    if (!isReadable_) return std::nullopt;
    if (passedAsIs_ > 0) {
        const std::string_view start = waiting_.substr(0, std::exchange(passedAsIs_, 0));
        waiting_.remove_prefix(start.size());
        return start;
    }
    if (!decoder_) {
        if (waiting_.empty()) isReadable_ = fill();
        return isReadable_ ? std::optional(std::exchange(waiting_, {})) : std::nullopt;
    }
    for (;;) {
        const std::size_t before = waiting_.size();
        if (!fill()) break;
        const bool isComplete = waiting_.size() == before;
        const std::string_view text = decode(decoder_, waiting_, decoded_);
        if (!text.empty()) return text;
        // What is left is no character, also when it fills the buffer.
        if (isComplete) {
            if (waiting_.empty()) return text;
            break;
        }
    }
    isReadable_ = false;
    return std::nullopt;
}

// Reads as many bytes behind those that wait as there is room for. False on an error.
bool PartText::fill() {
    std::string_view::traits_type::move(bytes_.data(), waiting_.data(), waiting_.size());
    const std::size_t size = waiting_.size();
    ssize_t count = -1;
    do count = ::read(descriptor_, bytes_.data() + size, bytes_.size() - size);
    while (count < 0 && errno == EINTR);
    const auto added = static_cast<std::size_t>(std::max<ssize_t>(count, 0));
    waiting_ = {bytes_.data(), size + added};
    Progress::countRead(added);
    return count >= 0;
}

// False when the encoding is unknown.
bool PartText::detectEncoding() {
    for (const auto& wide : kWideEncodings)
        if (waiting_.starts_with(wide.start)) return startDecoding(wide.encoding);
    if (waiting_.starts_with(kEbcdicStart)) return startDecoding(declaredEbcdic(waiting_));
    const Declaration declaration = declarationOf(waiting_);
    if (declaration.encoding.empty() || isUtf8(declaration.encoding)) return true;
    passedAsIs_ = declaration.end;
    return startDecoding(declaration.encoding);
}

bool PartText::startDecoding(const std::string& encoding) {
    decoder_ = decoderOf(encoding);
    return decoder_ != nullptr;
}

}  // namespace dp
