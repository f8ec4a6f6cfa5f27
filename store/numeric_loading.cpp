#include <algorithm>

#include "dpxlsx/formats/date_time_variable_format.h"
#include "dpxlsx/formats/numeric_variable_format.h"
#include "dpxlsx/store/column_loading.h"

namespace dp {

namespace {

using BasicDataType = IVariable::BasicDataType;
using FormatType = IVariableFormat::FormatType;

// A preview converts the first 101 values, up to this slot, and fills the rest with the missing
// value that is set initially, whatever missing value the host has set since.
constexpr std::uint32_t kLastPreviewSlot = 100;
constexpr double kPreviewFiller = 1.23456e30;

std::unique_ptr<IVariableFormat> automaticNumericFormat() {
    auto format = std::make_unique<NumericVariableFormat>();
    format->autoFormat = true;
    return format;
}

std::unique_ptr<IVariableFormat> automaticDateTimeFormat() {
    auto format = std::make_unique<DateTimeVariableFormat>();
    format->autoFormat = true;
    return format;
}

// The format of a column by the first cell that has a value.
std::unique_ptr<IVariableFormat> inferFormat(const CellContent& cell, BasicDataType requested,
                                             const CellFormats& formats) {
    if (requested == BasicDataType::Numeric) {
        if (cell.formatIndex >= 0)
            if (auto format = formats.create(cell); format->GetType() == FormatType::Numeric)
                return format;
        return automaticNumericFormat();
    }
    if (requested == BasicDataType::DateTime) {
        if (cell.formatIndex != -1)
            if (auto format = formats.create(cell); format->GetType() == FormatType::DateTime)
                return format;
        return automaticDateTimeFormat();
    }
    return formats.create(cell);
}

// The pattern by which further texts are read as date-times; null unless the format has one.
const IString* patternOf(const IVariableFormat& format) {
    if (format.GetType() != FormatType::DateTime) return nullptr;
    return static_cast<const IDateTimeVariableFormat&>(format).GetFormatString();
}

class NumericLoad {
  public:
    NumericLoad(NumericColumn& column, const LoadSettings& settings, BasicDataType requested,
                FormatType firstCellType)
        : column_(column),
          settings_(settings),
          requested_(requested),
          asDateTime_(requested == BasicDataType::DateTime ||
                      firstCellType == FormatType::DateTime),
          replacesMissing_(replacesMissingNumbers(settings.conversion)),
          plainNumbers_(!(asDateTime_ && settings.conversion.dateTimeHelper) &&
                        !settings.conversion.alphaMissingNumericSet) {}

    // Whether any cell was handled.
    bool run(const CellColumn& cells) {
        const std::uint32_t firstRow = settings_.layout.firstDataRow;
        std::uint32_t expectedRow = firstRow;
        std::uint32_t slot = 0;
        bool handled = false;
        const auto end = cells.end();
        for (auto cell = cells.lower_bound(firstRow); cell != end && slot < settings_.rowCount;
             ++cell) {
            const auto [row, content] = *cell;
            if (row != expectedRow) slot += passGap(expectedRow, row);
            if (slot >= settings_.rowCount) break;
            expectedRow = row + 1;
            handled = true;
            store(content, slot);
            ++slot;
        }
        return handled;
    }

  private:
    std::uint32_t passGap(std::uint32_t expectedRow, std::uint32_t row) {
        const Gap gap = gapBefore(settings_.layout, expectedRow, row);
        if (replacesMissing_)
            fillGap(gap, settings_.rowCount, [&](std::size_t slot) {
                column_.values[slot] = settings_.conversion.missingNumericTo;
            });
        return gap.slots;
    }

    // CellView is passed by value to stay in registers: passed by reference it costs more than the
    // rest of the loop.
    void store(CellView cell, std::uint32_t slot) {
        const double value = valueOf(cell, slot);
        column_.values[slot] = value;
        if (value == settings_.conversion.missingValue) return;
        --column_.missingCount;
        if (!column_.format) takeFormat(cell);
    }

    double valueOf(CellView cell, std::uint32_t slot) {
        if (settings_.previewing && slot > kLastPreviewSlot) return kPreviewFiller;
        bool converted = false;
        const double value = plainNumbers_ && isNumber(cell.type())
                                 ? plainNumber(cell.numValue(), converted)
                                 : convert(cell, converted);
        if (converted) ++column_.convertedMissingCount;
        return value;
    }

    bool isNumber(ExternalCellType type) const {
        return type == CELL_NUMBER ||
               (type == CELL_DATETIME && !settings_.conversion.convertDateTimeToText);
    }

    double plainNumber(double value, bool& converted) const {
        const ConversionSettings& conversion = settings_.conversion;
        if (value == conversion.missingNumericFrom) value = conversion.missingNumericTo;
        return inRange(value, conversion, converted);
    }

    double convert(CellView cell, bool& converted) const {
        return cellToNumber(CellContent(cell), asDateTime_, pattern_, settings_.conversion,
                            converted);
    }

    void takeFormat(CellView cell) {
        column_.format = inferFormat(CellContent(cell), requested_, settings_.formats);
        pattern_ = patternOf(*column_.format);
    }

    NumericColumn& column_;
    const LoadSettings& settings_;
    const BasicDataType requested_;
    const bool asDateTime_;
    const bool replacesMissing_;
    const bool plainNumbers_;  // numbers and date-times need neither the helper nor the cell's text
    const IString* pattern_ = nullptr;
};

}  // namespace

bool replacesMissingNumbers(const ConversionSettings& settings) {
    return settings.missingNumericFrom == settings.missingValue && !settings.alphaMissingNumericSet;
}

std::unique_ptr<NumericColumn> loadNumericColumn(const CellColumn& cells,
                                                 const ColumnIdentity& identity,
                                                 const LoadSettings& settings,
                                                 BasicDataType requested,
                                                 FormatType firstCellType) {
    auto column = std::make_unique<NumericColumn>();
    column->name = identity.name;
    column->primeKey = column->variableBodyPrimeKey = identity.key;
    column->useDefaultVariableBody = identity.key == 0;
    column->position = static_cast<std::int32_t>(identity.position + 1);
    column->dataType =
        requested == BasicDataType::DateTime ? NumericColumn::kDateTimes : NumericColumn::kNumbers;
    column->formatDirty = true;
    // A column with neither a name nor a data cell has no rows, whatever the layout says.
    const bool hasData = cells.lower_bound(settings.layout.firstDataRow) != cells.end();
    const std::uint32_t rowCount = hasData || !identity.name.empty() ? settings.rowCount : 0;
    column->rowCount = column->missingCount = static_cast<std::int32_t>(rowCount);
    column->values.reset(new double[rowCount]);
    std::fill_n(column->values.get(), rowCount, settings.conversion.missingValue);

    NumericLoad load(*column, settings, requested, firstCellType);
    const bool handled = load.run(cells);

    if (!column->format)
        column->format = column->dataType == NumericColumn::kDateTimes ? automaticDateTimeFormat()
                                                                       : automaticNumericFormat();
    if (column->format->GetType() == FormatType::DateTime)
        column->dataType = NumericColumn::kDateTimes;
    if (identity.name.empty() && !handled) column->rowCount = column->missingCount = 0;
    return column;
}

}  // namespace dp
