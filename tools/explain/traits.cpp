#include "tools/explain/traits.h"

#include <algorithm>
#include <iterator>
#include <string>
#include <string_view>
#include <utility>

#include "tools/host/exit_code.h"
#include "tools/views/text.h"

namespace dp::tool {

namespace {

// Cells or ranges that all have the same effect.
struct CellTrait {
    const char* key;
    Places Findings::*cells;
    const char* unit;  // one of them
    const char* what;  // they are, behind their places
    const char* effect;
    const char* advice;
    const char* note = "";
    const char* cure = "";
};

constexpr CellTrait kMissingTexts{
    "shared-strings-missing",
    &Findings::missingTexts,
    "cell",
    "with a text that the package does not have (xl/sharedStrings.xml)",
    "the texts are missing",
    "get a fresh copy, or open the book in a spreadsheet program and save it as .xlsx again",
    "the shared texts are missing"};
constexpr CellTrait kIsoDates{
    "iso-dates",
    &Findings::isoDates,
    "date",
    "written as ISO text",
    "only the number at the beginning arrives: the year of a date",
    "save the book as an ordinary .xlsx, not in the strict variant of the format",
    "of dates written as ISO text only the year arrives, as a number"};
constexpr CellTrait kFormulas{
    "formulas-without-values",
    &Findings::formulas,
    "formula",
    "without a saved value",
    "a missing value arrives",
    "open the book in a spreadsheet program, let it calculate, and save it"};
constexpr CellTrait kNumbersAsNames{
    "numbers-as-names",
    &Findings::numbersAsNames,
    "number",
    "and no text in the row of names",
    "they become names, not data",
    "if they are data: --names none; if the names are in another row: --name-row ROW",
    "",
    "--names none"};
constexpr CellTrait kMergedCells{
    "merged-cells",
    &Findings::mergedRanges,
    "merged range",
    "",
    "only the top left cell of each has a value, the others are missing",
    "unmerge the ranges and fill their cells where the value applies to all of them"};
constexpr CellTrait kErrorCells{
    "error-cells",
    &Findings::errors,
    "cell",
    "with an error such as #DIV/0!",
    "a missing value arrives, or no row where it is the last of its column",
    "correct the formula where a value is expected"};
constexpr CellTrait kInlineRuns{"inline-runs",
                                &Findings::runs,
                                "cell",
                                "with an inline text of several pieces",
                                "only the last piece arrives",
                                kSaveAgain};
constexpr CellTrait kInlineValues{"inline-values",
                                  &Findings::inlineValues,
                                  "cell",
                                  "with an inline text and a value",
                                  "the value arrives in place of the text",
                                  kSaveAgain};
constexpr CellTrait kCdataTexts{"cdata-texts",
                                &Findings::cdataTexts,
                                "cell",
                                "with a shared text in CDATA sections",
                                "the content of the sections is missing",
                                kSaveAgain};
constexpr CellTrait kPieces{"values-in-pieces",
                            &Findings::pieces,
                            "cell",
                            "with a value or text divided by CDATA sections or comments",
                            "only the first piece arrives",
                            kSaveAgain};
constexpr CellTrait kBooleanWords{"booleans-as-words",
                                  &Findings::booleanWords,
                                  "Boolean",
                                  "written as a word such as true",
                                  "0 arrives, as for FALSE",
                                  kSaveAgain};

std::vector<TraitPlace> placesOf(const Names& worksheets) {
    std::vector<TraitPlace> places;
    for (const std::string& title : worksheets.first) places.push_back({title});
    return places;
}

Found found(const Findings& findings, const CellTrait& trait) {
    const Places& cells = findings.*trait.cells;
    if (cells.count == 0) return std::nullopt;
    std::string what = placed(cells, trait.unit);
    if (*trait.what != '\0') what += std::string(" ") + trait.what;
    return located({trait.key, what, trait.effect, trait.advice, false, trait.note},
                   {{cells.first}}, trait.cure);
}

Found found(const Findings& findings, Found (*trait)(const Findings&)) { return trait(findings); }

Found namespacePrefix(const Findings& findings) {
    const bool fatal = findings.workbookPrefixed || findings.relationshipPrefixed;
    if (!fatal && findings.prefixedParts.count == 0) return std::nullopt;
    std::vector<std::string> found;
    if (findings.prefixedParts.count > 0) {
        found.push_back("elements have a namespace prefix, such as <" + findings.prefixedName +
                        "> (in " + listed(findings.prefixedParts, false) + ")");
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

Found datesFrom1904(const Findings& findings) {
    if (!findings.datesFrom1904) return std::nullopt;
    return Trait{"date-system-1904",
                 "the book counts its dates from 1904",
                 "dates arrive 1,462 days early",
                 "add 1462 to them after the import",
                 false,
                 "dates, if there are any, arrive 1,462 days early"};
}

Found lostWorksheets(const Findings& findings) {
    const Names& sheets = findings.lostWorksheets;
    if (sheets.count == 0) return std::nullopt;
    const bool one = sheets.count == 1;
    return located(
        {"worksheet-without-part",
         worksheets(sheets) + " for which the package has no relationship to a worksheet's "
                              "part (xl/_rels/workbook.xml.rels)",
         one ? "it is not imported" : "they are not imported",
         "get a fresh copy, or " + std::string(kSaveAgain), false,
         worksheets(sheets) + (one ? " is not imported" : " are not imported")},
        placesOf(sheets));
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
    {FileKind::OldWorkbook, "old-workbook",
     "the file is a workbook in the old binary format (.xls)", kSaveAsWorkbook},
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
                 "copy it to a name that does", true};
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
    const bool textsOnly = findings.moved.size() == 1 && first.wanted == kStrings;
    std::string found =
        "the package has " + quoted(first.found) + " where " + quoted(first.wanted) + " belongs";
    if (findings.moved.size() > 1) {
        found += ", and " + counted(findings.moved.size() - 1, "more part") + " under other names";
    }
    return Trait{"part-names", found, textsOnly ? "the shared texts are missing" : kOpenFails,
                 kSaveAgain, !textsOnly};
}

Found shownInTexts(const Findings& findings) {
    const Tally& cells = findings.lost.shown;
    if (cells.empty()) return std::nullopt;
    return located(
        {"shown-in-texts",
         counted(cells.total(), "number or date", "numbers or dates") +
             " in columns of texts: " + cells.text(cells.columns()),
         "they arrive as displayed: what their formats do not show is lost",
         "put them into columns of their own, or give them formats that show all of the value"},
        placesOf(cells));
}

Found phoneticTexts(const Findings& findings) {
    std::vector<std::string> found;
    std::vector<std::string> effects;
    std::vector<TraitPlace> places;
    if (findings.phoneticTexts.count > 0) {
        places.push_back({findings.phoneticTexts.first});
        found.push_back(placed(findings.phoneticTexts, "cell") +
                        " with phonetic readings in a shared text");
        effects.emplace_back("the readings are appended to the texts");
    }
    if (findings.phoneticCells.count > 0) {
        places.push_back({findings.phoneticCells.first});
        found.push_back(placed(findings.phoneticCells, "inline text") + " with phonetic readings");
        effects.emplace_back("the readings replace inline texts");
    }
    if (found.empty()) return std::nullopt;
    return located({"phonetic-texts", joined(found, ", "), joined(effects, ", "),
                    "delete the phonetic guides in a spreadsheet program"},
                   places);
}

Found hiddenWorksheets(const Findings& findings) {
    if (findings.hiddenWorksheets.count == 0) return std::nullopt;
    const std::string cure =
        "--exclude-sheet " + shellWord(findings.hiddenWorksheets.first.front());
    return located({"hidden-worksheets", "hidden " + worksheets(findings.hiddenWorksheets),
                    "imported like the visible ones", "to leave one out: " + cure},
                   placesOf(findings.hiddenWorksheets), cure);
}

std::string described(const WrongTexts& texts, const std::string& type) {
    return placed(texts.cells, "cell") + " of type " + type + " with " +
           (texts.cells.count == 1 ? "" : "texts such as ") + quoted(texts.first);
}

Found notNumbers(const Findings& findings) {
    if (findings.notNumbers.cells.count == 0) return std::nullopt;
    return located({"not-a-number", described(findings.notNumbers, "number"),
                    "the number at the beginning of such a text arrives (0x10 is 16), or 0",
                    "let the program that makes the book write plain numbers, such as 1.5"},
                   {{findings.notNumbers.cells.first}});
}

Found notBooleans(const Findings& findings) {
    if (findings.notBooleans.cells.count == 0) return std::nullopt;
    return located({"not-a-boolean", described(findings.notBooleans, "Boolean"),
                    "the number at the beginning of such a text arrives, or 0",
                    "let the program that makes the book write 0 or 1"},
                   {{findings.notBooleans.cells.first}});
}

Found lowerCase(const Findings& findings) {
    if (findings.lowerCase.count == 0) return std::nullopt;
    const std::string found =
        placed(findings.lowerCase, "cell") + " with lower-case letters in the reference";
    if (findings.lowerCaseFails) {
        return located({"lower-case-references", found, kOpenFails, kSaveAgain, true},
                       {{findings.lowerCase.first}});
    }
    const std::string first = findings.lowerCase.count == 1 ? "it" : "the first one";
    return located({"lower-case-references", found,
                    first + " arrives in column " + findings.lowerCaseColumn +
                        (findings.lowerCase.count == 1 ? "" : ", the others are moved as well"),
                    kSaveAgain},
                   {{findings.lowerCase.first}});
}

Found lostCells(const Findings& findings) {
    const Tally& cells = findings.lost.cells;
    if (cells.empty()) return std::nullopt;
    std::vector<TraitPlace> places = placesOf(cells);
    for (TraitPlace& place : places) place.options = "--type " + shellWord(place.place + "=text");
    const std::string cure = optionsOf(places);
    return located({"lost-on-conversion",
                    counted(cells.total(), "cell") + (cells.total() == 1 ? " does" : " do") +
                        " not fit the kind of the column: " + cells.text(cells.columns()),
                    "a missing value arrives", "to keep the content as displayed: " + cure},
                   places, cure);
}

Found unreadableCells(const Findings& findings) {
    const Tally& cells = findings.lost.unreadable;
    if (cells.empty()) return std::nullopt;
    return located(
        {"unreadable-cells",
         counted(cells.total(), "cell") + (cells.total() == 1 ? " holds" : " hold") +
             " something else than the type of the cell says: " + cells.text(cells.columns()),
         "a missing value arrives", "to keep the content, correct it in the workbook"},
        placesOf(cells));
}

Found longTexts(const Findings& findings) {
    const Tally& texts = findings.lost.cutTexts;
    if (texts.empty()) return std::nullopt;
    const std::string cure = "--max-text " + std::to_string(findings.lost.longest);
    return located(
        {"long-texts",
         counted(texts.total(), "text") + " longer than " + std::to_string(findings.textLimit) +
             " bytes: " + texts.text(texts.columns()),
         "the rest is cut off", "to keep all of it: " + cure},
        placesOf(texts), cure);
}

void add(std::vector<Trait>& traits, Found trait) {
    if (trait) traits.push_back(std::move(*trait));
}

// Adds those that are found, in this order.
template <class... Sources>
void addAll(std::vector<Trait>& traits, const Findings& findings, const Sources&... sources) {
    (add(traits, found(findings, sources)), ...);
}

// An import by the standard gives what spreadsheet programs show.
constexpr std::string_view kCuredByStandard[] = {
    "namespace-prefix",    "shared-strings-without-count",
    "iso-dates",           "date-system-1904",
    "no-style-sheet",      "part-names",
    "taken-for-dates",     "not-taken-for-dates",
    "number-format-count", "built-in-format-ids",
    "unlisted-formats",    "cells-without-style",
    "default-date-style",  "phonetic-texts",
    "inline-runs",         "inline-values",
    "cdata-texts",         "values-in-pieces",
    "booleans-as-words",   "lower-case-references",
};

bool isCuredByStandard(const Trait& trait) {
    return std::find(std::begin(kCuredByStandard), std::end(kCuredByStandard), trait.key) !=
           std::end(kCuredByStandard);
}

// What an import by the standard does differently with what it cannot cure.
struct StandardEffect {
    std::string_view key;
    const char* effect;
};

constexpr StandardEffect kStandardEffects[] = {
    {"error-cells", "a missing value arrives"},
    {"not-a-number", "a missing value arrives"},
    {"not-a-boolean", "a missing value arrives"},
};

}  // namespace

std::vector<Trait> underRules(std::vector<Trait> traits, bool standard) {
    if (!standard) {
        for (Trait& trait : traits) {
            if (!isCuredByStandard(trait)) continue;
            trait.advice.insert(0, "use --standard, or ");
            trait.cures.insert(trait.cures.begin(), "--standard");
            if (!trait.note.empty()) trait.note += " (--standard cures it)";
        }
        return traits;
    }
    std::erase_if(traits, isCuredByStandard);
    for (Trait& trait : traits)
        for (const StandardEffect& changed : kStandardEffects)
            if (trait.key == changed.key) trait.effect = changed.effect;
    return traits;
}

std::vector<Trait> traitsOf(const Findings& findings, const StyleAnswers& answers) {
    std::vector<Trait> traits = quickTraitsOf(findings);
    addAll(traits, findings, noStyleSheet, movedParts, lostCells, unreadableCells, longTexts,
           shownInTexts, kFormulas, kNumbersAsNames);
    if (!findings.stylesPrefixed) {  // otherwise the prefix explains what happens to the formats
        for (Trait& trait : misjudgedFormats(findings, answers)) add(traits, std::move(trait));
        for (const auto trait : {mixedDates, defaultDateStyle})
            add(traits, trait(findings, answers));
    }
    addAll(traits, findings, kMergedCells, phoneticTexts, kErrorCells, hiddenWorksheets,
           kInlineRuns, kInlineValues, kCdataTexts, kPieces, kBooleanWords, notNumbers, notBooleans,
           lowerCase);
    return traits;
}

std::vector<Trait> quickTraitsOf(const Findings& findings) {
    std::vector<Trait> traits;
    addAll(traits, findings, namespacePrefix, stringsWithoutCount, kMissingTexts, lostWorksheets,
           kIsoDates, datesFrom1904, otherFile);
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
    return {"unreadable", "a part of the package has content that an import cannot read",
            kOpenFails, kSaveAgain, true};
}

}  // namespace dp::tool
