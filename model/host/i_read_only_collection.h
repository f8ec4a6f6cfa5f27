#pragma once

#include "model/host/export.h"

namespace dp {

// A list that the host may only read. It belongs to the object that handed it out.
template <class T>
class DPXLSX_API IReadOnlyCollection {
  public:
    virtual ~IReadOnlyCollection() = default;

    virtual unsigned long Count() const = 0;
    // Element `index`, 0-based; it must be below Count().
    virtual T Item(unsigned long index) const = 0;
};

}  // namespace dp
