#include "dpxlsx/readers/xlsx/shared_string_table.h"

#include <algorithm>

namespace dp {

void SharedStringTable::clear() { *this = {}; }

void SharedStringTable::add(std::string_view text) {
    constexpr unsigned kHalf = 32;
    const std::size_t carries = ((bytes_.size() + text.size()) >> kHalf) - carries_.size();
    carries_.insert(carries_.end(), carries, ends_.size());
    bytes_ += text;
    ends_.push_back(static_cast<std::uint32_t>(bytes_.size()));
}

std::size_t SharedStringTable::farEndOf(std::size_t index) const {
    const auto carries = std::upper_bound(carries_.begin(), carries_.end(), index);
    return static_cast<std::size_t>(carries - carries_.begin()) << 32 | ends_[index];
}

}  // namespace dp
