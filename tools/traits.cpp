#include "tools/traits.h"

#include <algorithm>
#include <optional>
#include <set>

#include "tools/exit_code.h"
#include "tools/text.h"

namespace dp::tool {

namespace {

using Found = std::optional<Trait>;

constexpr const char* kOpenFails = "the import fails";
constexpr const char* kSaveAgain =
    "open the book in a spreadsheet program and save it as .xlsx again";

std::string quoted(const std::string& text) { return "\"" + text + "\""; }

// "A", "B", "C" and 4 more
std::string listed(const Names& names, bool quotes) {
    std::string text;
    for (const std::string& name : names.first) {
        text += (text.empty() ? "" : ", ") + (quotes ? quoted(name) : name);
    }
    if (names.count > names.first.size()) {
        text += " and " + std::to_string(names.count - names.first.size()) + " more";
    }
    return text;
}

std::string worksheets(const Names& names) {
    return (names.count == 1 ? "worksheet " : "worksheets ") + listed(names, true);
}

std::string placed(const Places& places, const std::string& unit) {
    const std::string first = places.count == 1 ? " (" : " (first: ";
    return counted(places.count, unit) + first + places.first + ")";
}

// For the column of a place such as "Data!B2"; a cell that names no place has no known column.
std::string typeOption(const std::string& place, const char* type) {
    const std::string column = place.substr(0, place.find_last_not_of("0123456789") + 1);
    const bool known = place.rfind('!') < column.size() && column.size() < place.size();
    return "--type " + (known ? shellWord(column + "=" + type) : std::string("COLUMN=") + type);
}

std::string joined(const std::vector<std::string>& texts, const char* between) {
    std::string result;
    for (const std::string& text : texts) result += (result.empty() ? "" : between) + text;
    return result;
}

Found namespacePrefix(const Findings& findings) {
    const bool fatal = findings.workbookPrefixed || findings.relationshipPrefixed;
    if (!fatal && findings.prefixedParts.count == 0) return std::nullopt;
    std::vector<std::string> found;
    if (findings.prefixedParts.count > 0) {
        found.push_back("elements of " + listed(findings.prefixedParts, false) +
                        " have a namespace prefix, such as <" + findings.prefixedName + ">");
    }
    if (findings.relationshipPrefixed) {
        found.emplace_back("the worksheets' r:id has another prefix in xl/workbook.xml");
    }
    std::vector<std::string> effects;
    const Names& sheets = findings.prefixedWorksheets;
    if (sheets.count > 0) {
        effects.push_back(worksheets(sheets) + (sheets.count == 1 ? " comes" : " come") +
                          " out empty");
    }
    if (findings.stringsPrefixed) effects.emplace_back("the shared texts are missing");
    if (findings.stylesPrefixed) effects.emplace_back("dates arrive as day numbers");
    const std::string effect = fatal ? kOpenFails : joined(effects, ", ");
    return Trait{"namespace-prefix", joined(found, ", "), effect, kSaveAgain, fatal, effect};
}

Found stringsWithoutCount(const Findings& findings) {
    if (!findings.stringsWithoutCount) return std::nullopt;
    const std::string cells =
        findings.sharedTexts > 0 ? " (" + counted(findings.sharedTexts, "cell") + ")" : "";
    return Trait{"shared-strings-without-count",
                 "the table of shared texts does not say how many there are (uniqueCount)",
                 "the texts that cells take from it are missing" + cells,
                 kSaveAgain,
                 false,
                 "the shared texts are missing"};
}

Found missingTexts(const Findings& findings) {
    if (findings.missingTexts.count == 0) return std::nullopt;
    return Trait{"shared-strings-missing",
                 placed(findings.missingTexts, "cell") +
                     " with a text that the package does not have (xl/sharedStrings.xml)",
                 "the texts are missing",
                 "get a fresh copy, or " + std::string(kSaveAgain),
                 false,
                 "the shared texts are missing"};
}

Found isoDates(const Findings& findings) {
    if (findings.isoDates.count == 0) return std::nullopt;
    return Trait{"iso-dates",
                 placed(findings.isoDates, "date") + " written as ISO text",
                 "only the number of the year arrives",
                 "save the book as \"Excel Workbook\", not as \"Strict Open XML\"",
                 false,
                 "of dates written as ISO text only the number of the year arrives"};
}

Found datesFrom1904(const Findings& findings) {
    if (!findings.datesFrom1904) return std::nullopt;
    return Trait{"date-system-1904",
                 "the book counts its dates from 1904",
                 "dates arrive 1,462 days early",
                 "add 1462 to them after the import, or turn the option \"1904 date system\" off "
                 "and check the dates",
                 false,
                 "dates arrive 1,462 days early"};
}

struct OtherFile {
    FileKind kind;
    const char* key;
    const char* found;
    const char* advice;
};

constexpr const char* kSaveAsWorkbook = "open it in a spreadsheet program and save it as .xlsx";

constexpr OtherFile kOtherFiles[] = {
    {FileKind::PasswordProtected, "password-protected", "the book is protected with a password",
     "save it without one"},
    {FileKind::OldWorkbook, "old-workbook", "the file is a binary workbook of old (.xls)",
     kSaveAsWorkbook},
    {FileKind::OtherCompound, "not-a-package",
     "the file is a document of an old office program, not a workbook", kSaveAsWorkbook},
    {FileKind::Spreadsheet2003, "spreadsheet-2003", "the file is an XML Spreadsheet 2003 document",
     kSaveAsWorkbook},
    {FileKind::WebPage, "web-page", "the file is a web page", kSaveAsWorkbook},
    {FileKind::PlainText, "plain-text", "the file is plain text, such as CSV", kSaveAsWorkbook},
    {FileKind::Empty, "empty-file", "the file is empty", "get a fresh copy"},
    {FileKind::CutPackage, "cut-package", "the package is cut off or damaged", "get a fresh copy"},
    {FileKind::OpenDocument, "open-document", "the file is an OpenDocument file, such as .ods",
     kSaveAsWorkbook},
    {FileKind::TextDocument, "text-document", "the file is a text document (.docx)",
     "copy its tables into a workbook"},
    {FileKind::Presentation, "presentation", "the file is a presentation (.pptx)",
     "copy its tables into a workbook"},
    {FileKind::BinaryWorkbook, "binary-workbook", "the file is a binary workbook (.xlsb)",
     kSaveAsWorkbook},
    {FileKind::OtherArchive, "other-archive", "the file is a ZIP archive without a workbook",
     "name the workbook itself; if it is inside, unpack it first"},
    {FileKind::Unknown, "not-a-package", "the file is no workbook of any known kind",
     "check where it comes from"},
};

Found otherFile(const Findings& findings) {
    const auto entry =
        std::find_if(std::begin(kOtherFiles), std::end(kOtherFiles),
                     [&](const OtherFile& file) { return file.kind == findings.kind; });
    if (entry != std::end(kOtherFiles)) {
        return Trait{entry->key, entry->found, kOpenFails, entry->advice, true};
    }
    if (findings.namedXlsx) return std::nullopt;
    return Trait{"other-name", "the file's name does not end in .xlsx", kOpenFails,
                 "copy it under such a name", true};
}

Found noStyleSheet(const Findings& findings) {
    const bool workbook = findings.kind == FileKind::Workbook;
    if (!workbook || findings.hasStyles) return std::nullopt;
    return Trait{"no-style-sheet", "the package has no style sheet (xl/styles.xml)", kOpenFails,
                 kSaveAgain, true};
}

Found movedParts(const Findings& findings) {
    if (findings.moved.empty()) return std::nullopt;
    const MovedPart& first = findings.moved.front();
    const bool textsOnly = findings.moved.size() == 1 && first.wanted == "xl/sharedStrings.xml";
    std::string found =
        "the package has " + quoted(first.found) + " where " + quoted(first.wanted) + " belongs";
    if (findings.moved.size() > 1) {
        found += ", and " + counted(findings.moved.size() - 1, "more part") + " under other names";
    }
    return Trait{"part-names", found, textsOnly ? "the shared texts are missing" : kOpenFails,
                 kSaveAgain, !textsOnly};
}

// The code without the backslashes, which spreadsheet programs do not show.
std::string asDisplayed(std::string code) {
    code.erase(std::remove(code.begin(), code.end(), '\\'), code.end());
    return code;
}

// The formats for which `matches(format, answer)` holds, as one trait. Formats of one code are
// counted together.
template <class Matches>
Places collected(const Findings& findings, const std::map<int, StyleAnswer>& answers, Names& codes,
                 Matches matches) {
    Places cells;
    std::set<std::string> seen;
    for (const auto& [style, format] : findings.formats) {
        const auto answer = answers.find(style);
        if (answer == answers.end() || !matches(format, answer->second)) continue;
        if (cells.count == 0) cells.first = format.cells.first;
        cells.count += format.cells.count;
        if (seen.insert(format.code).second) codes.add(asDisplayed(format.code));
    }
    return cells;
}

Found takenForDates(const Findings& findings, const std::map<int, StyleAnswer>& answers) {
    Names codes;
    const Places cells = collected(findings, answers, codes, [](const auto& format, auto answer) {
        return answer.isDate && !format.isDate;
    });
    if (cells.count == 0) return std::nullopt;
    return Trait{
        "taken-for-dates",
        placed(cells, "number") + " in formats with words or colours: " + listed(codes, true),
        "date-times arrive", "read the column as numbers: " + typeOption(cells.first, "numeric")};
}

Found notTakenForDates(const Findings& findings, const std::map<int, StyleAnswer>& answers) {
    Names codes;
    const Places cells = collected(findings, answers, codes, [](const auto& format, auto answer) {
        return !answer.isDate && format.isDate;
    });
    if (cells.count == 0) return std::nullopt;
    return Trait{"not-taken-for-dates",
                 placed(cells, "date") +
                     " in formats that the import does not know as dates: " + listed(codes, true),
                 "day numbers arrive",
                 "read the column as dates: " + typeOption(cells.first, "datetime")};
}

Found defaultDateStyle(const Findings& findings, const std::map<int, StyleAnswer>& answers) {
    Names codes;
    const Places cells = collected(findings, answers, codes, [](const auto& format, auto answer) {
        return answer.isDate && format.isDate && !answer.hasPattern;
    });
    if (cells.count == 0) return std::nullopt;
    return Trait{
        "default-date-style",
        placed(cells, "date") + " in formats without a counterpart: " + listed(codes, true),
        "the values are right, the look is that of the default date style",
        "to keep the look, use a format such as m/d/yyyy"};
}

Found mergedCells(const Findings& findings) {
    if (findings.mergedRanges.count == 0) return std::nullopt;
    return Trait{"merged-cells", placed(findings.mergedRanges, "merged range"),
                 "only the top left cell of each has a value, the others are missing",
                 "unmerge the ranges and fill their cells where the value stands for all"};
}

Found phoneticTexts(const Findings& findings) {
    std::vector<std::string> found;
    std::vector<std::string> effects;
    if (findings.phoneticTexts > 0) {
        found.push_back(counted(findings.phoneticTexts, "shared text") + " with phonetic readings");
        effects.emplace_back("the readings follow the texts");
    }
    if (findings.phoneticCells.count > 0) {
        found.push_back(placed(findings.phoneticCells, "inline text") + " with phonetic readings");
        effects.emplace_back("the readings replace inline texts");
    }
    if (found.empty()) return std::nullopt;
    return Trait{"phonetic-texts", joined(found, ", "), joined(effects, ", "),
                 "delete the phonetic guides in a spreadsheet program"};
}

Found errorCells(const Findings& findings) {
    if (findings.errors.count == 0) return std::nullopt;
    return Trait{"error-cells", placed(findings.errors, "cell") + " with an error such as #DIV/0!",
                 "a missing value arrives, and no row behind the last value of a column",
                 "mend the formula where a value is expected"};
}

Found hiddenWorksheets(const Findings& findings) {
    if (findings.hiddenWorksheets.count == 0) return std::nullopt;
    return Trait{
        "hidden-worksheets", "hidden " + worksheets(findings.hiddenWorksheets),
        "imported like the visible ones",
        "to leave one out: --exclude-sheet " + shellWord(findings.hiddenWorksheets.first.front())};
}

Found inlineRuns(const Findings& findings) {
    if (findings.runs.count == 0) return std::nullopt;
    return Trait{"inline-runs",
                 placed(findings.runs, "cell") + " with an inline text of several pieces",
                 "only the last piece arrives", kSaveAgain};
}

Found inlineValues(const Findings& findings) {
    if (findings.inlineValues.count == 0) return std::nullopt;
    return Trait{"inline-values",
                 placed(findings.inlineValues, "cell") + " with an inline text and a value",
                 "the value arrives in place of the text", kSaveAgain};
}

Found cdataTexts(const Findings& findings) {
    if (findings.cdataTexts == 0) return std::nullopt;
    return Trait{"cdata-texts", counted(findings.cdataTexts, "shared text") + " in CDATA sections",
                 "what stands in them is missing", kSaveAgain};
}

Found lostCells(const Findings& findings) {
    const Tally& cells = findings.lost.cells;
    if (cells.empty()) return std::nullopt;
    return Trait{"lost-on-conversion",
                 counted(cells.total(), "cell") + (cells.total() == 1 ? " does" : " do") +
                     " not fit the kind of the column: " + cells.text(cells.columns()),
                 "a missing value arrives",
                 "to keep the content: " + cells.textTypes(cells.columns())};
}

Found longTexts(const Findings& findings) {
    const Tally& texts = findings.lost.cutTexts;
    if (texts.empty()) return std::nullopt;
    return Trait{"long-texts",
                 counted(texts.total(), "text") + " longer than " +
                     std::to_string(findings.textLimit) + " bytes: " + texts.text(texts.columns()),
                 "what is longer is cut off",
                 "to keep all of it: --max-text " + std::to_string(findings.lost.longest)};
}

void add(std::vector<Trait>& traits, Found found) {
    if (found) traits.push_back(std::move(*found));
}

}  // namespace

std::vector<Trait> traitsOf(const Findings& findings, const std::map<int, StyleAnswer>& answers) {
    std::vector<Trait> traits = quickTraitsOf(findings);
    add(traits, noStyleSheet(findings));
    add(traits, movedParts(findings));
    add(traits, lostCells(findings));
    add(traits, longTexts(findings));
    if (!findings.stylesPrefixed) {  // else that explains what becomes of the formats
        add(traits, takenForDates(findings, answers));
        add(traits, notTakenForDates(findings, answers));
        add(traits, defaultDateStyle(findings, answers));
    }
    for (const auto trait : {mergedCells, phoneticTexts, errorCells, hiddenWorksheets, inlineRuns,
                             inlineValues, cdataTexts}) {
        add(traits, trait(findings));
    }
    return traits;
}

std::vector<Trait> quickTraitsOf(const Findings& findings) {
    std::vector<Trait> traits;
    for (const auto trait :
         {namespacePrefix, stringsWithoutCount, missingTexts, isoDates, datesFrom1904, otherFile}) {
        add(traits, trait(findings));
    }
    return traits;
}

Trait unreadableTrait(const Findings& findings, int code) {
    if (code == kReadFailure) {
        return {"unreadable", "an entry of the package cannot be unpacked", kOpenFails,
                "get a fresh copy of the file, or free some space if the disk is full", true};
    }
    if (!findings.broken.empty()) {
        return {"unreadable", quoted(findings.broken.front()) + " is missing or damaged",
                kOpenFails, "get a fresh copy, or " + std::string(kSaveAgain), true};
    }
    return {"unreadable", "a part of the package holds what an import cannot read", kOpenFails,
            kSaveAgain, true};
}

}  // namespace dp::tool
