#include "dpxlsx/readers/standard/cell_content.h"

#include <utility>

#include "dpxlsx/readers/standard/cell_values.h"
#include "dpxlsx/readers/standard/string_items.h"
#include "dpxlsx/store/text_cleaning.h"

namespace dp::standard {

namespace {

using Content = std::optional<ExternalDataRecordCell>;

ExternalDataRecordCell error() { return {}; }

ExternalDataRecordCell unreadable() {
    ExternalDataRecordCell cell;
    cell.type = kUnreadableContent;
    return cell;
}

Content text(std::string value) {
    if (isAllSpaces(value)) return std::nullopt;
    ExternalDataRecordCell cell;
    cell.type = CELL_TEXT;
    cell.textValue = std::move(value);
    return cell;
}

ExternalDataRecordCell number(ExternalCellType type, double value, int formatIndex) {
    ExternalDataRecordCell cell;
    cell.type = type;
    cell.numValue = value;
    cell.formatIndex = formatIndex;
    return cell;
}

// The day number of the 1900 system. A time of day has no date, and an elapsed time is no date.
double dayNumberFrom1904(double value, const NumberFormats::Format& format) {
    constexpr double kDaysTo1904 = 1462;
    const bool isTime = format.elapsed || (format.type == EXCEL_FORMAT_TIME && value < 1.0);
    return isTime ? value : value + kDaysTo1904;
}

ExternalDataRecordCell numberCell(const std::string& written, int style,
                                  const CellReferences& references) {
    const std::optional<double> value = parseNumber(written);
    if (!value) return unreadable();
    const int formatIndex = references.formats.ofCell(style);
    const NumberFormats::Format* format = references.formats.at(formatIndex);
    if (!format || format->type == EXCEL_FORMAT_NONE)
        return number(CELL_NUMBER, *value, formatIndex);
    return number(CELL_DATETIME, references.date1904 ? dayNumberFrom1904(*value, *format) : *value,
                  formatIndex);
}

ExternalDataRecordCell dateTimeCell(const std::string& written, int style,
                                    CellReferences& references) {
    const std::optional<IsoDateTime> value = parseIsoDateTime(written);
    if (!value) return unreadable();
    int formatIndex = references.formats.ofCell(style);
    const NumberFormats::Format* format = references.formats.at(formatIndex);
    if (!format || format->type == EXCEL_FORMAT_NONE)
        formatIndex = references.formats.ofDateTime(value->type, value->isDuration);
    return number(CELL_DATETIME, value->dayNumber, formatIndex);
}

// Without a format: a number format does not show Booleans.
ExternalDataRecordCell booleanCell(const std::string& written) {
    const std::optional<bool> value = parseBoolean(written);
    return value ? number(CELL_NUMBER, *value ? 1.0 : 0.0, -1) : unreadable();
}

Content sharedText(const std::string& written, const SharedStringTable& strings) {
    const std::optional<int> index = parseIndex(written);
    if (!index || static_cast<std::size_t>(*index) >= strings.size()) return unreadable();
    return text(std::string(strings[static_cast<std::size_t>(*index)]));
}

Content writtenText(std::string written) {
    decodeEscapes(written);
    return text(std::move(written));
}

}  // namespace

std::optional<ExternalDataRecordCell> contentOf(const CellMarkup& markup,
                                                CellReferences& references) {
    const std::string& type = markup.type;
    if (markup.inlineText) return text(*markup.inlineText);
    if (!markup.value || isAllSpaces(*markup.value)) return std::nullopt;
    if (type == "e") return error();
    if (type == "s") return sharedText(*markup.value, references.strings);
    if (type == "str" || type == "inlineStr") return writtenText(*markup.value);
    if (type == "b") return booleanCell(*markup.value);
    if (type == "d") return dateTimeCell(*markup.value, markup.style, references);
    return numberCell(*markup.value, markup.style, references);
}

}  // namespace dp::standard
