#include "tools/page/column_summary.h"

#include <cmath>
#include <utility>

namespace dp::tool {

namespace {

void noteConverted(ColumnSummary& summary, size_t row, const std::string& content, size_t first) {
    summary.converted.note(row);
    summary.contents.add(content, row);
    if (row < first) summary.firstConverted.push_back({row, content});
}

}  // namespace

ColumnSummary summaryOf(const Column& column, const std::optional<Column>& texts, size_t rows,
                        const PageLimits& limits) {
    ColumnSummary summary(rows, limits);
    std::vector<double> numbers;
    for (size_t row = 0; row < column.rows(); ++row) {
        if (column.isMissing(row)) {
            summary.missing.note(row);
            const bool hadContent = texts && !texts->isMissing(row);
            if (hadContent) noteConverted(summary, row, texts->text(row), limits.rows);
        } else if (column.kind() == Kind::Text) {
            const std::string text = column.text(row);
            numbers.push_back(static_cast<double>(characterCount(text)));
            summary.texts.add(text, row);
        } else if (std::isfinite(column.number(row))) {
            numbers.push_back(column.number(row));
        }
    }
    summary.numbers = distributionOf(std::move(numbers), limits.bins);
    return summary;
}

}  // namespace dp::tool
