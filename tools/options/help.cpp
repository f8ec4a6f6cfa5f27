#include "tools/options/help.h"

#include <algorithm>

#include <nlohmann/json.hpp>

#include "tools/options/option_table.h"

namespace dp::tool {

namespace {

constexpr const char* kIntroduction =
    "Usage: dpxlsx [OPTIONS] BOOK.xlsx ...: import Excel workbooks as a host does\n";

constexpr const char* kNotation = "Options with ... may be repeated. Defaults are in parentheses.";
constexpr const char* kExitCodes = R"(
Exit codes: 0 done, 1 damaged, 2 usage, 3 output, 4 library, 5 system, 13 bad
part, 17 no file, 18 temporary folder, 22 no package, 25 no workbook, 128+signal
)";

std::string valueText(const OptionRow& row) {
    const std::string value = row.value;
    if (row.action.takes == Takes::ValueOrNothing) return " [" + value + "]";
    if (row.action.takes == Takes::ValueEachTime) return " " + value + " ...";
    return value.empty() ? value : " " + value;
}

std::string line(const OptionRow& row) {
    constexpr size_t kSummaryColumn = 28;
    std::string text = "  " + std::string(row.names) + valueText(row) + "  ";
    text.resize(std::max(text.size(), kSummaryColumn), ' ');
    text += row.summary;
    std::erase(text, '`');
    return text + "\n";
}

std::string groupText(const OptionGroup& group) {
    const std::string note = group.note;
    std::string text = group.title + (note.empty() ? note : " (" + note + ")") + ":\n";
    for (const OptionRow& row : group.rows) text += line(row);
    return text;
}

}  // namespace

std::string helpText() {
    std::string text = kIntroduction;
    for (const OptionGroup& group : optionGroups()) text += groupText(group);
    return text + kNotation + kExitCodes;
}

std::string shortHelpText() {
    return kIntroduction + groupText(optionGroups().front()) + "All options: dpxlsx --help\n";
}

std::string optionTableText() {
    auto groups = nlohmann::json::array();
    for (const OptionGroup& group : optionGroups()) {
        auto rows = nlohmann::json::array();
        for (const OptionRow& row : group.rows) {
            rows.push_back({{"names", row.names},
                            {"value", valueText(row)},
                            {"summary", row.summary},
                            {"more", row.more}});
        }
        groups.push_back({{"title", group.title}, {"text", group.text}, {"options", rows}});
    }
    return nlohmann::json({{"notation", kNotation}, {"groups", groups}}).dump(1) + "\n";
}

}  // namespace dp::tool
