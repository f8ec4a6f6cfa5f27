#pragma once

#include <malloc.h>

#include <cstddef>

namespace testkit {

// The bytes that are allocated now; always the same number under a sanitizer, which has memory of
// its own.
inline std::size_t allocatedBytes() {
    const auto info = mallinfo2();
    return info.uordblks + info.hblkhd;
}

}  // namespace testkit
