#pragma once

#include <cstddef>
#include <optional>

namespace dp::tool {

// How much of a workbook its page shows, so that a browser opens it at once.
struct PageLimits {
    size_t rows;       // the first ones, with their values
    size_t bytes;      // of a text
    size_t frequent;   // texts of a column
    size_t bins;       // of a distribution
    size_t stretches;  // of rows, where values are missing
};

// The limits for so many columns in all worksheets: the more columns, the less of each. `rows` is
// the number of rows that the user asks for.
PageLimits pageLimits(size_t columns, std::optional<size_t> rows);

}  // namespace dp::tool
