#include "tools/explain/format_traits.h"

#include <algorithm>
#include <cstdio>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "tools/views/text.h"

namespace dp::tool {

namespace {

// The code as spreadsheet programs display it: without backslashes.
std::string asDisplayed(std::string code) {
    code.erase(std::remove(code.begin(), code.end(), '\\'), code.end());
    return code;
}

// The cells of some styles in some columns.
struct Collected {
    Places cells;
    Names codes;    // each one once
    Tally columns;  // of those without a name only the number of cells
    std::set<std::string> seen;

    void add(const StyledCells& of, const std::string& code) {
        if (cells.count == 0) cells.first = of.cells.first;
        cells.count += of.cells.count;
        if (seen.insert(code).second) codes.add(asDisplayed(code));
        columns.add({of.reference, "", of.cells.count});  // they come column by column
    }

    // The columns with the option that gives each of them the type.
    std::vector<TraitPlace> typed(const char* type) const {
        std::vector<TraitPlace> places = placesOf(columns);
        for (TraitPlace& place : places) {
            const std::string column = place.place.empty() ? "COLUMN" : place.place;
            place.options = "--type " + shellWord(column + "=" + type);
        }
        return places;
    }

    bool allNamed() const {
        const auto& entries = columns.entries();
        return std::none_of(entries.begin(), entries.end(),
                            [](const Tally::Entry& entry) { return entry.place.empty(); });
    }
};

// The cells for which `matches` holds; it gets the format, whether the library takes the style for
// a date, and the kind of the column.
template <class Matches>
Collected collected(const Findings& findings, const StyleAnswers& answers, Matches matches) {
    Collected result;
    for (const auto& [key, cells] : findings.styledCells) {
        const auto format = findings.formats.find(key.style);
        const auto answer = answers.find(key.style);
        if (format == findings.formats.end() || answer == answers.end()) continue;
        if (matches(format->second, answer->second, cells.kind)) {
            result.add(cells, format->second.code);
        }
    }
    return result;
}

bool mayBe(const std::optional<Kind>& kind, Kind wanted) { return !kind || *kind == wanted; }

// Formats of one origin that an import judges otherwise than spreadsheet programs do.
struct Misjudged {
    const char* key;
    FormatOrigin origin;
    bool isDate;              // to spreadsheet programs
    const char* where;        // their cells are
    const char* advice = "";  // beside another kind for the column
};

constexpr const char* kReadAsNumbers = "read the column as numbers: ";
constexpr const char* kReadAsDates = "read the column as dates: ";
constexpr const char* kLongCodes = "in formats with codes of more than 1,024 bytes";
constexpr const char* kUnderBuiltIns =
    "in formats of the book's own under the ids of built-in ones";

constexpr Misjudged kMisjudged[] = {
    {"taken-for-dates", FormatOrigin::Usual, false, "in formats with words or colours"},
    {"not-taken-for-dates", FormatOrigin::Usual, true,
     "in formats that the import does not know as dates"},
    {"number-format-count", FormatOrigin::Uncounted, true,
     "in formats beyond the number that the style sheet declares (the count of numFmts)",
     kSaveAgain},
    {"long-format-codes", FormatOrigin::TooLong, false, kLongCodes, "use a shorter code"},
    {"long-format-codes", FormatOrigin::TooLong, true, kLongCodes, "use a shorter code"},
    {"built-in-format-ids", FormatOrigin::BuiltInId, false, kUnderBuiltIns},
    {"built-in-format-ids", FormatOrigin::BuiltInId, true, kUnderBuiltIns},
    {"unlisted-formats", FormatOrigin::Unlisted, false,
     "in formats that stand outside the list of number formats, as in dxfs"},
    {"cells-without-style", FormatOrigin::FirstStyle, true,
     "in cells without a style number, which stands for the first style"},
};

Found misjudged(const Findings& findings, const StyleAnswers& answers, const Misjudged& formats) {
    const bool isDate = formats.isDate;
    const Collected found = collected(findings, answers, [&](auto& format, auto answer, auto kind) {
        return format.origin == formats.origin && format.isDate == isDate &&
               answer.isDate != isDate && mayBe(kind, isDate ? Kind::Number : Kind::DateTime);
    });
    if (found.cells.count == 0) return std::nullopt;
    const std::vector<TraitPlace> places = found.typed(isDate ? "datetime" : "numeric");
    const std::string cure = optionsOf(places);
    std::string advice = (isDate ? kReadAsDates : kReadAsNumbers) + cure;
    if (*formats.advice != '\0') advice += std::string(", or ") + formats.advice;
    return located({formats.key,
                    placed(found.cells, isDate ? "date" : "number") + " " + formats.where + ": " +
                        listed(found.codes, true),
                    isDate ? "day numbers arrive" : "date-times arrive", advice},
                   places, found.allNamed() ? cure : "");
}

}  // namespace

std::vector<Trait> misjudgedFormats(const Findings& findings, const StyleAnswers& answers) {
    std::vector<Trait> traits;
    for (const Misjudged& formats : kMisjudged)
        if (Found found = misjudged(findings, answers, formats))
            traits.push_back(std::move(*found));
    return traits;
}

Found defaultDateStyle(const Findings& findings, const StyleAnswers& answers) {
    const Collected found = collected(findings, answers, [](auto& format, auto answer, auto kind) {
        return answer.isDate && format.isDate && !answer.hasPattern && mayBe(kind, Kind::DateTime);
    });
    if (found.cells.count == 0) return std::nullopt;
    return located({"default-date-style",
                    placed(found.cells, "date") +
                        " in formats without a counterpart: " + listed(found.codes, true),
                    "the values are right, but are displayed in the default date style",
                    "use a format such as m/d/yyyy to choose how they are displayed"},
                   placesOf(found.columns));
}

// The first value decides the kind of the whole column.
Found mixedDates(const Findings& findings, const StyleAnswers& answers) {
    Tally cells;
    for (const auto& [key, styled] : findings.styledCells) {
        const auto format = findings.formats.find(key.style);
        const auto answer = answers.find(key.style);
        const bool isDate = format != findings.formats.end() && format->second.isDate;
        const bool taken = answer != answers.end() && answer->second.isDate;
        const bool mixed = (styled.kind == Kind::Number && isDate && taken) ||
                           (styled.kind == Kind::DateTime && !isDate && !taken);
        if (mixed && !styled.isChosen) cells.add({styled.reference, "", styled.cells.count});
    }
    if (cells.empty()) return std::nullopt;
    return located(
        {"mixed-dates", "dates and numbers in one column: " + cells.text(cells.columns()),
         "the first value of the column decides: dates arrive as day numbers, or numbers as dates",
         "give them columns of their own"},
        placesOf(cells));
}

}  // namespace dp::tool
