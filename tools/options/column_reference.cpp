#include "tools/options/column_reference.h"

#include <algorithm>
#include <charconv>
#include <system_error>
#include <utility>

namespace dp::tool {

namespace {

constexpr unsigned kLastColumn = 16384;

std::optional<unsigned> byLetters(std::string_view text) {
    unsigned number = 0;
    for (const char c : text) {
        const char upper = c >= 'a' && c <= 'z' ? static_cast<char>(c - 'a' + 'A') : c;
        if (upper < 'A' || upper > 'Z' || number > kLastColumn) return std::nullopt;
        number = number * 26 + static_cast<unsigned>(upper - 'A' + 1);
    }
    return number;
}

std::optional<unsigned> byDigits(std::string_view text) {
    unsigned number = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    if (error != std::errc() || end != text.data() + text.size()) return std::nullopt;
    return number;
}

}  // namespace

std::optional<unsigned> columnNumber(std::string_view text) {
    if (text.empty()) return std::nullopt;
    const bool digits = text[0] >= '0' && text[0] <= '9';
    const std::optional<unsigned> number = digits ? byDigits(text) : byLetters(text);
    return number && *number >= 1 && *number <= kLastColumn ? number : std::nullopt;
}

std::string columnLetters(unsigned number) {
    std::string letters;
    for (; number > 0; number = (number - 1) / 26) {
        letters.insert(letters.begin(), static_cast<char>('A' + (number - 1) % 26));
    }
    return letters;
}

std::string columnReference(const std::string& title, int key, unsigned number) {
    const bool plain = std::none_of(title.begin(), title.end(), [](char c) {
        return c == '=' || static_cast<unsigned char>(c) < ' ' || c == 0x7F;
    });
    return (plain ? title : std::to_string(key)) + "!" + columnLetters(number);
}

std::optional<ColumnReference> parseColumnReference(std::string_view text) {
    const size_t mark = text.rfind('!');
    const bool every = mark == std::string_view::npos;
    const auto number = columnNumber(every ? text : text.substr(mark + 1));
    if (!number || mark == 0) return std::nullopt;
    return ColumnReference{std::string(every ? "" : text.substr(0, mark)), *number};
}

std::optional<ColumnAssignment> parseColumnAssignment(std::string_view text) {
    // Names of worksheets may contain "=": the first one after a valid column is the separator.
    for (size_t at = text.find('='); at != std::string_view::npos; at = text.find('=', at + 1)) {
        if (auto column = parseColumnReference(text.substr(0, at))) {
            return ColumnAssignment{std::move(*column), std::string(text.substr(at + 1))};
        }
    }
    return std::nullopt;
}

}  // namespace dp::tool
