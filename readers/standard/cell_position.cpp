#include "dpxlsx/readers/standard/cell_position.h"

#include <algorithm>

#include "dpxlsx/readers/worksheet_size.h"

namespace dp::standard {

namespace {

// The 0-based number of a 1-based one out of `count`; the one beyond the last for all others.
std::uint32_t fromZero(std::uint64_t number, std::uint32_t count) {
    return number >= 1 && number <= count ? static_cast<std::uint32_t>(number - 1) : count;
}

// The value of a letter in a column's name, 0 for all other characters.
unsigned letterValue(char c) {
    if (c >= 'A' && c <= 'Z') return static_cast<unsigned>(c - 'A') + 1;
    if (c >= 'a' && c <= 'z') return static_cast<unsigned>(c - 'a') + 1;
    return 0;
}

unsigned digitValue(char c) { return c >= '0' && c <= '9' ? static_cast<unsigned>(c - '0') : 10; }

}  // namespace

std::optional<CellPosition> parseReference(std::string_view text) {
    // Numbers stop growing here, where no worksheet has rows or columns any more.
    constexpr std::uint64_t kFar = 1ULL << 32U;
    std::uint64_t column = 0;
    std::uint64_t row = 0;
    const auto* c = text.begin();
    for (; c != text.end() && letterValue(*c) != 0; ++c)
        column = std::min(column * 26 + letterValue(*c), kFar);
    const auto* const digits = c;
    for (; c != text.end() && digitValue(*c) < 10; ++c)
        row = std::min(row * 10 + digitValue(*c), kFar);
    if (digits == text.begin() || c == digits || c != text.end()) return std::nullopt;
    return CellPosition{fromZero(row, kWorksheetRows), fromZero(column, kWorksheetColumns)};
}

void CellOrder::beginRow(std::optional<int> number) {
    const std::uint32_t row =
        number ? fromZero(static_cast<std::uint64_t>(*number), kWorksheetRows) : nextRow_;
    next_ = {row, 0};
    nextRow_ = std::min<std::uint32_t>(row, kWorksheetRows) + 1;
}

CellPosition CellOrder::cell(std::optional<CellPosition> reference) {
    const CellPosition position = reference.value_or(next_);
    next_ = {position.row, std::min<std::uint32_t>(position.column, kWorksheetColumns) + 1};
    nextRow_ = std::min<std::uint32_t>(position.row, kWorksheetRows) + 1;
    return position;
}

}  // namespace dp::standard
