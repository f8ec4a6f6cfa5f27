#pragma once

#include <string_view>

#include "dpxlsx/model/host/export.h"

namespace dp {

// A text kept by a TextPool, one pointer wide; valid as long as that pool. Within one pool two
// handles are equal exactly when their texts are.
class DPXLSX_API PooledText {
  public:
    PooledText() = default;  // the empty text, of every pool

    // Not terminated by a zero; never a null pointer.
    std::string_view view() const {
        if (!stored_) return "";
        const auto length = static_cast<unsigned char>(*stored_);
        return length < kLong ? std::string_view(stored_ + 1, length) : longView();
    }

    friend bool operator==(PooledText, PooledText) = default;

  private:
    friend class TextPool;

    // In place of the one-byte length of a short text: the length follows as a std::size_t.
    static constexpr unsigned char kLong = 255;

    explicit PooledText(const char* stored) : stored_(stored) {}
    std::string_view longView() const;

    // The length in one byte, or kLong and the length as a std::size_t, then the text.
    const char* stored_ = nullptr;
};

}  // namespace dp
