#pragma once

#include <cstddef>
#include <map>
#include <optional>
#include <string>
#include <tuple>
#include <vector>

#include "tools/explain/tally.h"
#include "tools/host/column.h"
#include "tools/package/file_kind.h"

namespace dp::tool {

// Cells, ranges or texts with one trait: their number and the first place.
struct Places {
    size_t count = 0;
    std::string first;  // such as "Sheet1!B2"; the worksheet alone when the cell names no place

    void add(const std::string& place) {
        if (count++ == 0) first = place;
    }
};

// Cells with texts where others belong: their places and the first text.
struct WrongTexts {
    Places cells;
    std::string first;

    void add(const std::string& place, const std::string& text) {
        if (cells.count == 0) first = text;
        cells.add(place);
    }
};

// A part that the package has under another name than the one that the import looks for.
struct MovedPart {
    std::string wanted;
    std::string found;
};

// Where a number format stands, because of which an import may not find it.
enum class FormatOrigin {
    Usual,
    TooLong,     // its code is longer than an import reads
    BuiltInId,   // the workbook's own, under the id of a built-in one
    Uncounted,   // beyond the number of formats that the style sheet declares
    Unlisted,    // outside the list of number formats, as those of conditional formats are
    FirstStyle,  // that of the first cell style, for cells that name no style
};

// The number format of a cell style that cells with numbers use.
struct UsedFormat {
    std::string code;  // "built-in 30" for one that has none
    bool isDate;       // by the rules of spreadsheet programs
    FormatOrigin origin;
};

// The cells of one style in one column.
struct StyledColumn {
    size_t worksheet;  // its place in the book
    unsigned column;   // 1-based, 0 when the cells name none
    int style;         // or one of the following

    static constexpr int kBoolean = -1;  // Booleans, whose number format does not count
    static constexpr int kNone = -2;     // cells that name no style
    bool operator<(const StyledColumn& other) const {
        return std::tie(worksheet, column, style) <
               std::tie(other.worksheet, other.column, other.style);
    }
};

struct StyledCells {
    Places cells;
    std::string reference;     // the column in the form that options accept; empty when not known
    std::optional<Kind> kind;  // the kind that the import gave the column, if it was imported
    bool isChosen = false;     // the kind was set by an option
};

// A number of names, of which the first few are kept.
struct Names {
    size_t count = 0;
    std::vector<std::string> first;

    void add(const std::string& name) {
        constexpr size_t kMost = 3;
        if (count++ < kMost) first.push_back(name);
    }
};

// What the inspection of a file found.
struct Findings {
    FileKind kind = FileKind::Workbook;
    bool namedXlsx = true;

    Names lostWorksheets;  // without a relationship that leads to their part
    Names prefixedParts;
    std::string prefixedName;  // the first one, such as "x:workbook"
    // Notes a part whose elements have a prefix, with the name of the first such element in it.
    void notePrefix(const std::string& part, const std::string& writtenName) {
        prefixedParts.add(part);
        if (prefixedName.empty()) prefixedName = writtenName;
    }
    bool workbookPrefixed = false;
    bool relationshipPrefixed = false;  // a worksheet's id has another prefix than r:id
    bool stringsPrefixed = false;
    bool stylesPrefixed = false;
    Names prefixedWorksheets;

    bool stringsWithoutCount = false;
    size_t sharedTexts = 0;  // cells
    Places missingTexts;     // cells whose text the table does not have
    Places cdataTexts;       // cells with shared texts in CDATA sections
    Places isoDates;
    bool datesFrom1904 = false;
    bool hasStyles = true;
    std::vector<MovedPart> moved;

    std::map<int, UsedFormat> formats;  // by index of the cell style
    std::map<StyledColumn, StyledCells> styledCells;
    Places formulas;        // without a saved value
    Places numbersAsNames;  // in rows of names that hold no text
    Places mergedRanges;
    Places phoneticTexts;  // cells with shared texts
    Places phoneticCells;  // inline texts
    Places errors;
    Names hiddenWorksheets;       // those that are imported
    Places runs;                  // inline texts of several runs
    Places inlineValues;          // inline texts of cells that have a value too
    Places pieces;                // values and inline texts of which only the first piece arrives
    Places booleanWords;          // TRUE in letters
    WrongTexts notNumbers;        // in cells of numbers
    WrongTexts notBooleans;       // in cells of Booleans
    Places lowerCase;             // cells with content whose reference has lower-case letters
    std::string lowerCaseColumn;  // the column in which the first of them arrives
    bool lowerCaseFails = false;  // one of them is beyond the last column
    std::vector<std::string> broken;  // parts that are missing, malformed or cut off

    // What the import lost; this cannot be seen in the package alone.
    Lost lost;
    int textLimit = 0;  // bytes
};

}  // namespace dp::tool
