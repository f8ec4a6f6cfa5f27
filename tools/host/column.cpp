#include "tools/host/column.h"

#include <algorithm>
#include <charconv>
#include <memory>

#include <dpxlsx/model/host/i_finders.h>
#include <dpxlsx/model/host/i_string.h>
#include <dpxlsx/model/host/i_variable_format.h>

#include "tools/host/calendar.h"
#include "tools/options/settings.h"
#include "tools/views/text.h"

namespace dp::tool {

namespace {

constexpr size_t kPreviewRows = 101;

Kind kindOf(const IColumn& column) {
    constexpr int kDateTimes = 2;
    if (column.GetStorageType() == IVariable::StorageType::Text) return Kind::Text;
    return column.GetDataType() == kDateTimes ? Kind::DateTime : Kind::Number;
}

size_t rowsOf(const IColumn& column, bool preview) {
    const auto rows = static_cast<size_t>(std::max(column.GetRowCount(), 0));
    return preview ? std::min(rows, kPreviewRows) : rows;
}

std::string howMany(int count, const std::string& unit) {
    return counted(static_cast<size_t>(std::max(count, 0)), unit);
}

std::string fractionText(const IFractionVariableFormat& format) {
    if (!format.GetFixedDenominator()) {
        return "fraction, " + howMany(format.GetMaximumDigits(), "digit");
    }
    return "fraction, denominator " + std::to_string(format.GetDenominator());
}

std::string numericText(const INumericVariableFormat& format) {
    int decimals = 0;
    format.GetDecimalPlaces(&decimals, nullptr);
    switch (format.GetNumericSubtype()) {
        case NumericSubtype::Fixed:
            return "fixed, " + howMany(decimals, "decimal");
        case NumericSubtype::Scientific:
            return "scientific, " + howMany(decimals, "decimal");
        case NumericSubtype::Percentage:
            decimals = static_cast<const IPercentageVariableFormat&>(format).GetDecimalPlaces();
            return "percentage, " + howMany(decimals, "decimal");
        case NumericSubtype::Fraction:
            return fractionText(static_cast<const IFractionVariableFormat&>(format));
        case NumericSubtype::General:
            break;
    }
    return "general";
}

std::string patternOf(const IVariableFormat* format) {
    if (format == nullptr || format->GetType() != IVariableFormat::FormatType::DateTime) return {};
    const auto& dateTime = static_cast<const IDateTimeVariableFormat&>(*format);
    return dateTime.GetFormatString()->database_str();
}

}  // namespace

const char* kindName(Kind kind) {
    switch (kind) {
        case Kind::Number:
            return "numeric";
        case Kind::DateTime:
            return "datetime";
        case Kind::Text:
            break;
    }
    return "text";
}

std::string numberText(double value) {
    char text[32];
    const auto end = std::to_chars(text, text + sizeof text, value).ptr;
    return {text, end};
}

Column::Column(IColumn* column, double missing, bool preview)
    : column_(column),
      missing_(missing),
      preview_(preview),
      kind_(kindOf(*column)),
      rows_(rowsOf(*column, preview)) {}

std::string Column::name() const { return column_->GetName()->database_str(); }

bool Column::isMissing(size_t row) const {
    if (row >= rows_) return true;
    if (kind_ == Kind::Text) return *textual().GetTextValues()->Item(row).database_str() == '\0';
    const double value = number(row);
    return value == missing_ || (preview_ && value == kDefaultMissing);
}

double Column::number(size_t row) const { return numeric().GetValues()[row]; }

std::string Column::text(size_t row) const {
    return textual().GetTextValues()->Item(row).database_str();
}

std::string Column::shown(size_t row) const {
    if (isMissing(row)) return {};
    if (kind_ == Kind::Text) return text(row);
    const IVariableFormat* format = column_->GetFormat();
    // Without a pattern the format would show only the day.
    const bool plain = format == nullptr || (kind_ == Kind::DateTime && pattern().empty());
    if (plain) return exact(row, ' ');
    const std::unique_ptr<IString> shown(format->FormatValue(number(row), false));
    return shown->database_str();
}

std::string Column::exact(size_t row, char dateAndTime) const {
    if (isMissing(row)) return {};
    if (kind_ == Kind::Text) return text(row);
    const bool dated = kind_ == Kind::DateTime && isValidSerial(number(row));
    return dated ? isoText(number(row), pattern(), dateAndTime) : numberText(number(row));
}

int Column::convertedMissing() const {
    return kind_ == Kind::Text ? 0 : numeric().GetConvertedMissingCount();
}

size_t Column::longestText() const {
    const IVariableFormat* format = column_->GetFormat();
    if (format == nullptr || format->GetType() != IVariableFormat::FormatType::Text) return 0;
    const int count = static_cast<const ITextVariableFormat&>(*format).GetCharacterCount();
    return static_cast<size_t>(std::max(count, 0));
}

std::string Column::pattern() const { return patternOf(column_->GetFormat()); }

std::string Column::formatText() const {
    const IVariableFormat* format = column_->GetFormat();
    if (format == nullptr) return "none";
    switch (format->GetType()) {
        case IVariableFormat::FormatType::Numeric:
            return numericText(static_cast<const INumericVariableFormat&>(*format));
        case IVariableFormat::FormatType::DateTime:
            return pattern().empty() ? "date-time, automatic" : "date-time, " + pattern();
        case IVariableFormat::FormatType::Text:
            break;
    }
    const auto& texts = static_cast<const ITextVariableFormat&>(*format);
    return "text, up to " + howMany(texts.GetCharacterCount(), "byte");
}

std::optional<Column> loadedAsTexts(IDataProvider& provider, const Column& column, bool preview) {
    IColumn* found = nullptr;
    auto type = IVariableFormat::FormatType::Numeric;
    provider.GetVariableFinder()->FindColumn(column.host().GetPrimeKey(), &found,
                                             IVariable::StorageType::Text, &type, true);
    if (found == nullptr) return std::nullopt;
    Column texts(found, kDefaultMissing, preview);
    return texts.kind() == Kind::Text ? std::optional(texts) : std::nullopt;
}

const INumericColumn& Column::numeric() const {
    return static_cast<const INumericColumn&>(*column_);
}

const ITextColumn& Column::textual() const { return static_cast<const ITextColumn&>(*column_); }

}  // namespace dp::tool
