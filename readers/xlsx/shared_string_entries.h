#pragma once

#include <string>
#include <string_view>

#include "dpxlsx/readers/xlsx/shared_string_table.h"

namespace dp {

// What the elements of a shared-string part mean: takes its texts in the order of the document and
// makes the entries of the table of them.
class SharedStringEntries {
  public:
    // Empties `table`; `path` is that of the part.
    SharedStringEntries(SharedStringTable& table, const std::string& path);

    // The table begins; `uniqueCount` is its attribute of that name.
    void begin(const char* uniqueCount);
    // A text, and the end of the entry that all texts since the last one make up.
    void addText(std::string_view text) { text_ += text; }
    void endEntry();
    // An entry of one text, while no other has begun.
    void addEntry(std::string_view text);
    bool hasBegunEntry() const { return !text_.empty(); }

  private:
    SharedStringTable& table_;
    const std::string& path_;
    std::string text_;
};

}  // namespace dp
