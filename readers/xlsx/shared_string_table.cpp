#include "dpxlsx/readers/xlsx/shared_string_table.h"

#include <algorithm>

namespace dp {

void SharedStringTable::clear() { *this = SharedStringTable(endBits_); }

void SharedStringTable::add(std::string_view text) {
    const std::size_t end = bytes_.size() + text.size();
    carries_.resize(end >> endBits_, ends_.size());
    bytes_ += text;
    ends_.push_back(static_cast<std::uint32_t>(end & ((std::size_t{1} << endBits_) - 1)));
}

std::size_t SharedStringTable::farEndOf(std::size_t index) const {
    const auto carries = std::upper_bound(carries_.begin(), carries_.end(), index);
    return static_cast<std::size_t>(carries - carries_.begin()) << endBits_ | ends_[index];
}

}  // namespace dp
