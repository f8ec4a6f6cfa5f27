#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace dp::tool {

// Counts equal texts.
class TextCounts {
  public:
    struct Entry {
        std::string text;
        size_t count;
        size_t row;  // of the first one
    };

    void add(const std::string& text, size_t row);
    // The number of different texts.
    size_t different() const { return counts_.size(); }
    // The most frequent ones, at most `most`; of equally frequent ones those that come first.
    std::vector<Entry> mostFrequent(size_t most) const;

  private:
    struct Count {
        size_t count;
        size_t row;
    };

    std::unordered_map<std::string, Count> counts_;
};

// The beginning of a text in UTF-8: at most `bytes`, without a part of a character at its end.
std::string_view beginning(std::string_view text, size_t bytes);

// The number of characters in UTF-8.
size_t characterCount(std::string_view text);

}  // namespace dp::tool
