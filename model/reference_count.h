#pragma once

#include <cassert>

namespace dp {

// Lowers `count`; true when the object is to be deleted now. A Release without its AddRef is a
// mistake of the host: asserted in debug builds, ignored in release builds.
template <class Count>
bool releaseReference(Count& count) {
    assert(count != 0 && "Release without AddRef");
    return count != 0 && --count == 0;
}

}  // namespace dp
