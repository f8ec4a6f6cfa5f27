#pragma once

#include <map>
#include <string>
#include <vector>

#include "tools/explain/findings.h"
#include "tools/package/package.h"
#include "tools/package/part_reader.h"

namespace dp::tool {

// The number formats of a package as spreadsheet programs read them.
class NumberFormats {
  public:
    // Reads the style sheet in the entry of this name and notes what it finds there.
    void read(Package& package, const std::string& name, Findings& findings);

    // How many cell styles there are.
    size_t size() const { return formatIds_.size(); }
    // The format of the cell style with this 0-based index, which is below size(), or of cells
    // without a style (StyledColumn::kNone) when there is a first one.
    UsedFormat of(int style) const;

  private:
    struct Code {
        std::string text;
        FormatOrigin origin;
    };

    void takeCode(const PartReader& reader, bool isListed);

    std::map<int, Code> codes_;          // by id, those in numFmts
    std::map<int, std::string> others_;  // by id, those elsewhere
    int declared_ = 0;                   // number of codes that the style sheet declares
    int taken_ = 0;                      // number of codes read so far
    std::vector<int> formatIds_;         // by cell style
};

// Whether spreadsheet programs show numbers under this code as dates or times: its first section
// has a letter of a date, in any case, that is not quoted, escaped or the name of a colour.
bool isDateCode(const std::string& code);

}  // namespace dp::tool
