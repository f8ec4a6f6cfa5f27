#pragma once

#include <cstddef>
#include <vector>

namespace dp::tool {

// The rows of a worksheet in stretches of equal length, with the number of rows of each that are
// noted. Row r is in stretch r * stretches / rows, rounded down.
class RowStrip {
  public:
    RowStrip(size_t rows, size_t mostStretches);

    void note(size_t row) { ++counts_[row * counts_.size() / rows_]; }
    bool empty() const;
    const std::vector<size_t>& counts() const { return counts_; }

  private:
    size_t rows_;
    std::vector<size_t> counts_;
};

}  // namespace dp::tool
