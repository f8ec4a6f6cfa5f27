#pragma once

#include <optional>
#include <string>
#include <vector>

#include "tools/explain/findings.h"

namespace dp::tool {

// A property of a file because of which an import differs from what a spreadsheet program shows.
struct Trait {
    std::string key;        // for programs, such as "iso-dates"
    std::string found;      // what was found, and where
    std::string effect;     // what the import does with it
    std::string advice;     // what the user can do
    bool fatal = false;     // the import fails
    std::string note = {};  // the effect as a phrase of its own; only for the worst traits
};

using Found = std::optional<Trait>;

inline constexpr const char* kOpenFails = "the import fails";
inline constexpr const char* kSaveAgain =
    "open the book in a spreadsheet program and save it as .xlsx again";

std::string quoted(const std::string& text);
// `"A", "B", "C" and 4 more`, with or without the quotes.
std::string listed(const Names& names, bool quotes);
// `worksheets "A", "B"`.
std::string worksheets(const Names& names);
// "2 cells (first: Sheet1!B2)".
std::string placed(const Places& places, const std::string& unit);
std::string joined(const std::vector<std::string>& texts, const char* between);

}  // namespace dp::tool
