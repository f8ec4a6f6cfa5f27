#pragma once

#include <cstdint>
#include <set>
#include <string>

#include "dpxlsx/readers/limits.h"

namespace dp {

// Limits how often worksheet parts are read again. Any number of sheets may name the same part, so
// without a limit a small file could take any time.
class RepeatedParts {
  public:
    // To be called before a part is read. Throws CmXmlException when too much was read again.
    void visit(const std::string& path);

  private:
    std::set<std::string> paths_;            // ordered: hashes could be made to collide
    std::uint64_t left_ = kRepeatedReading;  // bytes
};

}  // namespace dp
