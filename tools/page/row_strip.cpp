#include "tools/page/row_strip.h"

#include <algorithm>

namespace dp::tool {

RowStrip::RowStrip(size_t rows, size_t mostStretches)
    : rows_(rows), counts_(std::min(rows, mostStretches)) {}

bool RowStrip::empty() const {
    return std::all_of(counts_.begin(), counts_.end(), [](size_t count) { return count == 0; });
}

}  // namespace dp::tool
