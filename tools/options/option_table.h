#pragma once

#include <span>

namespace dp::tool {

struct Given;
struct Options;

enum class Takes { Nothing, Value, ValueOrNothing, ValueEachTime, Help, Version };

struct OptionAction {
    Takes takes;
    void (*take)(Options& options, const Given& given);  // null for Takes::Help and Takes::Version
};

// An option of the command line. The parser, the help and the options of the pages in docs/ are
// made from these rows; scripts/make-option-pages renews the pages. Words in backticks are literal.
struct OptionRow {
    const char* names;    // as the parser takes them: "--pad", "-h, --help"
    const char* value;    // placeholder of the value in the help
    const char* summary;  // fits a line of the help
    const char* more;     // what the pages add to the summary: "; not with `--names`"
    OptionAction action;
};

struct OptionGroup {
    const char* title;
    const char* note;  // about the values of several options
    const char* text;  // the note in the pages, where there is more room
    std::span<const OptionRow> rows;
};

// In the order of the help; the first group is the short help.
std::span<const OptionGroup> optionGroups();

}  // namespace dp::tool
