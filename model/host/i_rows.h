#pragma once

#include "model/host/export.h"

namespace dp {

// A selection of rows.
class DPXLSX_API IRows {
  public:
    virtual ~IRows() = default;

    virtual bool UseAllRows() const = 0;
    virtual int GetRowCount() const = 0;
    // The listed row numbers, owned by the selection. Null pointers are skipped.
    virtual void GetRows(int* count, const int** rows) const = 0;
};

}  // namespace dp
