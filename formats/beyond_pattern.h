#pragma once

namespace dp {

// A base of the date-time formats that show more than their pattern says: elapsed times, and values
// by sections. A host's helper, which gets the pattern, would show something else.
class BeyondPattern {
  public:
    virtual ~BeyondPattern() = default;
};

}  // namespace dp
