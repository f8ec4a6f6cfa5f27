#include "tools/explain/format_traits.h"

#include <algorithm>
#include <cstdio>
#include <set>
#include <string>
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
    Names codes;                          // each one once
    std::vector<std::string> references;  // the columns, each one once
    std::set<std::string> seen;

    void add(const StyledCells& of, const std::string& code) {
        if (cells.count == 0) cells.first = of.cells.first;
        cells.count += of.cells.count;
        if (seen.insert(code).second) codes.add(asDisplayed(code));
        const bool isNew = references.empty() || references.back() != of.reference;
        if (isNew) references.push_back(of.reference);  // they come column by column
    }

    std::string types(const char* type) const {
        std::string text;
        for (const std::string& reference : references) {
            const std::string column = reference.empty() ? "COLUMN" : reference;
            text += (text.empty() ? "--type " : " --type ") + shellWord(column + "=" + type);
        }
        return text;
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

bool isUnknownDate(const UsedFormat& format, const StyleAnswer& answer,
                   const std::optional<Kind>& kind) {
    return format.isDate && !answer.isDate && mayBe(kind, Kind::Number);
}

std::string asDates(const Collected& found) {
    return "read the column as dates: " + found.types("datetime");
}

}  // namespace

Found takenForDates(const Findings& findings, const StyleAnswers& answers) {
    const Collected found = collected(findings, answers, [](auto& format, auto answer, auto kind) {
        return answer.isDate && !format.isDate && mayBe(kind, Kind::DateTime);
    });
    if (found.cells.count == 0) return std::nullopt;
    return Trait{"taken-for-dates",
                 placed(found.cells, "number") +
                     " in formats with words or colours: " + listed(found.codes, true),
                 "date-times arrive", "read the column as numbers: " + found.types("numeric")};
}

Found notTakenForDates(const Findings& findings, const StyleAnswers& answers) {
    const Collected found = collected(findings, answers, [](auto& format, auto answer, auto kind) {
        return isUnknownDate(format, answer, kind) && !format.isUncounted;
    });
    if (found.cells.count == 0) return std::nullopt;
    return Trait{
        "not-taken-for-dates",
        placed(found.cells, "date") +
            " in formats that the import does not know as dates: " + listed(found.codes, true),
        "day numbers arrive", asDates(found)};
}

// An import reads no more formats than the style sheet declares.
Found uncountedFormats(const Findings& findings, const StyleAnswers& answers) {
    const Collected found = collected(findings, answers, [](auto& format, auto answer, auto kind) {
        return isUnknownDate(format, answer, kind) && format.isUncounted;
    });
    if (found.cells.count == 0) return std::nullopt;
    return Trait{"number-format-count",
                 placed(found.cells, "date") +
                     " in formats beyond the number that the style sheet declares (the count "
                     "of numFmts): " +
                     listed(found.codes, true),
                 "day numbers arrive", asDates(found) + ", or " + kSaveAgain};
}

Found defaultDateStyle(const Findings& findings, const StyleAnswers& answers) {
    const Collected found = collected(findings, answers, [](auto& format, auto answer, auto kind) {
        return answer.isDate && format.isDate && !answer.hasPattern && mayBe(kind, Kind::DateTime);
    });
    if (found.cells.count == 0) return std::nullopt;
    return Trait{"default-date-style",
                 placed(found.cells, "date") +
                     " in formats without a counterpart: " + listed(found.codes, true),
                 "the values are right, but are displayed in the default date style",
                 "use a format such as m/d/yyyy to choose how they are displayed"};
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
    return Trait{
        "mixed-dates", "dates and numbers in one column: " + cells.text(cells.columns()),
        "the first value of the column decides: dates arrive as day numbers, or numbers as dates",
        "give them columns of their own"};
}

}  // namespace dp::tool
