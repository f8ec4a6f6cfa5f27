#include "tools/options/option_table.h"

#include "tools/options/option_values.h"

namespace dp::tool {

namespace {

constexpr unsigned kLastRow = 1048576;
constexpr unsigned kMostCharacters = 65535;

template <unsigned least, unsigned most>
unsigned wholeFrom(const Given& given) {
    return wholeValue(given, least, most);
}

// What an option does: the member that takes its value, and the function that reads the value.

template <class T>
T& field(Options& options, T Options::*member) {
    return options.*member;
}

template <class T>
T& field(Options& options, T ReadSettings::*member) {
    return options.settings.*member;
}

template <auto member>
constexpr OptionAction flag = {
    Takes::Nothing, [](Options& options, const Given&) { field(options, member) = true; }};

template <auto member, auto read>
constexpr OptionAction value = {Takes::Value, [](Options& options, const Given& given) {
                                    field(options, member) = read(given);
                                }};

template <auto member, auto read>
constexpr OptionAction values = {Takes::ValueEachTime, [](Options& options, const Given& given) {
                                     field(options, member).push_back(read(given));
                                 }};

void chooseView(Options& options, View view) {
    if (options.view != View::Tables) wrongUsage(kOneView);
    options.view = view;
}

template <View chosen>
constexpr OptionAction viewed = {
    Takes::Nothing, [](Options& options, const Given&) { chooseView(options, chosen); }};

template <View chosen>
constexpr OptionAction target = {Takes::ValueOrNothing, [](Options& options, const Given& given) {
                                     chooseView(options, chosen);
                                     if (!given.value.empty()) options.target = given.value;
                                 }};

constexpr OptionRow kOutput[] = {
    {"--list", "", "names of the worksheets, without reading cells", "", viewed<View::Names>},
    {"--explain", "", "what the import does to this book that may surprise",
     "; with `--json` as data", flag<&Options::explain>},
    {"--csv", "FILE|DIR/|-", "values as CSV; several worksheets go into a folder",
     ", several workbooks into a folder each; to standard output unless a file or folder is given",
     target<View::Csv>},
    {"--json", "FILE|-", "all that a host can read, or what `--explain` finds",
     ", one line a workbook; to standard output unless a file is given", target<View::Json>},
    {"--page", "FILE|-", "a page to look at in a browser",
     ": layout, first rows, columns, what `--explain` finds; one HTML file that needs no other",
     target<View::Page>},
    {"--as-shown", "", "CSV with values as displayed", ", not in full precision",
     flag<&Options::asShown>},
    {"--head", "N", "first N rows only (tables: 10, page: 50, else all)", "; 0 for none",
     value<&Options::head, wholeFrom<0, kLastRow>>},
    {"--standard", "", "read by the standard, as spreadsheet programs do",
     "; else by the default rules", flag<&Options::standard>},
    {"--sheet", "NAME|KEY", "only this worksheet", ", by its name or its key in the tables",
     values<&Options::sheets, textValue>}};

constexpr OptionRow kRows[] = {
    {"--names", "given|none|infer", "names are in a row (default), nowhere, or inferred",
     "; `infer` takes row 1 when it holds texts and no number",
     value<&ReadSettings::names, namesValue>},
    {"--name-row", "ROW", "row of the names (1)", "",
     value<&ReadSettings::nameRow, wholeFrom<1, kLastRow>>},
    {"--first-row", "ROW", "first row of data (the one after the names)", "",
     value<&ReadSettings::firstRow, wholeFrom<1, kLastRow>>},
    {"--rows", "N", "number of data rows to read", "",
     value<&ReadSettings::rows, wholeFrom<1, kLastRow>>},
    {"--skip-blank-rows", "", "leave out rows without any cell",
     "; cells of columns that are left out do not count", flag<&ReadSettings::skipBlankRows>},
    {"--pad", "", "fill short columns with missing values", ", up to the worksheet's last row",
     flag<&ReadSettings::pad>},
    {"--preview", "", "read the first 101 rows of each column only", "",
     flag<&ReadSettings::preview>}};

constexpr OptionRow kSheets[] = {
    {"--exclude-sheet", "NAME|KEY", "leave a worksheet out", "",
     values<&ReadSettings::excludedSheets, textValue>},
    {"--exclude", "COLUMN", "leave a column out", "", values<&ReadSettings::excluded, columnValue>},
    {"--type", "COLUMN=KIND", "read as this kind: numeric, text or datetime",
     "; without it the first data cell decides", values<&ReadSettings::types, columnType>},
    {"--rename", "COLUMN=NAME", "name of the variable", "; an empty NAME leaves it as it is",
     values<&ReadSettings::renamed, columnText>},
    {"--position", "COLUMN=N", "position of the column at the host", "",
     values<&ReadSettings::positions, columnPosition>},
    {"--max-name", "N", "maximum length of variable names, in characters", "",
     value<&ReadSettings::maxName, wholeFrom<1, kMostCharacters>>},
    {"--clean-sheet-names", "", "replace `? * / : < > | \" \\` in worksheet names by `_`", "",
     flag<&ReadSettings::cleanSheetNames>}};

constexpr OptionRow kMissing[] = {
    {"--missing", "VALUE", "number that marks a missing value (1.23456e30)", "",
     value<&ReadSettings::missing, numberValue>},
    {"--missing-number", "NUMBER=NUMBER", "numbers equal to the first become the second",
     "; rows that `missing=NUMBER` fills still count as missing",
     value<&ReadSettings::missingNumber, numberForNumber>},
    {"--missing-word", "TEXT=NUMBER", "this text in numeric columns becomes a number",
     "; not with `--missing-number`", value<&ReadSettings::missingWord, numberForText>},
    {"--missing-text", "TEXT=TEXT", "texts equal to the first become the second", "",
     value<&ReadSettings::missingText, textForText>},
    {"--missing-display", "TEXT", "how a missing number is shown (`*`)", "",
     value<&ReadSettings::missingDisplay, textValue>}};

constexpr OptionRow kValues[] = {
    {"--decimal", "SYMBOL", "decimal symbol, in texts and on display (`.`)", "",
     value<&ReadSettings::decimal, symbolValue>},
    {"--range", "MIN:MAX", "numbers outside become missing (`-1.001e18:1.001e18`)", "",
     value<&ReadSettings::range, rangeValue>},
    {"--max-text", "N|none", "maximum length of texts and names, in bytes (80)",
     "; `none` for no limit", value<&ReadSettings::maxText, limitValue>},
    {"--clean-text", "", "trim texts, drop control characters, collapse spaces", "",
     flag<&ReadSettings::cleanText>},
    {"--dates-as-text", "", "read date-times as their displayed texts", "",
     flag<&ReadSettings::datesAsText>},
    {"--true", "TEXT", "text of a true Boolean (TRUE)",
     "; workbooks deliver Booleans as 1 and 0, so nothing in an .xlsx file shows it",
     value<&ReadSettings::trueText, textValue>},
    {"--false", "TEXT", "text of a false Boolean (FALSE)", "; see `--true`",
     value<&ReadSettings::falseText, textValue>}};

constexpr OptionRow kProgram[] = {
    {"--library", "FILE", "the import library to load",
     "; else the one that `DPXLSX_LIBRARY` names", value<&Options::library, textValue>},
    {"-h, --help", "", "all options and exit codes", "", {Takes::Help, nullptr}},
    {"--version",
     "",
     "versions of this program and of what it is built on",
     "",
     {Takes::Version, nullptr}}};

constexpr OptionGroup kGroups[] = {
    {"What to show", "", "", kOutput},
    {"Rows", "", "", kRows},
    {"Worksheets and columns", "COLUMN is C, 3 or SHEET!C",
     "COLUMN is a letter, a number from 1, or `SHEET!C` for one worksheet. Without a worksheet the "
     "option applies to every worksheet that has such a column. Naming a column that the named "
     "worksheet does not have is wrong usage.",
     kSheets},
    {"Missing values", "NUMBER is a number or the word missing",
     "NUMBER is a number or the word `missing`.", kMissing},
    {"Values", "", "", kValues},
    {"Program", "", "", kProgram}};

}  // namespace

std::span<const OptionGroup> optionGroups() { return kGroups; }

}  // namespace dp::tool
