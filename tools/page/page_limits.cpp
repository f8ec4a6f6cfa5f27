#include "tools/page/page_limits.h"

#include <algorithm>

namespace dp::tool {

PageLimits pageLimits(size_t columns, std::optional<size_t> rows) {
    constexpr size_t kCells = 20000;
    constexpr size_t kBytesOfTexts = 1000000;
    constexpr size_t kManyColumns = 500;
    const size_t some = std::max<size_t>(columns, 1);
    const size_t shown = rows.value_or(std::clamp<size_t>(kCells / some, 5, 50));
    const size_t cells = std::max<size_t>(some * shown, 1);
    const bool many = columns > kManyColumns;
    return {shown, std::clamp<size_t>(kBytesOfTexts / cells, 40, 200), many ? 5U : 8U,
            many ? 16U : 24U, many ? 48U : 80U};
}

}  // namespace dp::tool
