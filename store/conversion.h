#pragma once

#include <cmath>
#include <cstdint>
#include <map>
#include <memory>
#include <string>
#include <string_view>

#include "dpxlsx/model/host/i_string.h"
#include "dpxlsx/model/host/i_variable_format.h"
#include "dpxlsx/store/cell_column.h"
#include "dpxlsx/store/external_data_record.h"

namespace dp {

// The initial missing value, which marks a missing value until the host sets another.
inline constexpr double kInitialMissingValue = 1.23456e30;

// Where a text that is too long ends.
enum class TextCut : std::uint8_t { AtBytes, AtCharacters };

// The host's settings that decide how cells become values. Texts are borrowed.
struct ConversionSettings {
    double missingValue;
    double minNumericValue;  // inclusive, like the maximum
    double maxNumericValue;
    std::int32_t maxTextLength;  // bytes
    char inputDecimal;
    std::string_view missingValueText;
    std::string_view trueValue;
    std::string_view falseValue;
    double missingNumericFrom;
    double missingNumericTo;
    bool alphaMissingNumericSet;
    std::string_view alphaMissingNumericFrom;
    bool cleanTextValues;
    bool convertDateTimeToText;
    IDateTimeVariableFormat* dateTimeHelper;  // null when the host gave none
    TextCut textCut = TextCut::AtBytes;       // where texts that are too long are cut
    bool errorsAreFiled = false;              // as cells without a value
};

// A cell to convert, wherever it is kept. The text is borrowed.
struct CellContent {
    explicit CellContent(const ExternalDataRecordCell& cell);
    explicit CellContent(const CellView& cell);

    ExternalDataRecordCell toCell() const;

    ExternalCellType type;
    std::int32_t intValue;
    std::int32_t boolValue;
    double numValue;
    std::string_view textValue;
    std::int32_t formatIndex;
};

// Where the formats of cell styles come from.
class CellFormats {
  public:
    virtual ~CellFormats() = default;

    // A new format for the cell's style, never null.
    virtual std::unique_ptr<IVariableFormat> create(const CellContent& cell) const = 0;
};

// The formats of one load, made once per style: the first value that a date-time format renders
// costs twenty times what the next ones do.
class FormatCache {
  public:
    struct Format {
        std::unique_ptr<IVariableFormat> made;
        bool isForHelper = false;  // a host's helper shows date-times by its pattern
    };

    explicit FormatCache(const CellFormats& source) : source_(source) {}

    // Valid as long as the cache.
    const Format& formatOf(const CellContent& cell);

  private:
    const CellFormats& source_;
    std::map<std::int32_t, Format> formats_;
    std::int32_t recentIndex_ = 0;
    const Format* recent_ = nullptr;
};

// `value` if it is in the host's range; otherwise the missing value, with `converted` set.
inline double inRange(double value, const ConversionSettings& settings, bool& converted) {
    const bool outside =
        std::isnan(value) || value < settings.minNumericValue || value > settings.maxNumericValue;
    if (!outside) return value;
    converted = true;
    return settings.missingValue;
}

// The cell as a number; the missing value when it has no number that the settings allow.
// `converted` is set when the content is not a number or is out of range, even if the host's
// mapping of missing values supplies another number, and for an empty cell when the missing value
// itself is out of range, unless empty cells are errors: they have nothing to convert.
// `dateTimeFormat` is the pattern by which texts are read as date-times,
// null when none is known.
double cellToNumber(const CellContent& cell, bool asDateTime, const IString* dateTimeFormat,
                    const ConversionSettings& settings, bool& converted);

// The cell as text, not cut; `text` is replaced.
void cellToText(const CellContent& cell, const ConversionSettings& settings, FormatCache& formats,
                std::string& text);

// A number or date-time cell as its style shows it.
std::string numericCellToText(const CellContent& cell, const ConversionSettings& settings,
                              FormatCache& formats);

// Keeps the first `maxLength` bytes, or as many of them as make up whole characters; a negative
// length sets no limit.
void cutToBytes(std::string& text, std::int32_t maxLength, TextCut cut = TextCut::AtBytes);

}  // namespace dp
