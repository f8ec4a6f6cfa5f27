#pragma once

#include <cstddef>
#include <string>
#include <vector>

namespace dp::tool {

// Cells counted by column.
class Tally {
  public:
    struct Entry {
        std::string place;  // such as "Data!B"
        std::string name;   // of the column
        size_t count;
    };

    // Adds the cells of one column.
    void add(Entry entry);
    const std::vector<Entry>& entries() const { return entries_; }
    bool empty() const { return entries_.empty(); }
    size_t total() const { return total_; }
    size_t columns() const { return entries_.size(); }

    // Such as "11 in Data!J (City), 1 in Data!L (Count) and 3 in 2 more columns"; names at most
    // `most` columns.
    std::string text(size_t most) const;
    // "--type Data!J=text --type Data!L=text" for the same columns.
    std::string textTypes(size_t most) const;

  private:
    std::vector<Entry> entries_;
    size_t total_ = 0;
};

// What an import lost of the columns that it loaded.
struct Lost {
    Tally cells;  // cells that became missing because they did not fit the kind of their column
    Tally unreadable;  // cells whose content is not what their type says, when told from the others
    Tally cutTexts;    // texts and names of columns beyond the limit of --max-text
    size_t longest = 0;  // of those, in bytes
    Tally shown;  // numbers and dates in columns of texts, whose displayed form shows only a part
};

}  // namespace dp::tool
