#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace dp::tool {

// A column as the user writes it: "C", "3", or "Sheet!C" for one worksheet only.
struct ColumnReference {
    std::string worksheet;  // name or key; empty for every worksheet
    unsigned column = 0;    // 1-based
};

// COLUMN=VALUE.
struct ColumnAssignment {
    ColumnReference column;
    std::string value;
};

// The 1-based number of "A" to "XFD" in any letter case or of "1" to "16384", else none.
std::optional<unsigned> columnNumber(std::string_view text);

// The letters of a column, the first being 1.
std::string columnLetters(unsigned number);

// The column in the form that options accept: "Sheet!C", or "1!C" with the worksheet's key when the
// title has a character that an option or a terminal would misread.
std::string columnReference(const std::string& title, int key, unsigned number);

// No value when the text is not a reference or assignment.
std::optional<ColumnReference> parseColumnReference(std::string_view text);
std::optional<ColumnAssignment> parseColumnAssignment(std::string_view text);

}  // namespace dp::tool
