#pragma once

#include <optional>
#include <string>

#include <dpxlsx/model/host/i_column.h>
#include <dpxlsx/model/host/i_data_provider.h>
#include <dpxlsx/model/host/reference.h>

namespace dp::tool {

enum class Kind { Number, DateTime, Text };

// "numeric", "datetime" or "text".
const char* kindName(Kind kind);

// The shortest text that reads back as the same number.
std::string numberText(double value);

// Access to a loaded column by row. Rows are 0-based.
class Column {
  public:
    // In a preview only the first 101 rows have values; the others are not counted.
    Column(IColumn* column, double missing, bool preview);

    const IColumn& host() const { return *column_; }
    Kind kind() const { return kind_; }
    std::string name() const;
    size_t rows() const { return rows_; }

    // Rows from rows() on are missing.
    bool isMissing(size_t row) const;
    // A number or a serial day number. Not for texts.
    double number(size_t row) const;
    // Not for numbers and date-times.
    std::string text(size_t row) const;

    // The value as its format displays it; empty for a missing one.
    std::string shown(size_t row) const;
    // The value in full: a number in its shortest form, a date-time in ISO form; empty for a
    // missing one.
    std::string exact(size_t row, char dateAndTime = 'T') const;

    // Cells that had content but became missing; 0 for texts.
    int convertedMissing() const;
    // Bytes of the longest text in a column of texts, else 0.
    size_t longestText() const;
    // The ICU pattern of a date-time column, else empty.
    std::string pattern() const;
    // The format in words, such as "fixed, 2 decimals".
    std::string formatText() const;

  private:
    const INumericColumn& numeric() const;
    const ITextColumn& textual() const;

    Reference<IColumn> column_;
    double missing_;
    bool preview_;
    Kind kind_;
    size_t rows_;
};

// The column of numbers or date-times loaded again as texts; none when an option forces its kind.
std::optional<Column> loadedAsTexts(IDataProvider& provider, const Column& column, bool preview);

}  // namespace dp::tool
