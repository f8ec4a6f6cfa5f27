#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

#include "dpxlsx/model/columns.h"
#include "dpxlsx/store/conversion.h"
#include "dpxlsx/store/read_options.h"
#include "dpxlsx/store/row_layout.h"

// Columns built from stored cells, in one pass in row order: numeric_loading.cpp and
// text_loading.cpp.
namespace dp {

// How a column identifies itself to the host.
struct ColumnIdentity {
    template <class Column>
    void applyTo(Column& column) const {
        column.name = name;
        column.primeKey = column.variableBodyPrimeKey = key;
        column.useDefaultVariableBody = key == 0;
        column.position = static_cast<std::int32_t>(position + 1);
    }

    std::string name;
    int key;
    std::uint32_t position;  // 0-based
};

// A preview converts the first 101 values of a column, up to this slot. Later ones are the initial
// missing value, whatever the host has set since, or empty texts.
inline constexpr std::uint32_t kLastPreviewSlot = 100;

// How a column is to be read. Texts and formats are borrowed for the duration of a load.
struct LoadSettings {
    ConversionSettings conversion;
    RowLayout layout;
    std::uint32_t rowCount;  // rows that the column gets
    bool previewing;
    const CellFormats& formats;
    std::string_view missingTextFrom;
    std::string_view missingTextTo;
};

// Whether rows without a cell, between two cells, receive the host's replacement for missing
// numbers.
bool replacesMissingNumbers(const ConversionSettings& settings);

// A new numeric or date-time column. `requested` is the kind that a column option asks for;
// `firstCellType` tells how the first data cell is shown.
std::unique_ptr<NumericColumn> loadNumericColumn(const CellColumn& cells,
                                                 const ColumnIdentity& identity,
                                                 const LoadSettings& settings,
                                                 IVariable::BasicDataType requested,
                                                 IVariableFormat::FormatType firstCellType);

// A new text column.
std::unique_ptr<TextColumn> loadTextColumn(const CellColumn& cells, const ColumnIdentity& identity,
                                           const LoadSettings& settings);

}  // namespace dp
