#include "dpxlsx/store/conversion.h"

#include <cstdio>

#include "dpxlsx/formats/beyond_pattern.h"
#include "dpxlsx/model/string.h"
#include "dpxlsx/store/date_time_recognition.h"
#include "dpxlsx/store/number_recognition.h"
#include "dpxlsx/store/text_cleaning.h"

namespace dp {

namespace {

// The value of a number or date-time cell; missing when a date-time is wanted and the host's helper
// rejects the value.
double checkedNumber(double value, bool asDateTime, const ConversionSettings& settings,
                     bool& converted) {
    const IDateTimeVariableFormat* helper = settings.dateTimeHelper;
    if (!asDateTime || !helper || helper->ValidVextralTime(value)) return value;
    converted = true;
    return settings.missingValue;
}

double textToNumber(std::string_view text, bool asDateTime, const IString* dateTimeFormat,
                    const ConversionSettings& settings, bool& converted) {
    double value = settings.missingValue;
    if (asDateTime) {
        String wrapped{std::string(text)};
        double time = 0.0;
        converted = !settings.dateTimeHelper ||
                    !IsDateTime(settings.dateTimeHelper, dateTimeFormat, &wrapped, time);
        return converted ? value : time;
    }
    converted =
        !recogniseNumber(std::string(text), settings.inputDecimal, settings.missingValue, &value);
    return value;
}

double rawNumber(const CellContent& cell, bool asDateTime, const IString* dateTimeFormat,
                 const ConversionSettings& settings, bool& converted) {
    switch (cell.type) {
        case CELL_INTEGER:
            return cell.intValue;
        case CELL_NUMBER:
            return checkedNumber(cell.numValue, asDateTime, settings, converted);
        case CELL_TEXT:
            return textToNumber(cell.textValue, asDateTime, dateTimeFormat, settings, converted);
        case CELL_BOOLEAN:
            return cell.boolValue;
        case CELL_DATETIME:
            if (!settings.convertDateTimeToText)
                return checkedNumber(cell.numValue, asDateTime, settings, converted);
            converted = true;
            return settings.missingValue;
        default:
            converted = settings.errorsAreFiled && cell.type == kUnreadableContent;
            return settings.missingValue;
    }
}

double mapMissing(double value, const CellContent& cell, const ConversionSettings& settings) {
    const bool missing = settings.alphaMissingNumericSet
                             ? cell.textValue == settings.alphaMissingNumericFrom
                             : value == settings.missingNumericFrom;
    return missing ? settings.missingNumericTo : value;
}

std::string integerText(std::int32_t value) {
    // Right-aligned in 12 characters, one more than the longest 32-bit integer has.
    char text[16];
    const int length = std::snprintf(text, sizeof text, "%12d", static_cast<int>(value));
    return std::string(text, static_cast<std::size_t>(length));
}

}  // namespace

CellContent::CellContent(const ExternalDataRecordCell& cell)
    : type(cell.type),
      intValue(cell.intValue),
      boolValue(cell.boolValue),
      numValue(cell.numValue),
      textValue(cell.textValue),
      formatIndex(cell.formatIndex) {}

CellContent::CellContent(const CellView& cell)
    : type(cell.type()),
      intValue(cell.intValue()),
      boolValue(cell.boolValue()),
      numValue(cell.numValue()),
      textValue(cell.textValue()),
      formatIndex(cell.formatIndex()) {}

ExternalDataRecordCell CellContent::toCell() const {
    ExternalDataRecordCell cell;
    cell.type = type;
    cell.intValue = intValue;
    cell.boolValue = boolValue;
    cell.numValue = numValue;
    cell.textValue = textValue;
    cell.formatIndex = formatIndex;
    return cell;
}

const FormatCache::Format& FormatCache::formatOf(const CellContent& cell) {
    if (!recent_ || cell.formatIndex != recentIndex_) {
        Format& format = formats_[cell.formatIndex];
        if (!format.made) {
            format.made = source_.create(cell);
            format.isForHelper = format.made->GetType() == IVariableFormat::FormatType::DateTime &&
                                 !dynamic_cast<const BeyondPattern*>(format.made.get());
        }
        recent_ = &format;
        recentIndex_ = cell.formatIndex;
    }
    return *recent_;
}

double cellToNumber(const CellContent& cell, bool asDateTime, const IString* dateTimeFormat,
                    const ConversionSettings& settings, bool& converted) {
    converted = false;
    const double raw = rawNumber(cell, asDateTime, dateTimeFormat, settings, converted);
    const double value = mapMissing(raw, cell, settings);
    const bool isError = settings.errorsAreFiled && cell.type == CELL_EMPTY;
    if (isError && value == settings.missingValue) return value;
    return inRange(value, settings, converted);
}

std::string numericCellToText(const CellContent& cell, const ConversionSettings& settings,
                              FormatCache& formats) {
    const FormatCache::Format& format = formats.formatOf(cell);
    if (cell.numValue == settings.missingValue) return std::string(settings.missingValueText);

    const IVariableFormat* shown = format.made.get();
    if (cell.type == CELL_DATETIME && settings.dateTimeHelper && format.isForHelper) {
        settings.dateTimeHelper->SetDateTimeParameters(
            static_cast<const IDateTimeVariableFormat*>(shown));
        shown = settings.dateTimeHelper;
    }
    const std::unique_ptr<IString> text(shown->FormatValue(cell.numValue, false));
    return text ? std::string(text->database_str()) : std::string();
}

void cellToText(const CellContent& cell, const ConversionSettings& settings, FormatCache& formats,
                std::string& text) {
    switch (cell.type) {
        case CELL_INTEGER:
            text = integerText(cell.intValue);
            break;
        case CELL_NUMBER:
        case CELL_DATETIME:
            text = numericCellToText(cell, settings, formats);
            break;
        case CELL_TEXT:
            text = cell.textValue;
            break;
        case CELL_BOOLEAN:
            text = cell.boolValue != 0 ? settings.trueValue : settings.falseValue;
            break;
        default:
            text.clear();
            break;
    }
    if (settings.cleanTextValues) CleanText(text);
}

void cutToBytes(std::string& text, std::int32_t maxLength, TextCut cut) {
    if (maxLength < 0 || text.size() <= static_cast<std::size_t>(maxLength)) return;
    const auto bytes = static_cast<std::size_t>(maxLength);
    text.resize(cut == TextCut::AtCharacters ? wholeCharacters(text, bytes) : bytes);
    // Otherwise a column of shortened texts would occupy the memory of the long ones.
    constexpr std::size_t kWorthReturning = 256;  // bytes
    if (text.capacity() > text.size() + kWorthReturning) text.shrink_to_fit();
}

}  // namespace dp
