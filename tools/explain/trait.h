#pragma once

#include <optional>
#include <string>
#include <vector>

#include "tools/explain/findings.h"

namespace dp::tool {

struct TraitPlace {
    std::string place;         // a column, a cell or a worksheet: "Data!B", "Data!B2", "Data"
    size_t cells = 0;          // of a column; 0 when their number is not known
    std::string options = {};  // that cure this place alone, as they are typed
};

// A property of a file because of which an import differs from what a spreadsheet program shows.
struct Trait {
    std::string key;        // for programs, such as "iso-dates"
    std::string found;      // what was found, and where
    std::string effect;     // what the import does with it
    std::string advice;     // what the user can do
    bool fatal = false;     // the import fails
    std::string note = {};  // the effect as a phrase of its own; only for the worst traits
    std::vector<std::string> cures = {};  // options as they are typed, each an alternative
    std::vector<TraitPlace> places = {};  // of cells often only the first
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
// The columns with the numbers of their cells, without options.
std::vector<TraitPlace> placesOf(const Tally& cells);
// The options of all the places, as they are typed.
std::string optionsOf(const std::vector<TraitPlace>& places);
// The trait with its places and the options that cure it; empty options cure nothing.
Trait located(Trait trait, std::vector<TraitPlace> places, const std::string& options = {});
std::string joined(const std::vector<std::string>& texts, const char* between);

}  // namespace dp::tool
