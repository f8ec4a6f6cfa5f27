#pragma once

#include <cstddef>
#include <map>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "dpxlsx/formats/style.h"
#include "dpxlsx/model/host/i_variable_format.h"

namespace dp::standard {

// The number formats of a workbook, and which of them its cells use. Formats are known by their
// index, -1 for none.
class NumberFormats {
  public:
    struct Format {
        std::string_view code;   // of this object or built in; parsed, it would take much memory
        EXCEL_FORMAT_TYPE type;  // a date-time type, or EXCEL_FORMAT_NONE
        bool elapsed;            // shows elapsed hours, minutes or seconds
    };

    // The formats refer to codes that are kept here.
    NumberFormats() = default;
    NumberFormats(NumberFormats&&) = default;
    NumberFormats& operator=(NumberFormats&&) = default;

    // Reads the style sheet, in place of what was known before. Throws CmXmlException.
    void read(const std::string& path);

    // The format of the cells that name the entry `style` of the cell formats.
    int ofCell(int style) const;
    // The built-in format that shows dates, times, elapsed times or date-times.
    int ofDateTime(EXCEL_FORMAT_TYPE type, bool elapsed);

    // Null for none.
    const Format* at(int index) const;
    // A new format, the automatic one for none.
    std::unique_ptr<IVariableFormat> create(int index) const;

  private:
    void addCode(int id, std::string code);
    int indexOf(int id);

    std::map<int, std::string> codeById_;  // of the workbook's own formats
    std::size_t codesSize_ = 0;            // as kFormatCodes counts
    std::map<std::string_view, int> indexByCode_;
    std::vector<Format> formats_;
    std::vector<int> ofCells_;  // by position in the cell formats
};

}  // namespace dp::standard
