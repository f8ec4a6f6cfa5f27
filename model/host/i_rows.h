#pragma once

#include "export.h"

namespace dp {

// A selection of rows, for the host's own use: an import makes none, and the numbering of the rows
// is the host's.
class DPXLSX_API IRows {
  public:
    virtual ~IRows() = default;

    // True when the selection stands for all rows, whatever it lists.
    virtual bool UseAllRows() const = 0;
    // The row count that the maker of the selection set; GetRows counts the listed rows.
    virtual int GetRowCount() const = 0;
    // The number of listed rows and their numbers, which belong to the selection. `*rows` must not
    // be read when `*count` is 0. Null pointers are skipped.
    virtual void GetRows(int* count, const int** rows) const = 0;
};

}  // namespace dp
