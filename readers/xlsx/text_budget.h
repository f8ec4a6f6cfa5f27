#pragma once

#include <cstddef>
#include <cstdint>
#include <string>

#include "dpxlsx/readers/limits.h"

namespace dp {

// Limits the total bytes of text in the cells of a package, by the size of its parts. One shared
// string may stand in every cell, so without a limit a small file could fill any memory.
class TextBudget {
  public:
    // Adds the size of a part that is read; nothing for a missing part.
    void addPart(const std::string& path);
    // Counts a text of `size` bytes. Throws CmXmlException when the cells then hold too much.
    void spend(std::size_t size);

  private:
    std::uint64_t left_ = kTextAllowance;
};

}  // namespace dp
