#include "dpxlsx/model/columns.h"
#include "dpxlsx/provider/excel_data_provider_base.h"
#include "dpxlsx/store/column_loading.h"
#include "dpxlsx/store/row_layout.h"

// Derives the rows of a worksheet from read options and stored cells. The results are kept: cells
// and column options that come later do not change them.
namespace dp {

void ExcelDataProviderBase::CalculateRowOffsets(unsigned key) const {
    SheetReadOptions& options = optionsWithDefaultSetting(key);
    if (options.exclude) return;
    makeRowsZeroBased(options);
    if (options.variableNameRowSetting == VNR_INFER)
        InferVariableNameRow(key);
    else
        placeRows(options);
}

void ExcelDataProviderBase::InferVariableNameRow(unsigned key) const {
    SheetReadOptions& options = optionsWithDefaultSetting(key);
    if (options.variableNameRowSetting != VNR_INFER || options.exclude || !worksheetExists(key))
        return;
    inferRows(options, cellsOf(key));
}

void ExcelDataProviderBase::FindLastRow(unsigned key) const {
    if (!worksheetExists(key) || !(_ignoreBlankRows || _padColumnsWithMissing) ||
        _lastRows.count(key) != 0 || isExcluded(key))
        return;
    _lastRows[key] = lastRow(cellsOf(key));
}

void ExcelDataProviderBase::FindBlankRows(unsigned key) const {
    if (!worksheetExists(key) || !_ignoreBlankRows || _blankRows.count(key) != 0 || isExcluded(key))
        return;
    const ColumnOptions& options = columnOptionsOf(key);
    const auto counts = [&options](std::uint32_t column) {
        const auto option = options.find(column + 1);
        return option == options.end() || !option->second.exclude;
    };
    // [] on purpose, here and in GetLoadColumnRowCount: a worksheet whose last row has not been
    // determined gets row 0 and keeps it, so that all later answers agree with this one.
    _blankRows[key] = findBlankRows(cellsOf(key), _lastRows[key], counts);
}

RowLayout ExcelDataProviderBase::rowLayout(unsigned key) const {
    const SheetReadOptions& options = plainOptions(key);
    RowLayout layout{options.firstDataRow, options.dataRowCount, nullptr};
    const auto blank = _blankRows.find(key);
    if (_ignoreBlankRows && blank != _blankRows.end()) layout.blankRows = &blank->second;
    return layout;
}

unsigned ExcelDataProviderBase::GetLoadColumnRowCount(unsigned key,
                                                      const CellColumn& column) const {
    const RowLayout layout = rowLayout(key);
    if (!_padColumnsWithMissing) return unpaddedRowCount(layout, column);
    const bool hasData = column.lower_bound(layout.firstDataRow) != column.end();
    if (hasData || !variableNameInSheet(key, column).empty())
        return rowCountUpTo(layout, _lastRows[key]);
    return column.empty() ? 0 : rowCountUpTo(layout, column.rbegin()->first);
}

unsigned ExcelDataProviderBase::HandleBlankRows(INumericColumn* column, unsigned key,
                                                unsigned expectedRow, unsigned rowCount,
                                                CellColumn::const_iterator cell) const {
    const Gap gap = gapBefore(rowLayout(key), expectedRow, cell->first);
    if (replacesMissingNumbers(conversionSettings())) {
        double* values = static_cast<NumericColumn*>(column)->values.get();
        fillGap(gap, rowCount, [&](std::size_t slot) { values[slot] = _missingNumericTo; });
    }
    return gap.slots;
}

}  // namespace dp
