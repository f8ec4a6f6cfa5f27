#include "dpxlsx/readers/standard/cell_position.h"

#include <algorithm>

#include "dpxlsx/readers/worksheet_size.h"

namespace dp::standard {

namespace {

// 0-based numbers: those of 1-based ones, and of the one beyond the last for all others.
std::uint32_t rowOf(std::uint64_t number) {
    const bool exists = number >= 1 && number <= kWorksheetRows;
    return exists ? static_cast<std::uint32_t>(number - 1) : kWorksheetRows;
}

std::uint32_t columnOf(std::uint64_t number) {
    const bool exists = number >= 1 && number <= kWorksheetColumns;
    return exists ? static_cast<std::uint32_t>(number - 1) : kWorksheetColumns;
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
    return CellPosition{rowOf(row), columnOf(column)};
}

void CellOrder::beginRow(std::optional<int> number) {
    const std::uint32_t row = number ? rowOf(static_cast<std::uint64_t>(*number)) : nextRow_;
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
