#pragma once

#include "export.h"

namespace dp {

// An object whose life is counted. Counts are plain integers that start at 0: whoever receives the
// object takes the first reference with AddRef. Not safe from two threads. Hosts never delete such
// an object themselves.
class DPXLSX_API IResource {
  public:
    virtual ~IResource() = default;

    // Takes a reference; returns the new count.
    virtual unsigned AddRef() = 0;
    // Gives a reference back; the object is deleted when the count comes to 0. Without an AddRef
    // before, it does nothing, and debug builds of the library stop.
    virtual void Release() = 0;
};

}  // namespace dp
