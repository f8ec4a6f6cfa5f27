#include "tools/help.h"

#include <CLI/CLI.hpp>

#include "tools/text.h"

namespace dp::tool {

namespace {

constexpr int kNameWidth = 33;  // characters

constexpr const char* kExitCodes =
    "Exit codes: 0 done; 1 damaged package; 2 wrong usage; 3 output cannot be written; 4 library\n"
    "cannot be loaded; 5 file system or memory; 13 malformed part; 17 no such file; 18 temporary\n"
    "directory; 22 no .xlsx package; 25 no workbook inside. 128 + n after signal n.\n";

std::string optionLine(const CLI::Option& option) {
    std::string name = "  " + option.get_name(false, true);
    if (!option.get_option_text().empty()) name += " " + option.get_option_text();
    return padded(name, kNameWidth, false) + " " + option.get_description() + "\n";
}

std::string groupText(const CLI::App& app, const std::string& group) {
    std::string text;
    for (const CLI::Option* option : app.get_options()) {
        const bool listed = option->get_group() == group && option->nonpositional();
        if (listed) text += optionLine(*option);
    }
    return text.empty() ? text : group + ":\n" + text;
}

}  // namespace

std::string helpText(const CLI::App& app) {
    std::string text = "Usage: dpxlsx [OPTIONS] BOOK.xlsx\n" + app.get_description() + "\n";
    for (const std::string& group : app.get_groups()) text += groupText(app, group);
    return text + kExitCodes;
}

}  // namespace dp::tool
