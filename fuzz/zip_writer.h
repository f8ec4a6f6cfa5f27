#pragma once

#include <cstdint>
#include <string>

namespace fuzz {

// Builds a ZIP archive in memory, valid unless told otherwise.
class ZipWriter {
  public:
    struct Entry {
        std::string name;
        std::string content;
        bool deflated = true;
        bool wrongSum = false;
        std::uint32_t claimedSize = 0;  // bytes unpacked; 0 for the truth
    };

    void add(const Entry& entry);
    // The archive so far.
    std::string finished() const;

  private:
    std::string local_;
    std::string directory_;
    unsigned entries_ = 0;
};

}  // namespace fuzz
