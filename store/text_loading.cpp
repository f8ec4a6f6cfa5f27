#include <algorithm>
#include <utility>

#include "dpxlsx/formats/text_variable_format.h"
#include "dpxlsx/store/column_loading.h"
#include "dpxlsx/store/text_cleaning.h"

namespace dp {

namespace {

class TextLoad {
  public:
    TextLoad(TextColumn& column, TextVariableFormat& format, const LoadSettings& settings)
        : column_(column), format_(format), settings_(settings), formats_(settings.formats) {}

    // Whether any cell was handled.
    bool run(const CellColumn& cells) {
        return walkDataCells(
            cells, settings_.layout, settings_.rowCount, [this](const Gap& gap) { passGap(gap); },
            [this](const CellView& cell, std::uint32_t slot) { store(cell, slot); });
    }

  private:
    std::string& textAt(std::size_t slot) { return column_.textValues.items[slot].text(); }

    void passGap(const Gap& gap) {
        if (!settings_.missingTextFrom.empty()) return;
        fillGap(gap, settings_.rowCount,
                [&](std::size_t slot) { textAt(slot) = settings_.missingTextTo; });
    }

    void store(const CellView& cell, std::uint32_t slot) {
        std::string& text = textAt(slot);
        if (settings_.previewing && slot > kLastPreviewSlot)
            text.clear();
        else
            cellToText(CellContent(cell), settings_.conversion, formats_, text);
        if (isAllSpaces(text)) text.clear();
        if (text == settings_.missingTextFrom) text = settings_.missingTextTo;
        cutToBytes(text, settings_.conversion.maxTextLength, settings_.conversion.textCut);
        if (!text.empty()) --column_.missingCount;
        format_.characterCount =
            std::max(format_.characterCount, static_cast<std::int32_t>(text.size()));
    }

    TextColumn& column_;
    TextVariableFormat& format_;
    const LoadSettings& settings_;
    FormatCache formats_;
};

}  // namespace

std::unique_ptr<TextColumn> loadTextColumn(const CellColumn& cells, const ColumnIdentity& identity,
                                           const LoadSettings& settings) {
    auto column = std::make_unique<TextColumn>();
    identity.applyTo(*column);
    column->formatDirty = true;
    auto format = std::make_unique<TextVariableFormat>();
    format->characterCount = 1;
    // A column without a data cell has no rows, whatever the layout says.
    const bool hasData = cells.lower_bound(settings.layout.firstDataRow) != cells.end();
    const std::uint32_t rowCount = hasData ? settings.rowCount : 0;
    column->rowCount = column->missingCount = static_cast<std::int32_t>(rowCount);
    column->textValues.items.resize(rowCount);

    TextLoad load(*column, *format, settings);
    if (!load.run(cells)) {
        column->rowCount = column->missingCount = 0;
        column->textValues.items.clear();
    }
    column->format = std::move(format);
    return column;
}

}  // namespace dp
