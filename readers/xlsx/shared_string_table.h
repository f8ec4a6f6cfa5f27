#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace dp {

// Texts by index, stored back to back in memory, and four bytes more for each.
class SharedStringTable {
  public:
    SharedStringTable() = default;
    // Keeps only `endBits` bits of a text's end in place; tests set fewer than the usual 32.
    explicit SharedStringTable(unsigned endBits) : endBits_(endBits) {}

    void clear();
    // Throws std::bad_alloc.
    void reserve(std::size_t count) { ends_.reserve(count); }
    void add(std::string_view text);

    std::size_t size() const { return ends_.size(); }
    // The text at `index` (0-based), which is below size(). Valid until the table changes.
    std::string_view operator[](std::size_t index) const {
        const std::size_t begin = index == 0 ? 0 : endOf(index - 1);
        return std::string_view(bytes_).substr(begin, endOf(index) - begin);
    }

    // Prefetch what operator[] reads: the first call the position of the text, the second the text
    // itself, for which the position should have arrived.
    void fetchPlace(std::size_t index) const { __builtin_prefetch(&ends_[index]); }
    void fetchText(std::size_t index) const {
        __builtin_prefetch(bytes_.data() + (index == 0 ? 0 : endOf(index - 1)));
    }

  private:
    std::size_t endOf(std::size_t index) const {
        return carries_.empty() ? ends_[index] : farEndOf(index);
    }
    std::size_t farEndOf(std::size_t index) const;

    std::string bytes_;
    unsigned endBits_ = 32;
    std::vector<std::uint32_t> ends_;   // the low bits, endBits_ of them
    std::vector<std::size_t> carries_;  // [n]: the first text whose end has high bits beyond n
};

}  // namespace dp
