#pragma once

#include "export.h"

namespace dp {

// A list that the host may only read. It belongs to the object that handed it out and is never to
// be deleted by the host.
template <class T>
class DPXLSX_API IReadOnlyCollection {
  public:
    virtual ~IReadOnlyCollection() = default;

    // The number of elements.
    virtual unsigned long Count() const = 0;
    // Element `index`, 0-based; it must be below Count(), which is not checked. A text is the
    // stored one, valid as long as the collection.
    virtual T Item(unsigned long index) const = 0;
};

}  // namespace dp
