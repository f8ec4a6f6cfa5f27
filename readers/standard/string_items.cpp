#include "dpxlsx/readers/standard/string_items.h"

#include <charconv>
#include <cstdint>
#include <optional>
#include <string_view>
#include <utility>

#include <unicode/unistr.h>
#include <unicode/utf16.h>

namespace dp::standard {

namespace {

constexpr std::size_t kEscapeLength = 7;  // of "_x000D_"

// The UTF-16 code of the escape that `text` begins with.
std::optional<char16_t> escapedCode(std::string_view text) {
    if (text.size() < kEscapeLength || !text.starts_with("_x") || text[kEscapeLength - 1] != '_')
        return std::nullopt;
    std::uint16_t code = 0;
    const char* const end = text.data() + kEscapeLength - 1;
    if (std::from_chars(text.data() + 2, end, code, 16).ptr != end) return std::nullopt;
    return code;
}

// Appends the character that `text` begins to escape; how many bytes it is written with, 0 when it
// is none.
std::size_t takeEscape(std::string_view text, std::string& decoded) {
    const std::optional<char16_t> code = escapedCode(text);
    if (!code || *code == 0 || U16_IS_TRAIL(*code)) return 0;
    icu::UnicodeString character(*code);
    std::size_t length = kEscapeLength;
    if (U16_IS_LEAD(*code)) {
        const std::optional<char16_t> low = escapedCode(text.substr(kEscapeLength));
        if (!low || !U16_IS_TRAIL(*low)) return 0;
        character.append(*low);
        length += kEscapeLength;
    }
    character.toUTF8String(decoded);
    return length;
}

}  // namespace

void decodeEscapes(std::string& text) {
    constexpr std::string_view kBegin = "_x";
    std::size_t escape = text.find(kBegin);
    if (escape == text.npos) return;
    std::string decoded;
    std::size_t copied = 0;
    while (escape != text.npos) {
        decoded.append(text, copied, escape - copied);
        const std::size_t length = takeEscape(std::string_view(text).substr(escape), decoded);
        copied = escape + length;
        escape = text.find(kBegin, length == 0 ? escape + 1 : copied);
    }
    decoded.append(text, copied, text.npos);
    text = std::move(decoded);
}

std::string readStringItem(ElementWalker& walker) {
    std::string text;
    const auto takeText = [&](std::string_view name) {
        if (name == "t") text += walker.text();
    };
    walker.children([&](std::string_view name) {
        if (name == "r")
            walker.children(takeText);
        else
            takeText(name);
    });
    decodeEscapes(text);
    return text;
}

void readSharedStrings(const std::string& path, SharedStringTable& table) {
    table.clear();
    ElementWalker walker(path);
    walker.children([&](std::string_view name) {
        if (name == "si") table.add(readStringItem(walker));
    });
    walker.finish();
}

}  // namespace dp::standard
