#pragma once

#include <cstddef>
#include <cstdint>
#include <string>

#include "readers/limits.h"

namespace dp {

// How many bytes of text the cells of a package may hold in all, by the size of its parts. One
// shared string may stand in every cell: a small file could fill any memory.
class TextBudget {
  public:
    // Grows by the size of a part that is read; a part that is not there has none.
    void addPart(const std::string& path);
    // Throws CmXmlException when the cells hold too much with this text of `size` bytes.
    void spend(std::size_t size);

  private:
    std::uint64_t left_ = kTextAllowance;
};

}  // namespace dp
