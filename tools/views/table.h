#pragma once

#include <optional>
#include <string>
#include <vector>

#include "tools/views/output.h"

namespace dp::tool {

// Texts in aligned columns under a heading.
class Table {
  public:
    struct Heading {
        std::string text;
        bool toTheRight;  // as numbers are written
    };

    explicit Table(std::vector<Heading> headings);

    // Adds a row of as many texts as there are headings. Control characters are replaced, and long
    // texts are cut.
    void addRow(const std::vector<std::string>& texts);
    // Lines longer than `width` cells are cut.
    void print(Output& output, std::optional<int> width) const;

  private:
    void add(std::vector<std::string> texts);
    std::string line(const std::vector<std::string>& texts) const;

    std::vector<Heading> headings_;
    std::vector<int> widths_;
    std::vector<std::vector<std::string>> rows_;  // the headings first
};

// One line of any text, cut to `width` cells.
std::string outputLine(const std::string& text, std::optional<int> width);

}  // namespace dp::tool
