#pragma once

#include <optional>
#include <string>
#include <vector>

#include "tools/host/column.h"
#include "tools/page/distribution.h"
#include "tools/page/page_limits.h"
#include "tools/page/row_strip.h"
#include "tools/page/text_counts.h"

namespace dp::tool {

// A cell whose content did not fit the kind of its column.
struct ConvertedCell {
    size_t row;  // 0-based
    std::string content;
};

// What a page tells of all values of a column.
struct ColumnSummary {
    ColumnSummary(size_t rows, const PageLimits& limits)
        : missing(rows, limits.stretches), converted(rows, limits.stretches) {}

    Distribution numbers;  // numbers and serial day numbers, or the lengths of texts in characters
    TextCounts texts;
    RowStrip missing;
    RowStrip converted;  // of the missing ones, those that had content
    TextCounts contents;
    std::vector<ConvertedCell> firstConverted;  // those in the first rows
};

// The summary of a column of a worksheet with `rows` rows. `texts` is the same column loaded as
// texts, which have the content of what is missing; without it no cell counts as converted.
ColumnSummary summaryOf(const Column& column, const std::optional<Column>& texts, size_t rows,
                        const PageLimits& limits);

}  // namespace dp::tool
