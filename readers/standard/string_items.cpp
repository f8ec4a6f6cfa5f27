#include "dpxlsx/readers/standard/string_items.h"

#include <charconv>
#include <optional>
#include <string_view>
#include <utility>

namespace dp::standard {

namespace {

constexpr std::size_t kEscapeLength = 7;  // of "_x000D_"

// The code of the escape that `text` begins with.
std::optional<char32_t> escapedCode(std::string_view text) {
    if (text.size() < kEscapeLength || !text.starts_with("_x") || text[kEscapeLength - 1] != '_')
        return std::nullopt;
    unsigned code = 0;
    const char* const end = text.data() + kEscapeLength - 1;
    if (std::from_chars(text.data() + 2, end, code, 16).ptr != end) return std::nullopt;
    return code;
}

bool isHighHalf(char32_t code) { return code >= 0xD800 && code < 0xDC00; }
bool isLowHalf(char32_t code) { return code >= 0xDC00 && code < 0xE000; }

void appendUtf8(std::string& text, char32_t code) {
    const auto tail = [&](unsigned shift) {
        text += static_cast<char>(0x80U | ((code >> shift) & 0x3FU));
    };
    if (code < 0x80) {
        text += static_cast<char>(code);
    } else if (code < 0x800) {
        text += static_cast<char>(0xC0U | (code >> 6U));
        tail(0);
    } else if (code < 0x10000) {
        text += static_cast<char>(0xE0U | (code >> 12U));
        tail(6);
        tail(0);
    } else {
        text += static_cast<char>(0xF0U | (code >> 18U));
        tail(12);
        tail(6);
        tail(0);
    }
}

// Appends the character that `text` begins to escape; how many bytes it is written with, 0 when it
// is none.
std::size_t takeEscape(std::string_view text, std::string& decoded) {
    const std::optional<char32_t> code = escapedCode(text);
    if (!code || *code == 0 || isLowHalf(*code)) return 0;
    if (!isHighHalf(*code)) {
        appendUtf8(decoded, *code);
        return kEscapeLength;
    }
    const std::optional<char32_t> low = escapedCode(text.substr(kEscapeLength));
    if (!low || !isLowHalf(*low)) return 0;
    appendUtf8(decoded, 0x10000 + ((*code - 0xD800) << 10U) + (*low - 0xDC00));
    return 2 * kEscapeLength;
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
