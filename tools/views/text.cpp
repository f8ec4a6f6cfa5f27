#include "tools/views/text.h"

#include <cstdint>

#include <unicode/uchar.h>
#include <unicode/unistr.h>

namespace dp::tool {

namespace {

constexpr UChar32 kReplacement = 0xFFFD;
constexpr const char* kEllipsis = "\u2026";

icu::UnicodeString decoded(std::string_view text) {
    return icu::UnicodeString::fromUTF8({text.data(), static_cast<int32_t>(text.size())});
}

bool turnsDirection(UChar32 c) {
    return (c >= 0x202A && c <= 0x202E) || (c >= 0x2066 && c <= 0x2069);
}

UChar32 visible(UChar32 c) {
    if (c < 0x20) return 0x2400 + c;  // the symbol for the control character
    if (c == 0x7F) return 0x2421;
    const int8_t category = u_charType(c);
    const bool breaks = category == U_CONTROL_CHAR || category == U_LINE_SEPARATOR ||
                        category == U_PARAGRAPH_SEPARATOR;
    return breaks || turnsDirection(c) ? kReplacement : c;
}

bool takesNoCell(UChar32 c) {
    constexpr uint32_t kZeroWidth =
        U_GC_MN_MASK | U_GC_ME_MASK | U_GC_CF_MASK;  // combining marks and format characters
    const bool jamoAfterTheFirst = c >= 0x1160 && c <= 0x11FF;
    return jamoAfterTheFirst || (U_MASK(u_charType(c)) & kZeroWidth) != 0;
}

int cells(UChar32 c) {
    if (takesNoCell(c)) return c == 0x00AD ? 1 : 0;  // terminals show the soft hyphen
    const int width = u_getIntPropertyValue(c, UCHAR_EAST_ASIAN_WIDTH);
    return width == U_EA_WIDE || width == U_EA_FULLWIDTH ? 2 : 1;
}

std::string encoded(const icu::UnicodeString& text) {
    std::string result;
    return text.toUTF8String(result);
}

int displayWidth(const icu::UnicodeString& text) {
    int width = 0;
    for (int32_t at = 0; at < text.length(); at = text.moveIndex32(at, 1)) {
        width += cells(text.char32At(at));
    }
    return width;
}

// The longest prefix that takes at most `width` cells, with the combining marks that follow it.
icu::UnicodeString beginning(const icu::UnicodeString& text, int width) {
    int used = 0;
    int32_t at = 0;
    for (; at < text.length(); at = text.moveIndex32(at, 1)) {
        used += cells(text.char32At(at));
        if (used > width) break;
    }
    return text.tempSubString(0, at);
}

}  // namespace

std::string validUtf8(std::string_view text) { return encoded(decoded(text)); }

std::string printable(std::string_view text) {
    const icu::UnicodeString given = decoded(text);
    icu::UnicodeString shown;
    for (int32_t at = 0; at < given.length(); at = given.moveIndex32(at, 1)) {
        shown.append(visible(given.char32At(at)));
    }
    return encoded(shown);
}

int displayWidth(std::string_view text) { return displayWidth(decoded(text)); }

std::string cutToWidth(const std::string& text, int width) {
    const icu::UnicodeString given = decoded(text);
    if (displayWidth(given) <= width) return text;
    return width <= 0 ? std::string() : encoded(beginning(given, width - 1)) + kEllipsis;
}

std::string shellWord(const std::string& text) {
    constexpr const char* kPlain =
        "abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ0123456789_.-=/";
    if (!text.empty() && text.find_first_not_of(kPlain) == std::string::npos) return text;
    std::string quoted = "'";
    for (const char c : text) quoted += c == '\'' ? "'\\''" : std::string(1, c);
    return quoted + "'";
}

std::string padded(const std::string& text, int width, bool toTheRight) {
    const int missing = width - displayWidth(text);
    const std::string spaces(missing > 0 ? static_cast<size_t>(missing) : 0, ' ');
    return toTheRight ? spaces + text : text + spaces;
}

std::string trimmed(const std::string& text) {
    constexpr const char* kSpace = " \t\r\n";
    const size_t first = text.find_first_not_of(kSpace);
    if (first == std::string::npos) return {};
    return text.substr(first, text.find_last_not_of(kSpace) - first + 1);
}

std::string counted(size_t count, const std::string& unit) {
    return counted(count, unit, unit + "s");
}

std::string counted(size_t count, const std::string& one, const std::string& more) {
    return std::to_string(count) + " " + (count == 1 ? one : more);
}

}  // namespace dp::tool
