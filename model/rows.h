#pragma once

#include <cstdint>
#include <vector>

#include "dpxlsx/model/host/i_rows.h"

namespace dp {

// A selection of rows for the host's use; no import makes one.
class DPXLSX_API CRows : public IRows {
  public:
    CRows();
    CRows(const CRows& other);
    CRows& operator=(const CRows& other);
    ~CRows() override;

    bool UseAllRows() const override;
    int GetRowCount() const override;
    // Counts the listed rows, whatever GetRowCount() says.
    void GetRows(int* count, const int** listed) const override;

    bool useAllRows = false;
    std::int32_t rowCount = 0;
    std::vector<int> rows;
};

}  // namespace dp
