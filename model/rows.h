#pragma once

#include <cstdint>
#include <vector>

#include "model/host/i_rows.h"

namespace dp {

// A selection of rows for the host's use; no import makes one.
class DPXLSX_API CRows : public IRows {
  public:
    CRows() = default;

    bool UseAllRows() const override { return useAllRows; }
    int GetRowCount() const override { return rowCount; }
    // Counts the listed rows, whatever GetRowCount() says.
    void GetRows(int* count, const int** listed) const override {
        if (count) *count = static_cast<int>(rows.size());
        if (listed) *listed = rows.data();
    }

    bool useAllRows = false;
    std::int32_t rowCount = 0;
    std::vector<int> rows;
};

}  // namespace dp
