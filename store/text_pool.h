#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string_view>
#include <unordered_map>

#include "dpxlsx/store/pooled_text.h"
#include "dpxlsx/store/short_texts.h"

namespace dp {

// Keeps every distinct text once, until the pool is destroyed. Not thread-safe.
class TextPool {
  public:
    // Only tests set the limit on the pages of short texts: all of them is 16 GB.
    explicit TextPool(std::size_t mostPages = ShortTexts::kMostPages) : short_(mostPages) {}
    TextPool(const TextPool&) = delete;
    TextPool& operator=(const TextPool&) = delete;

    // The handle of the pool's copy of `text`, which is added when it is new. Throws
    // std::bad_alloc, which leaves the pool unchanged. Reads all of `text` even when it is known:
    // keep the handle to file one long text many times.
    PooledText intern(std::string_view text);

    // The same in two steps, so that the lookups of many texts can overlap: begin, which throws as
    // intern does, and deliverTo, which names where the bits of the handle are written. That
    // happens at once or in a later call, in settle at the latest; `bits` must stay valid until
    // then.
    void begin(std::string_view text);
    void deliverTo(std::uint64_t& bits) noexcept;
    // Writes all handles that have not been written yet.
    void settle() noexcept;

    // Number of distinct texts, the empty one not counted.
    std::size_t size();

  private:
    static_assert(PooledText::kLong == ShortTexts::kLongest + 1);

    PooledText internLong(std::string_view text);

    ShortTexts short_;
    // Long texts, and short ones that short_ has no room for.
    std::unordered_map<std::string_view, std::unique_ptr<char[]>, TextHash> long_;
    PooledText recent_;     // a recent text, against which the next one is compared
    bool isRecent_ = true;  // recent_ is the text begun last; otherwise short_ looks it up
};

}  // namespace dp
