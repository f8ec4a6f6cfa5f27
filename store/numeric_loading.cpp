#include <algorithm>

#include "dpxlsx/formats/automatic_format.h"
#include "dpxlsx/formats/date_time_variable_format.h"
#include "dpxlsx/store/column_loading.h"

namespace dp {

namespace {

using BasicDataType = IVariable::BasicDataType;
using FormatType = IVariableFormat::FormatType;

std::unique_ptr<IVariableFormat> automaticFormat(BasicDataType requested) {
    if (requested == BasicDataType::DateTime) return std::make_unique<DateTimeVariableFormat>();
    return createAutomaticFormat();
}

// The format of a column by the first cell that has a value.
std::unique_ptr<IVariableFormat> inferFormat(const CellContent& cell, BasicDataType requested,
                                             const CellFormats& formats) {
    if (requested == BasicDataType::Numeric) {
        if (cell.formatIndex >= 0)
            if (auto format = formats.create(cell); format->GetType() == FormatType::Numeric)
                return format;
        return automaticFormat(requested);
    }
    if (requested == BasicDataType::DateTime) {
        if (cell.formatIndex != -1)
            if (auto format = formats.create(cell); format->GetType() == FormatType::DateTime)
                return format;
        return automaticFormat(requested);
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
        return walkDataCells(
            cells, settings_.layout, settings_.rowCount, [this](const Gap& gap) { passGap(gap); },
            [this](CellView cell, std::uint32_t slot) { store(cell, slot); });
    }

  private:
    void passGap(const Gap& gap) {
        if (!replacesMissing_) return;
        fillGap(gap, settings_.rowCount, [&](std::size_t slot) {
            column_.values[slot] = settings_.conversion.missingNumericTo;
        });
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
        if (settings_.previewing && slot > kLastPreviewSlot) return kInitialMissingValue;
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
    identity.applyTo(*column);
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

    if (!column->format) column->format = automaticFormat(requested);
    if (column->format->GetType() == FormatType::DateTime)
        column->dataType = NumericColumn::kDateTimes;
    if (identity.name.empty() && !handled) column->rowCount = column->missingCount = 0;
    return column;
}

}  // namespace dp
