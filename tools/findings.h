#pragma once

#include <cstddef>
#include <map>
#include <optional>
#include <string>
#include <tuple>
#include <vector>

#include "tools/column.h"
#include "tools/file_kind.h"
#include "tools/tally.h"

namespace dp::tool {

// Cells, ranges or texts with one trait. Only the first place is kept, however many there are.
struct Places {
    size_t count = 0;
    std::string first;  // such as "Sheet1!B2"; the worksheet alone when the cell names no place

    void add(const std::string& place) {
        if (count++ == 0) first = place;
    }
};

// A part that the package has, but not under the name at which the import looks.
struct MovedPart {
    std::string wanted;
    std::string found;
};

// A number format of cells with numbers.
struct UsedFormat {
    std::string code;  // "built-in 30" for one that has none
    bool isDate;       // by the rules of spreadsheet programs
    bool isUncounted;  // beyond the number of formats that the style sheet declares
};

// The cells of one style in one column.
struct StyledColumn {
    size_t worksheet;  // its place in the book
    unsigned column;   // 1-based, 0 when the cells name none
    int style;         // kBoolean for Booleans, which have no number format to go by

    static constexpr int kBoolean = -1;
    bool operator<(const StyledColumn& other) const {
        return std::tie(worksheet, column, style) <
               std::tie(other.worksheet, other.column, other.style);
    }
};

struct StyledCells {
    Places cells;
    std::string reference;     // the column as an option takes it; empty when it is not known
    std::optional<Kind> kind;  // what an import made of the column, when it did
    bool isChosen = false;     // the kind is an option's
};

// Names of which the first few are kept.
struct Names {
    size_t count = 0;
    std::vector<std::string> first;

    void add(const std::string& name) {
        constexpr size_t kMost = 3;
        if (count++ < kMost) first.push_back(name);
    }
};

// What a look into a file found.
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
    bool relationshipPrefixed = false;  // a worksheet's id is written otherwise than r:id
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
    Names hiddenWorksheets;           // those that are imported
    Places runs;                      // inline texts of several runs
    Places inlineValues;              // inline texts of cells that have a value too
    Places pieces;                    // values and inline texts of which a first piece arrives
    Places booleanWords;              // TRUE in letters
    Places notNumbers;                // texts where numbers belong
    std::string notNumber;            // the first of them
    Places lowerCase;                 // references, of cells with content
    std::string lowerCaseColumn;      // where the first of them arrives
    bool lowerCaseFails = false;      // one of them is beyond the last column
    std::vector<std::string> broken;  // parts that are missing or break off

    // What an import lost, which the package alone does not show.
    Lost lost;
    int textLimit = 0;  // bytes
};

}  // namespace dp::tool
