#include "dpxlsx/store/read_options.h"

#include "dpxlsx/model/string.h"
#include "dpxlsx/provider/excel_data_provider_base.h"

// What the host asks for when worksheets and columns are read.
namespace dp {

void ExcelDataProviderBase::SetReadOptionIgnoreBlankRows(bool ignore) {
    _ignoreBlankRows = ignore;
    if (!ignore) {
        _blankRows.clear();
        return;
    }
    for (const int key : _allWorksheetKeys.items) {
        FindLastRow(static_cast<unsigned>(key));
        FindBlankRows(static_cast<unsigned>(key));
    }
}

void ExcelDataProviderBase::SetReadOptionPadColumnsWithMissingValues(bool pad) {
    _padColumnsWithMissing = pad;
    if (!pad) return;
    for (const int key : _allWorksheetKeys.items) FindLastRow(static_cast<unsigned>(key));
}

void ExcelDataProviderBase::SetReadOptionCleanTextValues(bool clean) { _cleanTextValues = clean; }

void ExcelDataProviderBase::SetReadOptionCleanWorksheetNames(bool clean) {
    _cleanWorksheetNames = clean;
}

void ExcelDataProviderBase::SetReadOptionConvertDateTimeToText(bool convert) {
    _convertDateTimeToText = convert;
}

void ExcelDataProviderBase::SetReadOptionDataRowPositions(unsigned key,
                                                          EVariableNameRowSetting setting,
                                                          unsigned nameRow, unsigned firstRow) {
    SheetReadOptions& options = plainOptions(key);
    options.rowsOneBased = true;
    options.variableNameRowSetting = setting;
    options.variableNameRow = setting == VNR_GIVEN && nameRow != 0 ? nameRow : kNotSet;
    options.firstDataRow = firstRow != 0 ? firstRow : kNotSet;
    CalculateRowOffsets(key);
}

void ExcelDataProviderBase::SetReadOptionDefaultUseVariableNameRow(
    EVariableNameRowSetting setting) {
    _defaultVariableNameRowSetting = setting;
}

void ExcelDataProviderBase::SetReadOptionDataRowCount(unsigned key, unsigned count) {
    plainOptions(key).dataRowCount = count;
}

void ExcelDataProviderBase::SetReadOptionExclude(unsigned key, bool exclude) {
    plainOptions(key).exclude = exclude;
    CalculateRowOffsets(key);
    FindLastRow(key);
    FindBlankRows(key);
}

void ExcelDataProviderBase::SetReadColumnOptionExclude(unsigned key, unsigned column,
                                                       bool exclude) {
    columnOptions(key, column).exclude = exclude;
}

void ExcelDataProviderBase::SetReadColumnOptionColumnType(unsigned key, unsigned column,
                                                          IVariable::BasicDataType type) {
    columnOptions(key, column).columnType = type;
}

void ExcelDataProviderBase::SetReadColumnOptionName(unsigned key, unsigned column,
                                                    const char* name) {
    columnOptions(key, column).name = textOrEmpty(name);
}

void ExcelDataProviderBase::SetReadColumnOptionDestinationId(unsigned key, unsigned column,
                                                             unsigned id) {
    columnOptions(key, column).destinationId = id;
}

void ExcelDataProviderBase::ClearReadColumnOptions() { _columnReadOptions.clear(); }

ColumnReadOptions& ExcelDataProviderBase::columnOptions(unsigned key, unsigned column) {
    ColumnReadOptions& options = _columnReadOptions[key][column];
    options.column = column;
    return options;
}

const ColumnOptions& ExcelDataProviderBase::columnOptionsOf(unsigned key) const {
    static const ColumnOptions none;
    const auto options = _columnReadOptions.find(key);
    return options == _columnReadOptions.end() ? none : options->second;
}

SheetReadOptions& ExcelDataProviderBase::plainOptions(unsigned key) const {
    return _sheetReadOptions[key];
}

SheetReadOptions& ExcelDataProviderBase::optionsWithDefaultSetting(unsigned key) const {
    const auto [options, made] = _sheetReadOptions.try_emplace(key);
    if (made && _defaultVariableNameRowSetting != EVariableNameRowSetting{kNotSet})
        options->second.variableNameRowSetting = _defaultVariableNameRowSetting;
    return options->second;
}

bool ExcelDataProviderBase::isExcluded(unsigned key) const {
    const auto options = _sheetReadOptions.find(key);
    return options != _sheetReadOptions.end() && options->second.exclude;
}

}  // namespace dp
