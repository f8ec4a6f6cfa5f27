#include "dpxlsx/model/columns.h"

#include <algorithm>
#include <iterator>
#include <memory>
#include <numeric>

#include "dpxlsx/provider/excel_data_provider_base.h"
#include "dpxlsx/store/column_loading.h"
#include "dpxlsx/store/text_cleaning.h"

// Columns on demand: their keys, names and kinds, and the load itself.
namespace dp {

namespace {

using BasicDataType = IVariable::BasicDataType;
using FormatType = IVariableFormat::FormatType;

// The formats of an open file, obtained from the provider.
class ProviderFormats : public CellFormats {
  public:
    explicit ProviderFormats(const ExcelDataProviderBase& provider) : provider_(provider) {}

    std::unique_ptr<IVariableFormat> create(const CellContent& cell) const override {
        return std::unique_ptr<IVariableFormat>(
            provider_.CreateVextralNumericFormat(cell.toCell()));
    }

  private:
    const ExcelDataProviderBase& provider_;
};

bool hasValue(ExternalCellType type) { return type != CELL_EMPTY && type != kUnreadableContent; }

// The kind of a column: that of its first data cell, unless an option sets another one.
struct ColumnKind {
    ColumnType type;
    FormatType format;
};

ColumnType typeOf(FormatType format, bool convertDateTimeToText) {
    switch (format) {
        case FormatType::Text:
            return ColumnType::Text;
        case FormatType::DateTime:
            return convertDateTimeToText ? ColumnType::Text : ColumnType::Numeric;
        default:
            return ColumnType::Numeric;
    }
}

void applyRequestedType(ColumnKind& kind, BasicDataType requested) {
    switch (requested) {
        case BasicDataType::Text:
            kind = {ColumnType::Text, FormatType::Text};
            break;
        case BasicDataType::Numeric:
        case BasicDataType::DateTime:
            kind = {ColumnType::Numeric, FormatType::Numeric};
            break;
        default:
            break;
    }
}

const ColumnReadOptions* findOptions(const ColumnOptions& options, unsigned column) {
    const auto option = options.find(column + 1);
    return option == options.end() ? nullptr : &option->second;
}

BasicDataType requestedType(const ColumnOptions& options, unsigned column) {
    const ColumnReadOptions* option = findOptions(options, column);
    return option ? option->columnType : BasicDataType::NotSet;
}

// The column behind a key, and its worksheet.
struct ColumnAddress {
    unsigned worksheetPosition;
    const WorksheetCells::value_type* column;  // null for an unknown key
};

// Caches the number of columns before each worksheet, so that finding a key does not walk all
// worksheets. Code that changes the number of columns resets the last worksheet's count, which
// marks the cache as outdated.
void countColumns(const std::vector<WorksheetCells>& worksheets) {
    if (worksheets.empty() || worksheets.back().columnsBefore) return;
    std::size_t count = 0;
    for (const WorksheetCells& cells : worksheets) {
        cells.columnsBefore = count;
        count += cells.size();
    }
}

ColumnAddress decodeKey(const std::vector<WorksheetCells>& worksheets, int key) {
    if (key <= 0 || worksheets.empty()) return {0, nullptr};
    countColumns(worksheets);
    const std::size_t index = static_cast<std::size_t>(key) - 1;
    // The last worksheet that starts at or before the column: one without columns never holds it.
    const auto worksheet = std::prev(std::partition_point(
        worksheets.begin(), worksheets.end(),
        [index](const WorksheetCells& cells) { return *cells.columnsBefore <= index; }));
    const std::size_t nth = index - *worksheet->columnsBefore;
    if (nth >= worksheet->size()) return {0, nullptr};
    return {static_cast<unsigned>(worksheet - worksheets.begin()), &worksheet->nth(nth)};
}

}  // namespace

IReadOnlyCollection<int>* ExcelDataProviderBase::GetColumnPrimeKeys(int worksheetKey) const {
    std::vector<int>& keys = _columnKeys.items;
    keys.clear();
    if (worksheetKey <= 0 || !worksheetExists(static_cast<unsigned>(worksheetKey)))
        return &_columnKeys;
    const unsigned position = GetWorksheetPosition(static_cast<unsigned>(worksheetKey));
    countColumns(_cells);
    keys.resize(_cells[position].size());
    std::iota(keys.begin(), keys.end(), static_cast<int>(*_cells[position].columnsBefore) + 1);
    return &_columnKeys;
}

bool ExcelDataProviderBase::FindColumn(int key, IColumn** column, bool ignoreExclusion) const {
    FormatType discarded;
    return FindColumn(key, column, ColumnType::Automatic, &discarded, ignoreExclusion);
}

bool ExcelDataProviderBase::FindColumn(int key, IColumn** column, IVariable::StorageType storage,
                                       FormatType* formatType, bool ignoreExclusion) const {
    const ColumnType requested =
        storage == IVariable::StorageType::Numeric ? ColumnType::Numeric : ColumnType::Text;
    return FindColumn(key, column, requested, formatType, ignoreExclusion);
}

bool ExcelDataProviderBase::FindColumn(int key, IColumn** column, ColumnType requested,
                                       FormatType* formatType, bool ignoreExclusion) const {
    if (column) *column = nullptr;
    const ColumnAddress address = decodeKey(_cells, key);
    if (!address.column) return false;
    const auto& [columnIndex, cells] = *address.column;
    const auto worksheetKey =
        static_cast<unsigned>(GetWorksheetPrimeKey(address.worksheetPosition));

    ColumnKind kind{requested, firstDataType(worksheetKey, cells, requested)};
    if (requested == ColumnType::Automatic) kind.type = typeOf(kind.format, _convertDateTimeToText);
    std::string name = variableNameInSheet(worksheetKey, cells);
    unsigned position = columnIndex;
    bool excluded = false;
    if (const auto* options = findOptions(columnOptionsOf(worksheetKey), columnIndex)) {
        excluded = options->exclude && !ignoreExclusion;
        applyRequestedType(kind, options->columnType);
        if (options->destinationId != kNotSet) position = options->destinationId - 1;
        if (!options->name.empty()) name = options->name;
    }
    if (formatType) *formatType = kind.format;
    if (excluded || !column) return !excluded;

    // The limit is cut to 16 bits, so that no limit means 65,535 characters.
    cleanVariableName(name, static_cast<unsigned short>(_maxVariableNameLength & 0xFFFF));
    if (kind.type == ColumnType::Text)
        *column = LoadTextColumn(worksheetKey, cells, columnIndex, position, name, key);
    else
        *column =
            LoadNumericColumn(worksheetKey, cells, columnIndex, position, name, key, &kind.format);
    return true;
}

std::string ExcelDataProviderBase::variableNameInSheet(unsigned worksheetKey,
                                                       const CellColumn& cells) const {
    const SheetReadOptions& options = plainOptions(worksheetKey);
    if (options.variableNameRowSetting == VNR_NONE) return {};
    const auto cell = cells.find(options.variableNameRow);
    return cell == cells.end() ? std::string() : ConvertCellToString(cell->second, true);
}

FormatType ExcelDataProviderBase::firstDataType(unsigned worksheetKey, const CellColumn& cells,
                                                ColumnType requested) const {
    auto cell = cells.lower_bound(plainOptions(worksheetKey).firstDataRow);
    // By the standard there are cells without a value, which say nothing of the kind.
    if (isByStandard())
        while (cell != cells.end() && !hasValue(cell->second.type())) ++cell;
    if (cell == cells.end())
        return requested == ColumnType::Text ? FormatType::Text : FormatType::Numeric;
    if (cell->second.type() == CELL_TEXT) return FormatType::Text;
    return IsDateTimeFormatType(cell->second) ? FormatType::DateTime : FormatType::Numeric;
}

INumericColumn* ExcelDataProviderBase::LoadNumericColumn(unsigned worksheetKey,
                                                         const CellColumn& cells,
                                                         unsigned columnIndex, unsigned position,
                                                         const std::string& name, int key,
                                                         FormatType* formatType) const {
    const ProviderFormats formats(*this);
    const LoadSettings settings = loadSettings(worksheetKey, cells, formats);
    return loadNumericColumn(cells, {name, key, position}, settings,
                             requestedType(columnOptionsOf(worksheetKey), columnIndex),
                             formatType ? *formatType : FormatType::Numeric)
        .release();
}

ITextColumn* ExcelDataProviderBase::LoadTextColumn(unsigned worksheetKey, const CellColumn& cells,
                                                   unsigned /*columnIndex*/, unsigned position,
                                                   const std::string& name, int key) const {
    const ProviderFormats formats(*this);
    const LoadSettings settings = loadSettings(worksheetKey, cells, formats);
    return loadTextColumn(cells, {name, key, position}, settings).release();
}

LoadSettings ExcelDataProviderBase::loadSettings(unsigned worksheetKey, const CellColumn& cells,
                                                 const CellFormats& formats) const {
    return {.conversion = conversionSettings(),
            .layout = rowLayout(worksheetKey),
            .rowCount = GetLoadColumnRowCount(worksheetKey, cells),
            .previewing = _previewing,
            .formats = formats,
            .missingTextFrom = _missingTextFrom,
            .missingTextTo = _missingTextTo};
}

ConversionSettings ExcelDataProviderBase::conversionSettings() const {
    return {.missingValue = _missingValue,
            .minNumericValue = _minNumericValue,
            .maxNumericValue = _maxNumericValue,
            .maxTextLength = _maxTextLength,
            .inputDecimal = _inputDecimal,
            .missingValueText = _missingValueText,
            .trueValue = _trueValue,
            .falseValue = _falseValue,
            .missingNumericFrom = _missingNumericFrom,
            .missingNumericTo = _missingNumericTo,
            .alphaMissingNumericSet = _alphaMissingNumericSet,
            .alphaMissingNumericFrom = _alphaMissingNumericFrom,
            .cleanTextValues = _cleanTextValues,
            .convertDateTimeToText = _convertDateTimeToText,
            .dateTimeHelper = _dateTimeHelper.get(),
            .textCut = isByStandard() ? TextCut::AtCharacters : TextCut::AtBytes,
            .errorsAreFiled = isByStandard()};
}

double ExcelDataProviderBase::ConvertCellToReal(const ExternalDataRecordCell& cell, bool asDateTime,
                                                const IString* dateTimeFormat,
                                                bool& converted) const {
    return cellToNumber(CellContent(cell), asDateTime, dateTimeFormat, conversionSettings(),
                        converted);
}

std::string ExcelDataProviderBase::ConvertCellToString(const ExternalDataRecordCell& cell,
                                                       bool truncate) const {
    const ProviderFormats source(*this);
    FormatCache formats(source);
    std::string text;
    const ConversionSettings settings = conversionSettings();
    cellToText(CellContent(cell), settings, formats, text);
    if (truncate) cutToBytes(text, settings.maxTextLength, settings.textCut);
    return text;
}

std::string ExcelDataProviderBase::ConvertNumericCellToString(
    const ExternalDataRecordCell& cell) const {
    const ProviderFormats source(*this);
    FormatCache formats(source);
    return numericCellToText(CellContent(cell), conversionSettings(), formats);
}

}  // namespace dp
