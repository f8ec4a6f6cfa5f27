#include "dpxlsx/store/pooled_text.h"

#include <cstddef>
#include <cstring>

namespace dp {

std::string_view PooledText::longView() const {
    std::size_t length;
    std::memcpy(&length, stored_ + 1, sizeof length);
    return {stored_ + 1 + sizeof length, length};
}

}  // namespace dp
