#include "tools/views/table.h"

#include <algorithm>
#include <utility>

#include "tools/views/text.h"

namespace dp::tool {

namespace {

constexpr int kWidestText = 40;  // cells; CSV and JSON have the whole text
constexpr const char* kGap = "  ";

std::string withoutTrailingSpaces(const std::string& text) {
    return text.substr(0, text.find_last_not_of(' ') + 1);
}

}  // namespace

Table::Table(std::vector<Heading> headings)
    : headings_(std::move(headings)), widths_(headings_.size(), 0) {
    std::vector<std::string> texts;
    texts.reserve(headings_.size());
    for (const Heading& heading : headings_) texts.push_back(heading.text);
    addRow(texts);
}

void Table::addRow(const std::vector<std::string>& texts) {
    std::vector<std::string> cut;
    cut.reserve(texts.size());
    for (const std::string& text : texts) cut.push_back(cutToWidth(printable(text), kWidestText));
    add(std::move(cut));
}

void Table::print(Output& output, std::optional<int> width) const {
    for (size_t i = 0; i < rows_.size(); ++i) {
        output.write(outputLine(line(rows_[i]), width));
        if (i > 0) continue;
        std::vector<std::string> rules;
        for (const int cells : widths_) rules.emplace_back(static_cast<size_t>(cells), '-');
        output.write(outputLine(line(rules), width));
    }
}

void Table::add(std::vector<std::string> texts) {
    for (size_t i = 0; i < texts.size(); ++i) {
        widths_[i] = std::max(widths_[i], displayWidth(texts[i]));
    }
    rows_.push_back(std::move(texts));
}

std::string Table::line(const std::vector<std::string>& texts) const {
    std::string result;
    for (size_t i = 0; i < texts.size(); ++i) {
        if (i > 0) result += kGap;
        result += padded(texts[i], widths_[i], headings_[i].toTheRight);
    }
    return withoutTrailingSpaces(result);
}

std::string outputLine(const std::string& text, std::optional<int> width) {
    return (width ? cutToWidth(text, *width) : text) + "\n";
}

}  // namespace dp::tool
