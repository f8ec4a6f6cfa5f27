#pragma once

#include <cstdint>
#include <string>
#include <unordered_set>

#include "readers/limits.h"

namespace dp {

// The worksheet parts that were read. Any number of sheets may name the same one: a small file
// could take any time.
class RepeatedParts {
  public:
    // To be called before a part is read. Throws CmXmlException when too much was read again.
    void visit(const std::string& path);

  private:
    std::unordered_set<std::string> paths_;
    std::uint64_t left_ = kRepeatedReading;  // bytes
};

}  // namespace dp
